// SPDX-License-Identifier: MIT
#include <map>
#include <utility>

#include "names/NameTree.h"

namespace Ostinet::Impl {

namespace {

// One table for each pair of a default list and a patch's own list.
template <class Table, class Data>
class TableCache {
 public:
  // Null if both lists are.
  RCPtrMT<Table> Get(Data const* defaults, Data const* own) {
    if (defaults == nullptr && own == nullptr) {
      return RCPtrMT<Table>();
    }
    RCPtrMT<Table>& table = tables_[{defaults, own}];
    if (table.get() == nullptr) {
      table = Table::Merge(defaults, own);
    }
    return table;
  }

 private:
  std::map<std::pair<Data const*, Data const*>, RCPtrMT<Table>> tables_;
};

template <class Map>
auto Find(Map const& map, typename Map::key_type const& key) {
  auto const place = map.find(key);
  return place != map.end() ? place->second.get() : nullptr;
}

template <class Map>
void CopyUse(Map& map, RCPtrMT<PatchImpl> const& patch, RCPtrMT<PatchImpl> const& copy) {
  auto const place = map.find(patch);
  if (place != map.end()) {
    map.emplace(copy, place->second);
  }
}

}  // namespace

void NameListUses::Merge(NameListUses const& other) {
  nameSetNotes.insert(other.nameSetNotes.begin(), other.nameSetNotes.end());
  nameSetControls.insert(other.nameSetControls.begin(), other.nameSetControls.end());
  patchNotes.insert(other.patchNotes.begin(), other.patchNotes.end());
  patchControls.insert(other.patchControls.begin(), other.patchControls.end());
}

void NameListUses::CopyFor(RCPtrMT<PatchImpl> const& patch, RCPtrMT<PatchImpl> const& copy) {
  CopyUse(patchNotes, patch, copy);
  CopyUse(patchControls, patch, copy);
}

void AssignLists(NameTree const& tree, NameListUses const& uses) {
  TableCache<NoteNameTable, NoteNameData> notes;
  TableCache<ControlTable, ControlNameData> controls;
  for (RCPtrMT<DestNameSetImpl> const& nameSet : tree.nameSets) {
    NoteNameData const* const defaultNotes = Find(uses.nameSetNotes, nameSet);
    ControlNameData const* const defaultControls = Find(uses.nameSetControls, nameSet);
    nameSet->SetDefaultNotes(notes.Get(defaultNotes, nullptr));
    nameSet->SetDefaultControls(controls.Get(defaultControls, nullptr));
    for (RCPtrMT<PatchBankImpl> const& bank : nameSet->GetBanks()) {
      for (RCPtrMT<PatchImpl> const& patch : bank->GetPatches()) {
        patch->SetNoteNames(notes.Get(defaultNotes, Find(uses.patchNotes, patch)));
        patch->SetControls(controls.Get(defaultControls, Find(uses.patchControls, patch)));
      }
    }
  }
}

}  // namespace Ostinet::Impl
