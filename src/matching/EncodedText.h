// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>

#include "ostinet/core/UString.h"

namespace Ostinet::Impl {

/// A text as it lies in a reference: code units in big-endian order, at any alignment.
///
/// Ownership    A view; the bytes are the reference's. Looking at it allocates nothing.
class EncodedText {
 public:
  EncodedText() = default;
  EncodedText(char const* bytes, std::size_t length) : bytes_(bytes), length_(length) {}

  /// In code units.
  std::size_t length() const { return length_; }
  bool empty() const { return length_ == 0; }
  /// Code unit by code unit.
  bool Equals(UString const& text) const;
  UString Decode() const;
  /// Replaces `text`, in the memory that it has if that is enough.
  void DecodeTo(UString& text) const;

 private:
  char16_t UnitAt(std::size_t index) const;

  char const* bytes_ = nullptr;
  std::size_t length_ = 0;
};

}  // namespace Ostinet::Impl
