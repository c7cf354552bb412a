// SPDX-License-Identifier: MIT
#include "HexBytes.h"

#include "Errors.h"

namespace Ostinet::Tool {
namespace {

constexpr std::string_view kDigits = "0123456789ABCDEF";
constexpr std::string_view kBlanks = " \t\r\n";

int DigitValue(char c) {
  if (c >= 'a' && c <= 'f') {
    return c - 'a' + 10;
  }
  size_t const at = kDigits.find(c);
  return at == std::string_view::npos ? -1 : static_cast<int>(at);
}

[[noreturn]] void FailWord(std::string_view word) {
  throw UsageError("\"" + std::string(word) +
                   "\" is not hexadecimal: expected bytes like 90 3C 40");
}

void AppendWord(std::string_view word, Bytes& bytes) {
  if (word.size() > 1 && word.size() % 2 != 0) {
    FailWord(word);
  }
  size_t const digitsPerByte = word.size() == 1 ? 1 : 2;
  for (size_t i = 0; i < word.size(); i += digitsPerByte) {
    int value = 0;
    for (char const c : word.substr(i, digitsPerByte)) {
      int const digit = DigitValue(c);
      if (digit < 0) {
        FailWord(word);
      }
      value = value * 16 + digit;
    }
    bytes.push_back(static_cast<unsigned char>(value));
  }
}

}  // namespace

Bytes ParseHex(std::string_view text) {
  Bytes bytes;
  for (std::string const& word : SplitWords(text)) {
    AppendWord(word, bytes);
  }
  return bytes;
}

std::string ToHex(Bytes const& bytes) {
  std::string text;
  for (unsigned char const byte : bytes) {
    if (!text.empty()) {
      text += ' ';
    }
    text += kDigits[byte >> 4];
    text += kDigits[byte & 0x0F];
  }
  return text;
}

std::vector<std::string> SplitWords(std::string_view text) {
  std::vector<std::string> words;
  size_t start = text.find_first_not_of(kBlanks);
  while (start != std::string_view::npos) {
    size_t const end = text.find_first_of(kBlanks, start);
    words.emplace_back(text.substr(start, end - start));
    start = text.find_first_not_of(kBlanks, end);
  }
  return words;
}

}  // namespace Ostinet::Tool
