// SPDX-License-Identifier: MIT
#include "names/NoteNameTable.h"

#include <algorithm>

namespace Ostinet::Impl {

namespace {

bool IsBefore(NoteEntry const& note, unsigned char pitch) { return note.pitch < pitch; }
bool IsGroupBefore(NoteGroupEntry const& group, int id) { return group.id < id; }

}  // namespace

RCPtrMT<NoteNameTable> NoteNameTable::CopyForEditing() const {
  RCPtrMT<NoteNameTable> const copy(new NoteNameTable);
  copy->name_ = name_;
  copy->isEditable_ = true;
  copy->notes_ = notes_;
  copy->hiddenPitches_ = hiddenPitches_;
  copy->groups_ = groups_;
  return copy;
}

NoteNameTable::Notes::iterator NoteNameTable::NotePlace(unsigned char pitch) {
  return std::lower_bound(notes_.begin(), notes_.end(), pitch, IsBefore);
}

NoteNameTable::Groups::iterator NoteNameTable::GroupPlace(int id) {
  return std::lower_bound(groups_.begin(), groups_.end(), id, IsGroupBefore);
}

NoteEntry const* NoteNameTable::FindNote(unsigned char pitch) const {
  auto const place = std::lower_bound(notes_.begin(), notes_.end(), pitch, IsBefore);
  return place != notes_.end() && place->pitch == pitch ? &*place : nullptr;
}

NoteGroupEntry const* NoteNameTable::FindGroup(int id) const {
  auto const place = std::lower_bound(groups_.begin(), groups_.end(), id, IsGroupBefore);
  return place != groups_.end() && place->id == id ? &*place : nullptr;
}

void NoteNameTable::SetNoteName(unsigned char pitch, UString const& name) {
  auto place = NotePlace(pitch);
  if (place == notes_.end() || place->pitch != pitch) {
    NoteEntry note;
    note.pitch = pitch;
    note.hasDefault = Unhide(pitch);
    place = notes_.insert(place, note);
  } else if (place->inherited && place->group != 0) {
    // A group is written whole or not at all, so it becomes the patch's own with all its notes.
    Own(*GroupPlace(place->group));
  }
  place->name = name;
  place->inherited = false;
}

void NoteNameTable::ClearNoteName(unsigned char pitch) {
  auto const place = NotePlace(pitch);
  if (place == notes_.end() || place->pitch != pitch) {
    return;
  }
  if (place->group != 0) {
    auto const group = GroupPlace(place->group);
    Leave(pitch, *group);
    // A group of one stays here, other than when a note moves to another group.
    if (group->pitches.empty()) {
      groups_.erase(group);
    }
  }
  if (place->hasDefault) {
    Hide(pitch);
  }
  notes_.erase(place);
}

void NoteNameTable::PutNoteInGroup(unsigned char pitch, int group, UString const& groupName) {
  auto place = NotePlace(pitch);
  if (place == notes_.end() || place->pitch != pitch) {
    NoteEntry note;
    note.pitch = pitch;
    place = notes_.insert(place, note);
  }
  if (place->group == group) {
    return;
  }
  if (place->group != 0) {
    LeaveGroupBelowTwo(*place);
  }
  if (group != 0) {
    Join(pitch, group, groupName);
  }
  place->group = group;
  place->inherited = false;
}

void NoteNameTable::RemoveGroup(int id, bool removeNotes) {
  auto const group = GroupPlace(id);
  if (group == groups_.end() || group->id != id) {
    return;
  }
  if (!removeNotes) {
    Dissolve(group);
    return;
  }
  groups_.erase(group);
  Notes kept;
  for (NoteEntry& note : notes_) {
    if (note.group != id) {
      kept.push_back(std::move(note));
    } else if (note.hasDefault) {
      Hide(note.pitch);
    }
  }
  notes_.swap(kept);
}

int NoteNameTable::GetUnusedGroupID() const {
  int unused = 1;
  for (NoteGroupEntry const& group : groups_) {
    if (group.id == unused) {
      ++unused;
    }
  }
  return unused;
}

void NoteNameTable::Own(NoteGroupEntry& group) {
  group.inherited = false;
  for (NoteEntry& note : notes_) {
    if (note.group == group.id) {
      note.inherited = false;
    }
  }
}

void NoteNameTable::Leave(unsigned char pitch, NoteGroupEntry& group) {
  std::vector<unsigned char>& pitches = group.pitches;
  pitches.erase(std::remove(pitches.begin(), pitches.end(), pitch), pitches.end());
}

void NoteNameTable::LeaveGroupBelowTwo(NoteEntry& note) {
  auto const group = GroupPlace(note.group);
  Leave(note.pitch, *group);
  if (group->pitches.size() < 2) {
    Dissolve(group);
  }
}

void NoteNameTable::Join(unsigned char pitch, int id, UString const& groupName) {
  auto group = GroupPlace(id);
  if (group == groups_.end() || group->id != id) {
    NoteGroupEntry fresh;
    fresh.id = id;
    fresh.name = groupName;
    group = groups_.insert(group, fresh);
  } else if (group->inherited) {
    Own(*group);
  }
  group->pitches.push_back(pitch);
}

void NoteNameTable::Dissolve(Groups::iterator group) {
  for (NoteEntry& note : notes_) {
    if (note.group == group->id) {
      note.group = 0;
      note.inherited = false;
    }
  }
  groups_.erase(group);
}

void NoteNameTable::DissolveGroupsBelowTwo() {
  for (auto i = groups_.size(); i > 0; --i) {
    auto const group = groups_.begin() + static_cast<std::ptrdiff_t>(i - 1);
    if (group->pitches.size() < 2) {
      Dissolve(group);
    }
  }
}

bool NoteNameTable::Unhide(unsigned char pitch) {
  auto const place = std::lower_bound(hiddenPitches_.begin(), hiddenPitches_.end(), pitch);
  bool const isHidden = place != hiddenPitches_.end() && *place == pitch;
  if (isHidden) {
    hiddenPitches_.erase(place);
  }
  return isHidden;
}

void NoteNameTable::Hide(unsigned char pitch) {
  auto const place = std::lower_bound(hiddenPitches_.begin(), hiddenPitches_.end(), pitch);
  if (place == hiddenPitches_.end() || *place != pitch) {
    hiddenPitches_.insert(place, pitch);
  }
}

}  // namespace Ostinet::Impl
