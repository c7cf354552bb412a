// SPDX-License-Identifier: MIT
#include "model/PropertyKeys.h"
#include "ostinet/ObjectFilter.h"
#include "support/StudioTest.h"

namespace Ostinet::Testing {
namespace {

using Impl::EndpointKind;
using Impl::ImplOf;
using ::testing::ElementsAre;

using Filter = ObjectFilter<Endpoint>;
using Predicate = boost::function<bool(Endpoint const&)>;

/// A filter of a fixed answer that counts how often it is asked.
Filter Answer(bool answer, int& asked) {
  return Predicate([answer, &asked](Endpoint const&) {
    ++asked;
    return answer;
  });
}

Filter Answer(bool answer) {
  return Predicate([answer](Endpoint const&) { return answer; });
}

bool Ask(Filter const& filter) { return filter(Endpoint()); }

TEST(ObjectFilter, WithoutAPredicateIsConstant) {
  EXPECT_TRUE(Ask(Filter()));
  EXPECT_TRUE(Ask(Filter(true)));
  EXPECT_FALSE(Ask(Filter(false)));
  EXPECT_FALSE(Ask(!Filter()));
  EXPECT_TRUE(Ask(!Filter(false)));
}

TEST(ObjectFilter, AFunctionIsAPredicateAndNoConstant) {
  Filter const filter([](Endpoint const&) { return false; });
  EXPECT_FALSE(Ask(filter));
  EXPECT_TRUE(Ask(!filter));
}

TEST(ObjectFilter, AndOrAndNotOfEveryPairOfAnswers) {
  for (bool const a : {false, true}) {
    EXPECT_EQ(Ask(!Answer(a)), !a);
    for (bool const b : {false, true}) {
      EXPECT_EQ(Ask(Answer(a) & Answer(b)), a && b);
      EXPECT_EQ(Ask(Answer(a) | Answer(b)), a || b);
      EXPECT_EQ(Ask(!(Answer(a) & Answer(b))), !(a && b));
      EXPECT_EQ(Ask(!(Answer(a) | Answer(b))), !(a || b));
      // Constants on either side.
      EXPECT_EQ(Ask(Filter(a) & Answer(b)), a && b);
      EXPECT_EQ(Ask(Filter(a) | Answer(b)), a || b);
      EXPECT_EQ(Ask(Answer(a) & Filter(b)), a && b);
      EXPECT_EQ(Ask(Answer(a) | Filter(b)), a || b);
      EXPECT_EQ(Ask(Filter(a) & Filter(b)), a && b);
      EXPECT_EQ(Ask(Filter(a) | Filter(b)), a || b);
      for (bool const c : {false, true}) {
        EXPECT_EQ(Ask((Answer(a) & Answer(b)) | Answer(c)), (a && b) || c);
        EXPECT_EQ(Ask(Answer(a) & (Answer(b) | Answer(c))), a && (b || c));
        EXPECT_EQ(Ask(!((Answer(a) | !Answer(b)) & Answer(c))), !((a || !b) && c));
        for (bool const d : {false, true}) {
          EXPECT_EQ(Ask((Answer(a) & Answer(b)) | (Answer(c) & !Answer(d))), (a && b) || (c && !d));
        }
      }
    }
  }
}

TEST(ObjectFilter, CombinesInPlaceAlsoWithItself) {
  Filter filter = Answer(true);
  Filter const& itself = filter;  // a name of its own, so that no compiler takes it for a slip
  filter &= itself;
  EXPECT_TRUE(Ask(filter));
  filter &= Answer(false);
  EXPECT_FALSE(Ask(filter));
  filter |= Answer(true);
  EXPECT_TRUE(Ask(filter));
  filter |= itself;
  EXPECT_TRUE(Ask(filter));
}

TEST(ObjectFilter, DoesNotAskWhatCannotChangeTheAnswer) {
  int left = 0;
  int right = 0;
  EXPECT_FALSE(Ask(Answer(false, left) & (Answer(true, right) | Answer(true, right))));
  EXPECT_TRUE(Ask(Answer(true, left) | (Answer(true, right) & Answer(true, right))));
  EXPECT_EQ(left, 2);
  EXPECT_EQ(right, 0);
  int last = 0;
  EXPECT_TRUE(Ask((Answer(false, left) & Answer(true, right)) | Answer(true, last)));
  EXPECT_EQ(right, 0);
  EXPECT_EQ(last, 1);
}

TEST(ObjectFilter, TheLeftSideOfAnOperatorIsCopied) {
  Filter const online = OnlineEndpoint();
  Filter const combined = OnlineEndpoint() & Filter(false);
  EXPECT_FALSE(Ask(combined));
  EXPECT_EQ(Ask(OnlineEndpoint()), Ask(online));
}

TEST(ObjectFilter, AnEmptyFunctionThrowsWhenItIsAsked) {
  Filter const filter{Predicate()};
  EXPECT_THROW(Ask(filter), boost::bad_function_call);
}

class FilterTest : public StudioTest {
 protected:
  Destination MakeInEntity(UString const& name, bool isDirect) {
    return setup.MakeEntity(setup.MakeDevice(name, isDirect), "Port 1", 0, 1).GetDestination(0);
  }
};

TEST_F(FilterTest, ConstantTrueAndAFilterIsTheFilter) {
  Destination const online = setup.MakePort("On");
  Destination const offline = setup.MakePort("Off");
  TestSetup::SetInt(offline, "offline", 1);
  EXPECT_TRUE((Filter(true) & OnlineEndpoint())(online));
  EXPECT_FALSE((Filter(true) & OnlineEndpoint())(offline));
  EXPECT_FALSE((Filter(false) & OnlineEndpoint())(online));
}

TEST_F(FilterTest, NotOnlineAndSoftwarePassesOfflineSoftware) {
  Destination const software = setup.MakeDestination("S", EndpointKind::Software(false, false));
  Filter const filter = !(OnlineEndpoint() & SoftwareEndpoint());
  EXPECT_FALSE(filter(software));
  TestSetup::SetInt(software, "offline", 1);
  EXPECT_TRUE(filter(software));
}

TEST_F(FilterTest, InterfaceFiltersTellThreeStatesApart) {
  Destination const yes = MakeInEntity("INTERFACE", true);
  Destination const no = setup.MakePort("Bare");
  Destination const unknown = MakeInEntity("Box", true);
  struct {
    Filter& filter;
    bool yes, no, unknown;
  } const kCases[] = {{DefinitelyInterfaceEndpoint(), true, false, false},
                      {DefinitelyNonInterfaceEndpoint(), false, true, false},
                      {CouldBeInterfaceEndpoint(), true, false, true},
                      {CouldBeNonInterfaceEndpoint(), false, true, true}};
  for (auto const& one : kCases) {
    EXPECT_EQ(one.filter(yes), one.yes);
    EXPECT_EQ(one.filter(no), one.no);
    EXPECT_EQ(one.filter(unknown), one.unknown);
  }
}

TEST_F(FilterTest, TheOtherNamedFiltersReadTheirFlags) {
  Destination const bare = setup.MakePort("Bare");
  Destination const hidden = setup.MakeDestination("H", EndpointKind::Bare(true, true));
  Destination const users = MakeInEntity("Synth", false);
  auto const pair = setup.CreateVirtualEndpoint("V", Setup::kSourceEnd, Setup::kDestinationEnd);
  EXPECT_TRUE(DirectEndpoint()(bare));
  EXPECT_FALSE(DirectEndpoint()(users));
  EXPECT_TRUE(PublicEndpoint()(bare));
  EXPECT_FALSE(PublicEndpoint()(hidden));
  EXPECT_TRUE(SoftwareEndpoint()(pair.second));
  EXPECT_FALSE(SoftwareEndpoint()(bare));
  EXPECT_TRUE(EntitylessNonSoftwareEndpoint()(bare));
  EXPECT_FALSE(EntitylessNonSoftwareEndpoint()(pair.first));
  EXPECT_FALSE(EntitylessNonSoftwareEndpoint()(users));
  EXPECT_TRUE(DirectDevice()(setup.MakeDevice("D", true)));
  EXPECT_FALSE(DirectDevice()(setup.MakeDevice("D")));
}

template <class List>
std::vector<std::string> NamesOf(List const& list) {
  std::vector<std::string> names;
  for (auto const& handle : list) {
    names.push_back(handle.GetName().string());
  }
  return names;
}

class ListTest : public FilterTest {};

TEST_F(ListTest, IsEmptyUntilReset) {
  setup.MakePort("Port");
  DestinationList list;
  EXPECT_TRUE(list.empty());
  list.Reset(Filter());
  EXPECT_EQ(list.size(), 1U);
  EXPECT_TRUE(SourceList().empty());
  EXPECT_TRUE(DeviceList().empty());
}

TEST_F(ListTest, ResetTwiceGivesNoDuplicates) {
  setup.MakePort("B");
  setup.MakePort("A");
  DestinationList list{Filter()};
  list.Reset(Filter());
  EXPECT_THAT(NamesOf(list), ElementsAre("B", "A"));  // in the order of the studio
}

TEST_F(ListTest, HoldsWhatPassesOfThePublicLists) {
  setup.MakePort("Out");
  setup.MakeDestination("Hidden", EndpointKind::Bare(true, true));
  setup.MakeSourcePort("In");
  setup.MakeSource("Hidden", EndpointKind::Bare(true, true));
  setup.MakeDevice("Synth");
  setup.MakeDevice("Box", true);
  EXPECT_THAT(NamesOf(DestinationList(Filter())), ElementsAre("Out"));
  EXPECT_THAT(NamesOf(SourceList(Filter())), ElementsAre("In"));
  EXPECT_THAT(NamesOf(DeviceList(DirectDevice())), ElementsAre("Box"));
  DeviceList devices(DirectDevice());
  devices.Reset(!DirectDevice());
  EXPECT_THAT(NamesOf(devices), ElementsAre("Synth"));
}

TEST_F(ListTest, IsASnapshotOfHandles) {
  Destination const port = setup.MakePort("Out");
  DestinationList const list{Filter()};
  setup.RemoveDestination(ImplOf(port));
  ASSERT_EQ(list.size(), 1U);
  EXPECT_FALSE(list[0].Exists());
}

TEST_F(ListTest, AFilterMayChangeTheStudio) {
  Destination const first = setup.MakePort("A");
  setup.MakePort("B");
  DestinationList const list{Filter(Predicate([&](Endpoint const&) {
    setup.RemoveDestination(ImplOf(first));
    return true;
  }))};
  EXPECT_FALSE(list.empty());
  EXPECT_EQ(setup.CountDestinations(), 1);
}

TEST_F(ListTest, WithoutFiltersSortsByName) {
  for (char const* name : {"beta", "Alpha", "gamma"}) {
    setup.MakePort(name);
    setup.MakeSourcePort(name);
  }
  std::vector<Filter> none;
  DestinationList destinations{Filter()};
  destinations.Sort(none);
  EXPECT_THAT(NamesOf(destinations), ElementsAre("Alpha", "beta", "gamma"));
  SourceList sources{Filter()};
  sources.Sort(none);
  EXPECT_THAT(NamesOf(sources), ElementsAre("Alpha", "beta", "gamma"));
}

TEST_F(ListTest, TheDefaultOrderIsInstrumentsOnlineOfflineInterfacesAndTheRest) {
  MakeInEntity("a unknown", true);
  MakeInEntity("INTERFACE b", true);
  MakeInEntity("INTERFACE a", true);
  Destination const off = setup.MakePort("a offline");
  TestSetup::SetInt(off, "offline", 1);
  setup.MakePort("z online");
  setup.MakePort("b online");
  DestinationList list{Filter()};
  ASSERT_EQ(DestinationList::sDefaultSortFilters.size(), 3U);
  list.Sort(DestinationList::sDefaultSortFilters);
  EXPECT_THAT(NamesOf(list), ElementsAre("b online", "z online", "a offline", "INTERFACE a",
                                         "INTERFACE b", "a unknown"));
}

TEST_F(ListTest, TheDefaultFiltersAreFilledOnce) {
  DestinationList const one;
  DestinationList const two;
  SourceList const three;
  EXPECT_EQ(DestinationList::sDefaultSortFilters.size(), 3U);
  EXPECT_EQ(SourceList::sDefaultSortFilters.size(), 3U);
}

}  // namespace
}  // namespace Ostinet::Testing
