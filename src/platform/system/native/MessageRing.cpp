// SPDX-License-Identifier: MIT
#include "platform/system/native/MessageRing.h"

#include <algorithm>
#include <cstring>

namespace Ostinet::Impl {

static_assert((MessageRing::kCapacity & (MessageRing::kCapacity - 1)) == 0,
              "Running totals wrap without a step only for a power of two");

MessageRing::MessageRing() : bytes_(std::make_unique<unsigned char[]>(kCapacity)) {}

bool MessageRing::Push(std::uint32_t time, unsigned char const* bytes, std::size_t count) {
  std::size_t const at = pushed_.load(std::memory_order_relaxed);
  std::size_t const used = at - popped_.load(std::memory_order_acquire);
  if (count > kCapacity || sizeof(Head) + count > kCapacity - used) return false;
  Head const head{time, static_cast<std::uint32_t>(count)};
  Copy(at, &head, sizeof head);
  Copy(at + sizeof head, bytes, count);
  pushed_.store(at + sizeof head + count, std::memory_order_release);
  return true;
}

bool MessageRing::Pop(std::uint32_t& time, std::vector<unsigned char>& bytes) {
  std::size_t const at = popped_.load(std::memory_order_relaxed);
  if (at == pushed_.load(std::memory_order_acquire)) return false;
  Head head{};
  CopyOut(at, &head, sizeof head);
  time = head.time;
  bytes.resize(head.count);
  CopyOut(at + sizeof head, bytes.data(), head.count);
  popped_.store(at + sizeof head + head.count, std::memory_order_release);
  return true;
}

void MessageRing::Copy(std::size_t at, void const* from, std::size_t count) {
  std::size_t const start = at % kCapacity;
  std::size_t const first = std::min(count, kCapacity - start);
  if (first > 0) std::memcpy(bytes_.get() + start, from, first);
  if (count > first) {
    std::memcpy(bytes_.get(), static_cast<unsigned char const*>(from) + first, count - first);
  }
}

void MessageRing::CopyOut(std::size_t at, void* to, std::size_t count) const {
  std::size_t const start = at % kCapacity;
  std::size_t const first = std::min(count, kCapacity - start);
  if (first > 0) std::memcpy(to, bytes_.get() + start, first);
  if (count > first) {
    std::memcpy(static_cast<unsigned char*>(to) + first, bytes_.get(), count - first);
  }
}

}  // namespace Ostinet::Impl
