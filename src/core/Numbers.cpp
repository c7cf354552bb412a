// SPDX-License-Identifier: MIT
#include <charconv>
#include <limits>
#include <string_view>

#include "ostinet/core/UString.h"

namespace Ostinet {

namespace {

// Room for every 64-bit number with its sign, and for every double in its shortest form.
constexpr std::size_t kLongestNumber = 32;

template <class Number>
void AppendNumber(Number number, UString& target) {
  char digits[kLongestNumber];
  auto const result = std::to_chars(digits, digits + kLongestNumber, number);
  target.append(UString(digits, static_cast<std::size_t>(result.ptr - digits), UString::kASCII));
}

std::string_view WithoutWhiteSpace(std::string_view text) {
  constexpr char kWhiteSpace[] = " \t\r\n";
  std::size_t const first = text.find_first_not_of(kWhiteSpace);
  if (first == std::string_view::npos) {
    return {};
  }
  return text.substr(first, text.find_last_not_of(kWhiteSpace) - first + 1);
}

}  // namespace

namespace vantor {

void NumToUString(long long number, NumFormat format, UString& out) {
  out.clear();
  if (format != kHexadecimal) {
    AppendNumber(number, out);
    return;
  }
  char digits[kLongestNumber];
  auto const result =
      std::to_chars(digits, digits + kLongestNumber, static_cast<unsigned long long>(number), 16);
  for (char const* digit = digits; digit != result.ptr; ++digit) {
    bool const isLetter = *digit >= 'a';
    out.push_back(static_cast<char16_t>(isLetter ? *digit - 'a' + 'A' : *digit));
  }
}

long long UStringToNum(UString const& text, NumFormat format) {
  std::string const bytes = text.string(UString::kASCII, '?');
  std::string_view digits = WithoutWhiteSpace(bytes);
  if (digits.size() >= 2 && digits[0] == '+' && digits[1] != '-') {
    digits.remove_prefix(1);
  }
  char const* const end = digits.data() + digits.size();
  if (format == kHexadecimal) {
    unsigned long long number = 0;
    auto const result = std::from_chars(digits.data(), end, number, 16);
    return result.ec == std::errc() && result.ptr == end ? static_cast<long long>(number) : 0;
  }
  long long number = 0;
  auto const result = std::from_chars(digits.data(), end, number);
  return result.ec == std::errc() && result.ptr == end ? number : 0;
}

int UStringToInt32(UString const& text, NumFormat format) {
  long long const number = UStringToNum(text, format);
  bool const fits =
      number >= std::numeric_limits<int>::min() && number <= std::numeric_limits<int>::max();
  return fits ? static_cast<int>(number) : 0;
}

}  // namespace vantor

using Proxy = UString::FormattedStreamProxy;

Proxy& Proxy::operator<<(UString const& text) {
  target_.append(text);
  return *this;
}
Proxy& Proxy::operator<<(char const* text) { return *this << UString(text); }
Proxy& Proxy::operator<<(char character) { return *this << UString(character); }
Proxy& Proxy::operator<<(int number) { return *this << static_cast<long long>(number); }
Proxy& Proxy::operator<<(long number) { return *this << static_cast<long long>(number); }
Proxy& Proxy::operator<<(long long number) {
  AppendNumber(number, target_);
  return *this;
}
Proxy& Proxy::operator<<(unsigned int number) {
  return *this << static_cast<unsigned long long>(number);
}
Proxy& Proxy::operator<<(unsigned long number) {
  return *this << static_cast<unsigned long long>(number);
}
Proxy& Proxy::operator<<(unsigned long long number) {
  AppendNumber(number, target_);
  return *this;
}
Proxy& Proxy::operator<<(double number) {
  AppendNumber(number, target_);
  return *this;
}

}  // namespace Ostinet
