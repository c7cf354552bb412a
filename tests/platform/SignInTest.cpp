// SPDX-License-Identifier: MIT

#include "platform/PlatformTest.h"

namespace Ostinet::Testing {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;

class SignIn : public PlatformTest {};

TEST_F(SignIn, FindsThePortsAndTellsTheListenerOnce) {
  AddOut("Out");
  AddIn("In");
  PlatformTest::SignIn();
  EXPECT_THAT(DestNames(), ElementsAre("Out"));
  EXPECT_THAT(SourceNames(), ElementsAre("In"));
  EXPECT_EQ(listener.setupChanges, 1);
}

TEST_F(SignIn, ASecondOneChangesNothing) {
  PlatformTest::SignIn();
  EXPECT_EQ(setup.SignIn(UString("Other"), nullptr, nullptr), Setup::kSignInAlreadySignedIn);
  EXPECT_EQ(setup.SignInName(), UString("Test"));
  EXPECT_EQ(setup.GetReceiver(), &receiver);
}

TEST_F(SignIn, WithoutPrefsHandlerAndReceiverWorks) {
  AddOut("Out");
  EXPECT_EQ(setup.SignIn(UString("Test"), nullptr, nullptr), Setup::kSignInOK);
  EXPECT_THAT(DestNames(), ElementsAre("Out"));
  SignOut(true);
}

TEST_F(SignIn, ReportsAnAbsentClockAndStaysSignedInWithoutPorts) {
  AddOut("Out");
  midi.SetMasterClockAbsent(true);
  PlatformTest::SignIn(Setup::kSignInNoMasterClock);
  EXPECT_TRUE(setup.IsSignedIn());
  EXPECT_EQ(setup.CountDestinations(), 0);
  EXPECT_EQ(listener.setupChanges, 0);
  PlatformTest::SignIn(Setup::kSignInAlreadySignedIn);
}

TEST_F(SignIn, ReportsAClockCoarserThanAMillisecond) {
  midi.MoveClockByHand(1000000);
  midi.SetStepPerReading(10001);
  PlatformTest::SignIn(Setup::kSignInCoarseMasterClock);
  EXPECT_TRUE(setup.IsSignedIn());
}

TEST_F(SignIn, TakesAClockOfExactlyAMillisecond) {
  midi.MoveClockByHand(1000000);
  midi.SetStepPerReading(10000);
  PlatformTest::SignIn();
}

TEST_F(SignIn, FailsOnAClockThatStandsStill) {
  midi.SetMasterClockStill(true);
  PlatformTest::SignIn(Setup::kSignInPlatformError);
  EXPECT_FALSE(setup.IsSignedIn());
  EXPECT_EQ(midi.CountObjects(), 0);
  midi.SetMasterClockStill(false);
  PlatformTest::SignIn();
}

TEST_F(SignIn, MakesTwentyBuffersAndBothDirectMusicObjects) {
  midi.LogCalls(true);
  PlatformTest::SignIn();
  auto const calls = Names(Log({"CreateDirectMusic", "SetDirectSound", "CreateDirectMusicLoader",
                                "CreateMusicBuffer", "GetMasterClock"}));
  std::vector<std::string> expected{"CreateDirectMusic", "SetDirectSound",
                                    "CreateDirectMusicLoader"};
  expected.insert(expected.end(), 20, "CreateMusicBuffer");
  expected.push_back("GetMasterClock");
  EXPECT_EQ(calls, expected);
}

// Fail the first, the second, ... call of the system until the sign-in comes through untouched:
// after each, the studio is either signed in and whole, or signed out and empty.
TEST_F(SignIn, SurvivesAFailureOfEachCallOfTheSystem) {
  AddOut("Out");
  AddIn("In");
  AddNative("Native", SimulatedPort::Kind::kDirectMusicOut);
  AddNative("Native In", SimulatedPort::Kind::kDirectMusicIn);
  SimulatedPort synth;
  synth.name = "Synth";
  synth.kind = SimulatedPort::Kind::kDirectMusicOut;
  synth.dls = true;
  midi.AddPort(synth);
  midi.SetCollection({0, 1});

  midi.ResetCalls();
  PlatformTest::SignIn();
  SignOut();
  std::uint64_t const calls = midi.CountCalls();
  ASSERT_GT(calls, 100u);
  for (std::uint64_t nth = 1; nth <= calls; ++nth) {
    SCOPED_TRACE(nth);
    midi.Fail("*", nth);
    Setup::SignInResult result = Setup::kSignInOK;
    try {
      result = setup.SignIn(UString("Test"), &receiver, &prefs);
    } catch (VantorError const&) {
      // Audio sessions that cannot be listed end the loading; the session is up.
    }
    midi.ClearFaults();
    if (result == Setup::kSignInPlatformError) {
      EXPECT_FALSE(setup.IsSignedIn());
      EXPECT_EQ(setup.CountDestinations() + setup.CountSources(), 0);
      EXPECT_EQ(midi.CountObjects(), 0);
    } else {
      EXPECT_TRUE(setup.IsSignedIn());
      Rescan();  // what was missed comes with the next list of ports
      EXPECT_EQ(setup.CountDestinations(), 3);
      EXPECT_EQ(setup.CountSources(), 2);
    }
    SignOut();
  }
}

TEST_F(SignIn, SignOutSurvivesAFailureOfEachCallOfTheSystem) {
  AddOut("Out");
  AddIn("In");
  AddNative("Native", SimulatedPort::Kind::kDirectMusicOut);
  AddNative("Native In", SimulatedPort::Kind::kDirectMusicIn);
  PlatformTest::SignIn();
  midi.ResetCalls();
  SignOut();
  std::uint64_t const calls = midi.CountCalls();
  ASSERT_GT(calls, 10u);
  for (std::uint64_t nth = 1; nth <= calls; ++nth) {
    SCOPED_TRACE(nth);
    // A device that the system refuses to close stays open for good: a system of its own for each.
    SimulatedMIDI other;
    for (SimulatedPort const& port : midi.Ports()) {
      other.AddPort(port);
    }
    other.Install();
    PlatformTest::SignIn();
    other.Fail("*", nth);
    SignOut();
    other.ClearFaults();
    EXPECT_FALSE(setup.IsSignedIn());
    EXPECT_EQ(setup.CountDestinations() + setup.CountSources(), 0);
  }
  midi.Install();
}

TEST_F(SignIn, SignOutEmptiesTheStudioAndKeepsItsName) {
  AddOut("Out");
  PlatformTest::SignIn();
  Destination const out = Dest("Out");
  SignOut();
  EXPECT_FALSE(out.Exists());
  EXPECT_EQ(setup.CountDestinations(), 0);
  EXPECT_EQ(setup.GetReceiver(), nullptr);
  EXPECT_EQ(setup.SignInName(), UString("Test"));
}

// Ports that the sign-in found count as a change: hosts that draw the studio after their first poll
// rely on it.
TEST_F(SignIn, TheFirstPollTellsOfTheStudioOnceMore) {
  AddOut("Out");
  PlatformTest::SignIn();
  EXPECT_EQ(listener.setupChanges, 1);
  setup.PollSetupChanges();
  EXPECT_EQ(listener.setupChanges, 2);
  setup.PollSetupChanges();
  EXPECT_EQ(listener.setupChanges, 2);
}

TEST_F(SignIn, SignOutDropsAListOfPortsThatWaits) {
  PlatformTest::SignIn();
  AddOut("Out");
  ListPorts();
  midi.RemovePort("Out");
  SignOut();
  PlatformTest::SignIn();
  EXPECT_FALSE(setup.HasListedPorts());
  setup.PollSetupChanges();
  EXPECT_THAT(DestNames(), IsEmpty());
}

TEST_F(SignIn, PollsAndSignOutsWhileSignedOutAreHarmless) {
  SignOut(true);
  setup.Poll();
  setup.PollSetupChanges();
  setup.ProcessInput();
  setup.DevicesChanged();
  setup.Panic();
  EXPECT_FALSE(setup.HasListedPorts());
  EXPECT_THAT(prefs.blocks, IsEmpty());
}

TEST_F(SignIn, AFailedOneNeverOverwritesTheSavedStudio) {
  AddOut("Out");
  PlatformTest::SignIn();
  Dest("Out").SetManufacturer(UString("Acme"));
  SignOut(true);
  midi.Fail("CreateDirectMusic");
  PlatformTest::SignIn(Setup::kSignInPlatformError);
  SignOut(true);
  midi.SetMasterClockAbsent(true);
  PlatformTest::SignIn(Setup::kSignInNoMasterClock);
  SignOut(true);
  midi.SetMasterClockAbsent(false);
  PlatformTest::SignIn();
  EXPECT_EQ(Dest("Out").GetManufacturer(), UString("Acme"));
}

TEST_F(SignIn, TheBackendDescribesItself) {
  Properties const& properties = setup.GetProperties();
  EXPECT_EQ(properties.GetImplementation(), 3);
  EXPECT_EQ(properties.GetImplementationName(), UString("WinMIDI"));
  EXPECT_EQ(properties.GetImplementationVersion(), 0u);
  EXPECT_FALSE(properties.ConfigUtilityExists());
  EXPECT_EQ(properties.GetConfigUtilityName(), UString("No MIDI Utility"));
  EXPECT_EQ(properties.RunConfigUtility(), 3);
}

}  // namespace
}  // namespace Ostinet::Testing
