// SPDX-License-Identifier: MIT
#pragma once

#include "names/MIDICommandList.h"
#include "ostinet/core/XML.h"

namespace Ostinet::Impl {

/// Writes the messages of a list as the content of an element of this name.
void WriteCommands(XMLLib::Writer& writer, XMLLib::Name const& element,
                   MIDICommandList const& commands);

}  // namespace Ostinet::Impl
