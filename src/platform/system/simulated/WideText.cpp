// SPDX-License-Identifier: MIT
#include "platform/system/simulated/WideText.h"

#include <algorithm>
#include <cstdint>

namespace Ostinet::Impl::Simulated {

namespace {

constexpr char32_t kReplacement = 0xFFFD;

// The number of bytes that follow a first byte; -1 for one that starts nothing.
int Following(std::uint8_t first) {
  if (first < 0x80) return 0;
  if (first >= 0xC2 && first < 0xE0) return 1;
  if (first >= 0xE0 && first < 0xF0) return 2;
  if (first >= 0xF0 && first < 0xF5) return 3;
  return -1;
}

char32_t Decode(std::string const& text, std::size_t& position) {
  auto const first = static_cast<std::uint8_t>(text[position++]);
  int const following = Following(first);
  if (following == 0) return first;
  if (following < 0) return kReplacement;
  char32_t value = first & (0x3Fu >> following);
  for (int i = 0; i < following; ++i) {
    if (position >= text.size()) return kReplacement;
    auto const next = static_cast<std::uint8_t>(text[position]);
    if ((next & 0xC0) != 0x80) return kReplacement;
    value = (value << 6) | (next & 0x3Fu);
    ++position;
  }
  constexpr char32_t kLeast[] = {0, 0x80, 0x800, 0x10000};
  bool const surrogate = value >= 0xD800 && value < 0xE000;
  return surrogate || value < kLeast[following] || value > 0x10FFFF ? kReplacement : value;
}

}  // namespace

std::u16string Widen(std::string const& text) {
  std::u16string result;
  for (std::size_t i = 0; i < text.size();) {
    char32_t const value = Decode(text, i);
    if (value < 0x10000) {
      result += static_cast<char16_t>(value);
    } else {
      result += static_cast<char16_t>(0xD7C0 + (value >> 10));
      result += static_cast<char16_t>(0xDC00 + (value & 0x3FF));
    }
  }
  return result;
}

void CopyWide(std::u16string const& text, WCHAR* to, std::size_t room) {
  std::size_t count = std::min(text.size(), room - 1);
  bool const cutsPair =
      count < text.size() && count > 0 && text[count - 1] >= 0xD800 && text[count - 1] < 0xDC00;
  if (cutsPair) --count;
  std::transform(text.begin(), text.begin() + static_cast<std::ptrdiff_t>(count), to,
                 [](char16_t unit) { return static_cast<WCHAR>(unit); });
  std::fill(to + count, to + room, WCHAR());
}

}  // namespace Ostinet::Impl::Simulated
