// SPDX-License-Identifier: MIT
#include "platform/system/native/AlsaService.h"

#include <unistd.h>

#include <chrono>
#include <thread>
#include <utility>

#include "platform/system/native/PortNames.h"
#include "platform/system/native/RtMidiSupport.h"
#include "platform/system/native/WireBudget.h"

namespace Ostinet::Impl {
namespace {

// Where it is missing RtMidi throws, and both it and ALSA's library write to standard error; so the
// device is looked at first.
constexpr char kSequencerDevice[] = "/dev/snd/seq";
// What a sysex is cut to: an event of this size fits the sequencer's memory also when others wait,
// and every driver's.
constexpr std::size_t kEncoderBytes = 256;

template <class Midi>
std::unique_ptr<Midi> MakeAlsaMidi(RtMidiErrors& errors) {
  if (access(kSequencerDevice, R_OK | W_OK) != 0) return nullptr;
  try {
    auto midi = std::make_unique<Midi>(RtMidi::LINUX_ALSA, NextWireClientName());
    errors.ListenTo(*midi);
    return midi;
  } catch (RtMidiError const&) {
    return nullptr;
  }
}

template <class Midi>
std::vector<std::string> ListIds(Midi& midi) {
  std::vector<std::string> ids;
  unsigned const count = midi.getPortCount();
  for (unsigned i = 0; i < count; ++i) ids.push_back(midi.getPortName(i));
  return ids;
}

bool IsOwn(std::string const& id) { return id.empty() || id.starts_with(kWireClientPrefix); }

template <class Midi>
std::vector<ServicePort> ListPorts() {
  std::vector<ServicePort> ports;
  RtMidiErrors errors;
  auto const midi = MakeAlsaMidi<Midi>(errors);
  if (!midi) return ports;
  for (std::string& id : ListIds(*midi)) {
    if (IsOwn(id)) continue;
    std::string name = AlsaPortName(id);
    ports.push_back({std::move(id), std::move(name)});
  }
  return ports;
}

// RtMidi knows ports by their place in the list only, so the list is read again just before.
template <class Midi>
bool OpenById(Midi& midi, RtMidiErrors const& errors, std::string const& id) {
  std::vector<std::string> const ids = ListIds(midi);
  for (std::size_t i = 0; i < ids.size(); ++i) {
    if (ids[i] != id) continue;
    unsigned const before = errors.Count();
    midi.openPort(static_cast<unsigned>(i), kWirePortName);
    return errors.Count() == before;
  }
  return false;
}

class AlsaOutputWire : public OutputWire {
 public:
  bool Open(std::string const& id) {
    midi_ = MakeAlsaMidi<RtMidiOut>(errors_);
    return midi_ && OpenById(*midi_, errors_, id);
  }

  // A piece that the sequencer has no room for at present is complained of, and tried again.
  bool Send(unsigned char const* bytes, std::size_t count) override {
    constexpr int kTries = 200;
    std::this_thread::sleep_for(budget_.Spend(count, std::chrono::steady_clock::now()));
    for (int i = 0; i < kTries; ++i) {
      unsigned const before = errors_.Count();
      midi_->sendMessage(bytes, count);
      if (errors_.Count() == before) return true;
      std::this_thread::sleep_for(std::chrono::milliseconds(1));
    }
    return false;
  }

  std::size_t MaxPiece() const override { return kEncoderBytes; }
  bool IsUsable() const override { return true; }

 private:
  WireBudget budget_;
  RtMidiErrors errors_;
  std::unique_ptr<RtMidiOut> midi_;
};

class AlsaInputWire : public InputWire {
 public:
  explicit AlsaInputWire(InputSink sink) : sink_(std::move(sink)) {}

  bool Open(std::string const& id) {
    midi_ = MakeAlsaMidi<RtMidiIn>(errors_);
    if (!midi_) return false;
    midi_->ignoreTypes(false, false, false);
    midi_->setCallback(
        [](double, std::vector<unsigned char>* message, void* self) {
          static_cast<AlsaInputWire*>(self)->sink_(message->data(), message->size());
        },
        this);
    return OpenById(*midi_, errors_, id);
  }

 private:
  InputSink const sink_;
  RtMidiErrors errors_;
  std::unique_ptr<RtMidiIn> midi_;  // last: its death ends the flow
};

}  // namespace

// The sequencer is part of the machine: once there, it stays.
bool AlsaService::IsAlive() {
  if (isAlive_) return true;
  RtMidiErrors errors;
  isAlive_ = MakeAlsaMidi<RtMidiIn>(errors) != nullptr;
  return isAlive_;
}

std::vector<ServicePort> AlsaService::List(PortDirection direction) {
  return direction == PortDirection::kInput ? ListPorts<RtMidiIn>() : ListPorts<RtMidiOut>();
}

std::unique_ptr<OutputWire> AlsaService::OpenOutput(std::string const& id) {
  auto wire = std::make_unique<AlsaOutputWire>();
  return wire->Open(id) ? std::move(wire) : nullptr;
}

std::unique_ptr<InputWire> AlsaService::OpenInput(std::string const& id, InputSink sink) {
  auto wire = std::make_unique<AlsaInputWire>(std::move(sink));
  return wire->Open(id) ? std::move(wire) : nullptr;
}

}  // namespace Ostinet::Impl
