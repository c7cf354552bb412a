// SPDX-License-Identifier: MIT
#pragma once

namespace Ostinet::Impl {

class System;

/// Returns to the automatic choice if `system` is the installed one. Any thread, while signed out.
void UninstallSystem(System const* system);

}  // namespace Ostinet::Impl
