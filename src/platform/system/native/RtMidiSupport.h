// SPDX-License-Identifier: MIT
#pragma once

#include <RtMidi.h>

#include <atomic>
#include <string>

namespace Ostinet::Impl {

/// Keeps RtMidi's complaints from standard error, and counts them: its operations report many a
/// failure in no other way.
class RtMidiErrors {
 public:
  void ListenTo(RtMidi& midi) {
    midi.setErrorCallback(
        [](RtMidiError::Type, std::string const&, void* self) {
          static_cast<RtMidiErrors*>(self)->count_.fetch_add(1, std::memory_order_relaxed);
        },
        this);
  }
  unsigned Count() const { return count_; }

 private:
  std::atomic<unsigned> count_{0};  // orders nothing
};

/// The name under which this process's own clients of either service go; every list leaves out the
/// ports of names that begin so, also those of other programs with this library.
inline constexpr char kWireClientPrefix[] = "ostinet-wire-";
/// The one port of such a client.
inline constexpr char kWirePortName[] = "wire";
/// Never the same twice.
std::string NextWireClientName();

}  // namespace Ostinet::Impl
