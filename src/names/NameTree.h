// SPDX-License-Identifier: MIT
#pragma once

#include <map>
#include <vector>

#include "names/DestModeImpl.h"

namespace Ostinet::Impl {

/// All the names of a destination, and what is selected among them. A load fills a fresh tree,
/// which then takes the place of the old one.
///
/// Ownership  The tree owns its modes and name sets; these own banks, and banks patches. Back
///            references are plain. When a tree goes, those to the destination are cleared and the
///            rings through patches' tables of name sets are broken, so objects that a host still
///            holds go on answering from what they own, and nothing leaks.
class NameTree {
 public:
  NameTree() = default;
  NameTree(NameTree&& other) noexcept = default;
  NameTree& operator=(NameTree&& other) noexcept;
  ~NameTree();

  void Swap(NameTree& other) noexcept;
  /// Takes over the modes and name sets of another tree, not its selection.
  void Append(NameTree&& other);

  std::vector<RCPtrMT<DestModeImpl>> modes;
  std::vector<RCPtrMT<DestNameSetImpl>> nameSets;
  RCPtrMT<DestModeImpl> currentMode;
  ChannelNameSets currentNameSets;

 private:
  void Detach();
};

/// What a document has in lists of notes and controls, for the objects that use it. Keyed by
/// counted pointers, so that no new object can take the place of one that is gone.
struct NameListUses {
  std::map<RCPtrMT<DestNameSetImpl>, RCPtrMT<NoteNameData>> nameSetNotes;
  std::map<RCPtrMT<DestNameSetImpl>, RCPtrMT<ControlNameData>> nameSetControls;
  std::map<RCPtrMT<PatchImpl>, RCPtrMT<NoteNameData>> patchNotes;
  std::map<RCPtrMT<PatchImpl>, RCPtrMT<ControlNameData>> patchControls;

  /// Adds those of another document; what is there stays.
  void Merge(NameListUses const& other);
  /// The copy of a patch uses what the patch uses.
  void CopyFor(RCPtrMT<PatchImpl> const& patch, RCPtrMT<PatchImpl> const& copy);
};

/// Gives each name set and patch of the tree its tables: defaults and the patch's own list merged,
/// one table for each pair of lists.
void AssignLists(NameTree const& tree, NameListUses const& uses);

/// A list of patches while a document is read, with the banks that ask for it.
struct PatchNameListData : RCObjectMT<PatchNameListData> {
  explicit PatchNameListData(UString listName) : name(std::move(listName)) {}

  /// Puts the patches into the banks, and empties both. The first bank gets the patches
  /// themselves, each further one copies, for which their lists are entered in `uses` too. A list
  /// with no patches or no banks leaves the banks as they are.
  void Attach(bool isTemporary, NameListUses& uses);

  UString const name;
  std::vector<RCPtrMT<PatchImpl>> patches;
  std::vector<RCPtrMT<PatchBankImpl>> banks;
};

}  // namespace Ostinet::Impl
