// SPDX-License-Identifier: MIT
#pragma once

#include <vector>

#include "ostinet/Common.h"

namespace Ostinet::Impl {

/// The notes of a list as a document has them. Uses of one named list share the object.
struct NoteNameData : RCObjectMT<NoteNameData> {
  struct Note {
    unsigned char pitch = 0;
    UString name;
    int group = 0;  ///< 0 for none, else 1 for the first of groupNames, and so on
  };

  explicit NoteNameData(UString listName = UString(), bool listIsNamed = false)
      : name(std::move(listName)), isNamed(listIsNamed) {}
  /// A pitch that is there already gets the new name and group.
  void SetNote(unsigned char pitch, UString const& noteName, int group);

  UString const name;
  bool const isNamed;       ///< reached by its name, not written at its place of use
  std::vector<Note> notes;  ///< sorted by pitch, unique
  std::vector<UString> groupNames;
};

struct NoteEntry {
  unsigned char pitch = 0;
  UString name;
  int group = 0;            ///< 0 for none
  bool hasDefault = false;  ///< the default list has this pitch
  bool inherited = false;   ///< it came from the default list unchanged
};

struct NoteGroupEntry {
  int id = 0;  ///< from 1
  UString name;
  std::vector<unsigned char> pitches;  ///< in order of joining
  bool inherited = false;
};

/// The note names of a patch, with the default list of its name set already in them. Patches with
/// equal sources share one table until one of them is edited.
class NoteNameTable : public RCObjectMT<NoteNameTable> {
 public:
  /// An empty table without a name.
  NoteNameTable() = default;
  /// The default list `defaults` beneath the list `own` of a patch; either may be null.
  static RCPtrMT<NoteNameTable> Merge(NoteNameData const* defaults, NoteNameData const* own);
  /// A table with the same entries that may be edited and that a document writes inline.
  RCPtrMT<NoteNameTable> CopyForEditing() const;

  UString const& GetName() const { return name_; }
  bool IsEditable() const { return isEditable_; }
  /// True if the table came from a named or merged list: documents refer to it by name.
  bool IsShared() const { return isShared_; }
  /// Sorted by pitch.
  std::vector<NoteEntry> const& GetNotes() const { return notes_; }
  /// Sorted by ID.
  std::vector<NoteGroupEntry> const& GetGroups() const { return groups_; }
  /// The pitches of the default list that this table hides, sorted.
  std::vector<unsigned char> const& GetHiddenPitches() const { return hiddenPitches_; }
  /// Null if there is none.
  NoteEntry const* FindNote(unsigned char pitch) const;
  NoteGroupEntry const* FindGroup(int id) const;

  void SetNoteName(unsigned char pitch, UString const& name);
  void ClearNoteName(unsigned char pitch);
  void PutNoteInGroup(unsigned char pitch, int group, UString const& groupName);
  void RemoveGroup(int id, bool removeNotes);
  /// The smallest ID from 1 up that no group has.
  int GetUnusedGroupID() const;

 private:
  friend class NoteNameMerger;
  using Notes = std::vector<NoteEntry>;
  using Groups = std::vector<NoteGroupEntry>;

  Notes::iterator NotePlace(unsigned char pitch);
  Groups::iterator GroupPlace(int id);
  /// Makes the group, and all its notes, the patch's own.
  void Own(NoteGroupEntry& group);
  /// Takes the pitch out of its group, which stays even if it is empty then.
  void Leave(unsigned char pitch, NoteGroupEntry& group);
  void LeaveGroupBelowTwo(NoteEntry& note);
  void Join(unsigned char pitch, int id, UString const& groupName);
  void Dissolve(Groups::iterator group);
  void DissolveGroupsBelowTwo();
  bool Unhide(unsigned char pitch);
  void Hide(unsigned char pitch);

  UString name_;
  bool isEditable_ = false;
  bool isShared_ = false;
  Notes notes_;
  std::vector<unsigned char> hiddenPitches_;
  Groups groups_;
};

}  // namespace Ostinet::Impl
