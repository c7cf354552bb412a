// SPDX-License-Identifier: MIT
#include "names/DocumentNumbers.h"

#include <algorithm>
#include <charconv>
#include <limits>
#include <string>

namespace Ostinet::Impl {

namespace {

bool IsDigit(char16_t unit) { return unit >= '0' && unit <= '9'; }

UString::const_iterator BehindWhiteSpace(UString const& text) {
  return std::find_if(text.begin(), text.end(),
                      [](char16_t unit) { return unit != ' ' && (unit < '\t' || unit > '\r'); });
}

// The digits from `place` on, up to 0 to `max`.
bool ReadDigits(UString::const_iterator place, UString::const_iterator end, long long max,
                long long& out) {
  if (place == end || !IsDigit(*place)) {
    return false;
  }
  long long number = 0;
  for (; place != end && IsDigit(*place); ++place) {
    number = number * 10 + (*place - '0');
    if (number > max) {
      return false;
    }
  }
  out = number;
  return true;
}

}  // namespace

bool ReadUnsigned(UString const& text, unsigned max, unsigned& out) {
  long long number = 0;
  if (!ReadDigits(BehindWhiteSpace(text), text.end(), max, number)) {
    return false;
  }
  out = static_cast<unsigned>(number);
  return true;
}

bool ReadSigned(UString const& text, int& out) {
  auto place = BehindWhiteSpace(text);
  bool const isNegative = place != text.end() && *place == '-';
  place += isNegative ? 1 : 0;
  long long const max = static_cast<long long>(std::numeric_limits<int>::max());
  long long number = 0;
  if (!ReadDigits(place, text.end(), isNegative ? max + 1 : max, number)) {
    return false;
  }
  out = static_cast<int>(isNegative ? -number : number);
  return true;
}

bool ReadDouble(UString const& text, double& out) {
  auto place = BehindWhiteSpace(text);
  place += place != text.end() && *place == '+' ? 1 : 0;
  std::string number;
  for (; place != text.end() && *place < 0x80; ++place) {
    number.push_back(static_cast<char>(*place));
  }
  // Words such as "inf" are numbers to the function below, but not to documents.
  std::size_t const first = !number.empty() && number[0] == '-' ? 1 : 0;
  bool const isNumber =
      first < number.size() &&
      (IsDigit(static_cast<unsigned char>(number[first])) || number[first] == '.');
  double value = 0;
  if (!isNumber ||
      std::from_chars(number.data(), number.data() + number.size(), value).ec != std::errc()) {
    return false;
  }
  out = value;
  return true;
}

int HexadecimalDigit(char16_t unit) {
  if (IsDigit(unit)) {
    return unit - '0';
  }
  if (unit >= 'a' && unit <= 'f') {
    return unit - 'a' + 10;
  }
  return unit >= 'A' && unit <= 'F' ? unit - 'A' + 10 : -1;
}

bool ReadHexadecimalByte(UString const& text, unsigned char& out) {
  unsigned value = 0;
  for (char16_t const unit : text) {
    int const digit = HexadecimalDigit(unit);
    if (digit < 0) {
      return false;
    }
    value = (value * 16 + static_cast<unsigned>(digit)) & 0xFFU;
  }
  if (text.empty()) {
    return false;
  }
  out = static_cast<unsigned char>(value);
  return true;
}

}  // namespace Ostinet::Impl
