// SPDX-License-Identifier: MIT
#include "platform/system/native/MessageSplitter.h"

namespace Ostinet::Impl {
namespace {

constexpr unsigned char kSysexStart = 0xF0;
constexpr unsigned char kSysexEnd = 0xF7;
constexpr unsigned char kFirstRealtime = 0xF8;

bool IsStatus(unsigned char byte) { return byte >= 0x80; }

// Where the sysex or piece that starts at `from` ends, its F7 included.
std::size_t EndOfSysex(unsigned char const* bytes, std::size_t from, std::size_t count) {
  for (std::size_t i = from; i < count; ++i) {
    if (bytes[i] == kSysexEnd) return i + 1;
    if (i > from && IsStatus(bytes[i]) && bytes[i] < kFirstRealtime) return i;
  }
  return count;
}

}  // namespace

std::size_t MessageLength(unsigned char status) {
  // By the high nibble from 8 to E, then by the low nibble of F.
  constexpr std::size_t kChannelLengths[] = {3, 3, 3, 3, 2, 2, 3};
  constexpr std::size_t kSystemLengths[] = {0, 2, 3, 2, 1, 1, 1, 1, 1, 1, 1, 1, 1, 1, 1, 1};
  if (status < 0x80) return 0;
  if (status < 0xF0) return kChannelLengths[(status >> 4) - 8];
  return kSystemLengths[status & 0x0F];
}

void SplitMessages(unsigned char const* bytes, std::size_t count, MessageSink const& sink) {
  unsigned char running = 0;
  std::size_t at = 0;
  while (at < count) {
    unsigned char const first = bytes[at];
    if (first == kSysexStart || (!IsStatus(first) && running == 0)) {
      std::size_t const end = EndOfSysex(bytes, at, count);
      sink(bytes + at, end - at);
      at = end;
      continue;
    }
    unsigned char const status = IsStatus(first) ? first : running;
    if (status < 0xF0) running = status;
    std::size_t const data = MessageLength(status) - 1;
    unsigned char message[3] = {status, 0, 0};
    if (IsStatus(first)) ++at;
    std::size_t have = 0;
    while (have < data && at < count && !IsStatus(bytes[at])) message[1 + have++] = bytes[at++];
    if (have == data) sink(message, 1 + data);
  }
}

}  // namespace Ostinet::Impl
