// SPDX-License-Identifier: MIT
#include "platform/system/simulated/Recorder.h"

#include <algorithm>

namespace Ostinet::Impl::Simulated {

void Recorder::Reserve(std::size_t capacity) {
  capacity_ = std::max<std::size_t>(capacity, 1);
  entries_.clear();
  entries_.resize(capacity_);
  oldest_ = count_ = 0;
}

void Recorder::Clear() { oldest_ = count_ = 0; }

void Recorder::Add(std::string const& port, std::uint8_t const* bytes, std::size_t size,
                   Times const& times) {
  if (!on_) return;
  std::size_t index = 0;
  if (count_ < capacity_) {
    index = count_++;
    if (index >= entries_.size()) entries_.emplace_back();
  } else {
    index = oldest_;
    oldest_ = (oldest_ + 1) % capacity_;
  }
  Entry& entry = entries_[index];
  entry.port = &port;
  entry.size = size;
  entry.times = times;
  if (size <= kInlineBytes) {
    std::copy_n(bytes, size, entry.inlineBytes.begin());
  } else {
    entry.moreBytes.assign(bytes, bytes + size);
  }
}

std::vector<SimulatedMessage> Recorder::Read(std::string const* port) const {
  std::vector<SimulatedMessage> result;
  for (std::size_t i = 0; i < count_; ++i) {
    Entry const& entry = entries_[(oldest_ + i) % capacity_];
    if (port != nullptr && *entry.port != *port) continue;
    std::uint8_t const* const bytes =
        entry.size <= kInlineBytes ? entry.inlineBytes.data() : entry.moreBytes.data();
    result.push_back({*entry.port,
                      {bytes, bytes + entry.size},
                      entry.times.handedOver,
                      entry.times.due,
                      entry.times.left});
  }
  return result;
}

}  // namespace Ostinet::Impl::Simulated
