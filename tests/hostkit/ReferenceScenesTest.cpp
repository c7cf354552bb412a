// SPDX-License-Identifier: MIT
//
// A host's document meets a studio that changed: the whole library on simulated studios, by what
// hosts have.
#include <gtest/gtest.h>

#include <thread>

#include "ostinet/SimulatedMIDI.h"
#include "ostinet/hostkit/FolderPrefs.h"
#include "ostinet/hostkit/HostCallbacks.h"
#include "ostinet/hostkit/ReferenceResolver.h"
#include "support/TemporaryFolder.h"

namespace Ostinet {
namespace {

using Outcome = ReferenceResolver::Outcome;
using Testing::TemporaryFolder;

// The setup tells them of its end, so they live as long as the process.
HostCallbacks& TheCallbacks() {
  static auto* const callbacks = new HostCallbacks;
  return *callbacks;
}

/// A host with a studio and a folder of settings: one machine.
class Machine {
 public:
  explicit Machine(std::vector<std::string> const& outputs)
      : setup_((TheCallbacks(), Setup::Instance())), prefs_(settings_.GetFolder()) {
    for (std::string const& name : outputs) {
      PlugIn(name);
    }
    Start();
  }
  ~Machine() {
    setup_.SignOut(false);
    midi.Remove();
  }
  Machine(Machine const&) = delete;
  Machine& operator=(Machine const&) = delete;

  void Start() {
    midi.Install();
    EXPECT_EQ(setup_.SignIn(UString("Scenes"), nullptr, &prefs_), Setup::kSignInOK);
  }
  /// The host ends, having saved the studio, and starts anew.
  void Restart() {
    setup_.SignOut(true);
    Start();
  }

  void PlugIn(std::string const& name) {
    SimulatedPort port;
    port.name = name;
    port.technology = 1;
    midi.AddPort(port);
  }
  /// Lets the host find the ports that there are now.
  void LookUntil(std::function<bool()> const& done) {
    TheCallbacks().GetDeviceWatcher().DevicesChanged();
    while (!done()) {
      setup_.PollSetupChanges();
      std::this_thread::yield();
    }
  }

  Destination Named(std::string const& name) const {
    for (int i = 0; i < setup_.CountDestinations(); ++i) {
      if (setup_.GetDestination(i).GetName().string() == name) {
        return setup_.GetDestination(i);
      }
    }
    return Destination();
  }
  bool IsOnline(std::string const& name) const { return Named(name).IsOnline(); }

  Destination Instrument(char const* name, char const* maker, char const* model) {
    Device const device = setup_.CreateDevice(UString(name));
    device.SetManufacturer(UString(maker));
    device.SetModel(UString(model));
    return device.GetEntity(0).GetDestination(0);
  }

  SimulatedMIDI midi;

