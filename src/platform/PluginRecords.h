// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>

#include "ostinet/PluginHost.h"

namespace Ostinet::Impl {

// The records in which a plug-in of the host's engine takes its MIDI. PluginHost.h has the table of
// their fields.
constexpr std::size_t kPluginRecordBytes = 270;
constexpr std::size_t kPluginRecordData = 256;

/// Sends a message of any length as records of up to 256 bytes, in one call. None of no bytes, to
/// null, or for which there is no memory. [any thread]
void SendLongMessage(TimeStamp stamp, unsigned char const* bytes, std::size_t length,
                     ISynapMIDIDestination* destination);

}  // namespace Ostinet::Impl
