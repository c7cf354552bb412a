// SPDX-License-Identifier: MIT
#pragma once

#include <memory>
#include <string>

#include "ostinet/Setup.h"
#include "ostinet/SimulatedMIDI.h"
#include "platform/WinMIDISetup.h"
#include "platform/system/simulated/SimulatedSystem.h"

namespace Ostinet::Bench {

inline constexpr unsigned char kNoteOn[] = {0x90, 60, 100};
inline constexpr unsigned kNoteOnWord = 0x643C90;  // as WinMM packs it

/// Reads each packet a little, as a host would.
class CountingReceiver : public Receiver {
 public:
  bool WantsPacket(DataPacket const&, Source const&) override { return true; }
  void HandlePacket(DataPacket const& packet, Source const&) override {
    sum += packet.data[1] + packet.stamp.AsMIDITime().Value();
    ++count;
  }

  unsigned long long sum = 0;
  std::size_t count = 0;
};

/// A host on a simulated studio that records nothing, signed out at first and in the end.
class BenchHost {
 public:
  BenchHost();
  ~BenchHost();
  BenchHost(BenchHost const&) = delete;
  BenchHost& operator=(BenchHost const&) = delete;

  void AddPort(std::string const& name, SimulatedPort::Kind kind);
  void SignIn();
  /// The destination of that name; the program ends where there is none.
  Destination Dest(std::string const& name) const;
  Impl::System& System() const { return *midi.GetSystem(); }

  SimulatedMIDI midi;
  CountingReceiver receiver;
  Impl::WinMIDISetup& setup;
};

}  // namespace Ostinet::Bench
