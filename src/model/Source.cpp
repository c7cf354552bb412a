// SPDX-License-Identifier: MIT
#include "model/Handles.h"

namespace Ostinet {

using Impl::ImplOf;

MatchObjectID const Source::kObjectID;
Source const Source::kNoSource;

Source::Source() = default;
Source::Source(RCPtrMT<Impl::EndpointImpl> const& impl) : Endpoint(impl) {}

Source Source::GetDirectSource() const {
  Impl::EndpointImpl const* const impl = ImplOf(*this);
  return impl != nullptr ? Source(impl->GetDirectEndpoint()) : Source();
}

Destination Source::GetMatchingVirtualDestination() const {
  Impl::EndpointImpl const* const impl = ImplOf(*this);
  return impl != nullptr ? Destination(AsDestination(impl->GetMatchingVirtual())) : Destination();
}

void Source::AddConnectedSource(Source const& source) const {
  Impl::EndpointImpl* const added = ImplOf(source);
  if (HasConnections() && added != nullptr && !added->IsDirect()) {
    ImplOf(*this)->AddConnected(added);
  }
}

void Source::RemoveConnectedSource(Source const& source) const {
  if (Impl::EndpointImpl* const impl = ImplOf(*this)) {
    impl->RemoveConnected(ImplOf(source));
  }
}

int Source::CountConnectedSources() const {
  Impl::EndpointImpl const* const impl = ImplOf(*this);
  return impl != nullptr ? static_cast<int>(impl->GetConnected().size()) : 0;
}

Source Source::GetConnectedSource(int index) const {
  bool const isThere = index >= 0 && index < CountConnectedSources();
  return isThere ? Source(ImplOf(*this)->GetConnected()[static_cast<std::size_t>(index)])
                 : Source();
}

Receiver* Source::getDirectReceiver() const {
  Impl::EndpointImpl const* const impl = ImplOf(*this);
  return impl != nullptr ? impl->GetDirectReceiver() : nullptr;
}

bool Source::hasDirectReceiver() const { return getDirectReceiver() != nullptr; }

void Source::setDirectReceiver(Receiver* receiver) const {
  if (Impl::EndpointImpl* const impl = ImplOf(*this)) {
    impl->SetDirectReceiver(receiver);
  }
}

}  // namespace Ostinet
