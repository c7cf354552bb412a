// SPDX-License-Identifier: MIT
#pragma once

#include <string>

#include "platform/system/simulated/Studio.h"

namespace Ostinet::Impl::Simulated {

/// Fills an empty studio from its description; docs/studio-files.md tells the keys. Throws
/// StudioFileError with one sentence.
void ReadStudioText(std::string const& text, Studio& studio);
void ReadStudioFile(std::string const& path, Studio& studio);

}  // namespace Ostinet::Impl::Simulated
