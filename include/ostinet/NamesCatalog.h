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

/// What selects a patch: program, and bank by its coarse and fine half, controllers 0 and 32. Each
/// is 0 to 127, or 255 for none.
struct OSTINET_EXPORT PatchNumbers {
  unsigned char program, msb, lsb;
  /// All three none.
  PatchNumbers();
  PatchNumbers(unsigned char program, unsigned char msb, unsigned char lsb);
};

/// Refers to one name document, or a part of one: what a destination or a bank is to use.
///
/// Ownership    A value. The document is not opened.
/// Null handle  Default-constructed: Exists is false.
/// Threads      [any thread], one object on one thread at a time.
class OSTINET_EXPORT Names {
 public:
  enum Type {
    kNoNames = 0,
    kMasterNames = 1,         ///< all names of a device
    kStandardModeNames = 2,   ///< a mode that many devices have, as "General MIDI"
    kOverrideNames = 3,       ///< a list of patches in place of a bank's own
    kEditedOverrideNames = 4  ///< the same, in a document that the library wrote
  };
  /// No names.
  Names();
  /// Called after the file, without the ending of its name.
  Names(Type type, FileSpecification const& file);
  /// `name` is the mode's, or that of the list of patches inside the document.
  Names(Type type, FileSpecification const& file, UString const& name);
  /// True for every type but kNoNames, also where the file does not exist.
  bool Exists() const;
  Type GetType() const;
  FileSpecification const& GetFile() const;
  UString const& GetName() const;
  /// Type, file and name are compared.
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
/// This and the other objects of a destination's names are made when its document is read. When the
/// destination gets other names, handles of the old ones stay and go on answering; they know no
/// destination then, and what is above them may be gone.
///
/// Ownership    Counted, as Object. A mode keeps its name sets.
/// Null handle  kNoDestinationMode. False, an empty text, a null handle; buffers stay as they are.
/// Threads      The host's polling thread.
/// Errors       None are thrown.
class OSTINET_EXPORT DestinationMode : public Object {
 public:
  /// The tag of modes in persistent references.
  static const MatchObjectID kObjectID = MatchObjectID(5);
  static DestinationMode const kNoDestinationMode;

  /// A null handle.
  DestinationMode();
  DestinationMode(RCPtrMT<Impl::DestModeImpl> const& impl);

  /// Whose mode it is; a null handle once the destination has other names.
  Destination GetDestination() const;
  /// The name set on `channel`, 0 to 15; a null handle where there is none.
  DestinationNameSet GetNameSet(short channel) const;
  /// True for a mode that many devices have, as "General MIDI"; false for one of this device.
  bool IsStandardMode() const;
  /// True if the document has a script of MIDI messages that selects the mode. One that takes no
  /// more than a bank select and a program change is not counted, though it can be sent.
  bool SelectableWithMIDI() const;
  /// Appends to the buffer what selects the mode, the first message at `stamp`. `deviceID` is put
  /// into long messages as it is: 0 to 127, 126 or 255 for one that is not known. Channels in the
  /// messages are the first.
  void GetEnablingCommand(DataBuffer& buffer, TimeStamp stamp, unsigned char deviceID) const;
  /// The same with what is sent when the mode is left.
  void GetDisablingCommand(DataBuffer& buffer, TimeStamp stamp, unsigned char deviceID) const;
};

/// The banks that one or more channels offer. Channels are 0 to 15.
///
/// Ownership    Counted, as Object. A name set keeps its banks, not the modes that use it.
/// Null handle  kNoDestinationNameSet. 0, an empty text, a null handle.
/// Threads      The host's polling thread.
/// Errors       None are thrown.
class OSTINET_EXPORT DestinationNameSet : public Object {
 public:
  /// The tag of name sets in persistent references.
  static const MatchObjectID kObjectID = MatchObjectID(6);
  static DestinationNameSet const kNoDestinationNameSet;

  /// A null handle.
  DestinationNameSet();
  DestinationNameSet(RCPtrMT<Impl::DestNameSetImpl> const& impl);

