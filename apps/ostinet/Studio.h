// SPDX-License-Identifier: MIT
#pragma once

#include <string>

namespace Ostinet::Tool {

/// Chooses the MIDI system before the first sign-in: the simulated studio of that file, or, for an
/// empty text, what the library chooses by itself (the environment variable OSTINET_STUDIO, else
/// the machine). Throws Failure for a file that describes no studio.
void ChooseStudio(std::string const& studioFile);

/// The studio file that was asked for, by that option or by the environment; empty if none was.
std::string StudioFileAskedFor(std::string const& studioFile);

/// Where the machine has no MIDI and nobody asked for a simulated studio, by that option or by the
/// environment: why, and what to do about it; else empty.
std::string WhyNoMIDI(std::string const& studioFile);

}  // namespace Ostinet::Tool
