// SPDX-License-Identifier: MIT

#include <functional>
#include <random>
#include <set>

#include "model/DestinationImpl.h"
#include "ostinet/core/Error.h"
#include "platform/PlatformTest.h"
#include "platform/WinMIDIPort.h"
#include "platform/system/simulated/SimulatedSystem.h"

namespace Ostinet::Testing {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;
using ::testing::UnorderedElementsAre;
using Kind = SimulatedPort::Kind;

class Reconciliation : public PlatformTest {};

TEST_F(Reconciliation, APortThatComesAppearsAsAnEndpoint) {
  SignIn();
  EXPECT_THAT(DestNames(), IsEmpty());
  AddOut("Out");
  listener.setupChanges = 0;
  Rescan();
  EXPECT_EQ(listener.setupChanges, 1);
  Destination const out = Dest("Out");
  EXPECT_TRUE(out.IsDirect());
  EXPECT_TRUE(out.IsOnline());
  EXPECT_FALSE(out.IsSoftware());
  EXPECT_NE(out.GetUniqueID(), 0);
  EXPECT_EQ(out.GetEntity(), Entity::kNoEntity);
}

TEST_F(Reconciliation, APortThatGoesLeavesItsEndpointOffline) {
  AddOut("Out");
  AddOut("Stays");
  SignIn();
  Destination const out = Dest("Out");
  setup.PollSetupChanges();
  midi.RemovePort("Out");
  Rescan();
  EXPECT_TRUE(out.Exists());
  EXPECT_FALSE(out.IsOnline());
  EXPECT_EQ(OfflineProperty(out), 1);
  EXPECT_EQ(setup.CountDestinations(), 2);
}

TEST_F(Reconciliation, APortThatComesBackJoinsItsOldEndpoint) {
  AddOut("Out");
  SignIn();
  Destination const out = Dest("Out");
  int const id = out.GetUniqueID();
  midi.RemovePort("Out");
  Rescan();
  EXPECT_EQ(out.GetUniqueID(), id);
  AddOut("Out");
  Rescan();
  EXPECT_EQ(Dest("Out"), out);
  EXPECT_TRUE(out.IsOnline());
  EXPECT_EQ(OfflineProperty(out), 0);
  EXPECT_EQ(out.GetUniqueID(), id);
  Send(out, {0x90, 60, 64});
  EXPECT_THAT(SentTo("Out"), ElementsAre(Bytes{0x90, 60, 64}));
}

// Saved studios rely on it: what an offline port remembers is what it knew before it was plugged.
TEST_F(Reconciliation, WhatIsWrittenWhileOnlineGoesWithThePortButForItsIdentity) {
  AddOut("Out");
  SignIn();
  Destination const out = Dest("Out");
  int const id = out.GetUniqueID();
  out.SetManufacturer(UString("Acme"));
  midi.RemovePort("Out");
  Rescan();
  EXPECT_EQ(out.GetManufacturer(), UString());
  EXPECT_EQ(out.GetUniqueID(), id);
  EXPECT_EQ(out.GetRawName(), UString("Out"));
}

TEST_F(Reconciliation, WhatIsWrittenWhileOfflineStaysWhenThePortComes) {
  AddOut("Out");
  SignIn();
  Destination const out = Dest("Out");
  midi.RemovePort("Out");
  Rescan();
  out.SetManufacturer(UString("Acme"));
  out.SetAdvanceScheduleMicroseconds(7);
  AddOut("Out");
  Rescan();
  EXPECT_EQ(out.GetManufacturer(), UString("Acme"));
  EXPECT_EQ(out.GetAdvanceScheduleMicroseconds(), 7);
  midi.RemovePort("Out");
  Rescan();
  EXPECT_EQ(out.GetManufacturer(), UString("Acme"));
}

TEST_F(Reconciliation, OpeningADirectMusicPortOverwritesItsAdvance) {
  AddNative("Native", Kind::kDirectMusicOut);
  SignIn();
  Destination const out = Dest("Native");
  midi.RemovePort("Native");
  Rescan();
  out.SetAdvanceScheduleMicroseconds(5000);
  AddNative("Native", Kind::kDirectMusicOut);
  Rescan();
  EXPECT_EQ(out.GetAdvanceScheduleMicroseconds(), 0);
}

TEST_F(Reconciliation, ConnectionsOutliveAnUnpluggedPort) {
  AddOut("Out");
  SignIn();
  Destination const out = Dest("Out");
  Device const synth = setup.CreateDevice(UString("Synth"));
  Destination const in = synth.GetEntity(0).GetDestination(0);
  out.AddConnectedDestination(in);
  setup.PollSetupChanges();
  EXPECT_TRUE(in.IsOnline());
  midi.RemovePort("Out");
  Rescan();
  EXPECT_FALSE(in.IsOnline());
  EXPECT_EQ(in.GetDirectDestination(), out);
  AddOut("Out");
  Rescan();
  EXPECT_TRUE(in.IsOnline());
  EXPECT_EQ(in.GetDirectDestination(), out);
  Send(in, {0xC0, 5});
  EXPECT_THAT(SentTo("Out"), ElementsAre(Bytes{0xC0, 5}));
}

TEST_F(Reconciliation, AnEmptyListTakesEverythingOfflineAndReportsItOnce) {
  AddOut("Out");
  AddIn("In");
  SignIn();
  setup.PollSetupChanges();
  midi.RemovePort("Out");
  midi.RemovePort("In");
  listener.setupChanges = 0;
  Rescan();
  EXPECT_EQ(listener.setupChanges, 1);
  EXPECT_FALSE(Dest("Out").IsOnline());
  EXPECT_FALSE(Src("In").IsOnline());
  setup.PollSetupChanges();  // hears of the properties that were written
  listener.setupChanges = 0;
  Rescan();
  setup.PollSetupChanges();
  EXPECT_EQ(listener.setupChanges, 0);
}

TEST_F(Reconciliation, EachAnswerInWhichAPresentPortMatchesIsReported) {
  AddOut("Out");
  SignIn();
  setup.PollSetupChanges();
  setup.PollSetupChanges();
  listener.setupChanges = 0;
  Rescan();
  EXPECT_EQ(listener.setupChanges, 1);
}

TEST_F(Reconciliation, OfTwoPortsOfOneNameTheLaterIsTheEndpoint) {
  AddNative("Twin", Kind::kDirectMusicOut, true);
  AddNative("Twin", Kind::kDirectMusicOut, false);
  SignIn();
  midi.RemovePort("Twin");
  SignOut();
  SignIn();
  AddNative("Twin", Kind::kDirectMusicOut, true);
  AddNative("Twin", Kind::kDirectMusicOut, false);
  Rescan();
  EXPECT_THAT(DestNames(), ElementsAre("Twin"));
  EXPECT_TRUE(Dest("Twin").IsSoftware());
}

// Hosts keep the endpoint as it was until a port of its own kind is back.
TEST_F(Reconciliation, ANameThatStaysWhileThePortChangesItsKindLeavesBothUntouched) {
  AddNative("Port", Kind::kDirectMusicOut, true);
  SignIn();
  Destination const port = Dest("Port");
  EXPECT_FALSE(port.IsSoftware());
  midi.RemovePort("Port");
  AddNative("Port", Kind::kDirectMusicOut, false);
  Rescan();
  EXPECT_THAT(DestNames(), ElementsAre("Port"));
  EXPECT_TRUE(port.IsOnline());
  EXPECT_FALSE(port.IsSoftware());
}

TEST_F(Reconciliation, OnlyTheNewestAnswerCounts) {
  SignIn();
  AddOut("First");
  ListPorts();
  midi.RemovePort("First");
  AddOut("Second");
  ListPorts();
  setup.PollSetupChanges();
  EXPECT_THAT(DestNames(), ElementsAre("Second"));
}

TEST_F(Reconciliation, NothingIsListedWhileSignedOut) {
  midi.ResetCalls();
  setup.DevicesChanged();
  EXPECT_FALSE(setup.HasListedPorts());
  EXPECT_EQ(midi.CountCalls("EnumPort"), 0u);
}

TEST_F(Reconciliation, TheHostsProviderReachesTheStudio) {
  SignIn();
  AddOut("Out");
  Callbacks().provider.ForEach([](Impl::WinMIDIDevicesListener& each) { each.DevicesChanged(); });
  while (!setup.HasListedPorts()) {
  }
  setup.PollSetupChanges();
  EXPECT_THAT(DestNames(), ElementsAre("Out"));
}

TEST_F(Reconciliation, APortThatDoesNotOpenLeavesTheOthers) {
  AddNative("Bad", Kind::kDirectMusicOut);
  AddNative("Good", Kind::kDirectMusicOut);
  midi.Fail("CreatePort", 1);
  SignIn();
  EXPECT_THAT(DestNames(), ElementsAre("Good"));
  Rescan();
  EXPECT_THAT(DestNames(), UnorderedElementsAre("Good", "Bad"));
}

TEST_F(Reconciliation, AKnownPortThatDoesNotOpenIsTriedAgain) {
  AddNative("Port", Kind::kDirectMusicOut);
  SignIn();
  Destination const port = Dest("Port");
  midi.RemovePort("Port");
  Rescan();
  AddNative("Port", Kind::kDirectMusicOut);
  midi.Fail("CreatePort", 1);
  Rescan();
  EXPECT_EQ(OfflineProperty(port), 0);  // it is there, though nothing can be sent
  Send(port, {0x90, 1, 1});
  EXPECT_THAT(SentTo("Port"), IsEmpty());
  Rescan();
  Send(port, {0x90, 1, 1});
  EXPECT_THAT(SentTo("Port"), ElementsAre(Bytes{0x90, 1, 1}));
}

TEST_F(Reconciliation, KindsOfPortsBecomeKindsOfEndpoints) {
  AddOut("Cable", 1);
  AddOut("Chip", 4);
  AddIn("In");
  AddNative("External", Kind::kDirectMusicOut, true);
  AddNative("Internal", Kind::kDirectMusicOut, false);
  AddNative("External In", Kind::kDirectMusicIn, true);
  SignIn();
  EXPECT_FALSE(Dest("Cable").IsSoftware());
  EXPECT_TRUE(Dest("Chip").IsSoftware());
  EXPECT_FALSE(Src("In").IsSoftware());
  EXPECT_FALSE(Dest("External").IsSoftware());
  EXPECT_TRUE(Dest("Internal").IsSoftware());
  EXPECT_FALSE(Src("External In").IsSoftware());
  EXPECT_EQ(WhichAPI(Dest("Cable")), 2);
  EXPECT_EQ(WhichAPI(Dest("External")), 0);
}

TEST_F(Reconciliation, AnEmulatedPortWithoutItsDriverSaysSo) {
  SimulatedPort port;
  port.name = "Lone";
  port.kind = Kind::kDirectMusicOut;
  port.emulated = true;
  port.external = true;
  midi.AddPort(port);
  SignIn();
  EXPECT_EQ(WhichAPI(Dest("Lone")), 1);
}

TEST_F(Reconciliation, AVirtualEndpointOfAPortsNameIsPassedOver) {
  SignIn();
  setup.CreateVirtualEndpoint(UString("Chip"), Setup::kSourceEnd, Setup::kSourceEnd);
  setup.CreateVirtualEndpoint(UString("Chip"), Setup::kDestinationEnd, Setup::kDestinationEnd);
  AddNative("Chip", Kind::kDirectMusicOut, false);
  AddNative("Chip", Kind::kDirectMusicIn, false);
  Rescan();
  EXPECT_THAT(DestNames(), ElementsAre("Chip", "Chip"));
  EXPECT_THAT(SourceNames(), ElementsAre("Chip", "Chip"));
}

TEST_F(Reconciliation, ABareEndpointCanBeDeletedOnlyWhileOffline) {
  AddOut("Out");
  SignIn();
  setup.DeleteBareEndpoint(Dest("Out"));
  EXPECT_THAT(DestNames(), ElementsAre("Out"));
  midi.RemovePort("Out");
  Rescan();
  setup.DeleteBareEndpoint(Dest("Out"));
  EXPECT_THAT(DestNames(), IsEmpty());
}

/// A system whose drivers can fail with an exception while they are listed.
class ThrowingSystem : public Impl::Simulated::SimulatedSystem {
 public:
  UINT midiOutGetNumDevs() override {
    if (throws) {
      throw VantorError("Test", "Driver", 7, "no list");
    }
    return SimulatedSystem::midiOutGetNumDevs();
  }
  std::atomic<bool> throws{false};  // set by the test, read by the job thread
};

TEST_F(Reconciliation, AListingThatFailsIsToldOnceAndTheNextGoesOn) {
  auto const system = std::make_shared<ThrowingSystem>();
  Impl::InstallSystem(system);
  SignIn();
  setup.CreateDevice(UString("Synth"));
  listener.setupChanges = 0;
  system->throws = true;
  ListPorts();
  EXPECT_THROW(setup.PollSetupChanges(), VantorError);
  EXPECT_EQ(listener.setupChanges, 0);
  setup.PollSetupChanges();
  EXPECT_EQ(listener.setupChanges, 1);  // of the new device, which waited
  system->throws = false;
  SimulatedPort port;
  port.name = "Out";
  system->GetStudio().AddPort(port);
  Rescan();
  EXPECT_THAT(DestNames(), ElementsAre("Synth", "Out"));
  SignOut();
  midi.Install();
}

// What sources and destinations name differently.
Source DirectOf(Source const& each) { return each.GetDirectSource(); }
Destination DirectOf(Destination const& each) { return each.GetDirectDestination(); }
int CountConnected(Source const& each) { return each.CountConnectedSources(); }
int CountConnected(Destination const& each) { return each.CountConnectedDestinations(); }
Source ConnectedOf(Source const& each, int i) { return each.GetConnectedSource(i); }
Destination ConnectedOf(Destination const& each, int i) { return each.GetConnectedDestination(i); }

/// Both ends of each link agree, and what is a port is online exactly while it has one.
template <class Handle>
void ExpectEndsAgree(Handle const& each) {
  ASSERT_TRUE(each.Exists());
  for (int k = 0; k < CountConnected(each); ++k) {
    ASSERT_EQ(DirectOf(ConnectedOf(each, k)), each);
  }
  Handle const port = DirectOf(each);
  if (port.Exists()) {
    bool isListed = false;
    for (int k = 0; k < CountConnected(port); ++k) {
      isListed = isListed || ConnectedOf(port, k) == each;
    }
    ASSERT_TRUE(isListed);
  }
  if (each.IsDirect() && !each.IsVirtual()) {
    auto const& impl =
        *static_cast<Impl::EndpointImpl*>(static_cast<Impl::ObjectImpl*>(each.GetImplPtr()));
    ASSERT_EQ(each.IsOnline(), Impl::WinMIDIPort::Of(impl)->GetActiveImpl() != nullptr);
  }
}

/// The endpoints of a list that belong to an entity.
template <class Handle>
std::set<Handle> InEntities(int count, std::function<Handle(int)> const& get) {
  std::set<Handle> result;
  for (int i = 0; i < count; ++i) {
    if (get(i).GetEntity().Exists()) {
      result.insert(get(i));
    }
  }
  return result;
}

/// The lists hold exactly what the devices have.
void ExpectListsAgree(Setup const& setup) {
  std::set<Entity> entities;
  std::set<Source> sources;
  std::set<Destination> destinations;
  for (int i = 0; i < setup.CountDevices(); ++i) {
    Device const device = setup.GetDevice(i);
    for (int k = 0; k < device.CountEntities(); ++k) {
      Entity const entity = device.GetEntity(k);
      ASSERT_EQ(entity.GetDevice(), device);
      entities.insert(entity);
      for (int n = 0; n < entity.CountSources(); ++n) {
        sources.insert(entity.GetSource(n));
      }
      for (int n = 0; n < entity.CountDestinations(); ++n) {
        destinations.insert(entity.GetDestination(n));
      }
    }
  }
  ASSERT_EQ(static_cast<int>(entities.size()), setup.CountEntities());
  for (int i = 0; i < setup.CountEntities(); ++i) {
    ASSERT_EQ(entities.count(setup.GetEntity(i)), 1u);
  }
  ASSERT_EQ(sources,
            InEntities<Source>(setup.CountSources(), [&](int i) { return setup.GetSource(i); }));
  ASSERT_EQ(destinations, InEntities<Destination>(setup.CountDestinations(),
                                                  [&](int i) { return setup.GetDestination(i); }));
}

/// What must hold of a studio at any time.
void ExpectWhole(Setup const& setup) {
  for (int i = 0; i < setup.CountSources(); ++i) {
    ASSERT_NO_FATAL_FAILURE(ExpectEndsAgree(setup.GetSource(i)));
  }
  for (int i = 0; i < setup.CountDestinations(); ++i) {
    ASSERT_NO_FATAL_FAILURE(ExpectEndsAgree(setup.GetDestination(i)));
  }
  ASSERT_NO_FATAL_FAILURE(ExpectListsAgree(setup));
}

/// One port of each way in and out.
std::vector<SimulatedPort> PortsOfEachKind() {
  std::vector<SimulatedPort> ports(5);
  ports[0].name = "Out";
  ports[1].name = "In";
  ports[1].kind = Kind::kWinMMIn;
  ports[2].name = "Native";
  ports[2].kind = Kind::kDirectMusicOut;
  ports[2].external = true;
  ports[3].name = "Native In";
  ports[3].kind = Kind::kDirectMusicIn;
  ports[3].external = true;
  ports[4].name = "Synth";
  ports[4].kind = Kind::kDirectMusicOut;
  ports[4].dls = true;
  return ports;
}

// Fails the first, the second, ... call of the system while all ports go and come back. Whatever is
// missed by that, comes with the next list of ports.
TEST_F(Reconciliation, SurvivesAFailureOfEachCallOfTheSystem) {
  std::vector<SimulatedPort> const ports = PortsOfEachKind();
  std::uint64_t calls = 0;
  for (std::uint64_t nth = 0; nth <= calls; ++nth) {
    SCOPED_TRACE(nth);
    // A device that the system refuses to close stays open for good: a system of its own for each.
    SimulatedMIDI other;
    other.SetCollection({0, 1});
    other.Install();
    SignIn();
    other.ResetCalls();
    if (nth > 0) {
      other.Fail("*", nth);
    }
    for (SimulatedPort const& port : ports) {
      other.AddPort(port);
    }
    Rescan();
    for (SimulatedPort const& port : ports) {
      other.RemovePort(port.name);
    }
    Rescan();
    for (SimulatedPort const& port : ports) {
      other.AddPort(port);
    }
    Rescan();
    calls = nth == 0 ? other.CountCalls() : calls;
    ASSERT_GT(calls, 200u);
    other.ClearFaults();
    Rescan();
    ExpectWhole(setup);
    EXPECT_THAT(DestNames(), UnorderedElementsAre("Out", "Native", "Synth"));
    EXPECT_THAT(SourceNames(), UnorderedElementsAre("In", "Native In"));
    for (int i = 0; i < setup.CountDestinations(); ++i) {
      EXPECT_TRUE(setup.GetDestination(i).IsOnline());
    }
    for (int i = 0; i < setup.CountSources(); ++i) {
      EXPECT_TRUE(setup.GetSource(i).IsOnline());
    }
    SignOut();
    if (HasFatalFailure()) {
      break;
    }
  }
  midi.Install();
}

TEST_F(Reconciliation, AStormOfPlugsLeavesTheStudioWhole) {
  std::mt19937 random(20260);
  auto const below = [&random](unsigned n) { return random() % n; };
  SignIn();
  for (int round = 0; round < 300; ++round) {
    SCOPED_TRACE(round);
    std::string const name = "Port " + std::to_string(below(8));
    switch (below(7)) {
      case 0:
        AddOut(name);
        break;
      case 1:
        AddIn(name);
        break;
      case 2:
        AddNative(name, Kind::kDirectMusicOut, below(2) == 0);
        break;
      case 3:
        midi.RemovePort(name);
        break;
      case 4:
        midi.RenamePort(name, "Port " + std::to_string(below(8)));
        break;
      case 5:
        setup.CreateDevice(UString("Synth"));
        break;
      default:
        if (setup.CountDevices() > 4) {
          setup.DeleteDevice(setup.GetDevice(0));
        } else if (setup.CountDevices() > 0) {
          Entity const entity = setup.GetDevice(0).GetEntity(0);
          setup.GetDestination(0).AddConnectedDestination(entity.GetDestination(0));
          setup.GetSource(0).AddConnectedSource(entity.GetSource(0));
        }
    }
    if (below(3) != 0) {
      Rescan();
    } else {
      setup.PollSetupChanges();
    }
    setup.Poll();
    setup.ProcessInput();
    if (below(3) != 0) {
      Rescan();
    }
    Rescan();
    ExpectWhole(setup);
    if (HasFatalFailure()) {
      return;
    }
  }
}

}  // namespace
}  // namespace Ostinet::Testing