  /// Whose name set it is; a null handle once the destination has other names.
  Destination GetDestination() const;
  int CountBanks() const;
  /// A null handle out of range.
  PatchBank GetBank(int index) const;
  /// The bank that was selected last, if it has these numbers, else the first that has; 255 means
  /// none. Without either number only the bank of a name set that has no other is found.
  PatchBank GetBank(unsigned char msb, unsigned char lsb) const;
  int CountModes() const;
  /// A mode that uses this name set, and on which channels: bit n for channel n. A null handle and
  /// 0 out of range.
  std::pair<DestinationMode, unsigned short> GetMode(int index) const;
  /// The channels on which the name set is available; bit n for channel n. 0 where the document
  /// does not say.
  unsigned short GetChannels() const;
};

/// A bank of patches. GetName gives the name of the list of patches in use, or else the bank's.
///
/// Ownership    Counted, as Object. A bank keeps its patches.
/// Null handle  kNoPatchBank. 0, an empty text, a null handle; the numbers 255.
/// Threads      The host's polling thread.
/// Errors       None are thrown.
class OSTINET_EXPORT PatchBank : public Object {
 public:
  /// The tag of banks in persistent references; patches have the same.
  static const MatchObjectID kObjectID = MatchObjectID(7);
  static PatchBank const kNoPatchBank;

  /// A null handle.
  PatchBank();
  PatchBank(RCPtrMT<Impl::PatchBankImpl> const& impl);

  /// A null handle once the name set is gone.
  DestinationNameSet GetNameSet() const;
  /// The bank's own name, under which an override of it is stored.
  UString GetBankName() const;
  int CountPatches() const;
  /// A null handle out of range.
  Patch GetPatch(int index) const;
  /// The coarse half of the bank select, 0 to 127; 255 if there is none, or if selecting the bank
  /// takes more than a plain bank select.
  unsigned char GetController0Number() const;
  /// The fine half likewise.
  unsigned char GetController32Number() const;
  /// What selects the bank on `channel`, 0 to 15, the first message at `stamp`. `deviceID` is put
  /// into long messages as it is.
  DataBuffer GetCommand(TimeStamp stamp, short channel, unsigned char deviceID) const;
};

/// One patch of a bank. Its object tag is the bank's: stored references rely on that.
///
/// Ownership    Counted, as Object.
/// Null handle  kNoPatch. An empty text, a null handle, lists of nothing; the numbers 255.
/// Threads      The host's polling thread.
/// Errors       None are thrown.
class OSTINET_EXPORT Patch : public Object {
 public:
  static const MatchObjectID kObjectID = MatchObjectID(7);
  static Patch const kNoPatch;

  /// A null handle.
  Patch();
  Patch(RCPtrMT<Impl::PatchImpl> const& impl);

