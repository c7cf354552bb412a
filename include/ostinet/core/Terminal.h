// SPDX-License-Identifier: MIT
#pragma once

#include "ostinet/Export.h"

namespace Ostinet {

/// Whether somebody watches what this process writes to its standard error, so that a line may be
/// written over to show progress. False where it goes to a file or a pipe. [any thread]
OSTINET_EXPORT bool IsErrorOutputATerminal();

}  // namespace Ostinet
