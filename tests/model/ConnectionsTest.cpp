// SPDX-License-Identifier: MIT
#include <random>

#include "model/PropertyKeys.h"
#include "support/StudioTest.h"

namespace Ostinet::Testing {
namespace {

using Impl::ImplOf;
using ::testing::ElementsAre;
using ::testing::IsEmpty;

class ConnectionsTest : public StudioTest {
 protected:
  static std::vector<int> Stored(DeviceObject const& object) {
    return TestSetup::GetIntList(object, "connUniqueID");
  }
  static void Store(DeviceObject const& object, std::vector<int> const& ids) {
    TestSetup::PeerOf(object).SetIntList("connUniqueID", ids);
  }
  static bool IsStored(DeviceObject const& object) {
    return TestSetup::PeerOf(object).OwnProperties().count("connUniqueID") != 0;
  }

  Destination const port = setup.MakePort("Port");
  Destination const synth = setup.MakeInstrument("Synth");
};

TEST_F(ConnectionsTest, AddingTheSameEndpointTwiceLeavesOneEntry) {
  port.AddConnectedDestination(synth);
  port.AddConnectedDestination(synth);
  EXPECT_EQ(port.CountConnectedDestinations(), 1);
  EXPECT_THAT(Stored(port), ElementsAre(synth.GetUniqueID()));
}

TEST_F(ConnectionsTest, BothEndsHoldEachOthersID) {
  port.AddConnectedDestination(synth);
  EXPECT_TRUE(synth.GetDirectDestination() == port);
  EXPECT_TRUE(port.GetConnectedDestination(0) == synth);
  EXPECT_THAT(Stored(port), ElementsAre(synth.GetUniqueID()));
  EXPECT_THAT(Stored(synth), ElementsAre(port.GetUniqueID()));
}

TEST_F(ConnectionsTest, SourcesConnectAsDestinationsDo) {
  Source const in = setup.MakeSourcePort("Port");
  Source const keys = setup.MakeSourceInstrument("Keys");
  in.AddConnectedSource(keys);
  EXPECT_EQ(in.CountConnectedSources(), 1);
  EXPECT_TRUE(in.GetConnectedSource(0) == keys);
  EXPECT_TRUE(in.GetConnectedSource(1) == Source());
  EXPECT_TRUE(keys.GetDirectSource() == in);
  EXPECT_THAT(Stored(keys), ElementsAre(in.GetUniqueID()));
  in.RemoveConnectedSource(keys);
  EXPECT_TRUE(keys.GetDirectSource() == Source());
  EXPECT_FALSE(IsStored(keys));
  EXPECT_THAT(Stored(in), IsEmpty());
}

TEST_F(ConnectionsTest, OnlyAUsersEndpointHangsOnAPort) {
  port.AddConnectedDestination(setup.MakePort("Other"));
  port.AddConnectedDestination(Destination());
  synth.AddConnectedDestination(setup.MakeInstrument("Other"));
  EXPECT_EQ(port.CountConnectedDestinations(), 0);
  EXPECT_EQ(synth.CountConnectedDestinations(), 0);
  EXPECT_FALSE(IsStored(port));
  TestSetup::SetInt(port, "embedded", 1);
  port.AddConnectedDestination(synth);
  EXPECT_EQ(port.CountConnectedDestinations(), 0);
}

TEST_F(ConnectionsTest, RemovingWhatIsNotConnectedOnlyWritesThePortsProperty) {
  Store(port, {1, 2});
  setup.pending.clear();
  port.RemoveConnectedDestination(synth);
  EXPECT_TRUE(IsStored(port));
  EXPECT_THAT(Stored(port), IsEmpty());
  EXPECT_TRUE(synth.GetDirectDestination() == Destination());
}

TEST_F(ConnectionsTest, RemovingNullOnlyWritesThePortsProperty) {
  port.AddConnectedDestination(synth);
  Store(port, {1, 2});
  port.RemoveConnectedDestination(Destination());
  EXPECT_THAT(Stored(port), ElementsAre(synth.GetUniqueID()));
  EXPECT_TRUE(synth.GetDirectDestination() == port);
}

// Its stored connection goes, but the link to the other port stays until the next rebuilding.
TEST_F(ConnectionsTest, RemovingWhatHangsElsewhereTakesItsPropertyAndLeavesItsLink) {
  Destination const other = setup.MakePort("Other");
  other.AddConnectedDestination(synth);
  port.RemoveConnectedDestination(synth);
  EXPECT_TRUE(synth.GetDirectDestination() == other);
  EXPECT_FALSE(IsStored(synth));
  EXPECT_EQ(other.CountConnectedDestinations(), 1);
}

TEST_F(ConnectionsTest, AnEndpointThatMovesLeavesTheOldPortsListButNotItsProperty) {
  Destination const other = setup.MakePort("Other");
  port.AddConnectedDestination(synth);
  other.AddConnectedDestination(synth);
  EXPECT_EQ(port.CountConnectedDestinations(), 0);
  EXPECT_EQ(other.CountConnectedDestinations(), 1);
  EXPECT_TRUE(synth.GetDirectDestination() == other);
  EXPECT_THAT(Stored(port), ElementsAre(synth.GetUniqueID()));
  EXPECT_THAT(Stored(synth), ElementsAre(other.GetUniqueID()));
}

TEST_F(ConnectionsTest, AFakeEndIsListedByThePortButGetsNoProperty) {
  TestSetup::PeerOf(synth).isFake = true;
  port.AddConnectedDestination(synth);
  EXPECT_THAT(Stored(port), ElementsAre(synth.GetUniqueID()));
  EXPECT_FALSE(IsStored(synth));
  Store(synth, {5});
  port.RemoveConnectedDestination(synth);
  EXPECT_THAT(Stored(synth), ElementsAre(5));
}

TEST_F(ConnectionsTest, OfTwoPortsThatListAnIDTheFirstGetsTheEndpoint) {
  Destination const other = setup.MakePort("Other");
  Store(other, {synth.GetUniqueID()});
  Store(port, {synth.GetUniqueID()});
  setup.UpdateConnections();
  EXPECT_EQ(port.CountConnectedDestinations(), 1);
  EXPECT_EQ(other.CountConnectedDestinations(), 0);
  EXPECT_TRUE(synth.GetDirectDestination() == port);
  EXPECT_THAT(Stored(other), ElementsAre(synth.GetUniqueID()));
}

TEST_F(ConnectionsTest, ANumberWaitsForItsEndpoint) {
  Store(port, {7, 8});
  setup.UpdateConnections();
  EXPECT_EQ(port.CountConnectedDestinations(), 0);
  Destination const late = setup.MakeInstrument("Late");
  TestSetup::SetInt(late, "uniqueID", 8);
  setup.UpdateConnections();
  EXPECT_TRUE(late.GetDirectDestination() == port);
  EXPECT_THAT(Stored(port), ElementsAre(7, 8));
}

TEST_F(ConnectionsTest, EqualIDsAreTakenInListOrder) {
  Destination const second = setup.MakeInstrument("Second");
  TestSetup::SetInt(second, "uniqueID", synth.GetUniqueID());
  Destination const other = setup.MakePort("Other");
  Store(port, {synth.GetUniqueID()});
  Store(other, {synth.GetUniqueID()});
  setup.UpdateConnections();
  EXPECT_TRUE(synth.GetDirectDestination() == port);
  EXPECT_TRUE(second.GetDirectDestination() == other);
}

TEST_F(ConnectionsTest, SourcesAndDestinationsOfOneIDAreKeptApart) {
  Source const keys = setup.MakeSourceInstrument("Keys");
  TestSetup::SetInt(keys, "uniqueID", synth.GetUniqueID());
  Source const in = setup.MakeSourcePort("In");
  Store(in, {keys.GetUniqueID()});
  Store(port, {keys.GetUniqueID()});
  setup.UpdateConnections();
  EXPECT_TRUE(keys.GetDirectSource() == in);
  EXPECT_TRUE(synth.GetDirectDestination() == port);
}

TEST_F(ConnectionsTest, RebuildingWritesNoPropertyAndChangesWhatChanged) {
  Destination const stays = setup.MakeInstrument("Stays");
  Destination const comes = setup.MakeInstrument("Comes");
  port.AddConnectedDestination(synth);
  port.AddConnectedDestination(stays);
  Store(port, {comes.GetUniqueID(), stays.GetUniqueID()});
  setup.pending.clear();
  setup.UpdateConnections();
  EXPECT_TRUE(port.GetConnectedDestination(0) == comes);
  EXPECT_TRUE(port.GetConnectedDestination(1) == stays);
  EXPECT_TRUE(synth.GetDirectDestination() == Destination());
  EXPECT_TRUE(comes.GetDirectDestination() == port);
  EXPECT_TRUE(setup.pending.empty());
}

// The old port is not asked in this round, so nothing else would take the endpoint off it.
TEST_F(ConnectionsTest, AnEndpointLeavesAPortThatHasNoConnectionsAnyMore) {
  Destination const other = setup.MakePort("Other");
  port.AddConnectedDestination(synth);
  TestSetup::SetInt(port, "embedded", 1);
  Store(other, {synth.GetUniqueID()});
  setup.UpdateConnections();
  EXPECT_TRUE(synth.GetDirectDestination() == other);
  EXPECT_EQ(port.CountConnectedDestinations(), 0);
}

TEST_F(ConnectionsTest, ARoundForOnePortTakesOnlyWhatIsNotUsed) {
  using Set = sorted_vector_set<RCPtrMT<Impl::DestinationImpl>,
                                std::less<RCPtrMT<Impl::DestinationImpl> > >;
  Store(port, {synth.GetUniqueID()});
  Set used;
  used.insert(RCPtrMT<Impl::DestinationImpl>(ImplOf(synth)));
  setup.UpdateDestConnections(ImplOf(port), used);
  EXPECT_EQ(port.CountConnectedDestinations(), 0);
  used.clear();
  setup.UpdateDestConnections(ImplOf(port), used);
  EXPECT_EQ(port.CountConnectedDestinations(), 1);
  EXPECT_EQ(used.size(), 1U);
  Source const in = setup.MakeSourcePort("In");
  Source const keys = setup.MakeSourceInstrument("Keys");
  Store(in, {keys.GetUniqueID()});
  sorted_vector_set<RCPtrMT<Impl::EndpointImpl>, std::less<RCPtrMT<Impl::EndpointImpl> > > sources;
  setup.UpdateSourceConnections(ImplOf(in), sources);
  EXPECT_TRUE(keys.GetDirectSource() == in);
}

TEST_F(ConnectionsTest, AStoredChangeTakesEffectAtTheNextRound) {
  Store(port, {synth.GetUniqueID()});
  setup.PollSetupChanges();
  EXPECT_TRUE(synth.GetDirectDestination() == port);
  EXPECT_EQ(listener.setupChanges, 1);
}

TEST_F(ConnectionsTest, APortThatGoesTakesItsInstrumentsOffline) {
  port.AddConnectedDestination(synth);
  int const portID = port.GetUniqueID();
  setup.RemoveDestination(ImplOf(port));
  EXPECT_FALSE(synth.IsOnline());
  EXPECT_TRUE(synth.GetDirectDestination() == Destination());
  EXPECT_THAT(Stored(synth), ElementsAre(portID));
}

TEST_F(ConnectionsTest, AnInstrumentThatGoesLeavesItsNumberWithThePort) {
  port.AddConnectedDestination(synth);
  int const id = synth.GetUniqueID();
  setup.RemoveDestination(ImplOf(synth));
  EXPECT_EQ(port.CountConnectedDestinations(), 0);
  EXPECT_THAT(Stored(port), ElementsAre(id));
}

class ImportTest : public ConnectionsTest {
 protected:
  void Import(char const* xml, bool isSource) {
    XMLLib::Parser parser(xml, std::char_traits<char>::length(xml));
    ASSERT_TRUE(parser.DownToChild("Connection"));
    setup.HandleImportConnection(parser, TestSetup::PeerOf(synth), isSource);
  }
};

TEST_F(ImportTest, StoresTheConnectionWithThePortOfThatName) {
  port.SetManufacturer("M");
  port.SetModel("P");
  Store(port, {9});
  Import("<Connection name='Port' manufacturer='M' model='P'/>", false);
  EXPECT_THAT(Stored(port), ElementsAre(9, synth.GetUniqueID()));
  EXPECT_THAT(Stored(synth), ElementsAre(port.GetUniqueID()));
  EXPECT_TRUE(synth.GetDirectDestination() == Destination());
  setup.UpdateConnections();
  EXPECT_TRUE(synth.GetDirectDestination() == port);
}

TEST_F(ImportTest, ComparesNamesExactlyAndInTheRightList) {
  Import("<Connection name='port' manufacturer='' model=''/>", false);
  Import("<Connection name='Port' manufacturer='M' model=''/>", false);
  Import("<Connection name='Port' manufacturer='' model='P'/>", false);
  Import("<Connection name='Port' manufacturer='' model=''/>", true);
  EXPECT_FALSE(IsStored(port));
  EXPECT_FALSE(IsStored(synth));
  Import("<Connection name='Port' manufacturer='' model=''/>", false);
  EXPECT_TRUE(IsStored(synth));
}

TEST_F(ImportTest, NeedsAllThreeNamesAndAnID) {
  Import("<Connection manufacturer='' model=''/>", false);
  Import("<Connection name='Port' model=''/>", false);
  Import("<Connection name='Port' manufacturer=''/>", false);
  EXPECT_FALSE(IsStored(port));
  TestSetup::PeerOf(synth).SetString("uniqueID", "x");
  Import("<Connection name='Port' manufacturer='' model=''/>", false);
  EXPECT_FALSE(IsStored(port));
}

// Random edits; after each, every link must have two ends that agree.
TEST_F(ConnectionsTest, BothEndsOfEveryLinkAgreeWhateverHappens) {
  std::mt19937 random(42);
  auto const pick = [&](int count) {
    return static_cast<int>(random() % static_cast<unsigned>(count));
  };
  std::vector<Destination> ports{port};
  std::vector<Destination> instruments{synth};
  for (int i = 0; i < 5; ++i) {
    ports.push_back(setup.MakePort("Port"));
    instruments.push_back(setup.MakeInstrument("Synth"));
  }
  for (int step = 0; step < 2000; ++step) {
    int const portIndex = pick(static_cast<int>(ports.size()));
    int const instrumentIndex = pick(static_cast<int>(instruments.size()));
    Destination const onePort = ports[static_cast<std::size_t>(portIndex)];
    Destination const instrument = instruments[static_cast<std::size_t>(instrumentIndex)];
    switch (pick(8)) {
      case 0:
      case 1:
        onePort.AddConnectedDestination(instrument);
        break;
      case 2:
        onePort.RemoveConnectedDestination(instrument);
        break;
      case 3:
        Store(onePort, {instrument.GetUniqueID(), instruments[0].GetUniqueID()});
        break;
      case 4:
        setup.UpdateConnections();
        break;
      case 5:
        TestSetup::SetInt(onePort, "embedded", pick(2));
        break;
      case 6:
        setup.RemoveDestination(ImplOf(onePort));
        ports[static_cast<std::size_t>(portIndex)] = setup.MakePort("Port");
        break;
      case 7:
        setup.RemoveDestination(ImplOf(instrument));
        instruments[static_cast<std::size_t>(instrumentIndex)] = setup.MakeInstrument("Synth");
        break;
    }
    for (Destination const& one : ports) {
      for (int i = 0; i < one.CountConnectedDestinations(); ++i) {
        ASSERT_TRUE(one.GetConnectedDestination(i).GetDirectDestination() == one) << step;
      }
    }
    for (Destination const& one : instruments) {
      Destination const direct = one.GetDirectDestination();
      int entries = 0;
      for (int i = 0; i < direct.CountConnectedDestinations(); ++i) {
        entries += direct.GetConnectedDestination(i) == one ? 1 : 0;
      }
      ASSERT_EQ(entries, direct == Destination() ? 0 : 1) << step;
    }
  }
}

}  // namespace
}  // namespace Ostinet::Testing
