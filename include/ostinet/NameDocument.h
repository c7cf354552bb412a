// SPDX-License-Identifier: MIT
#pragma once

#include <memory>
#include <vector>

#include "ostinet/Export.h"
#include "ostinet/NamesCatalog.h"
#include "ostinet/core/Files.h"

namespace Ostinet {

/// One MIDI Name Document by itself, as a destination would see it that is of the first maker and
/// model that the document names: for programs that show documents, no studio is needed. A file
/// that cannot be read, or only in part, gives what could be read.
///
/// Ownership    Owns what it has read. Handles that it gave stay good, but once it goes, what they
///              name belongs to nothing any more: a mode has no destination, a bank no name set.
/// Threads      One object on one thread at a time. It needs no signed-in Setup.
/// Errors       None are thrown.
class OSTINET_EXPORT NameDocument {
 public:
  explicit NameDocument(FileSpecification const& file);
  ~NameDocument();
  NameDocument(NameDocument const&) = delete;
  NameDocument& operator=(NameDocument const&) = delete;

  /// False if there is no such file, or if it is broken somewhere.
  bool IsWhole() const;

  /// The modes of the device's own, in the order of the document.
  int CountModes() const;
  /// A null handle for an index out of range.
  DestinationMode GetMode(int index) const;
  /// The standard modes that the device supports. They stand in other documents.
  int CountSupportedStandardModes() const;
  /// Empty for an index out of range.
  UString GetSupportedStandardMode(int index) const;
  /// The name sets, those too that the document only refers to.
  int CountNameSets() const;
  /// A null handle for an index out of range.
  DestinationNameSet GetNameSet(int index) const;

  /// The name of the list of patches that a bank uses, where PatchBank::GetName gives the bank's
  /// own name in its place: empty if the list has none, and for a null handle.
  static UString GetListName(PatchBank const& bank);
  /// What the notes and controls of a name set are called, for patches that do not say otherwise.
  static DefaultNoteNameList GetDefaultNotes(DestinationNameSet const& nameSet);
  static DefaultControlList GetDefaultControls(DestinationNameSet const& nameSet);
  /// True if there is a list, be it an empty one; false for a null handle.
  static bool HasControls(ControlListBase const& list);

 private:
  class Contents;
  std::unique_ptr<Contents> const contents_;
};

/// Something that a name document of this machine offers.
struct OSTINET_EXPORT NameDocumentOffer {
  /// A master document, a list of patches that can take the place of a bank's, or a standard mode.
  Names names;
  UString manufacturer;  ///< of the device that it is for; empty for a standard mode
  UString model;         ///< likewise
};

/// All that the catalog of names can find, in its order: a document once for each device that it
/// is for, a standard mode once, in the first document that has it. A document that cannot be read
/// stops nothing; its file is appended to `unreadable`.
///
/// Threads  The host's polling thread. It needs no signed-in Setup.
OSTINET_EXPORT std::vector<NameDocumentOffer> ListNameDocuments(
    std::vector<FileSpecification>& unreadable);

/// Something about a name document that its author should know.
struct OSTINET_EXPORT NameDocumentFinding {
  enum Kind : int {
    kMalformed = 0,    ///< it is no XML from here on, or it cannot be read at all
    kNotStandard = 1,  ///< the format does not have it so
    kPassedOver = 2,   ///< destinations get nothing from it
  };
  Kind kind = kMalformed;
  int line = 0;  ///< from 1; 0 where no line can be told
  UString text;  ///< one sentence, in English
};

/// What looking through a whole document has found.
struct OSTINET_EXPORT NameDocumentCheck {
  bool isWellFormed = false;                  ///< it can be read to its end
  bool isStandard = false;                    ///< it is as the format wants it, version 1.0
  std::vector<NameDocumentFinding> findings;  ///< in the order of their lines
};

/// Looks through a document: for what the format does not allow, and for all that no destination
/// gets anything from. Throws nothing; a file that cannot be read is a finding.
OSTINET_EXPORT NameDocumentCheck CheckNameDocument(FileSpecification const& file);

}  // namespace Ostinet
