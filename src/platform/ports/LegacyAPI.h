// SPDX-License-Identifier: MIT
#pragma once

namespace Ostinet::Impl {

/// What the property "which API" says of a port of WinMM.
constexpr int kLegacyAPI = 2;

}  // namespace Ostinet::Impl
