// SPDX-License-Identifier: MIT
#include <algorithm>
#include <cstddef>
#include <functional>

#include "ostinet/TimeStamp.h"

namespace Ostinet {

DataBuffer::DataBuffer() = default;

void DataBuffer::Add(TimeStamp const& stamp, unsigned char const* bytes, size_t length) {
  if (bytes == nullptr) {
    length = 0;
  }
  size_t const offset = bytes_.size();
  std::less<unsigned char const*> const before;
  unsigned char const* const own = bytes_.data();
  bool const isOwn = length > 0 && offset > 0 && !before(bytes, own) && before(bytes, own + offset);
  size_t const ownOffset = isOwn ? static_cast<size_t>(bytes - own) : 0;

  entries_.push_back({stamp, offset, length});
  try {
    // Growing moves the bytes, so that one's own are found again behind it.
    bytes_.resize(offset + length);
  } catch (...) {
    entries_.pop_back();
    throw;
  }
  unsigned char const* const from = isOwn ? bytes_.data() + ownOffset : bytes;
  std::copy(from, from + length, bytes_.begin() + static_cast<std::ptrdiff_t>(offset));
}

void DataBuffer::AppendByte(unsigned char byte) {
  if (!entries_.empty()) {
    bytes_.push_back(byte);
    ++entries_.back().length;
  }
}

DataPacket DataBuffer::operator[](size_t index) const {
  if (index >= entries_.size()) {
    return DataPacket();
  }
  Entry const& entry = entries_[index];
  return {bytes_.data() + entry.offset, entry.length, entry.stamp};
}

// Of an empty buffer the index wraps around, and lies beyond the last packet.
DataPacket DataBuffer::back() const { return (*this)[entries_.size() - 1]; }

}  // namespace Ostinet
