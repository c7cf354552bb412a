// SPDX-License-Identifier: MIT
#pragma once

#include "HexBytes.h"

namespace Ostinet::Tool {

/// One message in words, for people: "note on        ch 1  note 60 (C4) velocity 64".
std::string DescribeMessage(Bytes const& message);

/// "C4" for 60: the middle C is the fourth. `note` from 0 to 127.
std::string NoteName(int note);

/// The note of "60", "C4", "f#3" or "Bb-1"; -1 where the text is none from 0 to 127.
int ParseNote(std::string_view text);

}  // namespace Ostinet::Tool
