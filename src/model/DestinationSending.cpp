// SPDX-License-Identifier: MIT
//
// Destination: the road out. What is not a port itself goes out through the port it hangs on.
#include "model/Handles.h"
#include "model/PropertyKeys.h"

namespace Ostinet {

using Impl::ImplOf;

namespace {

// The peer that has the way out; null if there is none.
Impl::ImplImpl* SendingPeer(Destination const& handle) {
  Impl::EndpointImpl const* impl = ImplOf(handle);
  if (impl != nullptr && !impl->IsDirect()) {
    impl = impl->GetDirectEndpoint();
  }
  return impl != nullptr ? impl->Peer() : nullptr;
}

}  // namespace

std::unique_ptr<Impl::Sender> Destination::MakeSender() const {
  Impl::ImplImpl* const peer = SendingPeer(*this);
  return peer != nullptr ? peer->MakeSender(ImplOf(*this)) : nullptr;
}

void Destination::SendOnePacket(DataPacket const& packet) const {
  std::unique_ptr<Impl::Sender> const sender = MakeSender();
  if (sender != nullptr && sender->CanSend()) {
    sender->Send(packet);
    sender->Flush();
  }
}

void Destination::SendSysex(TimeStamp stamp, SysexRef const& sysex) const {
  if (Impl::ImplImpl* const peer = SendingPeer(*this)) {
    peer->SendSysex(stamp, sysex.GetImpl());
  }
}

void Destination::FlushOutput() const {
  if (Impl::ImplImpl* const peer = SendingPeer(*this)) {
    peer->FlushOutput();
  }
}

double Destination::GetAdvanceScheduleTime() const {
  return GetAdvanceScheduleMicroseconds() / 1000000.0;
}

}  // namespace Ostinet
