// SPDX-License-Identifier: MIT
#include "system/native/FakeService.h"

#include <algorithm>
#include <chrono>

namespace Ostinet::Testing {
namespace {

constexpr auto kPatience = std::chrono::seconds(10);

class FakeWire : public Impl::OutputWire {
 public:
  FakeWire(std::shared_ptr<FakeLine> line, std::size_t maxPiece)
      : line_(std::move(line)), maxPiece_(maxPiece) {}

  bool Send(unsigned char const* bytes, std::size_t count) override {
    return line_->Take(bytes, count);
  }
  std::size_t MaxPiece() const override { return maxPiece_; }
  bool IsUsable() const override { return line_->IsUsable(); }

 private:
  std::shared_ptr<FakeLine> const line_;
  std::size_t const maxPiece_;
};

class FakeInputWire : public Impl::InputWire {};

bool Has(FakeService::Ports const& ports, std::string const& id) {
  return std::any_of(ports.begin(), ports.end(), [&](auto const& port) { return port.id == id; });
}

}  // namespace

void FakeLine::SetFlow(Flow flow) {
  std::scoped_lock lock(mutex_);
  flow_ = flow;
  changed_.notify_all();
}

void FakeLine::SetUsable(bool usable) {
  std::scoped_lock lock(mutex_);
  usable_ = usable;
}

bool FakeLine::IsUsable() {
  std::scoped_lock lock(mutex_);
  return usable_;
}

bool FakeLine::Take(unsigned char const* bytes, std::size_t count) {
  std::unique_lock lock(mutex_);
  holding_ = flow_ == Flow::kHeld;
  changed_.notify_all();
  changed_.wait_for(lock, kPatience, [this] { return flow_ != Flow::kHeld; });
  holding_ = false;
  if (flow_ == Flow::kBroken) return false;
  pieces_.emplace_back(bytes, bytes + count);
  changed_.notify_all();
  return true;
}

std::vector<FakeLine::Piece> FakeLine::WaitForPieces(std::size_t count) {
  std::unique_lock lock(mutex_);
  changed_.wait_for(lock, kPatience, [&] { return pieces_.size() >= count; });
  return pieces_;
}

void FakeLine::WaitUntilHeld() {
  std::unique_lock lock(mutex_);
  changed_.wait_for(lock, kPatience, [this] { return holding_; });
}

std::unique_ptr<Impl::OutputWire> MakeFakeWire(std::shared_ptr<FakeLine> line,
                                               std::size_t maxPiece) {
  return std::make_unique<FakeWire>(std::move(line), maxPiece);
}

std::unique_ptr<Impl::OutputWire> FakeService::OpenOutput(std::string const& id) {
  return Has(outputs, id) ? MakeFakeWire(line) : nullptr;
}

std::unique_ptr<Impl::InputWire> FakeService::OpenInput(std::string const& id,
                                                        Impl::InputSink newSink) {
  if (!Has(inputs, id)) return nullptr;
  sink = std::move(newSink);
  return std::make_unique<FakeInputWire>();
}

}  // namespace Ostinet::Testing
