// SPDX-License-Identifier: MIT
#include "ostinet/core/Environment.h"

#include "core/SystemServices.h"

namespace Ostinet {

UString EnvironmentText(char const* name) {
  return SystemServices::Environment(name).value_or(UString());
}

}  // namespace Ostinet
