// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <functional>
#include <string>

#include "ostinet/Export.h"

namespace Ostinet {

/// A text of 16-bit code units (UTF-16). All names and paths of the library are such texts.
///
/// Ownership    A value: copies share nothing.
/// Threads      [any thread], one object on one thread at a time.
/// Errors       Positions behind the end throw std::out_of_range, as on a standard string. Text
///              that is malformed becomes U+FFFD and throws nothing.
class OSTINET_EXPORT UString {
 public:
  using value_type = char16_t;
  using size_type = std::size_t;
  using iterator = std::u16string::iterator;
  using const_iterator = std::u16string::const_iterator;
  using reverse_iterator = std::u16string::reverse_iterator;
  using const_reverse_iterator = std::u16string::const_reverse_iterator;

  /// How bytes stand for characters.
  enum ByteEncoding : int {
    kLatin1 = 0,  ///< one byte a character, U+0000 to U+00FF
    kUTF8 = 1,    ///< the default wherever bytes enter or leave
    kASCII = 2,   ///< one byte a character, U+0000 to U+007F
  };

  /// How `equal` and `less` compare. The two agree under each value: texts of which neither is
  /// less are equal.
  enum CompareFlags : int {
    kExact = 0,          ///< code unit by code unit
    kIgnoreCase = 1,     ///< file name endings
    kCatalogKey = 12,    ///< ignores case and all white space: makers, models and authors
    kLooselyEqual = 15,  ///< the loosest comparison, today the same as kCatalogKey
    kForPeople = 32,     ///< ignores case, runs of digits count as numbers; ties by code unit
  };

  class FormattedStreamProxy;

  static constexpr size_type npos = static_cast<size_type>(-1);
  /// The text of no characters.
  static UString const kEmptyString;

  UString() = default;
  UString(UString const&) = default;
  UString(UString&&) noexcept = default;
  /// At most `count` code units of `other`, from `position` on.
  UString(UString const& other, size_type position, size_type count = npos);
  /// One character, U+0000 to U+00FF.
  UString(char character);
  /// One code unit.
  UString(unsigned short unit);
  UString(char16_t unit);
  /// Bytes up to a 0; null counts as empty.
  UString(char const* bytes, ByteEncoding encoding = kUTF8);
  /// `count` bytes, which may hold 0.
  UString(char const* bytes, size_type count, ByteEncoding encoding);
  /// A length-prefixed byte text: one byte that counts those behind it. Null counts as empty.
  UString(unsigned char const* pascalText, ByteEncoding encoding);
  /// Code units up to a 0; null counts as empty.
  UString(unsigned short const* units);
  UString(char16_t const* units);
  /// Wide text up to a 0: UTF-16 or UTF-32, as wide as the compiler has it.
  UString(wchar_t const* text);
  UString(std::string const& bytes, ByteEncoding encoding = kUTF8);
  UString(std::u16string units) noexcept : units_(std::move(units)) {}
  ~UString() = default;

  UString& operator=(UString const&) = default;
  UString& operator=(UString&&) noexcept = default;
  UString& assign(UString const& other);
  /// At most `count` code units of `other`, from `position` on.
  UString& assign(UString const& other, size_type position, size_type count = npos);
  UString& append(UString const& other);
  UString& append(UString const& other, size_type position, size_type count = npos);
  /// `count` times `unit`.
  UString& append(size_type count, char16_t unit);
  UString& operator+=(UString const& other) { return append(other); }
  UString& operator+=(char16_t unit);
  void push_back(char16_t unit) { units_.push_back(unit); }
  void clear() noexcept { units_.clear(); }
  void resize(size_type count, char16_t fill = u'\0') { units_.resize(count, fill); }
  void reserve(size_type count) { units_.reserve(count); }
  void swap(UString& other) noexcept { units_.swap(other.units_); }
  UString& erase(size_type position = 0, size_type count = npos);

  char16_t& at(size_type position) { return units_.at(position); }
  char16_t const& at(size_type position) const { return units_.at(position); }
  char16_t& operator[](size_type position) { return units_[position]; }
  char16_t const& operator[](size_type position) const { return units_[position]; }

  iterator begin() noexcept { return units_.begin(); }
  iterator end() noexcept { return units_.end(); }
  const_iterator begin() const noexcept { return units_.begin(); }
  const_iterator end() const noexcept { return units_.end(); }
  reverse_iterator rbegin() noexcept { return units_.rbegin(); }
  reverse_iterator rend() noexcept { return units_.rend(); }
  const_reverse_iterator rbegin() const noexcept { return units_.rbegin(); }
  const_reverse_iterator rend() const noexcept { return units_.rend(); }

