// SPDX-License-Identifier: MIT

#include "platform/PlatformTest.h"

#include <algorithm>
#include <thread>

#include "model/EndpointImpl.h"
#include "model/PropertyKeys.h"

namespace Ostinet::Testing {

namespace {

Impl::EndpointImpl& ImplOf(Endpoint const& endpoint) {
  return *static_cast<Impl::EndpointImpl*>(static_cast<Impl::ObjectImpl*>(endpoint.GetImplPtr()));
}

Bytes BytesOf(DataPacket const& packet) { return Bytes(packet.data, packet.data + packet.length); }

Impl::WinMIDISetup& TheSetup() { return static_cast<Impl::WinMIDISetup&>(Setup::Instance()); }

}  // namespace

bool TestReceiver::WantsPacket(DataPacket const& packet, Source const&) {
  ++asked;
  return !filter || filter(BytesOf(packet));
}

void TestReceiver::HandlePacket(DataPacket const& packet, Source const& source) {
  packets.push_back(
      {source.GetName().string(), BytesOf(packet), packet.stamp.AsMIDITime().Value()});
  if (onPacket) {
    onPacket(packets.back().bytes);
  }
}

std::vector<Bytes> TestReceiver::AllBytes() const {
  std::vector<Bytes> result;
  for (Received const& packet : packets) {
    result.push_back(packet.bytes);
  }
  return result;
}

TestCallbacks& PlatformTest::Callbacks() {
  static TestCallbacks callbacks;
  return callbacks;
}

PlatformTest::PlatformTest() : setup((OstinetCallbackAPI::gInstance = &Callbacks(), TheSetup())) {
  midi.Install();
  setup.SetListener(&listener);
}

PlatformTest::~PlatformTest() {
  listener.patches.clear();  // handles, which would keep ports alive
  midi.ClearFaults();
  SignOut();
  setup.SetListener(nullptr);
  midi.Remove();
  EXPECT_EQ(midi.CountObjects(), 0) << "COM objects are left over";
  EXPECT_EQ(midi.CountOpenDevices(), 0) << "devices are left open";
  EXPECT_EQ(midi.CountWaitHandles(), 0) << "wait handles are left over";
}

void PlatformTest::SignIn(Setup::SignInResult expected) {
  EXPECT_EQ(setup.SignIn(UString("Test"), &receiver, &prefs), expected);
}

void PlatformTest::SignOut(bool save) { setup.SignOut(save); }

void PlatformTest::ListPorts() {
  setup.DevicesChanged();
  while (!setup.HasListedPorts()) {
    std::this_thread::yield();
  }
}

void PlatformTest::Rescan() {
  ListPorts();
  setup.PollSetupChanges();
}

void PlatformTest::AddOut(std::string const& name, int technology) {
  SimulatedPort port;
  port.name = name;
  port.technology = technology;
  midi.AddPort(port);
}

void PlatformTest::AddIn(std::string const& name) {
  SimulatedPort port;
  port.name = name;
  port.kind = SimulatedPort::Kind::kWinMMIn;
  midi.AddPort(port);
}

void PlatformTest::AddNative(std::string const& name, SimulatedPort::Kind kind, bool external) {
  SimulatedPort port;
  port.name = name;
  port.kind = kind;
  port.external = external;
  midi.AddPort(port);
}

Destination PlatformTest::Dest(std::string const& name) {
  for (int i = 0; i < setup.CountDestinations(); ++i) {
    if (setup.GetDestination(i).GetName() == UString(name.c_str())) {
      return setup.GetDestination(i);
    }
  }
  ADD_FAILURE() << "no destination " << name;
  return Destination();
}

Source PlatformTest::Src(std::string const& name) {
  for (int i = 0; i < setup.CountSources(); ++i) {
    if (setup.GetSource(i).GetName() == UString(name.c_str())) {
      return setup.GetSource(i);
    }
  }
  ADD_FAILURE() << "no source " << name;
  return Source();
}

std::vector<std::string> PlatformTest::DestNames() const {
  std::vector<std::string> names;
  for (int i = 0; i < setup.CountDestinations(); ++i) {
    names.push_back(setup.GetDestination(i).GetName().string());
  }
  return names;
}

std::vector<std::string> PlatformTest::SourceNames() const {
  std::vector<std::string> names;
  for (int i = 0; i < setup.CountSources(); ++i) {
    names.push_back(setup.GetSource(i).GetName().string());
  }
  return names;
}

int PlatformTest::OfflineProperty(Endpoint const& endpoint) const {
  return ImplOf(endpoint).GetInt(Impl::Keys::kOffline, -1);
}

int PlatformTest::WhichAPI(Endpoint const& endpoint) const {
  return ImplOf(endpoint).GetInt(Impl::Keys::kWhichAPI, -1);
}

void PlatformTest::Send(Destination const& destination, Bytes const& bytes,
                        unsigned long long clocks) {
  destination.SendOnePacket({bytes.data(), bytes.size(), At(clocks)});
}

std::vector<Bytes> PlatformTest::SentTo(std::string const& port) const {
  std::vector<Bytes> result;
  for (SimulatedMessage const& message : midi.Sent(port)) {
    result.push_back(message.bytes);
  }
  return result;
}

std::vector<SimulatedCall> PlatformTest::Log(std::vector<std::string> const& operations) {
  std::vector<SimulatedCall> result;
  for (SimulatedCall const& call : midi.TakeLog()) {
    if (std::find(operations.begin(), operations.end(), call.operation) != operations.end()) {
      result.push_back(call);
    }
  }
  return result;
}

std::vector<std::string> Names(std::vector<SimulatedCall> const& calls) {
  std::vector<std::string> names;
  for (SimulatedCall const& call : calls) {
    names.push_back(call.operation);
  }
  return names;
}

}  // namespace Ostinet::Testing
