// SPDX-License-Identifier: MIT
#include "names/ControlTable.h"

#include <algorithm>

namespace Ostinet::Impl {

namespace {

bool IsBefore(ControlEntry const& entry, ControlKey key) {
  return ControlParts::KeyOf(entry.control) < key;
}

bool IsAt(std::vector<ControlEntry> const& entries, std::vector<ControlEntry>::const_iterator place,
          ControlKey key) {
  return place != entries.end() && ControlParts::KeyOf(place->control) == key;
}

}  // namespace

RCPtrMT<ControlTable> ControlTable::Merge(ControlNameData const* defaults,
                                          ControlNameData const* own) {
  static sorted_vector_set<Control, ControlOrder> const kNone;
  RCPtrMT<ControlTable> const table(new ControlTable);
  table->name_ = own != nullptr ? own->name : defaults != nullptr ? defaults->name : UString();
  table->isShared_ = defaults != nullptr || (own != nullptr && own->isNamed);

  // Both are sorted, so that one walk merges them.
  auto const& ofDefault = defaults != nullptr ? defaults->controls : kNone;
  auto const& ofOwn = own != nullptr ? own->controls : kNone;
  ControlOrder const isLess;
  auto a = ofDefault.begin();
  auto b = ofOwn.begin();
  while (a != ofDefault.end() || b != ofOwn.end()) {
    if (b == ofOwn.end() || (a != ofDefault.end() && isLess(*a, *b))) {
      table->Append(*a++, true, true);
    } else if (a == ofDefault.end() || isLess(*b, *a)) {
      table->Append(*b++, false, false);
    } else {
      if (ControlParts::IsEmpty(*b)) {
        table->Hide(ControlParts::KeyOf(*b));
      }
      table->Append(*b++, true, false);
      ++a;
    }
  }
  return table;
}

void ControlTable::Append(Control const& control, bool hasDefault, bool inherited) {
  if (!ControlParts::IsEmpty(control)) {
    controls_.push_back({control, hasDefault, inherited});
  }
}

RCPtrMT<ControlTable> ControlTable::CopyForEditing() const {
  RCPtrMT<ControlTable> const copy(new ControlTable);
  copy->name_ = name_;
  copy->isEditable_ = true;
  copy->controls_ = controls_;
  copy->hidden_ = hidden_;
  return copy;
}

ControlEntry const* ControlTable::Find(ControlKey key) const {
  auto const place = std::lower_bound(controls_.begin(), controls_.end(), key, IsBefore);
  return IsAt(controls_, place, key) ? &*place : nullptr;
}

void ControlTable::Set(Control const& control) {
  ControlKey const key = ControlParts::KeyOf(control);
  auto const place = std::lower_bound(controls_.begin(), controls_.end(), key, IsBefore);
  if (IsAt(controls_, place, key)) {
    place->control = control;
    place->inherited = false;
    return;
  }
  auto const hidden = std::lower_bound(hidden_.begin(), hidden_.end(), key);
  bool const isHidden = hidden != hidden_.end() && *hidden == key;
  if (isHidden) {
    hidden_.erase(hidden);
  }
  controls_.insert(place, {control, isHidden, false});
}

void ControlTable::Clear(ControlKey key) {
  auto const place = std::lower_bound(controls_.begin(), controls_.end(), key, IsBefore);
  if (!IsAt(controls_, place, key)) {
    return;
  }
  if (place->hasDefault) {
    Hide(key);
  }
  controls_.erase(place);
}

void ControlTable::Hide(ControlKey key) {
  auto const place = std::lower_bound(hidden_.begin(), hidden_.end(), key);
  if (place == hidden_.end() || !(*place == key)) {
    hidden_.insert(place, key);
  }
}

}  // namespace Ostinet::Impl
