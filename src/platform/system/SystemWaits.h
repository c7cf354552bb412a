// SPDX-License-Identifier: MIT
#pragma once

#include <memory>

#include "platform/system/System.h"

namespace Ostinet::Impl {

/// The waits of this machine: Windows' own there, threads and condition variables elsewhere.
std::unique_ptr<Waits> MakeSystemWaits();

}  // namespace Ostinet::Impl
