// SPDX-License-Identifier: MIT
#pragma once

// What the native system needs of a service that carries MIDI between programs: the ALSA sequencer
// or a JACK server. Everything above this interface knows neither.

#include <cstddef>
#include <cstdint>
#include <functional>
#include <memory>
#include <string>
#include <vector>

namespace Ostinet::Impl {

/// Seen from this program: input is what it hears, output what it plays.
enum class PortDirection : int { kInput, kOutput };

/// One port as its service lists it.
struct ServicePort {
  /// The service's own name, by which the port is opened; may hold numbers that change.
  std::string id;
  /// The name for people, stable from boot to boot; not necessarily unique.
  std::string name;
  bool operator==(ServicePort const&) const = default;
};

/// The way to one output port.
///
/// Threads  One at a time.
class OutputWire {
 public:
  virtual ~OutputWire() = default;
  /// One whole MIDI message, or one piece of a long sysex that the next call goes on with. Waits
  /// until the service can take it, for a bounded time; false when it could not be sent.
  virtual bool Send(unsigned char const* bytes, std::size_t count) = 0;
  /// The longest piece that Send takes; longer sysex is cut.
  virtual std::size_t MaxPiece() const = 0;
  /// False once the service has gone for good. [any thread]
  virtual bool IsUsable() const = 0;
};

/// The way from one input port; ends the flow when it dies, and waits for a call in progress.
class InputWire {
 public:
  virtual ~InputWire() = default;
};

/// Takes one whole MIDI message. On the service's realtime thread: must not block.
using InputSink = std::function<void(unsigned char const* bytes, std::size_t count)>;

/// Threads  Any.
/// Errors   Opening gives null on failure, listing an empty list; nothing is thrown.
class MidiService {
 public:
  virtual ~MidiService() = default;
  /// Whether the service answers at present; may try to reach it.
  virtual bool IsAlive() = 0;
  /// Without this library's own ports, in the service's order.
  virtual std::vector<ServicePort> List(PortDirection direction) = 0;
  virtual std::unique_ptr<OutputWire> OpenOutput(std::string const& id) = 0;
  virtual std::unique_ptr<InputWire> OpenInput(std::string const& id, InputSink sink) = 0;
  /// Calls `hint` on any thread whenever the ports may have changed; optional for a service.
  virtual void SetChangeHint(std::function<void()> hint) = 0;
};

}  // namespace Ostinet::Impl
