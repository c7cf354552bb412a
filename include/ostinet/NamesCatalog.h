// SPDX-License-Identifier: MIT
#pragma once

#include <string>
#include <utility>
#include <vector>

#include "ostinet/DeviceObject.h"
#include "ostinet/Endpoint.h"
#include "ostinet/TimeStamp.h"
#include "ostinet/core/Files.h"
#include "ostinet/core/SortedVector.h"

namespace Ostinet {

namespace Impl {
struct ControlParts;
}

/// What selects a patch: program, and bank by its coarse and fine half. 255 means none.
struct OSTINET_EXPORT PatchNumbers {
  unsigned char program, msb, lsb;
  PatchNumbers();
  PatchNumbers(unsigned char, unsigned char, unsigned char);
};

/// Refers to one name document, or a part of one.
///
/// Ownership    A value.
/// Null handle  Default-constructed: Exists is false.
class OSTINET_EXPORT Names {
 public:
  enum Type {
    kNoNames = 0,
    kMasterNames = 1,
    kStandardModeNames = 2,
    kOverrideNames = 3,
    kEditedOverrideNames = 4
  };
  Names();
  Names(Type, FileSpecification const&);
  Names(Type, FileSpecification const&, UString const& name);
  bool Exists() const;
  Type GetType() const;
  FileSpecification const& GetFile() const;
  UString const& GetName() const;
  bool operator==(Names const&) const;
  bool operator!=(Names const&) const;

 private:
  Type type_;
  FileSpecification file_;
  UString name_;
};

/// The name documents of this machine: those in the folders for device files of the user and of
/// the machine, whose names end in ".midnam".
///
/// The folders are walked at most once a minute, and a document is opened only if it is new or its
/// date changed since it was last looked at, also in an earlier session.
///
/// Ownership    One object, made by the first call of Instance, which lives to the end of the
///              process. It needs no sign-in.
/// Threads      Instance: [any thread]; the rest the host's polling thread.
/// Errors       A document that is malformed throws a VantorError out of the search that first
///              looks at it; the next search tries it again. Nothing found is no error.
class OSTINET_EXPORT NamesCatalog {
 public:
  static NamesCatalog& Instance();
  NamesCatalog(NamesCatalog const&) = delete;
  NamesCatalog& operator=(NamesCatalog const&) = delete;

  /// The document with the names of a model, of kMasterNames, or no names. Both texts are compared
  /// exactly. A document that the manufacturer itself wrote comes before all others.
  Names FindMaster(UString const& manufacturer, UString const& model);
  /// Appends every such document, in the order of the walk: the user's first.
  void FindMasters(UString const& manufacturer, UString const& model, std::vector<Names>& out);
  /// Appends every patch list that a document offers for the banks of a model, of kOverrideNames;
  /// GetName is the list's name.
  void FindOverrides(UString const& manufacturer, UString const& model, std::vector<Names>& out);
  /// The first document that defines the standard mode `name`, as "General MIDI", of
  /// kStandardModeNames; or no names.
  Names FindStandardMode(UString const& name);
  /// Appends each standard mode that some document defines, once.
  void FindStandardModes(std::vector<Names>& out);

 private:
  NamesCatalog();

