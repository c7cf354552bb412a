// SPDX-License-Identifier: MIT
#pragma once

#include <atomic>

#include "platform/system/native/MidiService.h"

namespace Ostinet::Impl {

/// The ports of the ALSA sequencer. It tells nothing of changes here: whoever wants to know looks
/// at the list from time to time.
class AlsaService : public MidiService {
 public:
  bool IsAlive() override;
  std::vector<ServicePort> List(PortDirection direction) override;
  std::unique_ptr<OutputWire> OpenOutput(std::string const& id) override;
  std::unique_ptr<InputWire> OpenInput(std::string const& id, InputSink sink) override;
  void SetChangeHint(std::function<void()>) override {}

 private:
  std::atomic<bool> isAlive_{false};  // set once, by whoever finds out; orders nothing
};

}  // namespace Ostinet::Impl
