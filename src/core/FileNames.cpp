// SPDX-License-Identifier: MIT
#include <algorithm>
#include <string_view>
#include <type_traits>

#include "core/Paths.h"
#include "core/Unicode.h"

namespace Ostinet::Impl {

namespace {

using PathCharacter = std::filesystem::path::value_type;

// Bytes of UTF-8. The common limit is 255; some room is for a number and for a temporary's name.
constexpr std::size_t kLongestName = 200;
constexpr std::u16string_view kForbidden = u"/\\:*?\"<>|";
constexpr char16_t kSubstitute = u'_';

// Names that one system keeps for its devices, with any ending.
constexpr char const* kDeviceNames[] = {"con", "prn", "aux", "nul"};
constexpr char const* kNumberedDeviceNames[] = {"com", "lpt"};

bool IsAllowed(char16_t unit) {
  return unit >= 0x20 && unit != 0x7F && kForbidden.find(unit) == std::u16string_view::npos;
}

// Where the ending starts, with its dot; the length where there is none. A leading dot starts no
// ending.
std::size_t EndingOf(UString const& name) {
  std::size_t const dot = name.rfind(u'.');
  return dot == UString::npos || dot == 0 ? name.length() : dot;
}

bool IsDeviceName(UString const& name) {
  UString const stem = name.substr(0, name.find(u'.'));
  auto const equals = [&stem](char const* device) {
    return stem.equal(device, UString::kIgnoreCase);
  };
  if (std::any_of(std::begin(kDeviceNames), std::end(kDeviceNames), equals)) {
    return true;
  }
  if (stem.length() != 4 || stem[3] < u'1' || stem[3] > u'9') {
    return false;
  }
  UString const letters = stem.substr(0, 3);
  return std::any_of(
      std::begin(kNumberedDeviceNames), std::end(kNumberedDeviceNames),
      [&letters](char const* device) { return letters.equal(device, UString::kIgnoreCase); });
}

// Cuts between characters.
UString CutToBytes(UString const& text, std::size_t limit) {
  std::size_t bytes = 0;
  for (std::size_t position = 0; position < text.length();) {
    std::size_t const start = position;
    std::string character;
    AppendAsUTF8(NextCharacter(text.utf16_str(), position), character);
    bytes += character.size();
    if (bytes > limit) {
      return text.substr(0, start);
    }
  }
  return text;
}

}  // namespace

std::filesystem::path ToPath(UString const& text) {
  if constexpr (std::is_same_v<PathCharacter, char>) {
    return std::filesystem::path(text.string(UString::kUTF8));
  } else {
    std::filesystem::path path(
        std::basic_string<PathCharacter>(text.utf16_str().begin(), text.utf16_str().end()));
    return path.make_preferred();
  }
}

UString FromPath(std::filesystem::path const& path) { return UString(path.native().c_str()); }

UString MakeFileName(UString const& name) {
  UString result;
  for (char16_t const unit : name) {
    result.push_back(IsAllowed(unit) ? unit : kSubstitute);
  }
  std::size_t const ending = EndingOf(result);
  UString const tail = CutToBytes(result.substr(ending), kLongestName / 2);
  result = CutToBytes(result.substr(0, ending), kLongestName - tail.string().size()) + tail;
  // One system drops a dot or a blank at the end, and "." and ".." are folders.
  if (result.empty() || result.ends_with(".") || result.ends_with(" ")) {
    result.push_back(kSubstitute);
  }
  if (IsDeviceName(result)) {
    result = UString(kSubstitute) + result;
  }
  return result;
}

UString NumberedFileName(UString const& name, int number) {
  std::size_t const ending = EndingOf(name);
  UString result = name.substr(0, ending);
  result.Stream() << ' ' << number << name.substr(ending);
  return result;
}

}  // namespace Ostinet::Impl