  Impl::NamesCatalogImpl* const impl_;  // lives as long as this
};

class NoteNameList;
class ControlList;

/// A mode that a destination can be in, with names of its own.
///
/// Ownership    Counted, as Object.
/// Null handle  kNoDestinationMode.
/// Threads      The host's polling thread.
class OSTINET_EXPORT DestinationMode : public Object {
 public:
  static const MatchObjectID kObjectID = MatchObjectID(5);
  static DestinationMode const kNoDestinationMode;
  DestinationMode();
  DestinationMode(RCPtrMT<Impl::DestModeImpl> const&);
  Destination GetDestination() const;
  DestinationNameSet GetNameSet(short channel) const;
  bool IsStandardMode() const;
  bool SelectableWithMIDI() const;
  void GetEnablingCommand(DataBuffer&, TimeStamp, unsigned char deviceID) const;
  void GetDisablingCommand(DataBuffer&, TimeStamp, unsigned char deviceID) const;
};

/// The banks that one or more channels offer. Channels are 0 to 15.
///
/// Ownership    Counted, as Object.
/// Null handle  kNoDestinationNameSet.
/// Threads      The host's polling thread.
class OSTINET_EXPORT DestinationNameSet : public Object {
 public:
  static const MatchObjectID kObjectID = MatchObjectID(6);
  static DestinationNameSet const kNoDestinationNameSet;
  DestinationNameSet();
  DestinationNameSet(RCPtrMT<Impl::DestNameSetImpl> const&);
  Destination GetDestination() const;
  int CountBanks() const;
  PatchBank GetBank(int index) const;
  PatchBank GetBank(unsigned char msb, unsigned char lsb) const;
  int CountModes() const;
  std::pair<DestinationMode, unsigned short> GetMode(int index) const;
  unsigned short GetChannels() const;
};

/// A bank of patches.
///
/// Ownership    Counted, as Object.
/// Null handle  kNoPatchBank.
/// Threads      The host's polling thread.
class OSTINET_EXPORT PatchBank : public Object {
 public:
  static const MatchObjectID kObjectID = MatchObjectID(7);
  static PatchBank const kNoPatchBank;
  PatchBank();
  PatchBank(RCPtrMT<Impl::PatchBankImpl> const&);
  DestinationNameSet GetNameSet() const;
  UString GetBankName() const;
  int CountPatches() const;
  Patch GetPatch(int index) const;
  unsigned char GetController0Number() const;
  unsigned char GetController32Number() const;
  DataBuffer GetCommand(TimeStamp, short channel, unsigned char deviceID) const;
};

/// One patch of a bank. Its object tag is the bank's: stored references rely on that.
///
/// Ownership    Counted, as Object.
/// Null handle  kNoPatch.
/// Threads      The host's polling thread.
class OSTINET_EXPORT Patch : public Object {
 public:
  static const MatchObjectID kObjectID = MatchObjectID(7);
  static Patch const kNoPatch;
  Patch();
  Patch(RCPtrMT<Impl::PatchImpl> const&);
  PatchBank GetBank() const;
  UString GetNumber() const;
  UString GetNumberAndName() const;
  unsigned char GetProgramChange() const;
  PatchNumbers GetPatchNumbers() const;
  DataBuffer GetCommand(TimeStamp, short channel, unsigned char deviceID) const;
  NoteNameList GetNoteNames() const;
  ControlList GetControlNames() const;
};

/// Notes that belong together.
struct OSTINET_EXPORT NoteGroup {
  int id;
  UString name;
  std::vector<unsigned char> pitches;
  NoteGroup();
};

/// What the notes of a patch are called. Pitches are 0 to 127.
///
/// Ownership    Counted, as Object.
/// Null handle  Has no names.
/// Threads      The host's polling thread.
class OSTINET_EXPORT NoteNameListBase : public Object {
 public:
  virtual UString GetName() const;
  virtual ~NoteNameListBase();
  virtual bool HasNames() const;
  virtual int CountNoteNames() const;
  virtual std::pair<unsigned char, UString> GetNoteName(int) const;
  virtual int CountNoteGroups() const;
  virtual NoteGroup GetNoteGroup(int) const;
  virtual NoteGroup GetNoteGroupForID(int) const;
  virtual UString GetNoteNameForPitch(unsigned char) const;
  virtual int GetNoteGroupForPitch(unsigned char) const;

