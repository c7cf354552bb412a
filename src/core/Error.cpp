// SPDX-License-Identifier: MIT
#include "ostinet/core/Error.h"

#include <cerrno>
#include <cstdint>
#include <cstdio>
#include <new>
#include <system_error>
#include <utility>

namespace Ostinet {

namespace {

// Domains that hosts see in VantorError::Domain.
constexpr char kOSDomain[] = "OS";
constexpr char kWindowsDomain[] = "Windows";
constexpr char kCOMDomain[] = "COM";
constexpr char kLanguageDomain[] = "C++";

constexpr int kEndOfFile = -39;
constexpr int kMemoryFull = -108;

std::string TextOfOSError(int error) {
  switch (error) {
    case kEndOfFile:
      return "End of file";
    case kMemoryFull:
      return "Out of memory";
    default:
      return error > 0 ? std::generic_category().message(error) : std::string();
  }
}

std::string Hexadecimal(int result) {
  char text[11];
  std::snprintf(text, sizeof text, "0x%08X", static_cast<unsigned int>(result));
  return text;
}

}  // namespace

VantorError::VantorError(int code) : VantorError(kOSDomain, "", code, TextOfOSError(code)) {}

VantorError::VantorError(std::string domain, std::string component, std::string text)
    : VantorError(std::move(domain), std::move(component), 0, std::move(text)) {}

VantorError::VantorError(std::string domain, std::string component, int code, std::string text)
    : domain_(std::move(domain)),
      component_(std::move(component)),
      code_(code),
      text_(std::move(text)),
      what_(domain_) {
  if (!component_.empty()) {
    what_ += " " + component_;
  }
  if (code_ != 0) {
    what_ += " " + std::to_string(code_);
  }
  what_ += ": " + text_;
}

VantorError::~VantorError() = default;

VantorError VantorError::GetCurrentError() {
  if (std::current_exception() == nullptr) {
    return VantorError();
  }
  try {
    throw;
  } catch (VantorError const& error) {
    return error;
  } catch (std::bad_alloc const&) {
    return VantorError(kMemoryFull);
  } catch (std::exception const& error) {
    return VantorError(kLanguageDomain, "", 0, error.what());
  } catch (...) {
    return VantorError(kLanguageDomain, "", 0, "Unknown exception");
  }
}

void FailOSErr(int error) {
  if (error != 0) {
    throw VantorError(error);
  }
}

void FailWinError(int error) {
  if (error != 0) {
    throw VantorError(kWindowsDomain, "", error, "Windows error " + Hexadecimal(error));
  }
}

void FailCOMError(int result) {
  if (result < 0) {
    throw VantorError(kCOMDomain, "", result, "COM result " + Hexadecimal(result));
  }
}

void FailMemFullError() { throw VantorError(kMemoryFull); }

}  // namespace Ostinet
