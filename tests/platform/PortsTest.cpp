// SPDX-License-Identifier: MIT

#include <gmock/gmock.h>

#include "platform/PlatformTest.h"

namespace Ostinet::Testing {
namespace {

using ::testing::ElementsAre;
using Kind = SimulatedPort::Kind;

class DirectMusicPort : public PlatformTest {
 protected:
  DirectMusicPort() {
    midi.MoveClockByHand(1000000);
    midi.SetStepPerReading(1);
    midi.SetCollection({0, 1, 2});
  }
  /// A signed-in host with this one output.
  Destination Open(SimulatedPort port) {
    port.name = "Port";
    port.kind = Kind::kDirectMusicOut;
    midi.AddPort(port);
    SignIn();
    midi.SetStepPerReading(0);
    return Dest("Port");
  }
  /// The latency as the library reads it from clocks that stand still.
  int LatencyOf(long long microseconds) {
    SignIn();
    midi.SetStepPerReading(0);
    SimulatedPort port;
    port.name = "Port";
    port.kind = Kind::kDirectMusicOut;
    port.latencyMicroseconds = microseconds;
    midi.AddPort(port);
    Rescan();
    return Dest("Port").GetAdvanceScheduleMicroseconds();
  }
  static SimulatedPort Synth() {
    SimulatedPort port;
    port.dls = true;
    return port;
  }
};

TEST_F(DirectMusicPort, LatencyIsRoundedDownToWholeMilliseconds) {
  EXPECT_EQ(LatencyOf(1499), 1000);
}

TEST_F(DirectMusicPort, LatencyIsRoundedUpFromTheHalf) { EXPECT_EQ(LatencyOf(1500), 2000); }

TEST_F(DirectMusicPort, OfEqualClocksHasNoLatency) { EXPECT_EQ(LatencyOf(0), 0); }

TEST_F(DirectMusicPort, MeasuresItsLatencyAnewAtEachOpening) {
  ASSERT_EQ(LatencyOf(3000), 3000);
  Dest("Port").SetAdvanceScheduleMicroseconds(7);
  SimulatedPort port = midi.Ports().front();
  midi.RemovePort("Port");
  Rescan();
  midi.AddPort(port);
  Rescan();
  EXPECT_EQ(Dest("Port").GetAdvanceScheduleMicroseconds(), 3000);
}

TEST_F(DirectMusicPort, ASynthesizerGetsTheSetOnceAnOpening) {
  Destination const synth = Open(Synth());
  EXPECT_EQ(midi.CountDownloaded("Port"), 3);
  EXPECT_TRUE(synth.SupportsGeneralMIDI());
  Rescan();
  EXPECT_EQ(midi.CountDownloaded("Port"), 3);
  midi.LogCalls(true);
  midi.TakeLog();
  SignOut();
  EXPECT_EQ(Log({"UnloadInstrument"}).size(), 3u);
  EXPECT_EQ(midi.CountDownloaded("Port"), 0);
}

TEST_F(DirectMusicPort, AnInstrumentThatFailsIsSkipped) {
  midi.Fail("DownloadInstrument", 2);
  Open(Synth());
  EXPECT_EQ(midi.CountDownloaded("Port"), 2);
}

TEST_F(DirectMusicPort, AMissingCollectionIsNoError) {
  midi.Fail("GetObject");
  EXPECT_TRUE(Open(Synth()).IsOnline());
  EXPECT_EQ(midi.CountDownloaded("Port"), 0);
}

TEST_F(DirectMusicPort, ACollectionWithoutEndIsReadToABound) {
  midi.SetEndless("EnumInstrument", true);
  midi.Fail("DownloadInstrument");
  EXPECT_TRUE(Open(Synth()).IsOnline());
  midi.SetEndless("EnumInstrument", false);
}

TEST_F(DirectMusicPort, WithTheSoundsInHardwareSupportsGeneralMIDI) {
  SimulatedPort port;
  port.gmInHardware = true;
  EXPECT_TRUE(Open(port).SupportsGeneralMIDI());
  EXPECT_EQ(midi.CountDownloaded("Port"), 0);
}

TEST_F(DirectMusicPort, WithoutEitherDoesNot) {
  EXPECT_FALSE(Open(SimulatedPort()).SupportsGeneralMIDI());
}

// Synthesizers ring out: the port stays active until its object dies.
TEST_F(DirectMusicPort, AnOutputIsNotDeactivatedWhenItIsLetGo) {
  Destination const out = Open(SimulatedPort());
  midi.LogCalls(true);
  midi.TakeLog();
  midi.RemovePort("Port");
  Rescan();
  EXPECT_TRUE(Log({"Activate"}).empty());
  EXPECT_FALSE(out.IsOnline());
}

TEST_F(DirectMusicPort, AnInputIsDeactivatedWhenItIsLetGo) {
  AddNative("In", Kind::kDirectMusicIn);
  SignIn();
  midi.LogCalls(true);
  midi.TakeLog();
  midi.RemovePort("In");
  Rescan();
  EXPECT_EQ(Log({"Activate"}).size(), 1u);
}

// A host may hold an endpoint beyond the end of the session.
TEST_F(DirectMusicPort, AnOutputStaysActiveUntilItsObjectDies) {
  Destination held = Open(SimulatedPort());
  midi.LogCalls(true);
  midi.TakeLog();
  SignOut();
  EXPECT_TRUE(Log({"Activate"}).empty());
  EXPECT_EQ(midi.CountObjects("IDirectMusicPort"), 1);
  held = Destination();
  EXPECT_EQ(midi.CountObjects("IDirectMusicPort"), 0);
}

TEST_F(DirectMusicPort, AnOutputDoesNotExistOnceItIsDeactivated) {
  Destination const held = Open(SimulatedPort());
  ASSERT_TRUE(held.Exists());
  SignOut();
  EXPECT_EQ(midi.CountObjects("IDirectMusicPort"), 1) << "the port is still there";
  EXPECT_FALSE(held.Exists());
  held.SetModel(UString("x"));
  midi.SetStepPerReading(1);
  SignIn();
  midi.SetStepPerReading(0);
  setup.PollSetupChanges();
  listener.setupChanges = 0;
  held.SetModel(UString("y"));
  setup.PollSetupChanges();
  EXPECT_EQ(listener.setupChanges, 0) << "a dead endpoint tells of no change";
}

TEST_F(DirectMusicPort, AnInputIsReleasedWhileItsObjectLives) {
  AddNative("In", Kind::kDirectMusicIn);
  SignIn();
  Source const held = Src("In");
  midi.LogCalls(true);
  midi.TakeLog();
  SignOut();
  EXPECT_EQ(Log({"Activate"}).size(), 1u);
  EXPECT_EQ(midi.CountObjects("IDirectMusicPort"), 0);
  EXPECT_FALSE(held.Exists());
}

class LegacyPort : public PlatformTest {
 protected:
  // A device that the system refuses to close stays open for good: a system of its own.
  LegacyPort() {
    SimulatedPort port;
    port.name = "Out";
    port.technology = 1;
    own.AddPort(port);
    own.Install();
    SignIn();
  }
  ~LegacyPort() override {
    SignOut();
    midi.Install();
  }
  SimulatedMIDI own;
};

// Hosts see that the device is not closed then.
TEST_F(LegacyPort, AnOutputThatDoesNotResetStaysOpen) {
  own.Fail("midiOutReset");
  SignOut();
  EXPECT_EQ(own.CountCalls("midiOutClose"), 0u);
  EXPECT_EQ(own.CountOpenDevices(), 1);
}

TEST_F(LegacyPort, AnOutputThatResetsIsClosed) {
  SignOut();
  EXPECT_EQ(own.CountCalls("midiOutClose"), 1u);
  EXPECT_EQ(own.CountOpenDevices(), 0);
}

TEST_F(LegacyPort, AnOutputDoesNotExistOnceItIsDeactivated) {
  Destination const held = Dest("Out");
  ASSERT_TRUE(held.Exists());
  SignOut();
  EXPECT_FALSE(held.Exists());
  EXPECT_FALSE(held.IsOnline());
}

class Editing : public PlatformTest {
 protected:
  Editing() { SignIn(); }
};

TEST_F(Editing, ANewDeviceHasOneEntityWithOneOfEach) {
  Device const device = setup.CreateDevice(UString("Synth"));
  ASSERT_EQ(device.CountEntities(), 1);
  EXPECT_EQ(device.GetEntity(0).GetRawName(), UString("Port 1"));
  EXPECT_EQ(device.GetEntity(0).CountSources(), 1);
  EXPECT_EQ(device.GetEntity(0).CountDestinations(), 1);
}

// What it edits there is told in the next round, and no walk of this round is disturbed.
TEST_F(Editing, AListenerMayEditWhileChangesAreHandedOut) {
  struct Editor : RecordingListener {
    void DestinationNamesChanged(Destination destination, unsigned short channels) override {
      RecordingListener::DestinationNamesChanged(destination, channels);
      onNames(destination);
    }
    std::function<void(Destination const&)> onNames;
  };
  std::vector<Device> devices;
  for (int i = 0; i < 3; ++i) {
    devices.push_back(setup.CreateDevice(UString("Synth")));
  }
  setup.PollSetupChanges();
  Editor editor;
  editor.onNames = [&](Destination const&) {
    for (Device const& device : devices) {
      setup.DeleteDevice(device);
    }
    setup.CreateDevice(UString("Heir"));
  };
  setup.SetListener(&editor);
  for (Device const& device : devices) {
    device.SetSupportsGeneralMIDI(true);
  }
  setup.PollSetupChanges();
  setup.SetListener(&listener);
  EXPECT_EQ(editor.names.size(), 1u);  // the other two had gone
  ASSERT_EQ(setup.CountDevices(), 1);
  EXPECT_EQ(setup.GetDevice(0).GetName(), UString("Heir"));
  editor.names.clear();
  listener.setupChanges = 0;
  setup.PollSetupChanges();
  EXPECT_EQ(listener.setupChanges, 1);
}

TEST_F(Editing, CountsOfEndpointsGoUpAndDownToNothing) {
  Entity const entity = setup.CreateDevice(UString("Synth")).GetEntity(0);
  setup.SetEntitySources(entity, 3);
  EXPECT_EQ(setup.CountSources(), 3);
  setup.SetEntitySources(entity, -1);
  setup.SetEntityDestinations(entity, -7);
  EXPECT_EQ(setup.CountSources() + setup.CountDestinations(), 0);
}

TEST_F(Editing, AVirtualPairTakesTheIDOfItsReferenceWhereThatIsFree) {
  auto const first =
      setup.CreateVirtualEndpoint(UString("Loop"), Setup::kSourceEnd, Setup::kSourceEnd);
  MatchData const reference = first.first.GetMatchData();
  int const id = first.first.GetUniqueID();
  auto const second = setup.CreateVirtualEndpoint(reference, Setup::kSourceEnd, Setup::kSourceEnd);
  EXPECT_NE(second.first.GetUniqueID(), id);  // in use
  EXPECT_NE(second.first.GetUniqueID(), 0);
  setup.DeleteVirtualEndpoint(first.first);
  setup.DeleteVirtualEndpoint(second.first);
  auto const third = setup.CreateVirtualEndpoint(reference, Setup::kSourceEnd, Setup::kSourceEnd);
  EXPECT_EQ(third.first.GetUniqueID(), id);
  EXPECT_EQ(third.first.GetName(), UString("Loop"));
}

}  // namespace
}  // namespace Ostinet::Testing
