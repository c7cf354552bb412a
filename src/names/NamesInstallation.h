// SPDX-License-Identifier: MIT
#pragma once

namespace Ostinet::Impl {

/// Ties the names to the model: from now on each destination is made with its names, and the
/// catalog takes part in sign-in and sign-out. To be called before the first sign-in; a second
/// call does nothing more.
void InstallNames();

}  // namespace Ostinet::Impl