  /// A null handle once the bank is gone.
  PatchBank GetBank() const;
  /// Text for people, as "A1" or "001", not the number that MIDI has for the patch.
  UString GetNumber() const;
  /// Number, one blank, name: as lists of patches are drawn.
  UString GetNumberAndName() const;
  /// The program, 0 to 127; 255 if the patch has none, or has a bank select of its own, so that a
  /// program change alone does not select it within its bank.
  unsigned char GetProgramChange() const;
  /// The patch's own numbers, completed by those of its bank.
  PatchNumbers GetPatchNumbers() const;
  /// What selects the patch once its bank is selected, on `channel`, 0 to 15, the first message at
  /// `stamp`. `deviceID` is put into long messages as it is. Send PatchBank::GetCommand before it,
  /// or use Destination::SendPatchChange.
  DataBuffer GetCommand(TimeStamp stamp, short channel, unsigned char deviceID) const;
  /// Views of this patch; each call on them sees the newest names.
  NoteNameList GetNoteNames() const;
  ControlList GetControlNames() const;
};

/// Notes that belong together.
struct OSTINET_EXPORT NoteGroup {
  int id;  ///< from 1; 0 for no group
  UString name;
  std::vector<unsigned char> pitches;  ///< in order of joining
  /// No group.
  NoteGroup();
};

/// What the notes of a patch are called. Pitches are 0 to 127. GetName gives the name of the list
/// in its document, which may be empty.
///
/// Ownership    A view of a patch or a name set, which it keeps, as Object.
/// Null handle  Has no names; the same holds for an object without a list.
/// Threads      The host's polling thread.
/// Errors       None are thrown.
class OSTINET_EXPORT NoteNameListBase : public Object {
 public:
  UString GetName() const override;
  ~NoteNameListBase() override;
  /// True if there is a list, with or without notes in it.
  virtual bool HasNames() const;
  virtual int CountNoteNames() const;
  /// A pitch and its name, by rising pitch; pitch 0 and an empty name out of range.
  virtual std::pair<unsigned char, UString> GetNoteName(int index) const;
  virtual int CountNoteGroups() const;
  /// A group, by rising ID; no group out of range.
  virtual NoteGroup GetNoteGroup(int index) const;
  virtual NoteGroup GetNoteGroupForID(int id) const;
  /// Empty for a pitch without a name.
  virtual UString GetNoteNameForPitch(unsigned char pitch) const;
  /// The ID of the pitch's group, or 0.
  virtual int GetNoteGroupForPitch(unsigned char pitch) const;

 protected:
  NoteNameListBase();
  explicit NoteNameListBase(RCPtrMT<Impl::ObjectImpl> const& impl);
};

/// The note names of one patch, with the default names of its name set beneath them.
///
/// They can be edited. The first edit gives the patch a list of its own and marks its bank, so that
/// the bank is saved with the next Setup::SaveEditedDestBanks. Edits after that save are seen at
/// once, but a bank that was saved is not marked again.
class OSTINET_EXPORT NoteNameList : public NoteNameListBase {
 public:
  /// The tag of lists of notes in persistent references.
  static const MatchObjectID kObjectID = MatchObjectID(9);
  static NoteNameList const kNoNoteNameList;

  /// A null handle.
  NoteNameList();
  NoteNameList(RCPtrMT<Impl::PatchImpl> const& patch);

  Patch GetPatch() const;
  /// Names the note, or makes it. A note that a group has from the default names takes its whole
  /// group over into the patch's own.
  void SetNoteName(unsigned char pitch, UString const& name) const;
  /// The note goes, and its default name is hidden. Its group stays, unless it was the last there.
  void ClearNoteName(unsigned char pitch) const;
  /// Moves the note, or a new one without a name, to the group of that ID, which is made with
  /// `groupName` if there is none; an existing group keeps its name. ID 0 means no group. A group
  /// that is left with fewer than two notes goes.
  void PutNoteInGroup(unsigned char pitch, int groupID, UString const& groupName) const;
  /// The group goes, and its notes with it or else without a group.
  void RemoveNoteGroup(int groupID, bool removeNotes) const;
  /// The smallest ID from 1 up that no group has; 0 on a null handle.
  int GetUnusedGroupID() const;
};

/// The note names of a name set, which patches have beneath their own.
class OSTINET_EXPORT DefaultNoteNameList : public NoteNameListBase {
 public:
  /// The tag of default lists of notes in persistent references.
  static const MatchObjectID kObjectID = MatchObjectID(10);
  static DefaultNoteNameList const kNoDefaultNoteNameList;

  /// A null handle.
  DefaultNoteNameList();
  DefaultNoteNameList(RCPtrMT<Impl::DestNameSetImpl> const& nameSet);

  DestinationNameSet GetNameSet() const;
};

/// Which kind of message a control is.
enum ControlType : int {
  kControl7Bit = 0,   ///< a control change
  kControl14Bit = 1,  ///< a pair of control changes
  kControlRPN = 2,    ///< a registered parameter
  kControlNRPN = 3,   ///< a parameter of the maker's own
};

/// One control of a patch: its number, its name, its range, and names of its values.
///
/// Ownership    A value; copies share the named values.
/// Threads      [any thread], one object on one thread at a time.
/// Errors       None are thrown.
class OSTINET_EXPORT Control {
 public:
  typedef sorted_vector_map<unsigned short, UString, std::less<unsigned short> > ValueMap;

