// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <string>
#include <string_view>

namespace Ostinet::Impl {

constexpr char32_t kReplacementCharacter = 0xFFFD;

/// Appends UTF-8 as UTF-16. Each malformed sequence becomes one U+FFFD.
void AppendUTF8(std::string_view bytes, std::u16string& out);

/// Appends UTF-16 as UTF-8. Half a surrogate pair becomes U+FFFD.
void AppendAsUTF8(std::u16string_view units, std::string& out);
void AppendAsUTF8(char32_t character, std::string& out);

/// Appends one character, which is no surrogate, as UTF-16.
void AppendUTF16(char32_t character, std::u16string& out);

/// Takes the next character; half a surrogate pair is given as it stands. `position` is within
/// the text and moves behind the character.
char32_t NextCharacter(std::u16string_view units, std::size_t& position);

/// White space of any script, the no-break kinds too.
bool IsUnicodeWhiteSpace(char32_t character);

/// The character without its case. Most give one; a few, such as the sharp s, up to three.
struct FoldedCharacter {
  static constexpr std::size_t kMaxLength = 4;
  char32_t characters[kMaxLength];
  std::size_t length;
};
FoldedCharacter FoldCase(char32_t character);

}  // namespace Ostinet::Impl
