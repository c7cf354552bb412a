// SPDX-License-Identifier: MIT
#pragma once

#include "model/DestinationImpl.h"
#include "names/NameTree.h"

namespace Ostinet::Impl {

/// The names that a destination has loaded, and the banks whose edits are not saved yet. Where the
/// names come from is the business of the class derived from this; every destination's names are
/// of that class.
///
/// Ownership  The destination's.
/// Threads    The host's polling thread.
class DestinationTree : public DestinationNames {
 public:
  using Banks = sorted_vector_set<RCPtrMT<PatchBankImpl>, std::less<RCPtrMT<PatchBankImpl>>>;

  /// Null for a null handle, and for a destination without names.
  static DestinationTree* Of(Destination const& destination);
  static DestinationTree* Of(DestinationImpl const* destination);

  explicit DestinationTree(DestinationImpl& destination) : destination_(destination) {}

  DestinationImpl& GetDestination() const { return destination_; }
  /// Loads it where that still waits.
  NameTree const& GetTree() const { return const_cast<DestinationTree*>(this)->Tree(); }
  /// Null if there is none, and for a channel that is not 0 to 15.
  DestNameSetImpl* GetCurrentNameSet(int channel) const;

  /// The mode becomes the current one, its name sets those of the 16 channels, empty slots
  /// included; that is stored with the destination.
  void SelectMode(RCPtrMT<DestModeImpl> const& mode);
  /// A patch of the bank was edited.
  void MarkEdited(PatchBankImpl& bank) { editedBanks_.insert(RCPtrMT<PatchBankImpl>(&bank)); }
  Banks const& GetEditedBanks() const { return editedBanks_; }

 protected:
  /// Fills a fresh tree, when somebody first asks for one.
  virtual void LoadTree(NameTree& fresh);
  /// The tree goes. The next one is loaded on demand, if `loadsAnew`.
  void DropTree(bool loadsAnew);
  bool IsTreeLoaded() const { return !mustLoad_; }
  NameTree& Tree();
  Banks& EditedBanks() { return editedBanks_; }
  /// Writes what is selected into the "nameConfiguration" property, whose other entries stay.
  void StoreSelection();

 private:
  DestinationImpl& destination_;
  NameTree tree_;
  bool mustLoad_ = false;
  Banks editedBanks_;
};

}  // namespace Ostinet::Impl
