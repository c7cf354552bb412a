// SPDX-License-Identifier: MIT
#include "names/NameHandles.h"

namespace Ostinet {

using Impl::ImplOf;

MatchObjectID const PatchBank::kObjectID;
PatchBank const PatchBank::kNoPatchBank;

PatchBank::PatchBank() = default;
PatchBank::PatchBank(RCPtrMT<Impl::PatchBankImpl> const& impl) : Object(impl) {}

DestinationNameSet PatchBank::GetNameSet() const {
  Impl::PatchBankImpl const* const impl = ImplOf(*this);
  return impl != nullptr ? DestinationNameSet(impl->GetNameSet()) : DestinationNameSet();
}

UString PatchBank::GetBankName() const {
  Impl::PatchBankImpl const* const impl = ImplOf(*this);
  return impl != nullptr ? impl->GetBankName() : UString();
}

int PatchBank::CountPatches() const {
  Impl::PatchBankImpl const* const impl = ImplOf(*this);
  return impl != nullptr ? static_cast<int>(impl->GetPatches().size()) : 0;
}

Patch PatchBank::GetPatch(int index) const {
  Impl::PatchBankImpl const* const impl = ImplOf(*this);
  return impl != nullptr ? Impl::HandleAt<Patch>(impl->GetPatches(), index) : Patch();
}

unsigned char PatchBank::GetController0Number() const {
  Impl::PatchBankImpl const* const impl = ImplOf(*this);
  return impl != nullptr ? impl->Commands().PendingMSB() : Impl::MIDICommandList::kNone;
}

unsigned char PatchBank::GetController32Number() const {
  Impl::PatchBankImpl const* const impl = ImplOf(*this);
  return impl != nullptr ? impl->Commands().PendingLSB() : Impl::MIDICommandList::kNone;
}

DataBuffer PatchBank::GetCommand(TimeStamp stamp, short channel, unsigned char deviceID) const {
  DataBuffer buffer;
  if (Impl::PatchBankImpl const* const impl = ImplOf(*this)) {
    impl->Commands().GenerateCommands(buffer, stamp, channel, deviceID);
  }
  return buffer;
}

}  // namespace Ostinet
