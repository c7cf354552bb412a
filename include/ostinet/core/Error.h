// SPDX-License-Identifier: MIT
#pragma once

#include <exception>
#include <string>

#include "ostinet/Export.h"

namespace Ostinet {

/// What the library's operations throw: where it went wrong, a number, and a sentence.
///
/// Ownership    A value.
/// Threads      [any thread], one object on one thread at a time.
class OSTINET_EXPORT VantorError : public std::exception {
 public:
  /// No error: code 0 and empty texts.
  VantorError() = default;
  /// An error number of the operating system, in the domain "OS".
  explicit VantorError(int code);
  VantorError(std::string domain, std::string component, int code, std::string text);
  VantorError(std::string domain, std::string component, std::string text);
  VantorError(VantorError const&) = default;
  VantorError& operator=(VantorError const&) = default;
  ~VantorError() override;

  /// The realm that the code belongs to: "OS", "Windows", "COM", "XML", "VantorThreads"...
  std::string const& Domain() const noexcept { return domain_; }
  /// The part of the library that failed, or empty.
  std::string const& Component() const noexcept { return component_; }
  int Code() const noexcept { return code_; }
  std::string const& Text() const noexcept { return text_; }
  /// Domain, component, code and text in one line.
  char const* what() const noexcept override { return what_.c_str(); }

  /// The error being handled: to be called in a catch block. An exception of another class
  /// gives its text in the domain "C++"; no exception gives no error.
  static VantorError GetCurrentError();

 private:
  std::string domain_;
  std::string component_;
  int code_ = 0;
  std::string text_;
  std::string what_;
};

/// Throws a VantorError for an error number of the operating system, unless it is 0. Numbers
/// below 0 are the operating errors that hosts know, as -39: the end of a file.
OSTINET_EXPORT void FailOSErr(int error);
/// Throws for the result of a Windows call, an error number or a COM result, unless it is 0.
OSTINET_EXPORT void FailWinError(int error);
/// Throws for a COM result below 0.
OSTINET_EXPORT void FailCOMError(int result);
/// Throws for exhausted memory.
[[noreturn]] OSTINET_EXPORT void FailMemFullError();

}  // namespace Ostinet
