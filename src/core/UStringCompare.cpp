// SPDX-License-Identifier: MIT
#include "core/UStringCompare.h"

#include "core/Unicode.h"

// Each text is read as a stream of characters, already folded and without what is not to count,
// and the two streams are walked in step: one pass, no copies, and `equal` and `less` cannot
// disagree because both ask the same walk.

namespace Ostinet::Impl {

namespace {

// The bits that the flags in use are made of.
constexpr int kCaseBits = 1 | 4 | 32;
constexpr int kWhiteSpaceBit = 8;
constexpr int kNumbersBit = 32;

constexpr char32_t kEnd = 0;  // below every character of a stream, which are given one higher

bool IsDigit(char32_t character) { return character >= '0' && character <= '9'; }

class FoldedStream {
 public:
  FoldedStream(std::u16string_view units, bool ignoreCase, bool ignoreWhiteSpace)
      : units_(units), ignoreCase_(ignoreCase), ignoreWhiteSpace_(ignoreWhiteSpace) {
    Advance();
  }

  char32_t Current() const { return current_; }
  bool AtDigit() const { return current_ != kEnd && IsDigit(current_ - 1); }

  void Advance() {
    if (foldedIndex_ < folded_.length) {
      current_ = folded_.characters[foldedIndex_++] + 1;
      return;
    }
    while (position_ < units_.size()) {
      char32_t const character = NextCharacter(units_, position_);
      if (ignoreWhiteSpace_ && IsUnicodeWhiteSpace(character)) {
        continue;
      }
      if (ignoreCase_) {
        folded_ = FoldCase(character);
        foldedIndex_ = 1;
        current_ = folded_.characters[0] + 1;
      } else {
        current_ = character + 1;
      }
      return;
    }
    current_ = kEnd;
  }

 private:
  std::u16string_view const units_;
  bool const ignoreCase_;
  bool const ignoreWhiteSpace_;
  std::size_t position_ = 0;
  FoldedCharacter folded_{{}, 0};
  std::size_t foldedIndex_ = 0;
  char32_t current_ = kEnd;
};

int Sign(char32_t a, char32_t b) { return a < b ? -1 : (a > b ? 1 : 0); }

void SkipZeros(FoldedStream& stream) {
  while (stream.Current() == U'0' + 1) {
    stream.Advance();
  }
}

// Both streams stand at a digit; both end behind their run of digits, however long it is.
int CompareNumbers(FoldedStream& a, FoldedStream& b) {
  SkipZeros(a);
  SkipZeros(b);
  int firstDifference = 0;
  while (a.AtDigit() && b.AtDigit()) {
    if (firstDifference == 0) {
      firstDifference = Sign(a.Current(), b.Current());
    }
    a.Advance();
    b.Advance();
  }
  if (a.AtDigit() != b.AtDigit()) {
    return a.AtDigit() ? 1 : -1;
  }
  return firstDifference;
}

}  // namespace

int CompareUnits(std::u16string_view a, std::u16string_view b, UString::CompareFlags flags) {
  if (flags == UString::kExact) {
    return a.compare(b);
  }
  bool const numbers = (flags & kNumbersBit) != 0;
  FoldedStream left(a, (flags & kCaseBits) != 0, (flags & kWhiteSpaceBit) != 0);
  FoldedStream right(b, (flags & kCaseBits) != 0, (flags & kWhiteSpaceBit) != 0);
  while (left.Current() != kEnd || right.Current() != kEnd) {
    if (numbers && left.AtDigit() && right.AtDigit()) {
      if (int const order = CompareNumbers(left, right)) {
        return order;
      }
      continue;
    }
    if (int const order = Sign(left.Current(), right.Current())) {
      return order;
    }
    left.Advance();
    right.Advance();
  }
  // "7" and "007" are the same number, but a list needs one order of them.
  return numbers ? a.compare(b) : 0;
}

}  // namespace Ostinet::Impl
