// SPDX-License-Identifier: MIT
#pragma once

#include <algorithm>
#include <vector>

#include "names/ControlTable.h"
#include "names/NoteNameTable.h"

namespace Ostinet::Impl {

/// `wanted`, or `wanted` with the first number from 2 up behind it for which `isTaken` is false.
template <class IsTaken>
UString MakeUniqueName(UString const& wanted, IsTaken isTaken) {
  UString name = wanted;
  for (int number = 2; isTaken(name); ++number) {
    name = wanted;
    name.Stream() << number;
  }
  return name;
}

/// The lists of one kind that a document refers to by name, each under a name of its own; sorted
/// by that. Names that a reader would take for the same one are kept apart, and none is empty,
/// because a list without a name cannot be referred to.
template <class List>
class SharedLists {
 public:
  struct Entry {
    UString name;
    List const* list;
  };

  /// The name of this very list, which is entered if it is not there yet.
  UString NameOf(List const& list) {
    for (Entry const& entry : entries_) {
      if (entry.list == &list) {
        return entry.name;
      }
    }
    UString const name = MakeUniqueName(list.GetName(), [this](UString const& taken) {
      return taken.empty() ||
             std::any_of(entries_.begin(), entries_.end(), [&](Entry const& entry) {
               return entry.name.equal(taken, UString::kCatalogKey);
             });
    });
    auto const place = std::find_if(entries_.begin(), entries_.end(),
                                    [&](Entry const& entry) { return name < entry.name; });
    entries_.insert(place, Entry{name, &list});
    return name;
  }

  std::vector<Entry> const& Entries() const { return entries_; }

 private:
  std::vector<Entry> entries_;
};

/// What the banks of one written document share. The lists outlive it.
struct NameListRegistry {
  SharedLists<NoteNameTable> notes;
  SharedLists<ControlTable> controls;
  SharedLists<ValueListImpl> values;
};

}  // namespace Ostinet::Impl
