// SPDX-License-Identifier: MIT
#include "names/NameHandles.h"

namespace Ostinet {

using Impl::ImplOf;

MatchObjectID const DestinationMode::kObjectID;
DestinationMode const DestinationMode::kNoDestinationMode;

DestinationMode::DestinationMode() = default;
DestinationMode::DestinationMode(RCPtrMT<Impl::DestModeImpl> const& impl) : Object(impl) {}

Destination DestinationMode::GetDestination() const {
  Impl::DestModeImpl const* const impl = ImplOf(*this);
  return impl != nullptr ? Destination(impl->GetDestination()) : Destination();
}

DestinationNameSet DestinationMode::GetNameSet(short channel) const {
  Impl::DestModeImpl const* const impl = ImplOf(*this);
  return impl != nullptr ? DestinationNameSet(impl->GetNameSet(channel)) : DestinationNameSet();
}

bool DestinationMode::IsStandardMode() const {
  Impl::DestModeImpl const* const impl = ImplOf(*this);
  return impl != nullptr && impl->IsStandard();
}

// Pending numbers do not count, although they are sent: hosts offer a mode as selectable by MIDI
// only where its document has a script for it.
bool DestinationMode::SelectableWithMIDI() const {
  Impl::DestModeImpl const* const impl = ImplOf(*this);
  return impl != nullptr && !impl->EnableCommands().Items().empty();
}

void DestinationMode::GetEnablingCommand(DataBuffer& buffer, TimeStamp stamp,
                                         unsigned char deviceID) const {
  if (Impl::DestModeImpl const* const impl = ImplOf(*this)) {
    impl->EnableCommands().GenerateCommands(buffer, stamp, 0, deviceID);
  }
}

void DestinationMode::GetDisablingCommand(DataBuffer& buffer, TimeStamp stamp,
                                          unsigned char deviceID) const {
  if (Impl::DestModeImpl const* const impl = ImplOf(*this)) {
    impl->DisableCommands().GenerateCommands(buffer, stamp, 0, deviceID);
  }
}

}  // namespace Ostinet
