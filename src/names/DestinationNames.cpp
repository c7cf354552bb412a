// SPDX-License-Identifier: MIT
//
// Destination: what its modes, banks and patches are called.
#include "names/DestinationNameManager.h"
#include "names/NameHandles.h"

namespace Ostinet {

using Impl::DestinationNameManager;
using Impl::DestinationTree;
using Impl::HandleAt;
using Impl::ImplOf;

namespace {

// What was last sent on the channel: to the port itself, or to the one that the instrument hangs
// on.
PatchNumbers NumbersPlaying(Impl::DestinationImpl const& destination, short channel) {
  Impl::DestinationImpl const* const port =
      destination.IsDirect() ? &destination : Impl::AsDestination(destination.GetDirectEndpoint());
  if (port == nullptr || port->GetChannelState().get() == nullptr) {
    return PatchNumbers();
  }
  Impl::ChannelPatchState::Patch const sent = port->GetChannelState()->GetPatch(channel);
  return PatchNumbers(sent.program, sent.bankMSB, sent.bankLSB);
}

Impl::DestNameSetImpl* CurrentNameSet(Destination const& destination, short channel) {
  DestinationTree const* const tree = DestinationTree::Of(destination);
  return tree != nullptr ? tree->GetCurrentNameSet(channel) : nullptr;
}

}  // namespace

int Destination::CountModes() const {
  DestinationTree const* const tree = DestinationTree::Of(*this);
  return tree != nullptr ? static_cast<int>(tree->GetTree().modes.size()) : 0;
}

DestinationMode Destination::GetMode(int index) const {
  DestinationTree const* const tree = DestinationTree::Of(*this);
  return tree != nullptr ? HandleAt<DestinationMode>(tree->GetTree().modes, index)
                         : DestinationMode();
}

int Destination::CountNameSets() const {
  DestinationTree const* const tree = DestinationTree::Of(*this);
  return tree != nullptr ? static_cast<int>(tree->GetTree().nameSets.size()) : 0;
}

DestinationNameSet Destination::GetNameSet(int index) const {
  DestinationTree const* const tree = DestinationTree::Of(*this);
  return tree != nullptr ? HandleAt<DestinationNameSet>(tree->GetTree().nameSets, index)
                         : DestinationNameSet();
}

DestinationMode Destination::GetCurrentMode() const {
  DestinationTree const* const tree = DestinationTree::Of(*this);
  return tree != nullptr ? DestinationMode(tree->GetTree().currentMode) : DestinationMode();
}

DestinationNameSet Destination::GetCurrentNameSet(short channel) const {
  return DestinationNameSet(CurrentNameSet(*this, channel));
}

Patch Destination::GetCurrentPatch(short channel) const {
  Impl::DestNameSetImpl const* const nameSet = CurrentNameSet(*this, channel);
  return nameSet != nullptr
             ? Patch(nameSet->FindPlayingPatch(NumbersPlaying(*ImplOf(*this), channel)))
             : Patch();
}

PatchBank Destination::GetCurrentBank(short channel) const {
  return GetCurrentPatch(channel).GetBank();
}

Patch Destination::GetPatch(short channel, PatchNumbers const& numbers) const {
  Impl::DestNameSetImpl const* const nameSet = CurrentNameSet(*this, channel);
  return nameSet != nullptr ? Patch(nameSet->FindPatch(numbers)) : Patch();
}

Names Destination::GetNames() const {
  DestinationNameManager const* const manager = DestinationNameManager::Of(*this);
  return manager != nullptr ? manager->GetNames() : Names();
}

void Destination::SetNames(Names const& names) const {
  if (DestinationNameManager* const manager = DestinationNameManager::Of(*this)) {
    manager->SetNames(names);
  }
}

Names Destination::GetOverrideNames(PatchBank const& bank) const {
  DestinationNameManager const* const manager = DestinationNameManager::Of(*this);
  Impl::PatchBankImpl const* const impl = ImplOf(bank);
  return manager != nullptr && impl != nullptr ? manager->GetOverrideNames(*impl) : Names();
}

void Destination::SetOverrideNames(PatchBank const& bank, Names const& names) const {
  DestinationNameManager* const manager = DestinationNameManager::Of(*this);
  Impl::PatchBankImpl* const impl = ImplOf(bank);
  if (manager != nullptr && impl != nullptr) {
    manager->SetOverrideNames(*impl, names);
  }
}

}  // namespace Ostinet
