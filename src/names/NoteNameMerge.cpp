// SPDX-License-Identifier: MIT
//
// From the lists of a document to the table of a patch. Both lists are sorted by pitch, so one walk
// merges them. Groups get new IDs, 1 and up in the order of the first note that uses each; a group
// that is left with one note says nothing and goes.
#include <algorithm>
#include <map>

#include "names/NoteNameTable.h"

namespace Ostinet::Impl {

void NoteNameData::SetNote(unsigned char pitch, UString const& noteName, int group) {
  auto place =
      std::lower_bound(notes.begin(), notes.end(), pitch,
                       [](Note const& note, unsigned char wanted) { return note.pitch < wanted; });
  if (place == notes.end() || place->pitch != pitch) {
    place = notes.insert(place, Note());
    place->pitch = pitch;
  }
  place->name = noteName;
  place->group = group;
}

class NoteNameMerger {
 public:
  NoteNameMerger(NoteNameData const* defaults, NoteNameData const* own)
      : defaults_(defaults), own_(own) {}

  RCPtrMT<NoteNameTable> Merge() {
    table_ = new NoteNameTable;
    if (defaults_.data != nullptr && own_.data != nullptr) {
      table_->name_ = own_.data->name;
      table_->isShared_ = true;
      MergeBoth();
    } else if (own_.data != nullptr) {
      table_->name_ = own_.data->name;
      table_->isShared_ = own_.data->isNamed;
      AddAll(own_, false);
    } else if (defaults_.data != nullptr) {
      table_->name_ = defaults_.data->name;
      table_->isShared_ = true;
      AddAll(defaults_, true);
    }
    table_->DissolveGroupsBelowTwo();
    return table_;
  }

 private:
  using Note = NoteNameData::Note;

  struct Source {
    explicit Source(NoteNameData const* source) : data(source) {}
    NoteNameData const* data;
    std::map<int, int> groupIDs;  // from the document's numbers to those of the table
  };

  void AddAll(Source& source, bool isDefault) {
    for (Note const& note : source.data->notes) {
      AddIfNamed(source, note, isDefault, isDefault);
    }
  }

  void MergeBoth() {
    auto ofDefault = defaults_.data->notes.begin();
    auto ofOwn = own_.data->notes.begin();
    auto const defaultEnd = defaults_.data->notes.end();
    auto const ownEnd = own_.data->notes.end();
    while (ofDefault != defaultEnd || ofOwn != ownEnd) {
      if (ofOwn == ownEnd || (ofDefault != defaultEnd && ofDefault->pitch < ofOwn->pitch)) {
        AddIfNamed(defaults_, *ofDefault++, true, true);
      } else if (ofDefault == defaultEnd || ofOwn->pitch < ofDefault->pitch) {
        AddIfNamed(own_, *ofOwn++, false, false);
      } else {
        if (ofOwn->name.empty()) {
          table_->hiddenPitches_.push_back(ofOwn->pitch);
        }
        AddIfNamed(own_, *ofOwn++, true, false);
        ++ofDefault;
      }
    }
  }

  void AddIfNamed(Source& source, Note const& note, bool hasDefault, bool inherited) {
    if (note.name.empty()) {
      return;
    }
    NoteEntry entry;
    entry.pitch = note.pitch;
    entry.name = note.name;
    entry.group = note.group != 0 ? PutInGroup(source, note, inherited) : 0;
    entry.hasDefault = hasDefault;
    entry.inherited = inherited;
    table_->notes_.push_back(entry);
  }

  int PutInGroup(Source& source, Note const& note, bool inherited) {
    int& id = source.groupIDs[note.group];
    if (id == 0) {
      NoteGroupEntry group;
      group.id = id = static_cast<int>(table_->groups_.size()) + 1;
      group.name = source.data->groupNames[static_cast<std::size_t>(note.group - 1)];
      group.inherited = inherited;
      table_->groups_.push_back(group);
    }
    table_->groups_[static_cast<std::size_t>(id - 1)].pitches.push_back(note.pitch);
    return id;
  }

  Source defaults_;
  Source own_;
  RCPtrMT<NoteNameTable> table_;
};

RCPtrMT<NoteNameTable> NoteNameTable::Merge(NoteNameData const* defaults, NoteNameData const* own) {
  return NoteNameMerger(defaults, own).Merge();
}

}  // namespace Ostinet::Impl
