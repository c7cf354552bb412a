// SPDX-License-Identifier: MIT
#pragma once

#include <stdexcept>

namespace Ostinet::Tool {

/// The program was asked in a form that it does not understand: exit code 2.
struct UsageError : std::runtime_error {
  using std::runtime_error::runtime_error;
};

/// What was asked for failed or was not found: exit code 1.
struct Failure : std::runtime_error {
  using std::runtime_error::runtime_error;
};

constexpr int kExitDone = 0;
constexpr int kExitFailed = 1;
constexpr int kExitUsage = 2;

}  // namespace Ostinet::Tool
