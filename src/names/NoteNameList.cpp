// SPDX-License-Identifier: MIT
#include "names/NameHandles.h"

namespace Ostinet {

using Impl::ImplOf;
using Impl::NoteNameTable;

MatchObjectID const NoteNameList::kObjectID;
MatchObjectID const DefaultNoteNameList::kObjectID;
NoteNameList const NoteNameList::kNoNoteNameList;
DefaultNoteNameList const DefaultNoteNameList::kNoDefaultNoteNameList;

namespace {

// A list of notes is a view: its object is the patch or the name set that has the table, which is
// looked up at each call, because an edit through another handle may have put a new one there.
Impl::PatchImpl* PatchOf(NoteNameListBase const& list) {
  return dynamic_cast<Impl::PatchImpl*>(ImplOf(static_cast<Object const&>(list)));
}

Impl::DestNameSetImpl* NameSetOf(NoteNameListBase const& list) {
  return dynamic_cast<Impl::DestNameSetImpl*>(ImplOf(static_cast<Object const&>(list)));
}

NoteNameTable const* TableOf(NoteNameListBase const& list) {
  if (Impl::PatchImpl const* const patch = PatchOf(list)) {
    return patch->GetNoteNames().get();
  }
  Impl::DestNameSetImpl const* const nameSet = NameSetOf(list);
  return nameSet != nullptr ? nameSet->GetDefaultNotes().get() : nullptr;
}

NoteGroup AsGroup(Impl::NoteGroupEntry const& entry) {
  NoteGroup group;
  group.id = entry.id;
  group.name = entry.name;
  group.pitches = entry.pitches;
  return group;
}

}  // namespace

NoteNameListBase::NoteNameListBase() = default;
NoteNameListBase::NoteNameListBase(RCPtrMT<Impl::ObjectImpl> const& impl) : Object(impl) {}
NoteNameListBase::~NoteNameListBase() = default;

UString NoteNameListBase::GetName() const {
  NoteNameTable const* const table = TableOf(*this);
  return table != nullptr ? table->GetName() : UString();
}

bool NoteNameListBase::HasNames() const { return TableOf(*this) != nullptr; }

int NoteNameListBase::CountNoteNames() const {
  NoteNameTable const* const table = TableOf(*this);
  return table != nullptr ? static_cast<int>(table->GetNotes().size()) : 0;
}

std::pair<unsigned char, UString> NoteNameListBase::GetNoteName(int index) const {
  if (index < 0 || index >= CountNoteNames()) {
    return std::pair<unsigned char, UString>();
  }
  Impl::NoteEntry const& note = TableOf(*this)->GetNotes()[static_cast<std::size_t>(index)];
  return std::pair<unsigned char, UString>(note.pitch, note.name);
}

int NoteNameListBase::CountNoteGroups() const {
  NoteNameTable const* const table = TableOf(*this);
  return table != nullptr ? static_cast<int>(table->GetGroups().size()) : 0;
}

NoteGroup NoteNameListBase::GetNoteGroup(int index) const {
  bool const isThere = index >= 0 && index < CountNoteGroups();
  return isThere ? AsGroup(TableOf(*this)->GetGroups()[static_cast<std::size_t>(index)])
                 : NoteGroup();
}

NoteGroup NoteNameListBase::GetNoteGroupForID(int id) const {
  NoteNameTable const* const table = TableOf(*this);
  Impl::NoteGroupEntry const* const group = table != nullptr ? table->FindGroup(id) : nullptr;
  return group != nullptr ? AsGroup(*group) : NoteGroup();
}

UString NoteNameListBase::GetNoteNameForPitch(unsigned char pitch) const {
  NoteNameTable const* const table = TableOf(*this);
  Impl::NoteEntry const* const note = table != nullptr ? table->FindNote(pitch) : nullptr;
  return note != nullptr ? note->name : UString();
}

int NoteNameListBase::GetNoteGroupForPitch(unsigned char pitch) const {
  NoteNameTable const* const table = TableOf(*this);
  Impl::NoteEntry const* const note = table != nullptr ? table->FindNote(pitch) : nullptr;
  return note != nullptr ? note->group : 0;
}

NoteNameList::NoteNameList() = default;
NoteNameList::NoteNameList(RCPtrMT<Impl::PatchImpl> const& impl) : NoteNameListBase(impl) {}

Patch NoteNameList::GetPatch() const { return Patch(PatchOf(*this)); }

void NoteNameList::SetNoteName(unsigned char pitch, UString const& name) const {
  if (Impl::PatchImpl* const patch = PatchOf(*this)) {
    patch->EditNoteNames().SetNoteName(pitch, name);
  }
}

void NoteNameList::ClearNoteName(unsigned char pitch) const {
  if (Impl::PatchImpl* const patch = PatchOf(*this)) {
    patch->EditNoteNames().ClearNoteName(pitch);
  }
}

void NoteNameList::PutNoteInGroup(unsigned char pitch, int groupID,
                                  UString const& groupName) const {
  if (Impl::PatchImpl* const patch = PatchOf(*this)) {
    patch->EditNoteNames().PutNoteInGroup(pitch, groupID, groupName);
  }
}

void NoteNameList::RemoveNoteGroup(int groupID, bool removeNotes) const {
  if (Impl::PatchImpl* const patch = PatchOf(*this)) {
    patch->EditNoteNames().RemoveGroup(groupID, removeNotes);
  }
}

int NoteNameList::GetUnusedGroupID() const {
  if (!Exists()) {
    return 0;
  }
  NoteNameTable const* const table = TableOf(*this);
  return table != nullptr ? table->GetUnusedGroupID() : 1;
}

DefaultNoteNameList::DefaultNoteNameList() = default;
DefaultNoteNameList::DefaultNoteNameList(RCPtrMT<Impl::DestNameSetImpl> const& impl)
    : NoteNameListBase(impl) {}

DestinationNameSet DefaultNoteNameList::GetNameSet() const {
  return DestinationNameSet(NameSetOf(*this));
}

}  // namespace Ostinet
