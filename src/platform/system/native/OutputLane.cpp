// SPDX-License-Identifier: MIT
//
// Pushed blocks wait in one flat buffer, each behind its size. The lane's thread takes the whole
// buffer and leaves its own empty one, so that pushing allocates nothing once both have grown.
//
// The mutex is never held while the wire sends, since a wire may wait for its service. Silence and
// the end are noticed between two pieces; a sysex that they cut short is closed with an F7, because
// a listener would take all that follows for its rest.
#include "platform/system/native/OutputLane.h"

#include <algorithm>
#include <chrono>
#include <cstdint>
#include <cstring>
#include <utility>

#include "platform/system/native/MessageSplitter.h"

namespace Ostinet::Impl {

using BlockSize = std::uint32_t;

OutputLane::OutputLane(std::unique_ptr<OutputWire> wire)
    : wire_(std::move(wire)), thread_([this] { Run(); }) {}

OutputLane::~OutputLane() {
  {
    std::scoped_lock lock(mutex_);
    ending_ = true;
  }
  changed_.notify_all();
  thread_.join();
}

bool OutputLane::Push(unsigned char const* bytes, std::size_t count) {
  if (!wire_->IsUsable()) return false;
  {
    std::scoped_lock lock(mutex_);
    if (count + sizeof(BlockSize) > kMaxWaiting - waiting_.size()) return false;
    auto const size = static_cast<BlockSize>(count);
    unsigned char sizeBytes[sizeof size];
    std::memcpy(sizeBytes, &size, sizeof size);
    waiting_.insert(waiting_.end(), sizeBytes, sizeBytes + sizeof size);
    waiting_.insert(waiting_.end(), bytes, bytes + count);
  }
  changed_.notify_all();
  return true;
}

void OutputLane::Silence() {
  {
    std::scoped_lock lock(mutex_);
    waiting_.clear();
    silencing_ = true;
  }
  changed_.notify_all();
}

void OutputLane::Finish(unsigned milliseconds) {
  std::unique_lock lock(mutex_);
  changed_.wait_for(lock, std::chrono::milliseconds(milliseconds),
                    [this] { return waiting_.empty() && !silencing_ && !sending_; });
}

void OutputLane::Run() {
  Bytes blocks;
  std::unique_lock lock(mutex_);
  for (;;) {
    changed_.wait(lock, [this] { return ending_ || silencing_ || !waiting_.empty(); });
    if (ending_) return;
    bool const silence = std::exchange(silencing_, false);
    blocks.clear();
    if (!silence) blocks.swap(waiting_);
    sending_ = true;
    lock.unlock();
    if (silence) {
      SendReleases();
    } else {
      SendBlocks(blocks);
    }
    lock.lock();
    sending_ = false;
    changed_.notify_all();
  }
}

void OutputLane::SendBlocks(Bytes const& blocks) {
  MessageSink const sink = [this](unsigned char const* bytes, std::size_t count) {
    SendMessage(bytes, count);
  };
  standsStill_ = false;
  for (std::size_t at = 0; at < blocks.size() && !standsStill_ && !IsInterrupted();) {
    BlockSize size = 0;
    std::memcpy(&size, blocks.data() + at, sizeof size);
    at += sizeof size;
    SplitMessages(blocks.data() + at, size, sink);
    at += size;
  }
}

void OutputLane::SendMessage(unsigned char const* bytes, std::size_t count) {
  if (standsStill_ || IsInterrupted()) return;
  notes_.Note(bytes, count);
  if (SendPieces(bytes, count)) return;
  unsigned char const end = 0xF7;
  if (count > wire_->MaxPiece()) wire_->Send(&end, 1);
}

// False when it was given up on the way.
bool OutputLane::SendPieces(unsigned char const* bytes, std::size_t count) {
  std::size_t const most = wire_->MaxPiece();
  for (std::size_t at = 0; at < count; at += most) {
    if (at > 0 && IsInterrupted()) return false;
    if (!wire_->Send(bytes + at, std::min(most, count - at))) {
      GiveUpWaiting();
      return false;
    }
  }
  return true;
}

void OutputLane::SendReleases() {
  notes_.Release([this](unsigned char const* bytes) { wire_->Send(bytes, 3); });
}

bool OutputLane::IsInterrupted() {
  std::scoped_lock lock(mutex_);
  return ending_ || silencing_;
}

// A service that stands still would else get, once it moves, what is long out of date.
void OutputLane::GiveUpWaiting() {
  standsStill_ = true;
  std::scoped_lock lock(mutex_);
  waiting_.clear();
}

}  // namespace Ostinet::Impl
