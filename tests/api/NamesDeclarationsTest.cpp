// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include "api/Link.h"
#include "ostinet/Autodetect.h"
#include "ostinet/DeviceTypeCatalog.h"
#include "ostinet/NamesCatalog.h"

// What the catalogs of device types, names and questions to instruments look like to hosts.

namespace Ostinet::Testing {
namespace {

static_assert(
    sizeof(Link<Mutable<Autodetect::Matcher, Autodetect::Matcher&, Autodetect::Matcher const&>>(
        &Autodetect::Matcher::operator=)) > 0,
    "");
static_assert(sizeof(Link<Const<Autodetect::Matcher, size_t>>(&Autodetect::Matcher::Start)) > 0,
              "");
static_assert(sizeof(Link<Const<Autodetect::Matcher, size_t>>(&Autodetect::Matcher::Success)) > 0,
              "");
static_assert(sizeof(Link<Const<Autodetect::Matcher, size_t, Data const&, size_t, unsigned char&,
                                Array<unsigned char, 7>&>>(&Autodetect::Matcher::Match)) > 0,
              "");

static_assert(
    sizeof(Link<Mutable<Autodetect::Response, Autodetect::Response&, Autodetect::Response const&>>(
        &Autodetect::Response::operator=)) > 0,
    "");
static_assert(
    sizeof(Link<Const<Autodetect::Response, int>>(&Autodetect::Response::CountDeviceTypeInfos)) > 0,
    "");
static_assert(sizeof(Link<Const<Autodetect::Response, DeviceTypeInfo, int>>(
                  &Autodetect::Response::GetDeviceTypeInfo)) > 0,
              "");
static_assert(sizeof(Link<Const<Autodetect::Response, int>>(&Autodetect::Response::CountRequests)) >
                  0,
              "");
static_assert(sizeof(Link<Const<Autodetect::Response, Autodetect::Request, int>>(
                  &Autodetect::Response::GetRequest)) > 0,
              "");
static_assert(sizeof(Link<Const<Autodetect::Response, Autodetect::Matcher>>(
                  &Autodetect::Response::GetMatcher)) > 0,
              "");
static_assert(
    sizeof(Link<Const<Autodetect::Response, DeviceTypeInfo, Array<unsigned char, 7> const&>>(
        &Autodetect::Response::GetMatchedDeviceTypeInfo)) > 0,
    "");

static_assert(
    sizeof(Link<Mutable<Autodetect::Request, Autodetect::Request&, Autodetect::Request const&>>(
        &Autodetect::Request::operator=)) > 0,
    "");
static_assert(sizeof(Link<Const<Autodetect::Request, DataBuffer, TimeStamp>>(
                  &Autodetect::Request::GetMessageW)) > 0,
              "");
static_assert(sizeof(Link<Const<Autodetect::Request, double>>(&Autodetect::Request::GetTimeout)) >
                  0,
              "");
static_assert(sizeof(Link<Const<Autodetect::Request, int>>(&Autodetect::Request::CountResponses)) >
                  0,
              "");
static_assert(sizeof(Link<Const<Autodetect::Request, Autodetect::Response, int>>(
                  &Autodetect::Request::GetResponse)) > 0,
              "");

static_assert(std::is_constructible<Data, unsigned char const*, size_t>::value, "");
static_assert(kIsImplicit<DataPacket, Data>, "");
static_assert(sizeof(Array<unsigned char, 7>) == 7, "");
static_assert(sizeof(MatchEntry) == 2, "");
static_assert(!std::is_default_constructible<Autodetect::Request>::value, "");
static_assert(!std::is_default_constructible<Autodetect::Response>::value, "");
static_assert(!std::is_default_constructible<Autodetect::Matcher>::value, "");
static_assert(std::is_copy_constructible<Autodetect::Request>::value, "");

static_assert(sizeof(Link<Mutable<DeviceTypeInfo, DeviceTypeInfo&, DeviceTypeInfo const&>>(
                  &DeviceTypeInfo::operator=)) > 0,
              "");
static_assert(sizeof(Link<Const<DeviceTypeInfo, bool, DeviceTypeInfo const&>>(
                  &DeviceTypeInfo::operator==)) > 0,
              "");
static_assert(sizeof(Link<Const<DeviceTypeInfo, bool, DeviceTypeInfo const&>>(
                  &DeviceTypeInfo::operator!=)) > 0,
              "");
static_assert(sizeof(Link<Const<DeviceTypeInfo, bool>>(&DeviceTypeInfo::Exists)) > 0, "");
static_assert(sizeof(Link<Const<DeviceTypeInfo, UString>>(&DeviceTypeInfo::GetMfrName)) > 0, "");
static_assert(sizeof(Link<Const<DeviceTypeInfo, UString>>(&DeviceTypeInfo::GetModelName)) > 0, "");
static_assert(
    sizeof(Link<Const<DeviceTypeInfo, bool, Device const&>>(&DeviceTypeInfo::MatchesDevice)) > 0,
    "");

static_assert(sizeof(Link<Static<DeviceTypeCatalog&>>(&DeviceTypeCatalog::Instance)) > 0, "");
static_assert(sizeof(Link<Const<DeviceTypeCatalog, int>>(&DeviceTypeCatalog::CountDeviceTypes)) > 0,
              "");
static_assert(sizeof(Link<Const<DeviceTypeCatalog, DeviceTypeInfo, int>>(
                  &DeviceTypeCatalog::GetDeviceType)) > 0,
              "");
static_assert(sizeof(Link<Const<DeviceTypeCatalog, DeviceTypeInfo, UString const&, UString const&>>(
                  &DeviceTypeCatalog::GetDeviceType)) > 0,
              "");
static_assert(
    sizeof(Link<Const<DeviceTypeCatalog, void, UString const&, std::vector<DeviceTypeInfo>&>>(
        &DeviceTypeCatalog::CollectModels)) > 0,
    "");
static_assert(
    sizeof(Link<Const<DeviceTypeCatalog, int>>(&DeviceTypeCatalog::CountAutodetectRequests)) > 0,
    "");
static_assert(sizeof(Link<Const<DeviceTypeCatalog, Autodetect::Request, int>>(
                  &DeviceTypeCatalog::GetAutodetectRequest)) > 0,
              "");

static_assert(sizeof(Link<Mutable<Impl::XMLFilesVisitor, void, File const&, bool>>(
                  &Impl::XMLFilesVisitor::Visit)) > 0,
              "");
static_assert(sizeof(Link<void (*)(Impl::XMLFilesVisitor&, char const*)>(&Impl::VisitXMLFiles)) > 0,
              "");
static_assert(
    sizeof(Link<Const<DeviceTypeCatalog, void, sorted_vector_set<UString, std::less<UString>>&>>(
        &DeviceTypeCatalog::CollectManufacturers)) > 0,
    "");

static_assert(kIsImplicit<RCPtrMT<Impl::DeviceTypeInfoImpl>, DeviceTypeInfo>, "");
static_assert(std::is_default_constructible<DeviceTypeInfo>::value, "");
static_assert(std::has_virtual_destructor<Impl::XMLFilesVisitor>::value, "");

TEST(Declarations, NamesAreThere) {
  Link<Const<Names, bool>>(&Names::Exists);
  Link<Const<Names, Names::Type>>(&Names::GetType);
  Link<Const<Names, FileSpecification const&>>(&Names::GetFile);
  Link<Const<Names, UString const&>>(&Names::GetName);
  Link<Const<Names, bool, Names const&>>(&Names::operator==);
  Link<Const<Names, bool, Names const&>>(&Names::operator!=);

  Link<Static<NamesCatalog&>>(&NamesCatalog::Instance);
  Link<Mutable<NamesCatalog, Names, UString const&, UString const&>>(&NamesCatalog::FindMaster);
  Link<Mutable<NamesCatalog, void, UString const&, UString const&, std::vector<Names>&>>(
      &NamesCatalog::FindMasters);
  Link<Mutable<NamesCatalog, void, UString const&, UString const&, std::vector<Names>&>>(
      &NamesCatalog::FindOverrides);
  Link<Mutable<NamesCatalog, Names, UString const&>>(&NamesCatalog::FindStandardMode);
  Link<Mutable<NamesCatalog, void, std::vector<Names>&>>(&NamesCatalog::FindStandardModes);

  Link<Const<DestinationMode, Destination>>(&DestinationMode::GetDestination);
  Link<Const<DestinationMode, DestinationNameSet, short>>(&DestinationMode::GetNameSet);
  Link<Const<DestinationMode, bool>>(&DestinationMode::IsStandardMode);
  Link<Const<DestinationMode, bool>>(&DestinationMode::SelectableWithMIDI);
  Link<Const<DestinationMode, void, DataBuffer&, TimeStamp, unsigned char>>(
      &DestinationMode::GetEnablingCommand);
  Link<Const<DestinationMode, void, DataBuffer&, TimeStamp, unsigned char>>(
      &DestinationMode::GetDisablingCommand);

  Link<Const<DestinationNameSet, Destination>>(&DestinationNameSet::GetDestination);
  Link<Const<DestinationNameSet, int>>(&DestinationNameSet::CountBanks);
  Link<Const<DestinationNameSet, PatchBank, int>>(&DestinationNameSet::GetBank);
  Link<Const<DestinationNameSet, PatchBank, unsigned char, unsigned char>>(
      &DestinationNameSet::GetBank);
  Link<Const<DestinationNameSet, int>>(&DestinationNameSet::CountModes);
  Link<Const<DestinationNameSet, std::pair<DestinationMode, unsigned short>, int>>(
      &DestinationNameSet::GetMode);
  Link<Const<DestinationNameSet, unsigned short>>(&DestinationNameSet::GetChannels);

  Link<Const<PatchBank, DestinationNameSet>>(&PatchBank::GetNameSet);
  Link<Const<PatchBank, UString>>(&PatchBank::GetBankName);
  Link<Const<PatchBank, int>>(&PatchBank::CountPatches);
  Link<Const<PatchBank, Patch, int>>(&PatchBank::GetPatch);
  Link<Const<PatchBank, unsigned char>>(&PatchBank::GetController0Number);
  Link<Const<PatchBank, unsigned char>>(&PatchBank::GetController32Number);
  Link<Const<PatchBank, DataBuffer, TimeStamp, short, unsigned char>>(&PatchBank::GetCommand);

  Link<Const<Patch, PatchBank>>(&Patch::GetBank);
  Link<Const<Patch, UString>>(&Patch::GetNumber);
  Link<Const<Patch, UString>>(&Patch::GetNumberAndName);
  Link<Const<Patch, unsigned char>>(&Patch::GetProgramChange);
  Link<Const<Patch, PatchNumbers>>(&Patch::GetPatchNumbers);
  Link<Const<Patch, DataBuffer, TimeStamp, short, unsigned char>>(&Patch::GetCommand);
  Link<Const<Patch, NoteNameList>>(&Patch::GetNoteNames);
  Link<Const<Patch, ControlList>>(&Patch::GetControlNames);

  Link<Const<NoteNameListBase, UString>>(&NoteNameListBase::GetName);
  Link<Const<NoteNameListBase, bool>>(&NoteNameListBase::HasNames);
  Link<Const<NoteNameListBase, int>>(&NoteNameListBase::CountNoteNames);
  Link<Const<NoteNameListBase, std::pair<unsigned char, UString>, int>>(
      &NoteNameListBase::GetNoteName);
  Link<Const<NoteNameListBase, int>>(&NoteNameListBase::CountNoteGroups);
  Link<Const<NoteNameListBase, NoteGroup, int>>(&NoteNameListBase::GetNoteGroup);
  Link<Const<NoteNameListBase, NoteGroup, int>>(&NoteNameListBase::GetNoteGroupForID);
  Link<Const<NoteNameListBase, UString, unsigned char>>(&NoteNameListBase::GetNoteNameForPitch);
  Link<Const<NoteNameListBase, int, unsigned char>>(&NoteNameListBase::GetNoteGroupForPitch);

  Link<Const<NoteNameList, Patch>>(&NoteNameList::GetPatch);
  Link<Const<NoteNameList, void, unsigned char, UString const&>>(&NoteNameList::SetNoteName);
  Link<Const<NoteNameList, void, unsigned char>>(&NoteNameList::ClearNoteName);
  Link<Const<NoteNameList, void, unsigned char, int, UString const&>>(
      &NoteNameList::PutNoteInGroup);
  Link<Const<NoteNameList, void, int, bool>>(&NoteNameList::RemoveNoteGroup);
  Link<Const<NoteNameList, int>>(&NoteNameList::GetUnusedGroupID);

  Link<Const<DefaultNoteNameList, DestinationNameSet>>(&DefaultNoteNameList::GetNameSet);

  Link<Const<Control, ControlType>>(&Control::GetType);
  Link<Const<Control, unsigned short>>(&Control::GetNumber);
  Link<Const<Control, UString>>(&Control::GetName);
  Link<Const<Control, double>>(&Control::GetMinValue);
  Link<Const<Control, double>>(&Control::GetMaxValue);
  Link<Const<Control, double>>(&Control::GetDefaultValue);
  Link<Const<Control, UString>>(&Control::GetUnits);
  Link<Const<Control, bool>>(&Control::HasValueRange);
  Link<Const<Control, bool>>(&Control::HasDefaultValue);
  Link<Const<Control, bool>>(&Control::HasUnits);
  Link<Const<Control, int>>(&Control::CountValueNames);
  Link<Const<Control, std::pair<unsigned short, UString>, int>>(&Control::GetValueName);
  Link<Const<Control, UString, unsigned short>>(&Control::GetNameForValue);

  Link<Const<ControlListBase, UString>>(&ControlListBase::GetName);
  Link<Const<ControlListBase, int>>(&ControlListBase::CountControls);
  Link<Const<ControlListBase, Control, ControlType, unsigned short>>(&ControlListBase::GetControl);
  Link<Const<ControlListBase, Control, int>>(&ControlListBase::GetControl);
  Link<Const<ControlListBase, bool, ControlType, unsigned short>>(&ControlListBase::HasControl);

  Link<Const<ControlList, Patch>>(&ControlList::GetPatch);
  Link<Const<ControlList, void, Control const&>>(&ControlList::SetControl);
  Link<Const<ControlList, void, ControlType, unsigned short>>(&ControlList::ClearControl);

  Link<Const<DefaultControlList, DestinationNameSet>>(&DefaultControlList::GetNameSet);
}

static_assert(DestinationMode::kObjectID == MatchObjectID(5), "");
static_assert(DestinationNameSet::kObjectID == MatchObjectID(6), "");
static_assert(PatchBank::kObjectID == MatchObjectID(7), "");
static_assert(Patch::kObjectID == MatchObjectID(7), "");
static_assert(NoteNameList::kObjectID == MatchObjectID(9), "");
static_assert(DefaultNoteNameList::kObjectID == MatchObjectID(10), "");
static_assert(ControlList::kObjectID == MatchObjectID(11), "");
static_assert(DefaultControlList::kObjectID == MatchObjectID(12), "");
static_assert(std::is_same<decltype(DestinationMode::kNoDestinationMode), DestinationMode const>(),
              "");
static_assert(
    std::is_same<decltype(DestinationNameSet::kNoDestinationNameSet), DestinationNameSet const>(),
    "");
static_assert(std::is_same<decltype(PatchBank::kNoPatchBank), PatchBank const>(), "");
static_assert(std::is_same<decltype(Patch::kNoPatch), Patch const>(), "");
static_assert(std::is_same<decltype(NoteNameList::kNoNoteNameList), NoteNameList const>(), "");
static_assert(std::is_same<decltype(DefaultNoteNameList::kNoDefaultNoteNameList),
                           DefaultNoteNameList const>(),
              "");
static_assert(std::is_same<decltype(ControlList::kNoControlList), ControlList const>(), "");
static_assert(
    std::is_same<decltype(DefaultControlList::kNoDefaultControlList), DefaultControlList const>(),
    "");
static_assert(kIsImplicit<RCPtrMT<Impl::DestModeImpl>, DestinationMode>, "");
static_assert(kIsImplicit<RCPtrMT<Impl::DestNameSetImpl>, DestinationNameSet>, "");
static_assert(kIsImplicit<RCPtrMT<Impl::PatchBankImpl>, PatchBank>, "");
static_assert(kIsImplicit<RCPtrMT<Impl::PatchImpl>, Patch>, "");
static_assert(kIsImplicit<RCPtrMT<Impl::PatchImpl>, NoteNameList>, "");
static_assert(kIsImplicit<RCPtrMT<Impl::PatchImpl>, ControlList>, "");
static_assert(kIsImplicit<RCPtrMT<Impl::DestNameSetImpl>, DefaultNoteNameList>, "");
static_assert(kIsImplicit<RCPtrMT<Impl::DestNameSetImpl>, DefaultControlList>, "");
static_assert(sizeof(DestinationMode) == kHandleSize, "");
static_assert(sizeof(DestinationNameSet) == kHandleSize, "");
static_assert(sizeof(PatchBank) == kHandleSize, "");
static_assert(sizeof(Patch) == kHandleSize, "");
static_assert(sizeof(NoteNameList) == kHandleSize, "");
static_assert(sizeof(DefaultNoteNameList) == kHandleSize, "");
static_assert(sizeof(ControlList) == kHandleSize, "");
static_assert(sizeof(DefaultControlList) == kHandleSize, "");

using Names4 = std::is_constructible<Names, Names::Type, FileSpecification, UString>;
static_assert(Names4::value, "");
static_assert(std::is_constructible<Names, Names::Type, FileSpecification>::value, "");
static_assert(Names::kMasterNames == 1 && Names::kEditedOverrideNames == 4, "");
static_assert(sizeof(PatchNumbers) == 3, "");

template <class... Arguments>
constexpr bool kMakesControl =
    std::is_constructible<Control, ControlType, unsigned short, UString, Arguments...>::value;
static_assert(std::is_default_constructible<Control>::value, "");
static_assert(kMakesControl<>, "");
static_assert(kMakesControl<double, double>, "");
static_assert(kMakesControl<double, double, UString>, "");
static_assert(kMakesControl<double, double, double>, "");
static_assert(kMakesControl<double, double, double, UString>, "");
static_assert(kMakesControl<Control::ValueMap>, "");
static_assert(kMakesControl<Control::ValueMap, unsigned short>, "");

}  // namespace
}  // namespace Ostinet::Testing
