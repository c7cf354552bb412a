// SPDX-License-Identifier: MIT

#include "platform/PortAttacher.h"

#include <utility>

#include "model/DestinationImpl.h"
#include "model/PropertyKeys.h"
#include "ostinet/core/Error.h"
#include "platform/WinMIDISetup.h"
#include "platform/ports/WinDMusMIDIInPort.h"
#include "platform/ports/WinDMusMIDIOutPort.h"
#include "platform/ports/WinLegacyMIDIInPort.h"
#include "platform/ports/WinLegacyMIDIOutPort.h"

namespace Ostinet::Impl {

namespace {

bool IsExternal(DMUS_PORTCAPS const& caps) { return (caps.dwFlags & DMUS_PC_EXTERNAL) != 0; }

/// Whether an endpoint of this port is a real port (true) or made by software (false).
struct IsHardware : boost::static_visitor<bool> {
  bool operator()(DMusInput const& port) const { return IsExternal(port.caps); }
  bool operator()(DMusOutput const& port) const { return IsExternal(port.caps); }
  bool operator()(LegacyInput const&) const { return true; }
  bool operator()(LegacyOutput const& port) const { return port.caps.wTechnology == MOD_MIDIPORT; }
};

struct PortOpener : boost::static_visitor<void> {
  PortOpener(WinMIDISetup& s, std::shared_ptr<Session> const& se, WinMIDIPort& p)
      : setup(s), session(se), peer(p) {}

  template <class Port, class Info>
  void OpenDMus(Info const& info) const {
    auto port = std::make_unique<Port>(setup, session);
    port->Open(info.caps);
    peer.Attach(WinMIDIPort::kDirectMusic, std::move(port));
  }
  template <class Port, class Info>
  void OpenLegacy(Info const& info) const {
    auto port = std::make_unique<Port>(setup, session);
    port->Open(info.device, info.caps);
    peer.Attach(WinMIDIPort::kLegacy, std::move(port));
  }
  void operator()(DMusInput const& info) const { OpenDMus<WinDMusMIDIInPort>(info); }
  void operator()(DMusOutput const& info) const { OpenDMus<WinDMusMIDIOutPort>(info); }
  void operator()(LegacyInput const& info) const { OpenLegacy<WinLegacyMIDIInPort>(info); }
  void operator()(LegacyOutput const& info) const { OpenLegacy<WinLegacyMIDIOutPort>(info); }

  WinMIDISetup& setup;
  std::shared_ptr<Session> const& session;
  WinMIDIPort& peer;
};

}  // namespace

PortAttacher::PortAttacher(WinMIDISetup& setup, std::shared_ptr<Session> session)
    : setup_(setup), session_(std::move(session)) {}

void PortAttacher::IndexEndpoints() {
  if (std::exchange(isIndexed_, true)) {
    return;
  }
  for (auto const& source : setup_.Lists().sources) {
    sources_[source->GetName()].push_back(source);
  }
  for (auto const& destination : setup_.Lists().destinations) {
    destinations_[destination->GetName()].push_back(destination);
  }
}

bool PortAttacher::IsPair(EndpointImpl const& endpoint, PortInfo const& port) {
  if (endpoint.GetEntity() != nullptr || !endpoint.IsDirect()) {
    return false;
  }
  // An input of WinMM is joined by its name alone, whatever kind the endpoint is of.
  bool const ofItsKind = boost::get<LegacyInput>(&port) != nullptr ||
                         endpoint.IsSoftware() != boost::apply_visitor(IsHardware(), port);
  return ofItsKind;
}

void PortAttacher::Attach(PortInfo const& port) {
  IndexEndpoints();
  try {
    AttachUnguarded(port);
  } catch (VantorError const&) {
  }
}

void PortAttacher::AttachUnguarded(PortInfo const& port) {
  RCPtrMT<EndpointImpl> const endpoint = Find(port);
  if (!endpoint) {
    auto peer = std::make_unique<WinMIDIPort>(setup_);
    OpenInto(*peer, port);
    AddEndpoint(port, std::move(peer));
    return;
  }
  WinMIDIPort& peer = *WinMIDIPort::Of(*endpoint);
  if (peer.GetActiveImpl() == nullptr) {
    OpenInto(peer, port);
    if (IsSource(port)) {
      StartInput(endpoint);
    }
  }
}

RCPtrMT<EndpointImpl> PortAttacher::Find(PortInfo const& port) const {
  Index const& index = IsSource(port) ? sources_ : destinations_;
  auto const found = index.find(NameOfPort(port));
  if (found != index.end()) {
    for (auto const& endpoint : found->second) {
      // Virtual endpoints may bear a port's name, but have no port object inside.
      if (IsPair(*endpoint, port) && WinMIDIPort::Of(*endpoint) != nullptr) {
        return endpoint;
      }
    }
  }
  return {};
}

void PortAttacher::AddEndpoint(PortInfo const& port, std::unique_ptr<WinMIDIPort> peer) {
  EndpointKind const kind = boost::apply_visitor(IsHardware(), port)
                                ? EndpointKind::Bare(true, false)
                                : EndpointKind::Software(false, false);
  peer->SetInt(Keys::kOffline, 0);
  RCPtrMT<EndpointImpl> endpoint;
  if (IsSource(port)) {
    endpoint = new EndpointImpl(std::move(peer), setup_, kind);
    setup_.Lists().sources.push_back(endpoint);
    sources_[endpoint->GetName()].push_back(endpoint);
  } else {
    RCPtrMT<DestinationImpl> const destination(new DestinationImpl(std::move(peer), setup_, kind));
    setup_.Lists().destinations.push_back(destination);
    endpoint = destination;
    destinations_[endpoint->GetName()].push_back(endpoint);
  }
  setup_.MarkChanged();
  setup_.AssignUniqueID(*endpoint);
  if (IsSource(port)) {
    StartInput(endpoint);
  } else {
    AsDestination(endpoint.get())->RenewNewNames();
  }
}

void PortAttacher::OpenInto(WinMIDIPort& peer, PortInfo const& port) const {
  boost::apply_visitor(PortOpener(setup_, session_, peer), port);
}

void PortAttacher::StartInput(RCPtrMT<EndpointImpl> const& source) const {
  WinMIDIPort const& peer = *WinMIDIPort::Of(*source);
  if (!peer.Exists()) {
    return;
  }
  setup_.AddActiveSource(source);
  if (peer.GetWhichAPI() == WinMIDIPort::kLegacy) {
    static_cast<WinLegacyMIDIInPort*>(peer.GetActiveImpl())
        ->SetTarget(Source(source), setup_.GetReceiver());
  }
}

}  // namespace Ostinet::Impl
