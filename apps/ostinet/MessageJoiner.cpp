// SPDX-License-Identifier: MIT
#include "MessageJoiner.h"

#include "Messages.h"

namespace Ostinet::Tool {
namespace {

// A driver that never ends a sysex must not take all memory.
constexpr size_t kMaxSysexSize = 16u << 20;

}  // namespace

void MessageJoiner::Take(unsigned long long clocks, Bytes const& packet, Sink const& sink) {
  if (packet.empty()) {
    return;
  }
  unsigned char const first = packet.front();
  if (first == kSysexStart || (!sysex_.empty() && (!IsStatus(first) || first == kSysexEnd))) {
    TakeSysexBytes(clocks, packet, sink);
    return;
  }
  if (!IsRealtime(first)) {
    Finish(sink);
  }
  size_t const length = MessageLength(first);
  if (length == 0 || length >= packet.size()) {
    sink(clocks, packet);
    return;
  }
  auto const end = packet.begin() + static_cast<std::ptrdiff_t>(length);
  sink(clocks, Bytes(packet.begin(), end));
  TakeRest(clocks, Bytes(end, packet.end()), sink);
}

// What follows a message in its packet is another message, or filling without meaning.
void MessageJoiner::TakeRest(unsigned long long clocks, Bytes const& rest, Sink const& sink) {
  if (!rest.empty() && IsStatus(rest.front())) {
    Take(clocks, rest, sink);
  }
}

void MessageJoiner::TakeSysexBytes(unsigned long long clocks, Bytes const& packet,
                                   Sink const& sink) {
  if (packet.front() == kSysexStart) {
    Finish(sink);
    sysexClocks_ = clocks;
  }
  for (auto byte = packet.begin(); byte != packet.end(); ++byte) {
    if (IsRealtime(*byte)) {
      sink(clocks, {*byte});
      continue;
    }
    if (IsStatus(*byte) && *byte != kSysexEnd && !sysex_.empty()) {
      Finish(sink);
      TakeRest(clocks, Bytes(byte, packet.end()), sink);
      return;
    }
    sysex_.push_back(*byte);
    if (*byte == kSysexEnd || sysex_.size() >= kMaxSysexSize) {
      Finish(sink);
    }
    if (*byte == kSysexEnd) {
      TakeRest(clocks, Bytes(byte + 1, packet.end()), sink);
      return;
    }
  }
}

void MessageJoiner::Finish(Sink const& sink) {
  if (!sysex_.empty()) {
    Bytes const message = std::move(sysex_);
    sysex_.clear();
    sink(sysexClocks_, message);
  }
}

}  // namespace Ostinet::Tool
