// SPDX-License-Identifier: MIT
#include <utility>

#include "devicetypes/AutodetectImpl.h"

namespace Ostinet {

namespace {

using Impl::kAnyByte;

constexpr unsigned char kFirstSlot = kAnyByte + 1;

}  // namespace

Data::Data(unsigned char const* begin, size_t size) : bytes(begin), count(size) {}
Data::Data(DataPacket const& packet)
    : bytes(packet.data), count(static_cast<size_t>(packet.length)) {}

namespace Autodetect {

Matcher::Matcher(std::vector<MatchEntry> table, bool strict)
    : table_(std::move(table)), strict_(strict) {}
Matcher::Matcher(Matcher const& other) = default;
Matcher& Matcher::operator=(Matcher const& other) = default;
Matcher::~Matcher() = default;

size_t Matcher::Start() const { return 0; }
size_t Matcher::Success() const { return table_.size(); }

// The end of the table is looked for before the byte, so that a longer reply ends as one of just
// the table's length does. Nothing written is taken back on a mismatch: hosts begin each attempt
// with fresh values.
size_t Matcher::Match(Data const& data, size_t position, unsigned char& deviceID,
                      Array<unsigned char, 7>& captured) const {
  for (size_t i = 0; i < data.count; ++i, ++position) {
    if (position >= table_.size()) {
      return strict_ ? 0 : table_.size();
    }
    MatchEntry const entry = table_[position];
    unsigned char const byte = data.bytes[i];
    if (entry.kind != 0) {
      deviceID = static_cast<unsigned char>(byte - entry.value);
    } else if (entry.value >= kFirstSlot) {
      captured[static_cast<size_t>(entry.value - kFirstSlot)] = byte;
    } else if (entry.value < kAnyByte && entry.value != byte) {
      return 0;
    }
  }
  return position;
}

}  // namespace Autodetect

}  // namespace Ostinet
