// SPDX-License-Identifier: MIT
#pragma once

#include "names/NameListRegistry.h"
#include "ostinet/core/XML.h"

namespace Ostinet::Impl {

// What a list says beyond the default list is written; an empty name is left out.

void WriteNotes(XMLLib::Writer& writer, UString const& name, NoteNameTable const& table);
void WriteControls(XMLLib::Writer& writer, UString const& name, ControlTable const& table,
                   NameListRegistry& registry);
void WriteValues(XMLLib::Writer& writer, UString const& name, ValueListImpl const& list);

/// False for a list that says nothing but what the default list says.
bool HasControlsToWrite(ControlTable const& table);

}  // namespace Ostinet::Impl