  /// A 7-bit control 0 without a name.
  Control();
  /// Without a range. `number` is the controller's or the parameter's.
  Control(ControlType type, unsigned short number, UString const& name);
  /// With a range, in units of the device's own.
  Control(ControlType type, unsigned short number, UString const& name, double min, double max);
  Control(ControlType type, unsigned short number, UString const& name, double min, double max,
          UString const& units);
  Control(ControlType type, unsigned short number, UString const& name, double min, double max,
          double dflt);
  Control(ControlType type, unsigned short number, UString const& name, double min, double max,
          double dflt, UString const& units);
  /// With named values, and the range from the first to the last of them. An empty map gives
  /// neither range nor default.
  Control(ControlType type, unsigned short number, UString const& name, ValueMap const& values);
  Control(ControlType type, unsigned short number, UString const& name, ValueMap const& values,
          unsigned short dflt);

  ControlType GetType() const;
  unsigned short GetNumber() const;
  UString GetName() const;
  /// 0 without a range.
  double GetMinValue() const;
  double GetMaxValue() const;
  /// 0 without a default.
  double GetDefaultValue() const;
  UString GetUnits() const;
  bool HasValueRange() const;
  bool HasDefaultValue() const;
  bool HasUnits() const;
  int CountValueNames() const;
  /// A value and its name, by rising value; 0 and an empty name out of range.
  std::pair<unsigned short, UString> GetValueName(int index) const;
  /// Empty for a value without a name, also between two that have one.
  UString GetNameForValue(unsigned short value) const;

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

/// What the controls of a patch are called. Controls of one number and different types are
/// different controls. GetName gives the name of the list in its document, which may be empty.
///
/// Ownership    A view of a patch or a name set, which it keeps, as Object.
/// Null handle  Has no controls; the same holds for an object without a list.
/// Threads      The host's polling thread.
/// Errors       None are thrown.
class OSTINET_EXPORT ControlListBase : public Object {
 public:
  UString GetName() const override;
  ~ControlListBase() override;
  virtual int CountControls() const;
  /// A default-constructed Control where there is none.
  virtual Control GetControl(ControlType type, unsigned short number) const;
  /// By rising type, and number within it; a default-constructed Control out of range.
  virtual Control GetControl(int index) const;
  virtual bool HasControl(ControlType type, unsigned short number) const;

 protected:
  ControlListBase();
  explicit ControlListBase(RCPtrMT<Impl::ObjectImpl> const& impl);
};

/// The controls of one patch, with the default controls of its name set beneath them. They can be
/// edited, in the way of NoteNameList.
class OSTINET_EXPORT ControlList : public ControlListBase {
 public:
  /// The tag of lists of controls in persistent references.
  static const MatchObjectID kObjectID = MatchObjectID(11);
  static ControlList const kNoControlList;

  /// A null handle.
  ControlList();
  ControlList(RCPtrMT<Impl::PatchImpl> const& patch);

  Patch GetPatch() const;
  /// Replaces the control of the same type and number, or adds it.
  void SetControl(Control const& control) const;
  /// The control goes, and its default is hidden.
  void ClearControl(ControlType type, unsigned short number) const;
};

/// The controls of a name set, which patches have beneath their own.
class OSTINET_EXPORT DefaultControlList : public ControlListBase {
 public:
  /// The tag of default lists of controls in persistent references.
  static const MatchObjectID kObjectID = MatchObjectID(12);
  static DefaultControlList const kNoDefaultControlList;

  /// A null handle.
  DefaultControlList();
  DefaultControlList(RCPtrMT<Impl::DestNameSetImpl> const& nameSet);

  DestinationNameSet GetNameSet() const;
};

}  // namespace Ostinet
