// SPDX-License-Identifier: MIT
#pragma once

#include <cstdio>
#include <ostream>

#include "ostinet/core/Error.h"
#include "ostinet/core/Files.h"
#include "ostinet/core/UString.h"
#include "ostinet/core/XML.h"

// How failing tests print the core's values. Each stands in its class's namespace, where the test
// framework looks for it.

namespace Ostinet {

inline void PrintTo(UString const& text, std::ostream* out) {
  *out << '"' << text.string() << '"';
  // What two texts of one look differ in.
  for (char16_t const unit : text) {
    if (unit < 0x20 || unit > 0x7E) {
      char digits[8];
      std::snprintf(digits, sizeof digits, " %04X", static_cast<unsigned int>(unit));
      *out << digits;
    }
  }
}

inline void PrintTo(FileSpecification const& file, std::ostream* out) {
  PrintTo(file.GetFullPath(), out);
}

inline void PrintTo(VantorError const& error, std::ostream* out) { *out << error.what(); }

namespace XMLLib {
inline void PrintTo(Name const& name, std::ostream* out) { *out << '<' << name.Text() << '>'; }
}  // namespace XMLLib

}  // namespace Ostinet