 protected:
  NoteNameListBase();
  explicit NoteNameListBase(RCPtrMT<Impl::ObjectImpl> const&);
};

/// The note names of one patch, which can be edited.
class OSTINET_EXPORT NoteNameList : public NoteNameListBase {
 public:
  static const MatchObjectID kObjectID = MatchObjectID(9);
  static NoteNameList const kNoNoteNameList;
  NoteNameList();
  NoteNameList(RCPtrMT<Impl::PatchImpl> const&);
  Patch GetPatch() const;
  void SetNoteName(unsigned char pitch, UString const& name) const;
  void ClearNoteName(unsigned char pitch) const;
  void PutNoteInGroup(unsigned char pitch, int groupID, UString const& groupName) const;
  void RemoveNoteGroup(int groupID, bool removeNotes) const;
  int GetUnusedGroupID() const;
};

/// The note names of a name set, for patches without their own.
class OSTINET_EXPORT DefaultNoteNameList : public NoteNameListBase {
 public:
  static const MatchObjectID kObjectID = MatchObjectID(10);
  static DefaultNoteNameList const kNoDefaultNoteNameList;
  DefaultNoteNameList();
  DefaultNoteNameList(RCPtrMT<Impl::DestNameSetImpl> const&);
  DestinationNameSet GetNameSet() const;
};

/// Which kind of message a control is.
enum ControlType : int {
  kControl7Bit = 0,   ///< a control change
  kControl14Bit = 1,  ///< a pair of control changes
  kControlRPN = 2,    ///< a registered parameter
  kControlNRPN = 3,   ///< a parameter of the maker's own
};

/// One control of a patch: its number, its name, its range.
///
/// Ownership    A value.
class OSTINET_EXPORT Control {
 public:
  typedef sorted_vector_map<unsigned short, UString, std::less<unsigned short> > ValueMap;
  Control();
  Control(ControlType, unsigned short number, UString const& name);
  Control(ControlType, unsigned short, UString const&, double min, double max);
  Control(ControlType, unsigned short, UString const&, double min, double max,
          UString const& units);
  Control(ControlType, unsigned short, UString const&, double min, double max, double dflt);
  Control(ControlType, unsigned short, UString const&, double min, double max, double dflt,
          UString const& units);
  Control(ControlType, unsigned short, UString const&, ValueMap const&);
  Control(ControlType, unsigned short, UString const&, ValueMap const&, unsigned short dflt);
  ControlType GetType() const;
  unsigned short GetNumber() const;
  UString GetName() const;
  double GetMinValue() const;
  double GetMaxValue() const;
  double GetDefaultValue() const;
  UString GetUnits() const;
  bool HasValueRange() const;
  bool HasDefaultValue() const;
  bool HasUnits() const;
  int CountValueNames() const;
  std::pair<unsigned short, UString> GetValueName(int) const;
  UString GetNameForValue(unsigned short) const;

 private:
  friend struct Impl::ControlParts;

  ControlType type_ = ControlType();
  unsigned short number_ = 0;
  bool hasValueRange_ = false;
  bool hasDefaultValue_ = false;
  double min_ = 0.0;
  double max_ = 0.0;
  double defaultValue_ = 0.0;
  UString name_;
  UString units_;
  RCPtrMT<Impl::ValueListImpl> valueNames_;
};

/// What the controls of a patch are called.
///
/// Ownership    Counted, as Object.
/// Null handle  Has no controls.
/// Threads      The host's polling thread.
class OSTINET_EXPORT ControlListBase : public Object {
 public:
  virtual UString GetName() const;
  virtual ~ControlListBase();
  virtual int CountControls() const;
  virtual Control GetControl(ControlType, unsigned short) const;
  virtual Control GetControl(int) const;
  virtual bool HasControl(ControlType, unsigned short) const;

 protected:
  ControlListBase();
  explicit ControlListBase(RCPtrMT<Impl::ObjectImpl> const&);
};

/// The controls of one patch, which can be edited.
class OSTINET_EXPORT ControlList : public ControlListBase {
 public:
  static const MatchObjectID kObjectID = MatchObjectID(11);
  static ControlList const kNoControlList;
  ControlList();
  ControlList(RCPtrMT<Impl::PatchImpl> const&);
  Patch GetPatch() const;
  void SetControl(Control const&) const;
  void ClearControl(ControlType, unsigned short) const;
};

/// The controls of a name set, for patches without their own.
class OSTINET_EXPORT DefaultControlList : public ControlListBase {
 public:
  static const MatchObjectID kObjectID = MatchObjectID(12);
  static DefaultControlList const kNoDefaultControlList;
  DefaultControlList();
  DefaultControlList(RCPtrMT<Impl::DestNameSetImpl> const&);
  DestinationNameSet GetNameSet() const;
};

}  // namespace Ostinet
