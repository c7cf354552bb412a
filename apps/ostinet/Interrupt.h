// SPDX-License-Identifier: MIT
#pragma once

namespace Ostinet::Tool {

/// From now on the first Ctrl-C (or request to terminate) only sets a mark, so that the program
/// can sign out; a second one ends it at once.
void CatchInterrupts();

/// Whether one came. [any thread]
bool IsInterrupted();

}  // namespace Ostinet::Tool
