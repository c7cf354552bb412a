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

void DestinationTree::LoadTree(NameTree&) {}

void DestinationTree::DropTree(bool loadsAnew) {
  mustLoad_ = loadsAnew;
  NameTree old;
  old.Swap(tree_);
}

NameTree& DestinationTree::Tree() {
  if (mustLoad_) {
    mustLoad_ = false;
    NameTree fresh;
    LoadTree(fresh);
    tree_.Swap(fresh);
  }
  return tree_;
}

DestNameSetImpl* DestinationTree::GetCurrentNameSet(int channel) const {
  bool const isChannel = channel >= 0 && channel < 16;
  return isChannel ? GetTree().currentNameSets[static_cast<std::size_t>(channel)].get() : nullptr;
}

void DestinationTree::SelectMode(RCPtrMT<DestModeImpl> const& mode) {
  NameTree& tree = Tree();
  tree.currentMode = mode;
  tree.currentNameSets = mode.get() != nullptr ? mode->GetNameSets() : ChannelNameSets();
  StoreSelection();
}

void DestinationTree::StoreSelection() {
  NameTree const& tree = GetTree();
  ImplImpl& peer = *destination_.Peer();
  PropertyDict dict;
  peer.GetDict(Keys::kNameConfiguration, dict);
  std::vector<UString> names;
  for (RCPtrMT<DestNameSetImpl> const& nameSet : tree.currentNameSets) {
    names.push_back(nameSet.get() != nullptr ? nameSet->GetName() : UString());
  }
  dict.entries[SelectionKeys::kCurrentMode] =
      tree.currentMode.get() != nullptr ? tree.currentMode->GetName() : UString();
  dict.entries[SelectionKeys::kCurrentNameSets] = names;
  peer.SetDict(Keys::kNameConfiguration, dict);
}

}  // namespace Ostinet::Impl
