// SPDX-License-Identifier: MIT
#include "core/Unicode.h"

#include <utf8proc.h>

#include <algorithm>
#include <cstdint>

namespace Ostinet::Impl {

namespace {

constexpr bool IsHighSurrogate(char32_t unit) { return unit >= 0xD800 && unit <= 0xDBFF; }
constexpr bool IsLowSurrogate(char32_t unit) { return unit >= 0xDC00 && unit <= 0xDFFF; }
constexpr bool IsSurrogate(char32_t unit) { return unit >= 0xD800 && unit <= 0xDFFF; }

// What a lead byte announces: how many bytes follow, the bits it holds itself, and the range of
// the byte behind it, which keeps out overlong forms, surrogates and what lies above U+10FFFF.
struct Lead {
  int following;
  char32_t bits;
  std::uint8_t secondMin;
  std::uint8_t secondMax;
};

Lead ReadLead(std::uint8_t byte) {
  if (byte >= 0xC2 && byte <= 0xDF) {
    return {1, byte & 0x1FU, 0x80, 0xBF};
  }
  if (byte >= 0xE0 && byte <= 0xEF) {
    return {2, byte & 0x0FU, std::uint8_t(byte == 0xE0 ? 0xA0 : 0x80),
            std::uint8_t(byte == 0xED ? 0x9F : 0xBF)};
  }
  if (byte >= 0xF0 && byte <= 0xF4) {
    return {3, byte & 0x07U, std::uint8_t(byte == 0xF0 ? 0x90 : 0x80),
            std::uint8_t(byte == 0xF4 ? 0x8F : 0xBF)};
  }
  return {0, kReplacementCharacter, 0, 0};
}

char32_t NextOfUTF8(std::string_view bytes, std::size_t& position) {
  auto const byteAt = [&](std::size_t at) { return static_cast<std::uint8_t>(bytes[at]); };
  Lead const lead = ReadLead(byteAt(position++));
  char32_t character = lead.bits;
  for (int i = 0; i < lead.following; ++i) {
    std::uint8_t const low = i == 0 ? lead.secondMin : 0x80;
    std::uint8_t const high = i == 0 ? lead.secondMax : 0xBF;
    if (position >= bytes.size() || byteAt(position) < low || byteAt(position) > high) {
      return kReplacementCharacter;
    }
    character = (character << 6) | (byteAt(position++) & 0x3FU);
  }
  return character;
}

}  // namespace

void AppendUTF8(std::string_view bytes, std::u16string& out) {
  out.reserve(out.size() + bytes.size());
  std::size_t position = 0;
  while (position < bytes.size()) {
    auto const byte = static_cast<unsigned char>(bytes[position]);
    if (byte < 0x80) {
      out.push_back(byte);
      ++position;
    } else {
      AppendUTF16(NextOfUTF8(bytes, position), out);
    }
  }
}

void AppendAsUTF8(char32_t character, std::string& out) {
  auto const put = [&out](char32_t byte) { out.push_back(static_cast<char>(byte)); };
  if (character < 0x80) {
    put(character);
    return;
  }
  if (character < 0x800) {
    put(0xC0 | (character >> 6));
  } else {
    if (character < 0x10000) {
      put(0xE0 | (character >> 12));
    } else {
      put(0xF0 | (character >> 18));
      put(0x80 | ((character >> 12) & 0x3F));
    }
    put(0x80 | ((character >> 6) & 0x3F));
  }
  put(0x80 | (character & 0x3F));
}

void AppendAsUTF8(std::u16string_view units, std::string& out) {
  out.reserve(out.size() + units.size());
  std::size_t position = 0;
  while (position < units.size()) {
    if (units[position] < 0x80) {
      out.push_back(static_cast<char>(units[position++]));
      continue;
    }
    char32_t const character = NextCharacter(units, position);
    AppendAsUTF8(IsSurrogate(character) ? kReplacementCharacter : character, out);
  }
}

void AppendUTF16(char32_t character, std::u16string& out) {
  if (character < 0x10000) {
    out.push_back(static_cast<char16_t>(character));
    return;
  }
  char32_t const rest = character - 0x10000;
  out.push_back(static_cast<char16_t>(0xD800 | (rest >> 10)));
  out.push_back(static_cast<char16_t>(0xDC00 | (rest & 0x3FF)));
}

char32_t NextCharacter(std::u16string_view units, std::size_t& position) {
  char32_t const first = units[position++];
  if (IsHighSurrogate(first) && position < units.size() && IsLowSurrogate(units[position])) {
    char32_t const second = units[position++];
    return 0x10000 + ((first & 0x3FF) << 10) + (second & 0x3FF);
  }
  return first;
}

bool IsUnicodeWhiteSpace(char32_t character) {
  if (character < 0x80) {
    return character == ' ' || (character >= 0x09 && character <= 0x0D);
  }
  if (character == 0x85) {
    return true;
  }
  switch (utf8proc_category(static_cast<utf8proc_int32_t>(character))) {
    case UTF8PROC_CATEGORY_ZS:
    case UTF8PROC_CATEGORY_ZL:
    case UTF8PROC_CATEGORY_ZP:
      return true;
    default:
      return false;
  }
}

FoldedCharacter FoldCase(char32_t character) {
  FoldedCharacter result{{character}, 1};
  if (character < 0x80) {
    if (character >= 'A' && character <= 'Z') {
      result.characters[0] = character + ('a' - 'A');
    }
    return result;
  }
  if (IsSurrogate(character)) {
    return result;
  }
  utf8proc_int32_t folded[FoldedCharacter::kMaxLength];
  int boundClass = 0;
  auto const length =
      utf8proc_decompose_char(static_cast<utf8proc_int32_t>(character), folded,
                              FoldedCharacter::kMaxLength, UTF8PROC_CASEFOLD, &boundClass);
  // A length of 0 or an error stands for a character that folding leaves alone.
  if (length >= 1 && length <= static_cast<utf8proc_ssize_t>(FoldedCharacter::kMaxLength)) {
    result.length = static_cast<std::size_t>(length);
    std::transform(folded, folded + length, result.characters,
                   [](utf8proc_int32_t c) { return static_cast<char32_t>(c); });
  }
  return result;
}

}  // namespace Ostinet::Impl
