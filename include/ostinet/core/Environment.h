// SPDX-License-Identifier: MIT
#pragma once

#include "ostinet/Export.h"
#include "ostinet/core/UString.h"

namespace Ostinet {

/// The value of an environment variable, whatever letters it holds; empty if it is not set.
/// [any thread], as long as none changes the environment.
OSTINET_EXPORT UString EnvironmentText(char const* name);

}  // namespace Ostinet
