// SPDX-License-Identifier: MIT
#pragma once

#include <string>

#include "ostinet/core/XML.h"

namespace Ostinet::Impl {

/// Hears what a validation finds, line by line.
class ValidationLog {
 public:
  virtual ~ValidationLog() = default;
  /// The document is not as the format wants it.
  virtual void AddViolation(int line, std::string const& sentence) = 0;
  /// The format has it, and the library does not read it.
  virtual void AddNotRead(int line, std::string const& sentence) = 0;
};

/// Holds a whole document against the MIDI Name Document format, version 1.0. The parser stands
/// above the root; what it throws ends the validation and travels on.
void ValidateNameDocument(XMLLib::Parser& parser, ValidationLog& log);

}  // namespace Ostinet::Impl
