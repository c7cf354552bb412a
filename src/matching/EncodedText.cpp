// SPDX-License-Identifier: MIT
#include "matching/EncodedText.h"

namespace Ostinet::Impl {

char16_t EncodedText::UnitAt(std::size_t index) const {
  auto const high = static_cast<unsigned char>(bytes_[2 * index]);
  auto const low = static_cast<unsigned char>(bytes_[2 * index + 1]);
  return static_cast<char16_t>(high << 8 | low);
}

bool EncodedText::Equals(UString const& text) const {
  if (text.length() != length_) {
    return false;
  }
  for (std::size_t i = 0; i < length_; ++i) {
    if (text[i] != UnitAt(i)) {
      return false;
    }
  }
  return true;
}

UString EncodedText::Decode() const {
  UString text;
  DecodeTo(text);
  return text;
}

void EncodedText::DecodeTo(UString& text) const {
  text.resize(length_);
  for (std::size_t i = 0; i < length_; ++i) {
    text[i] = UnitAt(i);
  }
}

}  // namespace Ostinet::Impl
