// SPDX-License-Identifier: MIT
#include "names/NameHandles.h"

namespace Ostinet {

using Impl::ControlTable;
using Impl::ImplOf;

MatchObjectID const ControlList::kObjectID;
MatchObjectID const DefaultControlList::kObjectID;
ControlList const ControlList::kNoControlList;
DefaultControlList const DefaultControlList::kNoDefaultControlList;

namespace {

// A list of controls is a view, as a list of notes is.
Impl::PatchImpl* PatchOf(ControlListBase const& list) {
  return dynamic_cast<Impl::PatchImpl*>(ImplOf(static_cast<Object const&>(list)));
}

Impl::DestNameSetImpl* NameSetOf(ControlListBase const& list) {
  return dynamic_cast<Impl::DestNameSetImpl*>(ImplOf(static_cast<Object const&>(list)));
}

ControlTable const* TableOf(ControlListBase const& list) {
  if (Impl::PatchImpl const* const patch = PatchOf(list)) {
    return patch->GetControls().get();
  }
  Impl::DestNameSetImpl const* const nameSet = NameSetOf(list);
  return nameSet != nullptr ? nameSet->GetDefaultControls().get() : nullptr;
}

Impl::ControlEntry const* Find(ControlListBase const& list, ControlType type,
                               unsigned short number) {
  ControlTable const* const table = TableOf(list);
  return table != nullptr ? table->Find({type, number}) : nullptr;
}

}  // namespace

ControlListBase::ControlListBase() = default;
ControlListBase::ControlListBase(RCPtrMT<Impl::ObjectImpl> const& impl) : Object(impl) {}
ControlListBase::~ControlListBase() = default;

UString ControlListBase::GetName() const {
  ControlTable const* const table = TableOf(*this);
  return table != nullptr ? table->GetName() : UString();
}

int ControlListBase::CountControls() const {
  ControlTable const* const table = TableOf(*this);
  return table != nullptr ? static_cast<int>(table->GetControls().size()) : 0;
}

Control ControlListBase::GetControl(ControlType type, unsigned short number) const {
  Impl::ControlEntry const* const entry = Find(*this, type, number);
  return entry != nullptr ? entry->control : Control();
}

Control ControlListBase::GetControl(int index) const {
  bool const isThere = index >= 0 && index < CountControls();
  return isThere ? TableOf(*this)->GetControls()[static_cast<std::size_t>(index)].control
                 : Control();
}

bool ControlListBase::HasControl(ControlType type, unsigned short number) const {
  return Find(*this, type, number) != nullptr;
}

ControlList::ControlList() = default;
ControlList::ControlList(RCPtrMT<Impl::PatchImpl> const& impl) : ControlListBase(impl) {}

Patch ControlList::GetPatch() const { return Patch(PatchOf(*this)); }

void ControlList::SetControl(Control const& control) const {
  if (Impl::PatchImpl* const patch = PatchOf(*this)) {
    patch->EditControls().Set(control);
  }
}

void ControlList::ClearControl(ControlType type, unsigned short number) const {
  if (Impl::PatchImpl* const patch = PatchOf(*this)) {
    patch->EditControls().Clear({type, number});
  }
}

DefaultControlList::DefaultControlList() = default;
DefaultControlList::DefaultControlList(RCPtrMT<Impl::DestNameSetImpl> const& impl)
    : ControlListBase(impl) {}

DestinationNameSet DefaultControlList::GetNameSet() const {
  return DestinationNameSet(NameSetOf(*this));
}

}  // namespace Ostinet
