// SPDX-License-Identifier: MIT
#include "names/DestinationTree.h"

#include "model/Handles.h"
#include "model/PropertyKeys.h"
#include "names/SelectionKeys.h"

namespace Ostinet::Impl {

DestinationTree* DestinationTree::Of(DestinationImpl const* destination) {
  return destination != nullptr ? static_cast<DestinationTree*>(destination->GetNames()) : nullptr;
}

DestinationTree* DestinationTree::Of(Destination const& destination) {
  return Of(ImplOf(destination));
}

DestNameSetImpl* DestinationTree::GetCurrentNameSet(int channel) const {
  bool const isChannel = channel >= 0 && channel < 16;
  return isChannel ? tree_.currentNameSets[static_cast<std::size_t>(channel)].get() : nullptr;
}

void DestinationTree::SelectMode(RCPtrMT<DestModeImpl> const& mode) {
  tree_.currentMode = mode;
  tree_.currentNameSets = mode.get() != nullptr ? mode->GetNameSets() : ChannelNameSets();
  StoreSelection();
}

void DestinationTree::StoreSelection() {
  ImplImpl& peer = *destination_.Peer();
  PropertyDict dict;
  peer.GetDict(Keys::kNameConfiguration, dict);
  std::vector<UString> names;
  for (RCPtrMT<DestNameSetImpl> const& nameSet : tree_.currentNameSets) {
    names.push_back(nameSet.get() != nullptr ? nameSet->GetName() : UString());
  }
  dict.entries[SelectionKeys::kCurrentMode] =
      tree_.currentMode.get() != nullptr ? tree_.currentMode->GetName() : UString();
  dict.entries[SelectionKeys::kCurrentNameSets] = names;
  peer.SetDict(Keys::kNameConfiguration, dict);
}

}  // namespace Ostinet::Impl
