// SPDX-License-Identifier: MIT
#include "model/Handles.h"
#include "model/PropertyKeys.h"

namespace Ostinet {

using Impl::AsDestination;
using Impl::ImplOf;

MatchObjectID const Destination::kObjectID;
Destination const Destination::kNoDestination;

Destination::Destination() = default;
Destination::Destination(RCPtrMT<Impl::DestinationImpl> const& impl) : Endpoint(impl) {}

Destination Destination::GetDirectDestination() const {
  Impl::DestinationImpl const* const impl = ImplOf(*this);
  return impl != nullptr ? Destination(AsDestination(impl->GetDirectEndpoint())) : Destination();
}

Source Destination::GetMatchingVirtualSource() const {
  Impl::DestinationImpl const* const impl = ImplOf(*this);
  return impl != nullptr ? Source(impl->GetMatchingVirtual()) : Source();
}

bool Destination::IsBroadcast() const {
  Impl::DestinationImpl const* const impl = ImplOf(*this);
  return impl != nullptr && impl->GetInt(Impl::Keys::kBroadcast, 0) != 0;
}

bool Destination::IsPregen() const {
  Impl::DestinationImpl const* const impl = ImplOf(*this);
  return impl != nullptr && impl->IsDirect() && impl->Peer()->IsPregen();
}

void Destination::AddConnectedDestination(Destination const& destination) const {
  Impl::DestinationImpl* const added = ImplOf(destination);
  if (HasConnections() && added != nullptr && !added->IsDirect()) {
    ImplOf(*this)->AddConnected(added);
  }
}

void Destination::RemoveConnectedDestination(Destination const& destination) const {
  if (Impl::DestinationImpl* const impl = ImplOf(*this)) {
    impl->RemoveConnected(ImplOf(destination));
  }
}

int Destination::CountConnectedDestinations() const {
  Impl::DestinationImpl const* const impl = ImplOf(*this);
  return impl != nullptr ? static_cast<int>(impl->GetConnected().size()) : 0;
}

Destination Destination::GetConnectedDestination(int index) const {
  bool const isThere = index >= 0 && index < CountConnectedDestinations();
  return isThere ? Destination(AsDestination(
                       ImplOf(*this)->GetConnected()[static_cast<std::size_t>(index)]))
                 : Destination();
}

}  // namespace Ostinet
