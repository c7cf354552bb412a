// SPDX-License-Identifier: MIT
#pragma once

#include <string>
#include <vector>

namespace Ostinet::Tool {

/// Nobody reads the standard output any more: the program ends without a word.
struct OutputClosed {};

/// Writes a line to the standard output and hands it on at once, so that a reader behind a pipe
/// sees it. Throws OutputClosed where the reader has gone, Failure where writing failed otherwise.
void PrintLine(std::string const& line);

/// Writes what a command found: the JSON if that is asked for, else the lines.
void PrintOne(bool asJSON, std::string const& json, std::vector<std::string> const& lines);

/// A notice for people on the standard error: "ostinet: " and the sentence.
void Notify(std::string const& sentence);

/// Takes a write to a closed pipe as an error of that write, not as the end of the program.
void KeepRunningOnClosedPipes();

}  // namespace Ostinet::Tool
