// SPDX-License-Identifier: MIT
//
// How sends to JACK are paced. RtMidi puts a message in a ring of 16 KB, and once a cycle all that
// is in the ring goes into the port's buffer. What does not fit there is silently dropped; a send
// into a full ring waits in a loop, for ever if the server or this client's place in it is gone.
// So within two cycles goes out either one long message or no more than a share of both, and
// nothing at all unless cycles go on and the wire's own port is still there: then the ring was
// emptied since.
#include "platform/system/native/JackWires.h"

#include <algorithm>
#include <utility>

#include "platform/system/native/RtMidiSupport.h"

namespace Ostinet::Impl {
namespace {

constexpr std::size_t kRingSize = 16384;
// A share of the ring, so that one that was missed by a cycle still holds the next.
constexpr std::size_t kRingShare = kRingSize / 3;
// Several programs may send to one port, and share its buffer.
constexpr std::size_t kPortShare = 4;
// Other clients expect a whole sysex in one event, so only those are cut that no ring would hold.
constexpr std::size_t kMaxPiece = 16000;
// What the ring and the port's buffer add to each message.
constexpr std::size_t kOverhead = 12;
// The window of two cycles: whatever was sent before it began has left the ring.
constexpr std::uint64_t kWindowCycles = 2;
// A server joins ports from a later cycle on; what a wire sent before would reach nobody.
constexpr std::uint64_t kJoinCycles = 3;

// RtMidi makes the client at construction, and complains on standard error if the server has just
// died; the look before keeps that to the width of a moment.
template <class Midi>
std::unique_ptr<Midi> MakeJackMidi(JackClient const& client, RtMidiErrors& errors,
                                   std::string const& name) {
  if (!client.IsAlive()) return nullptr;
  try {
    auto midi = std::make_unique<Midi>(RtMidi::UNIX_JACK, name);
    errors.ListenTo(*midi);
    midi->openVirtualPort(kWirePortName);
    return errors.Count() == 0 ? std::move(midi) : nullptr;
  } catch (RtMidiError const&) {
    return nullptr;
  }
}

class JackOutputWire : public OutputWire {
 public:
  explicit JackOutputWire(std::shared_ptr<JackClient> client)
      : client_(std::move(client)),
        name_(NextWireClientName()),
        allowance_(std::min(kRingShare, client_->MidiBufferSize() / kPortShare)) {}

  bool Open(std::string const& id) {
    midi_ = MakeJackMidi<RtMidiOut>(*client_, errors_, name_);
    if (!midi_ || !client_->Join(PortName(), id)) return false;
    windowEnd_ = client_->CycleCount() + kJoinCycles;
    spent_ = allowance_;
    return true;
  }

  bool Send(unsigned char const* bytes, std::size_t count) override {
    if (!IsUsable() || !MakeRoom(count + kOverhead)) return false;
    try {
      midi_->sendMessage(bytes, count);
    } catch (RtMidiError const&) {
      return false;
    }
    return true;
  }

  std::size_t MaxPiece() const override {
    return std::min(kMaxPiece, client_->MidiBufferSize() / 2 - kOverhead);
  }
  bool IsUsable() const override { return client_->IsAlive(); }

 private:
  std::string PortName() const { return name_ + ":" + kWirePortName; }

  bool MakeRoom(std::size_t bytes) {
    if (client_->CycleCount() < windowEnd_ && spent_ + bytes <= allowance_) {
      spent_ += bytes;
      return true;
    }
    if (!client_->WaitForCycle(windowEnd_) || !client_->HasPort(PortName())) return false;
    windowEnd_ = client_->CycleCount() + kWindowCycles;
    spent_ = bytes;
    return true;
  }

  std::shared_ptr<JackClient> const client_;
  std::string const name_;
  std::size_t const allowance_;
  std::uint64_t windowEnd_ = 0;  // as a cycle's count
  std::size_t spent_ = 0;        // within the window
  RtMidiErrors errors_;
  std::unique_ptr<RtMidiOut> midi_;
};

class JackInputWire : public InputWire {
 public:
  JackInputWire(std::shared_ptr<JackClient> client, InputSink sink)
      : client_(std::move(client)), sink_(std::move(sink)) {}

  bool Open(std::string const& id) {
    std::string const name = NextWireClientName();
    midi_ = MakeJackMidi<RtMidiIn>(*client_, errors_, name);
    if (!midi_) return false;
    midi_->ignoreTypes(false, false, false);
    midi_->setCallback(
        [](double, std::vector<unsigned char>* message, void* self) {
          static_cast<JackInputWire*>(self)->sink_(message->data(), message->size());
        },
        this);
    return client_->Join(id, name + ":" + kWirePortName);
  }

 private:
  std::shared_ptr<JackClient> const client_;
  InputSink const sink_;
  RtMidiErrors errors_;
  std::unique_ptr<RtMidiIn> midi_;  // last: its death ends the flow
};

}  // namespace

std::unique_ptr<OutputWire> OpenJackOutput(std::shared_ptr<JackClient> client,
                                           std::string const& id) {
  auto wire = std::make_unique<JackOutputWire>(std::move(client));
  return wire->Open(id) ? std::move(wire) : nullptr;
}

std::unique_ptr<InputWire> OpenJackInput(std::shared_ptr<JackClient> client, std::string const& id,
                                         InputSink sink) {
  auto wire = std::make_unique<JackInputWire>(std::move(client), std::move(sink));
  return wire->Open(id) ? std::move(wire) : nullptr;
}

}  // namespace Ostinet::Impl
