// SPDX-License-Identifier: MIT
#pragma once

#include <utility>
#include <vector>

#include "names/CommandReader.h"
#include "names/NameTree.h"
#include "ostinet/core/XML.h"

namespace Ostinet::Impl {

/// For whom a document is read.
struct NameDocumentOwner {
  NameDocumentOwner() = default;
  explicit NameDocumentOwner(DestinationImpl& of);

  UString manufacturer;
  UString model;
  int uniqueID = 0;                        ///< 0 for none
  DestinationImpl* destination = nullptr;  ///< owns what is read; may be null
};

/// Reads one MIDI Name Document, version 1.0, into the names of one destination. It never
/// validates: what it does not know or cannot use it passes over without a word.
///
/// An object serves one run: one of the three reads, then Resolve; after that the caller takes the
/// public members. If a read throws, what came before the fault stands, and Resolve is called all
/// the same.
///
/// Threads      One object on one thread at a time.
/// Errors       The reads let the parser's VantorError out; Load... catch it.
class NameDocumentReader {
 public:
  /// A bank and the list of patches in this document that is to fill it.
  using BankRequest = std::pair<RCPtrMT<PatchBankImpl>, UString>;

  explicit NameDocumentReader(NameDocumentOwner owner, PassedOverLog* log = nullptr);

  /// The first "MasterDeviceNames" that fits the owner.
  void ReadMaster(XMLLib::Parser& parser);
  /// The first "ExtendingDeviceNames" that fits the owner, as far as `requests` ask for it.
  void ReadExtending(XMLLib::Parser& parser, std::vector<BankRequest> const& requests);
  /// The standard mode of this name.
  void ReadStandardMode(XMLLib::Parser& parser, UString const& modeName);
  /// Gives the banks their patches.
  void Resolve();

  // The same on a file, with Resolve behind it. A file that cannot be read, or only in part, gives
  // what could be read. False if there was a fault.
  bool LoadMaster(FileSpecification const& file);
  bool LoadExtending(FileSpecification const& file, std::vector<BankRequest> const& requests);
  bool LoadStandardMode(FileSpecification const& file, UString const& modeName);

  // Parts of a document, for one that looks at all of it. The cursor stands on the element, and
  // for the first two behind the children that decide whether it fits.
  void ReadMasterContent(DocumentCursor& cursor);
  void ReadExtendingContent(DocumentCursor& cursor);
  void ReadStandardModeContent(DocumentCursor& cursor, UString const& modeName);
  /// True if all of a patch list is read though no bank asked for it.
  void ReadAllPatchLists() { readAllPatchLists_ = true; }

  // The results.

  NameTree tree;                           ///< without a selection
  NameListUses uses;                       ///< which objects have which lists
  std::vector<UString> standardModeNames;  ///< of each "SupportsStandardDeviceMode", in order
  bool isTemporary = false;                ///< the document is one of the library's own

 private:
  template <class Data>
  using Lists = std::vector<RCPtrMT<Data>>;

  bool Matches(DocumentCursor& cursor) const;
  void ReadTemporaryMark(XMLLib::Parser& parser);

  // Lists at the level of the device.
  void ReadDeviceList(DocumentCursor& cursor);
  void ReadPatchListDefinition(DocumentCursor& cursor);
  void ReadExtendingPatchList(DocumentCursor& cursor);

  // Modes, name sets, banks, patches.
  void ReadModeChild(DocumentCursor& cursor, DestModeImpl& mode);
  void ReadModeContent(DocumentCursor& cursor, DestModeImpl& mode);
  template <class HasNameSet, class Assign>
  void ReadAssignments(DocumentCursor& cursor, HasNameSet const& has, Assign const& assign);
  void ReadNameSet(DocumentCursor& cursor);
  void ReadNameSetContent(DocumentCursor& cursor, RCPtrMT<DestNameSetImpl> const& nameSet);
  void ReadBank(DocumentCursor& cursor, DestNameSetImpl& nameSet);
  void ReadInlinePatchList(DocumentCursor& cursor, RCPtrMT<PatchBankImpl> const& bank);
  void ReadPatches(DocumentCursor& cursor, PatchNameListData& list);
  void ReadPatch(DocumentCursor& cursor, PatchNameListData& list);
  RCPtrMT<DestNameSetImpl> DemandNameSet(UString const& name);

  // Notes, controls and values; null for an element that is none of a list or has no name.
  RCPtrMT<NoteNameData> ReadNotesInPlace(DocumentCursor& cursor);
  RCPtrMT<ControlNameData> ReadControlsInPlace(DocumentCursor& cursor);
  void ReadNotes(DocumentCursor& cursor, NoteNameData& list);
  void ReadControls(DocumentCursor& cursor, ControlNameData& list);
  void ReadControl(DocumentCursor& cursor, ControlNameData& list);
  void ReadRange(DocumentCursor& cursor, Control& control);
  RCPtrMT<ValueListImpl> ReadValueListInPlace(DocumentCursor& cursor);
  void ReadValues(DocumentCursor& cursor, ValueListImpl& list);

  NameDocumentOwner const owner_;
  PassedOverLog* const log_;
  bool readAllPatchLists_ = false;
  Lists<PatchNameListData> patchLists_;
  Lists<NoteNameData> noteLists_;
  Lists<ControlNameData> controlLists_;
  Lists<ValueListImpl> valueLists_;
};

}  // namespace Ostinet::Impl
