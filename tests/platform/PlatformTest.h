// SPDX-License-Identifier: MIT
#pragma once

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "ostinet/Setup.h"
#include "ostinet/SimulatedMIDI.h"
#include "platform/WinMIDISetup.h"
#include "support/Recorders.h"

namespace Ostinet::Testing {

using Bytes = std::vector<unsigned char>;

/// A packet as the host got it.
struct Received {
  std::string source;
  Bytes bytes;
  unsigned long long clocks;
  bool operator==(Received const& other) const {
    return source == other.source && bytes == other.bytes;
  }
};

/// Takes what the filter lets through and notes it.
class TestReceiver final : public Receiver {
 public:
  bool WantsPacket(DataPacket const& packet, Source const&) override;
  void HandlePacket(DataPacket const& packet, Source const& source) override;
  /// The bytes of all packets, in order.
  std::vector<Bytes> AllBytes() const;

  std::function<bool(Bytes const&)> filter;
  std::function<void(Bytes const&)> onPacket;
  std::atomic<int> asked{0};
  std::vector<Received> packets;
};

/// What the host lends the library.
class TestCallbacks : public OstinetCallbackAPI {
 public:
  double GetSampleTime(unsigned long long hostClocks) override {
    return static_cast<double>(hostClocks);
  }
  Provider<Impl::WinMIDIDevicesListener>* GetDevicesProvider() override { return &provider; }
  Provider<Impl::WinMIDIDevicesListener> provider;
};

/// A signed-out host on a simulated system of its own. At the end it signs out, and nothing of
/// the system may be left open.
class PlatformTest : public ::testing::Test {
 protected:
  PlatformTest();
  ~PlatformTest() override;

  /// The test fails unless the result is this one.
  void SignIn(Setup::SignInResult expected = Setup::kSignInOK);
  void SignOut(bool save = false);
  /// Lists the ports anew, as after a change that the host was told of, and polls.
  void Rescan();
  /// Lists the ports anew and waits until the list is there.
  void ListPorts();

  void AddOut(std::string const& name, int technology = 1);
  void AddIn(std::string const& name);
  void AddNative(std::string const& name, SimulatedPort::Kind kind, bool external = true);
  /// The endpoint of that name; the null handle, and a failed test, if there is none.
  Destination Dest(std::string const& name);
  Source Src(std::string const& name);
  std::vector<std::string> DestNames() const;
  std::vector<std::string> SourceNames() const;
  int OfflineProperty(Endpoint const& endpoint) const;
  int WhichAPI(Endpoint const& endpoint) const;
  void Send(Destination const& destination, Bytes const& bytes, unsigned long long clocks = 0);
  std::vector<Bytes> SentTo(std::string const& port) const;
  /// The operations logged since the last call, without those of which nothing was asked.
  std::vector<SimulatedCall> Log(std::vector<std::string> const& operations);

  SimulatedMIDI midi;
  TestReceiver receiver;
  RecordingListener listener;
  MemoryPrefs prefs;
  static TestCallbacks& Callbacks();
  Impl::WinMIDISetup& setup;
};

/// "midiOutOpen Interface 1", one for each call.
std::vector<std::string> Names(std::vector<SimulatedCall> const& calls);

inline TimeStamp At(unsigned long long clocks) { return TimeStamp(Clocks(clocks)); }

}  // namespace Ostinet::Testing
