// SPDX-License-Identifier: MIT

// A host on a simulated studio, by nothing but what hosts have.

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <functional>
#include <thread>

#include "ostinet/Endpoint.h"
#include "ostinet/Setup.h"
#include "ostinet/SimulatedMIDI.h"

namespace Ostinet::Testing {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;
using Bytes = std::vector<unsigned char>;

class Callbacks : public OstinetCallbackAPI {
 public:
  double GetSampleTime(unsigned long long hostClocks) override {
    return static_cast<double>(hostClocks);
  }
  Provider<Impl::WinMIDIDevicesListener>* GetDevicesProvider() override { return &provider; }
  Provider<Impl::WinMIDIDevicesListener> provider;
};

class Input : public Receiver {
 public:
  bool WantsPacket(DataPacket const&, Source const&) override { return true; }
  void HandlePacket(DataPacket const& packet, Source const& source) override {
    packets.emplace_back(source.GetName().string(),
                         Bytes(packet.data, packet.data + packet.length));
  }
  std::vector<std::pair<std::string, Bytes>> packets;
};

class Listener : public SetupListener {
 public:
  void SetupChanged() override { ++changes; }
  void CurrentPatchChanged(Destination destination, unsigned short channels) override {
    patches.emplace_back(destination.GetName().string(), channels);
  }
  void DestinationNamesChanged(Destination, unsigned short) override {}
  int changes = 0;
  std::vector<std::pair<std::string, unsigned short>> patches;
};

Callbacks& TheCallbacks() {
  static Callbacks callbacks;
  return callbacks;
}

// Before any test, since the first Setup::Instance of the program looks for them.
[[maybe_unused]] bool const kAreCallbacksInstalled =
    (OstinetCallbackAPI::gInstance = &TheCallbacks()) != nullptr;

/// A signed-in host. The devices provider must outlive the setup, which goes with the process.
class StudioHost : public ::testing::Test {
 protected:
  StudioHost() : setup(Setup::Instance()) { setup.SetListener(&listener); }
  ~StudioHost() override {
    setup.SignOut(false);
    setup.SetListener(nullptr);
  }
  void SignIn() {
    ASSERT_EQ(setup.SignIn(UString("Host"), &input, nullptr), Setup::kSignInOK);
    ASSERT_TRUE(setup.IsSignedIn());
  }
  /// As a host does on a change of the system's devices, until the studio shows it.
  void PollUntil(std::function<bool()> const& done) {
    TheCallbacks().provider.ForEach(
        [](Impl::WinMIDIDevicesListener& dependent) { dependent.DevicesChanged(); });
    while (!done()) {
      setup.PollSetupChanges();
      std::this_thread::yield();
    }
  }
  std::vector<std::string> Destinations() const {
    std::vector<std::string> names;
    for (int i = 0; i < setup.CountDestinations(); ++i) {
      names.push_back(setup.GetDestination(i).GetName().string());
    }
    return names;
  }
  void Send(Destination const& destination, Bytes const& bytes) const {
    destination.SendOnePacket(DataPacket{bytes.data(), bytes.size(), kNoTimeStamp});
  }

  Listener listener;
  Input input;
  Ostinet::Setup& setup;
};

TEST_F(StudioHost, RunsOnTheStudioThatTheEnvironmentNames) {
  SimulatedMIDI const midi = SimulatedMIDI::InUse();
  ASSERT_FALSE(midi.IsNull()) << "OSTINET_STUDIO, which CTest sets, has not chosen the studio";
  SignIn();
  EXPECT_THAT(Destinations(), ElementsAre("Interface", "Rack"));
  Destination const interface = setup.GetDestination(0);
  Destination const rack = setup.GetDestination(1);
  EXPECT_EQ(rack.GetAdvanceScheduleMicroseconds(), 2000);
  ASSERT_EQ(setup.CountSources(), 1);

  Send(interface, {0x90, 60, 64});  // a cable leads it back
  ASSERT_TRUE(midi.Settle());
  setup.ProcessInput();
  EXPECT_THAT(input.packets, ElementsAre(std::make_pair("Interface", Bytes{0x90, 60, 64})));

  EXPECT_TRUE(midi.RemovePort("Interface"));
  PollUntil([&] { return !interface.IsOnline(); });
  EXPECT_TRUE(interface.Exists());
  EXPECT_FALSE(setup.GetSource(0).IsOnline());

  setup.SignOut(false);
  EXPECT_FALSE(interface.Exists());
  EXPECT_EQ(setup.CountDestinations(), 0);
}

class OwnStudio : public StudioHost {
 protected:
  OwnStudio()
      : midi(SimulatedMIDI::FromJSON(R"({"ports": [{"name": "Keys", "kind": "winmm-in"},
                                                   {"name": "Synth", "kind": "winmm-out"}]})")) {
    midi.Install();
    SignIn();
  }
  ~OwnStudio() override {
    setup.SignOut(false);
    midi.Remove();
  }
  SimulatedMIDI midi;
};

