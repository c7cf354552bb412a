// SPDX-License-Identifier: MIT
#include "devicetypes/AttributeText.h"

namespace Ostinet::Impl {

namespace {

constexpr int kHighestDataByte = 0x7F;

bool IsDigit(char16_t unit) { return unit >= u'0' && unit <= u'9'; }

// The value of a digit, or -1.
int DigitValue(char16_t unit) {
  if (IsDigit(unit)) {
    return unit - u'0';
  }
  return unit >= u'A' && unit <= u'F' ? unit - u'A' + 10 : -1;
}

}  // namespace

std::optional<unsigned> ParseDecimal(UString const& text, unsigned max) {
  auto unit = text.begin();
  while (unit != text.end() && XMLLib::Parser::IsWhitespace(*unit)) {
    ++unit;
  }
  bool const isNegative = unit != text.end() && *unit == u'-';
  if (unit != text.end() && (*unit == u'-' || *unit == u'+')) {
    ++unit;
  }
  if (unit == text.end() || !IsDigit(*unit)) {
    return std::nullopt;
  }
  unsigned long long value = 0;
  for (; unit != text.end() && IsDigit(*unit); ++unit) {
    value = value * 10 + static_cast<unsigned>(*unit - u'0');
    if (value > max) {
      return std::nullopt;
    }
  }
  if (isNegative && value != 0) {
    return std::nullopt;
  }
  return static_cast<unsigned>(value);
}

std::optional<unsigned> ReadDecimal(XMLLib::Parser const& parser, XMLLib::Name const& name,
                                    unsigned max) {
  UString text;
  return parser.ReadAttribute(name, text) ? ParseDecimal(text, max) : std::nullopt;
}

std::optional<std::vector<unsigned char>> ParseHexBytes(UString const& text) {
  std::vector<unsigned char> bytes;
  int high = -1;  // the first digit of a pair that waits for its second
  for (char16_t const unit : text) {
    if (XMLLib::Parser::IsWhitespace(unit)) {
      continue;
    }
    int const digit = DigitValue(unit);
    if (digit < 0) {
      return std::nullopt;
    }
    if (high < 0) {
      high = digit;
      continue;
    }
    int const byte = high * 16 + digit;
    if (byte > kHighestDataByte) {
      return std::nullopt;
    }
    bytes.push_back(static_cast<unsigned char>(byte));
    high = -1;
  }
  if (high >= 0) {
    return std::nullopt;
  }
  return bytes;
}

}  // namespace Ostinet::Impl
