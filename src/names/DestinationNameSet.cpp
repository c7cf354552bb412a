// SPDX-License-Identifier: MIT
#include "names/NameHandles.h"

namespace Ostinet {

using Impl::ImplOf;

MatchObjectID const DestinationNameSet::kObjectID;
DestinationNameSet const DestinationNameSet::kNoDestinationNameSet;

DestinationNameSet::DestinationNameSet() = default;
DestinationNameSet::DestinationNameSet(RCPtrMT<Impl::DestNameSetImpl> const& impl) : Object(impl) {}

Destination DestinationNameSet::GetDestination() const {
  Impl::DestNameSetImpl const* const impl = ImplOf(*this);
  return impl != nullptr ? Destination(impl->GetDestination()) : Destination();
}

int DestinationNameSet::CountBanks() const {
  Impl::DestNameSetImpl const* const impl = ImplOf(*this);
  return impl != nullptr ? static_cast<int>(impl->GetBanks().size()) : 0;
}

PatchBank DestinationNameSet::GetBank(int index) const {
  Impl::DestNameSetImpl const* const impl = ImplOf(*this);
  return impl != nullptr ? Impl::HandleAt<PatchBank>(impl->GetBanks(), index) : PatchBank();
}

PatchBank DestinationNameSet::GetBank(unsigned char msb, unsigned char lsb) const {
  Impl::DestNameSetImpl const* const impl = ImplOf(*this);
  return impl != nullptr ? PatchBank(impl->FindBank(msb, lsb)) : PatchBank();
}

int DestinationNameSet::CountModes() const {
  Impl::DestNameSetImpl const* const impl = ImplOf(*this);
  return impl != nullptr ? static_cast<int>(impl->GetModes().size()) : 0;
}

std::pair<DestinationMode, unsigned short> DestinationNameSet::GetMode(int index) const {
  if (index < 0 || index >= CountModes()) {
    return std::pair<DestinationMode, unsigned short>(DestinationMode(),
                                                      static_cast<unsigned short>(0));
  }
  Impl::DestNameSetImpl::ModeUse const& use =
      ImplOf(*this)->GetModes()[static_cast<std::size_t>(index)];
  return std::pair<DestinationMode, unsigned short>(DestinationMode(use.first), use.second);
}

unsigned short DestinationNameSet::GetChannels() const {
  Impl::DestNameSetImpl const* const impl = ImplOf(*this);
  return impl != nullptr ? impl->GetChannels() : static_cast<unsigned short>(0);
}

}  // namespace Ostinet