TEST_F(OwnStudio, ListsSendsAndReceives) {
  EXPECT_THAT(Destinations(), ElementsAre("Synth"));
  EXPECT_EQ(listener.changes, 1);
  std::unique_ptr<Impl::Sender> const sender = setup.GetDestination(0).MakeSender();
  ASSERT_TRUE(sender->CanSend());
  Bytes const patch{0xC2, 5};
  sender->Send(DataPacket{patch.data(), patch.size(), kNoTimeStamp});
  sender->Flush();
  ASSERT_EQ(midi.Sent("Synth").size(), 1u);
  EXPECT_EQ(midi.Sent("Synth")[0].bytes, patch);
  setup.Poll();
  EXPECT_THAT(listener.patches, ElementsAre(std::make_pair("Synth", 4)));

  midi.Inject("Keys", {0x90, 1, 2});
  ASSERT_TRUE(midi.Settle());
  setup.ProcessInput();
  EXPECT_THAT(input.packets, ElementsAre(std::make_pair("Keys", Bytes{0x90, 1, 2})));
}

TEST_F(OwnStudio, HandlesOutliveAnUnpluggedPortAndServeAgainWhenItIsBack) {
  Destination const synth = setup.GetDestination(0);
  std::unique_ptr<Impl::Sender> const sender = synth.MakeSender();
  midi.RemovePort("Synth");
  PollUntil([&] { return !synth.IsOnline(); });
  EXPECT_FALSE(sender->CanSend());
  Send(synth, {0x90, 1, 1});
  EXPECT_THAT(midi.Sent(), IsEmpty());

  SimulatedPort port;
  port.name = "Synth";
  midi.AddPort(port);
  PollUntil([&] { return synth.IsOnline(); });
  EXPECT_TRUE(synth == setup.GetDestination(0));
  Send(synth, {0x90, 2, 2});
  EXPECT_EQ(midi.Sent("Synth").size(), 1u);
}

TEST_F(OwnStudio, AnInstrumentHangsOnAPort) {
  Device const device = setup.CreateDevice(UString("Sampler"));
  ASSERT_TRUE(device.Exists());
  Destination const sampler = device.GetEntity(0).GetDestination(0);
  Destination const port = setup.GetDestination(0);
  port.AddConnectedDestination(sampler);
  setup.PollSetupChanges();
  EXPECT_TRUE(sampler.GetDirectDestination() == port);
  EXPECT_TRUE(device.IsOnline());
  Send(sampler, {0x80, 1, 1});
  EXPECT_EQ(midi.Sent("Synth").size(), 1u);
  setup.DeleteDevice(device);
  EXPECT_FALSE(sampler.Exists());
}

TEST_F(OwnStudio, AVirtualPairCarriesBytesWithinTheHost) {
  std::pair<Source, Destination> const pair =
      setup.CreateVirtualEndpoint(UString("Loop"), Setup::kSourceEnd, Setup::kDestinationEnd);
  EXPECT_TRUE(pair.first.GetMatchingVirtualDestination() == pair.second);
  Send(pair.second, {0x90, 3, 3});
  setup.ProcessInput();
  EXPECT_THAT(input.packets, ElementsAre(std::make_pair("Loop", Bytes{0x90, 3, 3})));
  setup.DeleteVirtualEndpoint(pair.first);
  EXPECT_FALSE(pair.second.Exists());
}

}  // namespace
}  // namespace Ostinet::Testing
