// SPDX-License-Identifier: MIT

// Setup's destinations of the host's plug-in engine, and what the engine reaches of them.

#include "model/Handles.h"
#include "model/Studio.h"
#include "ostinet/PluginHost.h"
#include "ostinet/Setup.h"
#include "platform/SYNAP_MIDIDestImplImpl.h"

namespace Ostinet {

using Impl::ImplOf;

Destination Setup::CreateSYNAPPluginDestination(SynapMidiPort* port, bool isPrivate) {
  RCPtrMT<Impl::DestinationImpl> const destination(
      new Impl::DestinationImpl(std::make_unique<Impl::SYNAP_MIDIDestImplImpl>(*this, port), *this,
                                Impl::EndpointKind::Software(isPrivate, true)));
  Impl::Studio& studio = GetStudio();
  (isPrivate ? studio.privateDestinations : studio.destinations).push_back(destination);
  MaybeAssignUniqueID(*destination);
  PlatformPluginDestinationsChanged();
  return Destination(destination);
}

Impl::DestinationImpl* Setup::GetSynapPluginDestinationImpl(Destination& destination) {
  return destination.IsSoftware() ? ImplOf(destination) : nullptr;
}

void Setup::DeleteSYNAPPluginDestination(Destination& destination) {
  if (destination.Exists()) {
    RemoveDestination(ImplOf(destination));
    PlatformPluginDestinationsChanged();
  }
}

void Setup::UpdateNameSetsForSYNAPPluginDestination(Destination& destination) {
  Impl::DestinationNames* const names =
      destination.Exists() ? ImplOf(destination)->GetNames() : nullptr;
  if (names != nullptr) {
    names->Renew();  // the host that asks for it shows them anew by itself
  }
}

SynapMidiPort* SynapPeer::GetSynapMIDIPort() const {
  return peer_ != nullptr ? peer_->GetSynapMIDIPort() : nullptr;
}

bool SynapPeer::IsPregen() const { return peer_ != nullptr && peer_->IsPregen(); }

UString SynapPeer::GetName() const { return peer_ != nullptr ? peer_->GetName() : UString(); }

void SynapPeer::GetManufAndModel(UString& manufacturer, UString& model) const {
  if (peer_ != nullptr) {
    peer_->GetManufAndModel(manufacturer, model);
  } else {
    manufacturer = model = UString();
  }
}

void SynapPeer::SetManufAndModel(UString const& manufacturer, UString const& model) const {
  if (peer_ != nullptr) {
    peer_->SetManufAndModel(manufacturer, model);
  }
}

void SynapPeer::GetMasterNamesProperty(UString& path) const {
  if (peer_ != nullptr) {
    peer_->GetMasterNamesProperty(path);
  } else {
    path = UString();
  }
}

void SynapPeer::SetMasterNamesProperty(UString const& path) const {
  if (peer_ != nullptr) {
    peer_->SetMasterNamesProperty(path);
  }
}

SlotID SynapPeer::GetSlotID() const { return peer_ != nullptr ? peer_->GetSlotID() : SlotID(); }

int SynapPeer::GetUniqueID() const { return peer_ != nullptr ? peer_->GetUniqueID() : 0; }

void SynapPeer::SetAdvanceScheduleTime(int microseconds) const {
  if (peer_ != nullptr) {
    peer_->SetAdvanceScheduleTime(microseconds);
  }
}

void SynapPeer::SetChanMask(int mask) const {
  if (peer_ != nullptr) {
    peer_->SetChanMask(mask);
  }
}

void SynapPeer::SetChanName(int channel, UString const& name) const {
  if (peer_ != nullptr) {
    peer_->SetChanName(channel, name);
  }
}

}  // namespace Ostinet
