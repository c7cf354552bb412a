// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

#include "ostinet/core/UString.h"

namespace Ostinet::Impl {

// The blocks that the host keeps for the library share one form: numbers are unsigned, 32 bits,
// little-endian; a text is the count of its 16-bit code units, then those; a part is its length,
// counted from the length's own first byte, then its content.

/// Walks one block. It never reads outside it, whatever the block says.
///
/// Ownership    The bytes outlive the reader.
/// Errors       What does not fit into the block throws a VantorError, the end of a file (-39).
class PrefsBlockReader {
 public:
  explicit PrefsBlockReader(std::vector<unsigned char> const& bytes)
      : PrefsBlockReader(bytes.data(), bytes.data() + bytes.size()) {}

  bool AtEnd() const { return position_ == end_; }
  std::uint32_t ReadNumber();
  UString ReadText();
  /// A reader of the content of the part that begins here; this one goes on behind it.
  PrefsBlockReader ReadPart();

 private:
  PrefsBlockReader(unsigned char const* position, unsigned char const* end)
      : position_(position), end_(end) {}
  void Demand(std::size_t count) const;

  unsigned char const* position_;
  unsigned char const* end_;
};

/// Builds one block.
class PrefsBlockWriter {
 public:
  void WriteNumber(std::uint32_t number);
  void WriteText(UString const& text);
  /// Starts a part, which goes to the EndPart that is given the same place.
  std::size_t BeginPart();
  void EndPart(std::size_t place);

  std::vector<unsigned char> const& GetBytes() const { return bytes_; }

 private:
  std::vector<unsigned char> bytes_;
};

}  // namespace Ostinet::Impl
