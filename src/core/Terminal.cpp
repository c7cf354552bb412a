// SPDX-License-Identifier: MIT
#include "ostinet/core/Terminal.h"

#include "core/SystemServices.h"

namespace Ostinet {

bool IsErrorOutputATerminal() { return SystemServices::IsErrorOutputATerminal(); }

}  // namespace Ostinet
