// SPDX-License-Identifier: MIT
#pragma once

#include "HexBytes.h"

namespace Ostinet::Tool {

constexpr unsigned char kSysexStart = 0xF0;
constexpr unsigned char kSysexEnd = 0xF7;

/// Single-byte messages that may stand between the bytes of any other message.
constexpr bool IsRealtime(unsigned char byte) { return byte >= 0xF8; }
constexpr bool IsStatus(unsigned char byte) { return byte >= 0x80; }

/// The number of bytes of a message with this status byte, from 1 to 3. 0 for the start of a
/// sysex, whose end is marked, and for a data byte.
size_t MessageLength(unsigned char status);

/// Cuts a run of bytes into messages of one each, in order of completion. A running status is
/// written out, and a real-time message leaves the message that it stands in. Throws UsageError
/// where the run begins with data or ends within a message.
std::vector<Bytes> SplitMessages(Bytes const& run);

}  // namespace Ostinet::Tool
