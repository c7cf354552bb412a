// SPDX-License-Identifier: MIT
#include "names/NameHandles.h"

namespace Ostinet {

using Impl::ImplOf;

MatchObjectID const Patch::kObjectID;
Patch const Patch::kNoPatch;

Patch::Patch() = default;
Patch::Patch(RCPtrMT<Impl::PatchImpl> const& impl) : Object(impl) {}

PatchBank Patch::GetBank() const {
  Impl::PatchImpl const* const impl = ImplOf(*this);
  return impl != nullptr ? PatchBank(impl->GetBank()) : PatchBank();
}

UString Patch::GetNumber() const {
  Impl::PatchImpl const* const impl = ImplOf(*this);
  return impl != nullptr ? impl->GetNumber() : UString();
}

UString Patch::GetNumberAndName() const {
  Impl::PatchImpl const* const impl = ImplOf(*this);
  return impl != nullptr ? impl->GetNumberAndName() : UString();
}

// A patch that brings its own bank select needs more than the program change alone.
unsigned char Patch::GetProgramChange() const {
  constexpr unsigned char kNone = Impl::MIDICommandList::kNone;
  Impl::PatchImpl const* const impl = ImplOf(*this);
  if (impl == nullptr || impl->Commands().PendingMSB() != kNone ||
      impl->Commands().PendingLSB() != kNone) {
    return kNone;
  }
  return impl->Commands().PendingProgram();
}

PatchNumbers Patch::GetPatchNumbers() const {
  Impl::PatchImpl const* const impl = ImplOf(*this);
  return impl != nullptr ? impl->GetNumbers() : PatchNumbers();
}

DataBuffer Patch::GetCommand(TimeStamp stamp, short channel, unsigned char deviceID) const {
  DataBuffer buffer;
  if (Impl::PatchImpl const* const impl = ImplOf(*this)) {
    impl->Commands().GenerateCommands(buffer, stamp, channel, deviceID);
  }
  return buffer;
}

NoteNameList Patch::GetNoteNames() const { return NoteNameList(ImplOf(*this)); }
ControlList Patch::GetControlNames() const { return ControlList(ImplOf(*this)); }

}  // namespace Ostinet