 private:
  Setup& setup_;
  TemporaryFolder settings_;
  FolderPrefs prefs_;
};

ReferenceResolver::Answer Resolve(MatchData const& reference) {
  return ReferenceResolver().Resolve(reference);
}

/// The one that is found, if it is one.
Destination Found(MatchData const& reference) {
  auto const answer = Resolve(reference);
  EXPECT_EQ(answer.outcome, Outcome::kFound) << answer.InWords();
  return answer.Winner() != nullptr ? answer.Winner()->destination : Destination();
}

TEST(ReferenceScenes, APortThatTheUserRenamesIsFollowed) {
  Machine machine({"MIDI 1", "MIDI 2"});
  Destination const port = machine.Named("MIDI 1");
  MatchData const saved = port.GetMatchData();
  port.SetRawName(UString("Strings"));
  EXPECT_EQ(Found(saved), port);
  EXPECT_EQ(Resolve(saved).Winner()->InWords(), "same ID, other name");
}

TEST(ReferenceScenes, AnInstrumentThatTheUserRenamesIsFollowedThroughARestart) {
  Machine machine({"MIDI 1"});
  Destination const pad = machine.Instrument("Pad", "Acme", "One");
  machine.Instrument("Bass", "Acme", "Two");
  MatchData const saved = pad.GetMatchData();
  pad.GetEntity().GetDevice().SetRawName(UString("Strings"));
  machine.Restart();
  ASSERT_FALSE(pad.Exists());
  EXPECT_EQ(Found(saved), machine.Named("Strings"));
}

// The system's new name is another port to the library. The old one stays, but what is offline is
// nobody to play on.
TEST(ReferenceScenes, APortThatTheSystemRenamesIsNobody) {
  Machine machine({"MIDI 1"});
  Destination const port = machine.Named("MIDI 1");
  MatchData const saved = port.GetMatchData();
  machine.midi.RenamePort("MIDI 1", "Strings");
  machine.LookUntil([&] { return machine.IsOnline("Strings"); });
  EXPECT_EQ(Resolve(saved).outcome, Outcome::kNotFound);
  machine.midi.RenamePort("Strings", "MIDI 1");
  machine.LookUntil([&] { return machine.IsOnline("MIDI 1"); });
  EXPECT_EQ(Found(saved), port);
}

TEST(ReferenceScenes, APortThatIsPluggedInAgainIsItself) {
  Machine machine({"MIDI 1", "MIDI 2"});
  Destination const port = machine.Named("MIDI 2");
  MatchData const saved = port.GetMatchData();
  machine.midi.RemovePort("MIDI 2");
  machine.LookUntil([&] { return !port.IsOnline(); });
  EXPECT_EQ(Resolve(saved).outcome, Outcome::kNotFound);
  machine.PlugIn("MIDI 2");
  machine.LookUntil([&] { return port.IsOnline(); });
  EXPECT_EQ(Found(saved), port);
}

TEST(ReferenceScenes, APortThatIsPluggedInAtALaterStartIsItself) {
  Machine machine({"MIDI 1", "MIDI 2"});
  MatchData const saved = machine.Named("MIDI 2").GetMatchData();
  machine.midi.RemovePort("MIDI 2");
  machine.Restart();
  machine.PlugIn("MIDI 2");
  machine.Restart();
  EXPECT_EQ(Found(saved), machine.Named("MIDI 2"));
  EXPECT_TRUE(machine.IsOnline("MIDI 2"));
  EXPECT_EQ(Resolve(saved).InWords(), "MIDI 2: same ID, same name");
}

TEST(ReferenceScenes, AnInstrumentOnANewInterfaceIsItself) {
  Machine machine({"Old interface"});
  Destination const pad = machine.Instrument("Pad", "", "");
  machine.Named("Old interface").AddConnectedDestination(pad);
  MatchData const saved = pad.GetMatchData();
  machine.midi.RemovePort("Old interface");
  machine.PlugIn("New interface");
  machine.LookUntil([&] { return machine.IsOnline("New interface"); });
  machine.Named("Old interface").RemoveConnectedDestination(pad);
  machine.Named("New interface").AddConnectedDestination(pad);
  EXPECT_EQ(Found(saved), pad);
  EXPECT_EQ(Resolve(saved).Winner()->InWords(), "same ID, same name, other interface");
  machine.Restart();
  EXPECT_EQ(Found(saved), machine.Named("Pad"));
  EXPECT_TRUE(machine.IsOnline("Pad"));
}

MatchData PadOfJimsMachine() {
  Machine jims({"Jim's interface"});
  return jims.Instrument("Jim's Pad", "Acme", "Synth 1").GetMatchData();
}

TEST(ReferenceScenes, OnAnotherMachineTheSameModelIsFound) {
  MatchData const saved = PadOfJimsMachine();
  Machine theirs({"Desk"});
  theirs.Instrument("Bass", "Best", "Bass");
  Destination const rack = theirs.Instrument("Rack", "ACME", "Synth 1");
  EXPECT_EQ(Found(saved), rack);
  EXPECT_EQ(Resolve(saved).Winner()->weight, 2);
  EXPECT_EQ(Resolve(saved).Winner()->InWords(),
            "other ID, other name, same model but for case and blanks");
}

TEST(ReferenceScenes, OnAnotherMachineAPortIsFoundByItsName) {
  MatchData saved;
  {
    Machine jims({"USB MIDI", "Desk"});
    saved = jims.Named("USB MIDI").GetMatchData();
  }
  Machine theirs({"Mixer", "USB MIDI"});
  EXPECT_EQ(Found(saved), theirs.Named("USB MIDI"));
  EXPECT_EQ(Resolve(saved).Winner()->InWords(), "other ID, same name");
}

TEST(ReferenceScenes, BetweenIdenticalInstrumentsNobodyGuesses) {
  MatchData const saved = PadOfJimsMachine();
  Machine theirs({"Desk"});
  Destination const first = theirs.Instrument("Left", "Acme", "Synth 1");
  theirs.Instrument("Middle", "Best", "Bass");
  Destination const second = theirs.Instrument("Right", "Acme", "Synth 1");
  auto const answer = Resolve(saved);
  ASSERT_EQ(answer.outcome, Outcome::kAmbiguous) << answer.InWords();
  ASSERT_EQ(answer.best.size(), 2u);
  EXPECT_EQ(answer.best[0].destination, first);
  EXPECT_EQ(answer.best[1].destination, second);
  EXPECT_EQ(answer.Winner(), nullptr);
}

// Two interfaces of one kind, whose names the systems spell in their own ways.
TEST(ReferenceScenes, BetweenIdenticalInterfacesNobodyGuesses) {
  MatchData saved;
  {
    Machine jims({"Usb Midi"});
    saved = jims.Named("Usb Midi").GetMatchData();
  }
  Machine theirs({"USB MIDI", "Desk", "usb midi"});
  auto const answer = Resolve(saved);
  ASSERT_EQ(answer.outcome, Outcome::kAmbiguous) << answer.InWords();
  ASSERT_EQ(answer.best.size(), 2u);
  EXPECT_EQ(answer.best[0].destination, theirs.Named("USB MIDI"));
  EXPECT_EQ(answer.best[1].destination, theirs.Named("usb midi"));
  EXPECT_EQ(answer.InWords(),
            "2 fit equally well (other ID, same name but for case and blanks): USB MIDI, usb midi");
}

TEST(ReferenceScenes, IdenticalInterfacesOfThisMachineAreToldApartByTheirIDs) {
  Machine machine({"USB MIDI", "usb midi"});
  MatchData const saved = machine.Named("usb midi").GetMatchData();
  machine.Restart();
  EXPECT_EQ(Found(saved), machine.Named("usb midi"));
  EXPECT_EQ(Resolve(saved).runnersUp.size(), 1u);
}

}  // namespace
}  // namespace Ostinet
