// SPDX-License-Identifier: MIT
#include "names/NameTree.h"

#include <utility>

namespace Ostinet::Impl {

NameTree& NameTree::operator=(NameTree&& other) noexcept {
  if (this != &other) {
    NameTree old;
    old.Swap(*this);
    Swap(other);
  }
  return *this;
}

NameTree::~NameTree() { Detach(); }

void NameTree::Swap(NameTree& other) noexcept {
  modes.swap(other.modes);
  nameSets.swap(other.nameSets);
  std::swap(currentMode, other.currentMode);
  currentNameSets.swap(other.currentNameSets);
}

void NameTree::Append(NameTree&& other) {
  modes.insert(modes.end(), other.modes.begin(), other.modes.end());
  nameSets.insert(nameSets.end(), other.nameSets.begin(), other.nameSets.end());
  other.modes.clear();
  other.nameSets.clear();
}

void NameTree::Detach() {
  for (RCPtrMT<DestModeImpl> const& mode : modes) {
    mode->Detach();
  }
  for (RCPtrMT<DestNameSetImpl> const& nameSet : nameSets) {
    nameSet->Detach();
  }
}

void PatchNameListData::Attach(bool isTemporary, NameListUses& uses) {
  if (patches.empty() || banks.empty()) {
    return;
  }
  for (std::size_t i = 0; i < banks.size(); ++i) {
    PatchBankImpl& bank = *banks[i];
    bank.SetListName(name);
    bank.ClearPatches();
    bank.SetTemporary(isTemporary);
    for (RCPtrMT<PatchImpl> const& patch : patches) {
      if (i == 0) {
        bank.AddPatch(patch);
      } else {
        RCPtrMT<PatchImpl> const copy(new PatchImpl(*patch));
        uses.CopyFor(patch, copy);
        bank.AddPatch(copy);
      }
    }
  }
  patches.clear();
  banks.clear();
}

}  // namespace Ostinet::Impl
