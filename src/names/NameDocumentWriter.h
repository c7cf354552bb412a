// SPDX-License-Identifier: MIT
#pragma once

#include <vector>

#include "model/DestinationImpl.h"
#include "names/PatchBankImpl.h"

namespace Ostinet::Impl {

/// What a written document says of itself: who signed in, and which destination alone it is for.
struct WrittenFor {
  WrittenFor() = default;
  /// `destination` lends its unique ID, and the name of its device, or its own without one.
  WrittenFor(DestinationImpl const& destination, UString author);

  UString author;
  UString deviceName;
  int uniqueID = 0;
};

/// A bank in a written document.
struct WrittenBank {
  UString listName;  ///< of its list of patches; unique in the document
  UString bankName;

  friend bool operator==(WrittenBank const& a, WrittenBank const& b) {
    return a.listName == b.listName && a.bankName == b.bankName;
  }
};

// The two kinds of documents that the library writes, both marked as its own. Each replaces the
// file as a whole; failures of the disk pass out as VantorError, and then the old file stands.

/// A master document that points at a standard mode, so that the destination can carry overrides.
void WriteStandardModeMaster(File const& file, WrittenFor const& owner, UString const& modeName);

/// An overriding document with the patches of `banks`, and every list of notes, controls and
/// values that they share. What the default lists of the name sets say is left out: reading adds
/// it again. Returns the banks sorted by list name.
std::vector<WrittenBank> WriteBanks(File const& file, WrittenFor const& owner,
                                    std::vector<PatchBankImpl const*> const& banks);

}  // namespace Ostinet::Impl
