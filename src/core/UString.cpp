// SPDX-License-Identifier: MIT
#include "ostinet/core/UString.h"

#include <algorithm>
#include <charconv>
#include <cstring>
#include <string_view>

#include "core/UStringCompare.h"
#include "core/Unicode.h"

namespace Ostinet {

UString const UString::kEmptyString;

namespace {

constexpr char32_t LastCharacter(UString::ByteEncoding encoding) {
  switch (encoding) {
    case UString::kLatin1:
      return 0xFF;
    case UString::kASCII:
      return 0x7F;
    case UString::kUTF8:
      break;
  }
  return 0x10FFFF;
}

std::u16string Decode(std::string_view bytes, UString::ByteEncoding encoding) {
  std::u16string units;
  if (encoding == UString::kUTF8) {
    Impl::AppendUTF8(bytes, units);
    return units;
  }
  units.reserve(bytes.size());
  for (char const byte : bytes) {
    char32_t const character = static_cast<unsigned char>(byte);
    units.push_back(static_cast<char16_t>(
        character <= LastCharacter(encoding) ? character : Impl::kReplacementCharacter));
  }
  return units;
}

std::string_view ViewOf(char const* bytes) {
  return bytes == nullptr ? std::string_view() : std::string_view(bytes);
}

// Appends one character as bytes.
void Encode(char32_t character, UString::ByteEncoding encoding, char replacement, bool leaveOut,
            std::string& out) {
  if (encoding == UString::kUTF8) {
    bool const isSurrogate = character >= 0xD800 && character <= 0xDFFF;
    Impl::AppendAsUTF8(isSurrogate ? Impl::kReplacementCharacter : character, out);
  } else if (character <= LastCharacter(encoding)) {
    out.push_back(static_cast<char>(character));
  } else if (!leaveOut) {
    out.push_back(replacement);
  }
}

std::u16string FromWide(wchar_t const* text) {
  std::u16string units;
  for (; text != nullptr && *text != 0; ++text) {
    auto const character = static_cast<char32_t>(*text);
    bool const isUnit = sizeof(wchar_t) == sizeof(char16_t);
    bool const isCharacter = character <= 0x10FFFF && (character < 0xD800 || character > 0xDFFF);
    Impl::AppendUTF16(isUnit || isCharacter ? character : Impl::kReplacementCharacter, units);
  }
  return units;
}

}  // namespace

UString::UString(UString const& other, size_type position, size_type count)
    : units_(other.units_, position, count) {}
UString::UString(char character) : units_(1, static_cast<unsigned char>(character)) {}
UString::UString(unsigned short unit) : units_(1, unit) {}
UString::UString(char16_t unit) : units_(1, unit) {}
UString::UString(char const* bytes, ByteEncoding encoding)
    : units_(Decode(ViewOf(bytes), encoding)) {}
UString::UString(char const* bytes, size_type count, ByteEncoding encoding)
    : units_(Decode({bytes, count}, encoding)) {}
UString::UString(unsigned char const* pascalText, ByteEncoding encoding) {
  if (pascalText != nullptr) {
    std::string const bytes(pascalText + 1, pascalText + 1 + pascalText[0]);
    units_ = Decode(bytes, encoding);
  }
}
UString::UString(unsigned short const* units) {
  for (; units != nullptr && *units != 0; ++units) {
    units_.push_back(*units);
  }
}
UString::UString(char16_t const* units) : units_(units == nullptr ? u"" : units) {}
UString::UString(wchar_t const* text) : units_(FromWide(text)) {}
UString::UString(std::string const& bytes, ByteEncoding encoding)
    : units_(Decode(bytes, encoding)) {}

UString& UString::assign(UString const& other) { return *this = other; }
UString& UString::assign(UString const& other, size_type position, size_type count) {
  units_.assign(other.units_, position, count);
  return *this;
}
UString& UString::append(UString const& other) {
  units_.append(other.units_);
  return *this;
}
UString& UString::append(UString const& other, size_type position, size_type count) {
  units_.append(other.units_, position, count);
  return *this;
}
UString& UString::append(size_type count, char16_t unit) {
  units_.append(count, unit);
  return *this;
}
UString& UString::operator+=(char16_t unit) {
  units_.push_back(unit);
  return *this;
}
UString& UString::erase(size_type position, size_type count) {
  units_.erase(position, count);
  return *this;
}

UString UString::substr(size_type position, size_type count) const {
  return UString(*this, position, count);
}
UString::size_type UString::find(UString const& text, size_type from) const noexcept {
  return units_.find(text.units_, from);
}
UString::size_type UString::find(char16_t unit, size_type from) const noexcept {
  return units_.find(unit, from);
}
UString::size_type UString::rfind(UString const& text, size_type from) const noexcept {
  return units_.rfind(text.units_, from);
}
UString::size_type UString::rfind(char16_t unit, size_type from) const noexcept {
  return units_.rfind(unit, from);
}
UString::size_type UString::find_first_of(UString const& units, size_type from) const noexcept {
  return units_.find_first_of(units.units_, from);
}
bool UString::starts_with(UString const& text) const noexcept {
  return units_.compare(0, text.length(), text.units_) == 0;
}
bool UString::ends_with(UString const& text) const noexcept {
  return length() >= text.length() &&
         units_.compare(length() - text.length(), text.length(), text.units_) == 0;
}

bool UString::equal(UString const& other, CompareFlags flags) const {
  return Impl::CompareUnits(units_, other.units_, flags) == 0;
}
bool UString::less(UString const& other, CompareFlags flags) const {
  return Impl::CompareUnits(units_, other.units_, flags) < 0;
}

std::string UString::string(ByteEncoding encoding, char replacement, bool leaveOut) const {
  std::string bytes;
  bytes.reserve(length());
  for (size_type position = 0; position < length();) {
    if (units_[position] < 0x80) {  // the same in every encoding, and most of every path
      bytes.push_back(static_cast<char>(units_[position++]));
      continue;
    }
    char32_t const character = Impl::NextCharacter(units_, position);
    Encode(character, encoding, replacement, leaveOut, bytes);
  }
  return bytes;
}

unsigned char* UString::pstring(unsigned char* out, int max, ByteEncoding encoding,
                                unsigned char replacement) const {
  auto const limit = static_cast<size_type>(std::clamp(max, 0, 255));
  std::string bytes;
  for (size_type position = 0; position < length();) {
    size_type const whole = bytes.size();
    char32_t const character = Impl::NextCharacter(units_, position);
    Encode(character, encoding, static_cast<char>(replacement), false, bytes);
    if (bytes.size() > limit) {
      bytes.resize(whole);
      break;
    }
  }
  out[0] = static_cast<unsigned char>(bytes.size());
  std::copy(bytes.begin(), bytes.end(), out + 1);
  return out;
}

}  // namespace Ostinet
