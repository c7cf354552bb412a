// SPDX-License-Identifier: MIT
#pragma once

#include <condition_variable>
#include <map>
#include <memory>
#include <mutex>
#include <string>
#include <utility>
#include <vector>

#include "platform/system/native/MidiService.h"

namespace Ostinet::Testing {

/// What left through a fake output, shared by the wire and the test.
class FakeLine {
 public:
  using Piece = std::vector<unsigned char>;

  /// Whether sends go through, wait until they may, or fail.
  enum class Flow { kOpen, kHeld, kBroken };

  void SetFlow(Flow flow);
  void SetUsable(bool usable);
  bool IsUsable();
  bool Take(unsigned char const* bytes, std::size_t count);
  /// All pieces so far, once they are at least `count` or ten seconds have passed.
  std::vector<Piece> WaitForPieces(std::size_t count);
  /// Waits until a send is held.
  void WaitUntilHeld();

 private:
  std::mutex mutex_;
  std::condition_variable changed_;
  Flow flow_ = Flow::kOpen;
  bool usable_ = true;
  bool holding_ = false;
  std::vector<Piece> pieces_;
};

std::unique_ptr<Impl::OutputWire> MakeFakeWire(std::shared_ptr<FakeLine> line,
                                               std::size_t maxPiece = 256);

/// A MIDI service in memory. Ports are what the test says.
class FakeService : public Impl::MidiService {
 public:
  using Ports = std::vector<Impl::ServicePort>;

  Ports inputs, outputs;
  bool alive = true;
  std::shared_ptr<FakeLine> const line = std::make_shared<FakeLine>();
  Impl::InputSink sink;  // of the input opened last
  std::function<void()> hint;

  bool IsAlive() override { return alive; }
  Ports List(Impl::PortDirection direction) override {
    return direction == Impl::PortDirection::kInput ? inputs : outputs;
  }
  std::unique_ptr<Impl::OutputWire> OpenOutput(std::string const& id) override;
  std::unique_ptr<Impl::InputWire> OpenInput(std::string const& id,
                                             Impl::InputSink newSink) override;
  void SetChangeHint(std::function<void()> newHint) override { hint = std::move(newHint); }
};

}  // namespace Ostinet::Testing
