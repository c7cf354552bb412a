// SPDX-License-Identifier: MIT
#pragma once

#include <memory>

namespace Ostinet::Impl {

class System;

/// The automatic choice: the studio of that file, unless it is null or empty; else the machine's
/// own MIDI; else an empty simulated studio. Throws a VantorError with one sentence for a file that
/// does not load.
std::shared_ptr<System> ChooseSystem(char const* studioFile);

/// Returns to the automatic choice if `system` is the installed one. Any thread, while signed out.
void UninstallSystem(System const* system);

}  // namespace Ostinet::Impl
