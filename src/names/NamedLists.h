// SPDX-License-Identifier: MIT
#pragma once

#include <vector>

#include "names/NameTree.h"

namespace Ostinet::Impl {

// What is found by its name while a document is read: whoever comes first, a reference or the
// definition, makes the object, and the definition fills it. Names that differ in case and white
// space alone are the same name.

inline UString const& NameOf(PatchNameListData const& list) { return list.name; }
inline UString const& NameOf(NoteNameData const& list) { return list.name; }
inline UString const& NameOf(ControlNameData const& list) { return list.name; }
inline UString const& NameOf(ValueListImpl const& list) { return list.GetName(); }
inline UString NameOf(DestNameSetImpl const& nameSet) { return nameSet.GetName(); }

/// The first of this name; null if there is none.
template <class Data>
Data* FindByName(std::vector<RCPtrMT<Data>> const& all, UString const& name) {
  for (RCPtrMT<Data> const& each : all) {
    if (NameOf(*each).equal(name, UString::kCatalogKey)) {
      return each.get();
    }
  }
  return nullptr;
}

/// The first of this name, made by `make` if there is none.
template <class Data, class Make>
RCPtrMT<Data> DemandByName(std::vector<RCPtrMT<Data>>& all, UString const& name, Make make) {
  RCPtrMT<Data> found = FindByName(all, name);
  if (!found) {
    found = make();
    all.push_back(found);
  }
  return found;
}

}  // namespace Ostinet::Impl
