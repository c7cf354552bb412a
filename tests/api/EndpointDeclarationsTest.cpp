// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include "api/Link.h"
#include "ostinet/Endpoint.h"

namespace Ostinet::Testing {
namespace {

TEST(Declarations, OfEndpointsAreComplete) {
  Link<Mutable<Receiver, bool, DataPacket const&, Source const&>>(&Receiver::WantsPacket);
  Link<Mutable<Receiver, void, DataPacket const&, Source const&>>(&Receiver::HandlePacket);

  Link<Mutable<Impl::Sender, void, DataPacket const&>>(&Impl::Sender::Send);
  Link<Mutable<Impl::Sender, void>>(&Impl::Sender::Flush);
  Link<Const<Impl::Sender, bool>>(&Impl::Sender::CanSend);

  Link<Const<Endpoint, int>>(&Endpoint::GetUniqueID);
  Link<Const<Endpoint, Entity>>(&Endpoint::GetEntity);
  Link<Const<Endpoint, UString, short>>(&Endpoint::GetChannelName);
  Link<Const<Endpoint, unsigned short>>(&Endpoint::GetChannels);
  Link<Const<Endpoint, UString>>(&Endpoint::GetEntityAndEndpointName);
  Link<Const<Endpoint, SlotID>>(&Endpoint::GetSlotID);
  Link<Const<Endpoint, bool>>(&Endpoint::HasConnections);
  Link<Const<Endpoint, bool>>(&Endpoint::IsDeviceCommon);
  Link<Const<Endpoint, boost::optional<bool>>>(&Endpoint::IsInterface);
  Link<Const<Endpoint, bool>>(&Endpoint::IsInternalSoftware);
  Link<Const<Endpoint, bool>>(&Endpoint::IsLoop);
  Link<Const<Endpoint, bool>>(&Endpoint::IsPrivate);
  Link<Const<Endpoint, bool>>(&Endpoint::IsSoftware);
  Link<Const<Endpoint, bool>>(&Endpoint::IsVirtual);
  Link<Const<Endpoint, bool>>(&Endpoint::SupportsBankSelect0);
  Link<Const<Endpoint, bool>>(&Endpoint::SupportsBankSelect32);
  Link<Const<Endpoint, bool>>(&Endpoint::SupportsClock);
  Link<Const<Endpoint, bool>>(&Endpoint::SupportsMTC);
  Link<Const<Endpoint, bool>>(&Endpoint::SupportsNotes);
  Link<Const<Endpoint, bool>>(&Endpoint::SupportsProgramChange);
  Link<Const<Endpoint, MatchData>>(&Endpoint::GetMatchData);
  Link<Const<Endpoint, MatchData>>(&Endpoint::GetShortMatchData);
  Link<Const<Endpoint, ObjectMatch, MatchData const&>>(&Endpoint::MatchToData);
  Link<Const<Endpoint, bool, MatchData const&>>(&Endpoint::MatchToShortData);
  Link<Static<bool, UString const&, UString const&, UString&>>(&Endpoint::MatchOpposingNames);
  Link<Static<bool, UString const&, UString const&, UString&, UString&, UString&>>(
      &Endpoint::MatchRelatedNames);

  Link<Const<Source, Source>>(&Source::GetDirectSource);
  Link<Const<Source, Destination>>(&Source::GetMatchingVirtualDestination);
  Link<Const<Source, void, Source const&>>(&Source::AddConnectedSource);
  Link<Const<Source, void, Source const&>>(&Source::RemoveConnectedSource);
  Link<Const<Source, int>>(&Source::CountConnectedSources);
  Link<Const<Source, Source, int>>(&Source::GetConnectedSource);
  Link<Const<Source, Receiver*>>(&Source::getDirectReceiver);
  Link<Const<Source, bool>>(&Source::hasDirectReceiver);
  Link<Const<Source, void, Receiver*>>(&Source::setDirectReceiver);

  Link<Const<Destination, Destination>>(&Destination::GetDirectDestination);
  Link<Const<Destination, Source>>(&Destination::GetMatchingVirtualSource);
  Link<Const<Destination, bool>>(&Destination::IsBroadcast);
  Link<Const<Destination, bool>>(&Destination::IsPregen);
  Link<Const<Destination, void, Destination const&>>(&Destination::AddConnectedDestination);
  Link<Const<Destination, void, Destination const&>>(&Destination::RemoveConnectedDestination);
  Link<Const<Destination, int>>(&Destination::CountConnectedDestinations);
  Link<Const<Destination, Destination, int>>(&Destination::GetConnectedDestination);
  Link<Const<Destination, std::unique_ptr<Impl::Sender>>>(&Destination::MakeSender);
  Link<Const<Destination, void, DataPacket const&>>(&Destination::SendOnePacket);
  Link<Const<Destination, void, TimeStamp, SysexRef const&>>(&Destination::SendSysex);
  Link<Const<Destination, void>>(&Destination::FlushOutput);
  Link<Const<Destination, double>>(&Destination::GetAdvanceScheduleTime);
  Link<Const<Destination, int>>(&Destination::CountModes);
  Link<Const<Destination, DestinationMode, int>>(&Destination::GetMode);
  Link<Const<Destination, int>>(&Destination::CountNameSets);
  Link<Const<Destination, DestinationNameSet, int>>(&Destination::GetNameSet);
  Link<Const<Destination, DestinationMode>>(&Destination::GetCurrentMode);
  Link<Const<Destination, DestinationNameSet, short>>(&Destination::GetCurrentNameSet);
  Link<Const<Destination, Patch, short>>(&Destination::GetCurrentPatch);
  Link<Const<Destination, PatchBank, short>>(&Destination::GetCurrentBank);
  Link<Const<Destination, Patch, short, PatchNumbers const&>>(&Destination::GetPatch);
  Link<Const<Destination, Names>>(&Destination::GetNames);
  Link<Const<Destination, void, Names const&>>(&Destination::SetNames);
  Link<Const<Destination, Names, PatchBank const&>>(&Destination::GetOverrideNames);
  Link<Const<Destination, void, PatchBank const&, Names const&>>(&Destination::SetOverrideNames);
  Link<Const<Destination, void, DestinationMode const&>>(&Destination::SendModeChange);
  Link<Const<Destination, void, short, Patch const&>>(&Destination::SendPatchChange);

  Link<Static<bool, Endpoint const&, Endpoint const&>>(&CompMIDIEndpointNames);

  Link<Static<ObjectFilter<Endpoint>&>>(&DirectEndpoint);
  Link<Static<ObjectFilter<Endpoint>&>>(&OnlineEndpoint);
  Link<Static<ObjectFilter<Endpoint>&>>(&PublicEndpoint);
  Link<Static<ObjectFilter<Endpoint>&>>(&SoftwareEndpoint);
  Link<Static<ObjectFilter<Endpoint>&>>(&DefinitelyInterfaceEndpoint);
  Link<Static<ObjectFilter<Endpoint>&>>(&DefinitelyNonInterfaceEndpoint);
  Link<Static<ObjectFilter<Endpoint>&>>(&CouldBeInterfaceEndpoint);
  Link<Static<ObjectFilter<Endpoint>&>>(&CouldBeNonInterfaceEndpoint);
  Link<Static<ObjectFilter<Endpoint>&>>(&EntitylessNonSoftwareEndpoint);
  Link<Static<ObjectFilter<Device>&>>(&DirectDevice);

  Link<Mutable<DestinationList, void, ObjectFilter<Endpoint> const&>>(&DestinationList::Reset);
  Link<Mutable<DestinationList, void, std::vector<ObjectFilter<Endpoint>>&>>(
      &DestinationList::Sort);

  Link<Mutable<SourceList, void, ObjectFilter<Endpoint> const&>>(&SourceList::Reset);
  Link<Mutable<SourceList, void, std::vector<ObjectFilter<Endpoint>>&>>(&SourceList::Sort);

  Link<Mutable<DeviceList, void, ObjectFilter<Device> const&>>(&DeviceList::Reset);
}

// A handle may be handed on wherever one of its base is wanted, and is made of the object behind.
static_assert(kIsImplicit<RCPtrMT<Impl::EndpointImpl>, Endpoint>, "");
static_assert(kIsImplicit<RCPtrMT<Impl::EndpointImpl>, Source>, "");
static_assert(kIsImplicit<RCPtrMT<Impl::DestinationImpl>, Destination>, "");
static_assert(sizeof(Endpoint) == kHandleSize, "");
static_assert(sizeof(Source) == kHandleSize, "");
static_assert(sizeof(Destination) == kHandleSize, "");
static_assert(Source::kObjectID == MatchObjectID(3), "");
static_assert(Destination::kObjectID == MatchObjectID(4), "");

static_assert(kIsImplicit<boost::function<bool(Endpoint const&)>, ObjectFilter<Endpoint>>, "");
static_assert(kIsExplicit<bool, ObjectFilter<Endpoint>>, "");
static_assert(kIsExplicit<ObjectFilter<Endpoint>, DestinationList>, "");
static_assert(kIsExplicit<ObjectFilter<Endpoint>, SourceList>, "");
static_assert(kIsExplicit<ObjectFilter<Device>, DeviceList>, "");
static_assert(std::is_base_of<std::vector<Destination>, DestinationList>::value, "");
static_assert(std::is_base_of<std::vector<Source>, SourceList>::value, "");
static_assert(std::is_base_of<std::vector<Device>, DeviceList>::value, "");

bool IsNamedA(Endpoint const& endpoint) { return endpoint.GetName() == UString("A"); }

TEST(Declarations, FiltersAreMadeOfFunctionsAndCombined) {
  boost::function<bool(Endpoint const&)> const function = IsNamedA;
  ObjectFilter<Endpoint> filter = function;
  EXPECT_FALSE(filter(Destination()));
  EXPECT_TRUE((!filter)(Source::kNoSource));
  EXPECT_TRUE((filter | ObjectFilter<Endpoint>())(Source()));
  EXPECT_FALSE((ObjectFilter<Endpoint>(false) & !filter)(Source()));
  filter |= ObjectFilter<Endpoint>(true);
  filter &= OnlineEndpoint();
  EXPECT_FALSE(filter(Destination::kNoDestination));
  ObjectFilter<Device> const direct = DirectDevice();
  EXPECT_FALSE(direct(Device()));
}

TEST(Declarations, ListsAreSortedByTheUsualFilters) {
  DestinationList destinations((ObjectFilter<Endpoint>()));
  destinations.Sort(DestinationList::sDefaultSortFilters);
  SourceList sources;
  sources.Sort(SourceList::sDefaultSortFilters);
  EXPECT_EQ(DestinationList::sDefaultSortFilters.size(), SourceList::sDefaultSortFilters.size());
}

class OpenSender : public Impl::Sender {
 public:
  void Send(DataPacket const& packet) override { sent += packet.length; }
  void Flush() override {}
  bool CanSend() const override { return true; }
  unsigned long long sent = 0;
};

TEST(Declarations, AHostMayWriteASenderOfItsOwn) {
  unsigned char const bytes[] = {0x90, 60, 64};
  OpenSender sender;
  static_cast<Impl::Sender&>(sender).Send(DataPacket{bytes, sizeof bytes, kNoTimeStamp});
  EXPECT_EQ(sender.sent, 3u);
}

}  // namespace
}  // namespace Ostinet::Testing
