// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <functional>

namespace Ostinet::Impl {

/// Takes one whole message, or all of a sysex.
using MessageSink = std::function<void(unsigned char const* bytes, std::size_t count)>;

/// The number of bytes of a channel or system message with this status, 1 to 3; 0 for a byte
/// without a status bit and for F0, whose length is its own affair.
std::size_t MessageLength(unsigned char status);

/// Parts a run of bytes into MIDI messages, because the services take one at a time. Running status
/// is spelled out. A sysex reaches to its F7, else to the next status that is not realtime, else to
/// the end of the bytes; a run that begins without a status is passed on as it stands, since it is
/// the next piece of a sysex that the host cuts itself. A message that lacks bytes at the end is
/// dropped. Realtime bytes inside a sysex stay inside.
void SplitMessages(unsigned char const* bytes, std::size_t count, MessageSink const& sink);

}  // namespace Ostinet::Impl
