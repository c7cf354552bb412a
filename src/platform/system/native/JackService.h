// SPDX-License-Identifier: MIT
#pragma once

#include <functional>
#include <memory>
#include <mutex>

#include "platform/system/native/JackClient.h"
#include "platform/system/native/MidiService.h"

namespace Ostinet::Impl {

/// The ports of a JACK server. The server may come, die and come again; each wire belongs to the
/// server that it was opened on and is of no use once that has died.
///
/// A new server is looked for only when every wire to the dead one has been closed: JACK's library
/// frees whatever clients of a dead server are left when it connects to the next, and closing such
/// a client afterwards is fatal.
class JackService : public MidiService {
 public:
  JackService();

  bool IsAlive() override;
  std::vector<ServicePort> List(PortDirection direction) override;
  std::unique_ptr<OutputWire> OpenOutput(std::string const& id) override;
  std::unique_ptr<InputWire> OpenInput(std::string const& id, InputSink sink) override;
  void SetChangeHint(std::function<void()> hint) override;

 private:
  // Outlives the service, since wires keep their client and that its callbacks.
  struct ChangeHint {
    std::mutex mutex;
    std::function<void()> call;  // guarded by mutex
  };

  std::shared_ptr<JackClient> Client();

  std::shared_ptr<ChangeHint> const hint_;
  std::mutex mutex_;
  std::shared_ptr<JackClient> client_;  // guarded by mutex_, as is the following
  std::weak_ptr<JackClient> dead_;      // of the last server; wires may still hold it
};

}  // namespace Ostinet::Impl