  /// The number of code units.
  size_type length() const noexcept { return units_.size(); }
  size_type size() const noexcept { return units_.size(); }
  bool empty() const noexcept { return units_.empty(); }

  UString substr(size_type position = 0, size_type count = npos) const;
  /// The first place at or behind `from`, or npos.
  size_type find(UString const& text, size_type from = 0) const noexcept;
  size_type find(char16_t unit, size_type from = 0) const noexcept;
  /// The last place at or before `from`, or npos.
  size_type rfind(UString const& text, size_type from = npos) const noexcept;
  size_type rfind(char16_t unit, size_type from = npos) const noexcept;
  /// The first place at or behind `from` of any code unit of `units`, or npos.
  size_type find_first_of(UString const& units, size_type from = 0) const noexcept;
  bool starts_with(UString const& text) const noexcept;
  bool ends_with(UString const& text) const noexcept;

  bool equal(UString const& other, CompareFlags flags) const;
  bool less(UString const& other, CompareFlags flags) const;

  /// The text as bytes. A character that `encoding` cannot hold becomes `replacement`, or
  /// nothing if `leaveOut` is true; half a surrogate pair counts as U+FFFD.
  std::string string(ByteEncoding encoding = kUTF8, char replacement = '?',
                     bool leaveOut = false) const;
  /// The code units.
  std::u16string const& utf16_str() const noexcept { return units_; }
  /// Writes the text as a length-prefixed byte text and returns `out`. It is cut between
  /// characters at `max` bytes, 0 to 255, behind the length; `out` has room for `max` + 1.
  unsigned char* pstring(unsigned char* out, int max, ByteEncoding encoding = kLatin1,
                         unsigned char replacement = '?') const;

  /// Appends numbers and text to this one: `text.Stream() << "Port " << 2`.
  FormattedStreamProxy Stream();

  friend bool operator==(UString const& a, UString const& b) noexcept {
    return a.units_ == b.units_;
  }
  friend bool operator!=(UString const& a, UString const& b) noexcept { return !(a == b); }
  friend bool operator<(UString const& a, UString const& b) noexcept { return a.units_ < b.units_; }
  friend bool operator>(UString const& a, UString const& b) noexcept { return b < a; }
  friend bool operator<=(UString const& a, UString const& b) noexcept { return !(b < a); }
  friend bool operator>=(UString const& a, UString const& b) noexcept { return !(a < b); }
  friend UString operator+(UString a, UString const& b) { return std::move(a.append(b)); }

 private:
  std::u16string units_;
};

/// Appends numbers and text to a text that outlives it. Numbers are written as in the C locale.
class OSTINET_EXPORT UString::FormattedStreamProxy {
 public:
  explicit FormattedStreamProxy(UString& target) : target_(target) {}

  FormattedStreamProxy& operator<<(UString const& text);
  FormattedStreamProxy& operator<<(char const* text);
  FormattedStreamProxy& operator<<(char character);
  FormattedStreamProxy& operator<<(int number);
  FormattedStreamProxy& operator<<(unsigned int number);
  FormattedStreamProxy& operator<<(long number);
  FormattedStreamProxy& operator<<(unsigned long number);
  FormattedStreamProxy& operator<<(long long number);
  FormattedStreamProxy& operator<<(unsigned long long number);
  /// The shortest decimal text that reads back as the same number.
  FormattedStreamProxy& operator<<(double number);

 private:
  UString& target_;
};

inline UString::FormattedStreamProxy UString::Stream() { return FormattedStreamProxy(*this); }

namespace vantor {

/// How a number is written.
enum NumFormat : int {
  kHexadecimal = 0,  ///< upper-case digits, no prefix
  kDecimal = 1,      ///< with "-" in front of a negative number
};

/// Replaces `out` by the text of `number`.
OSTINET_EXPORT void NumToUString(long long number, NumFormat format, UString& out);

/// The number that `text` holds, or 0 if it holds anything else or too large a number. White
/// space around it and one sign in front are allowed.
OSTINET_EXPORT long long UStringToNum(UString const& text, NumFormat format);

/// As UStringToNum, but 0 too for a number that does not fit 32 bits with a sign.
OSTINET_EXPORT int UStringToInt32(UString const& text, NumFormat format);

}  // namespace vantor

}  // namespace Ostinet

template <>
struct std::hash<Ostinet::UString> {
  std::size_t operator()(Ostinet::UString const& text) const noexcept {
    return std::hash<std::u16string>()(text.utf16_str());
  }
};
