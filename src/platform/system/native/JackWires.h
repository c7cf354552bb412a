// SPDX-License-Identifier: MIT
#pragma once

#include <memory>
#include <string>

#include "platform/system/native/JackClient.h"
#include "platform/system/native/MidiService.h"

namespace Ostinet::Impl {

/// Null when the port is not there or does not let itself be joined.
std::unique_ptr<OutputWire> OpenJackOutput(std::shared_ptr<JackClient> client,
                                           std::string const& id);
std::unique_ptr<InputWire> OpenJackInput(std::shared_ptr<JackClient> client, std::string const& id,
                                         InputSink sink);

}  // namespace Ostinet::Impl
