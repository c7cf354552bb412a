// SPDX-License-Identifier: MIT
#pragma once

#include <vector>

#include "model/ImplImpl.h"
#include "ostinet/core/Files.h"
#include "ostinet/core/SortedVector.h"

namespace Ostinet::Impl {

/// Where a destination's names come from, as it stands in the destination's properties. Dates are
/// part of it, so that a document that was touched makes another configuration.
///
/// Ownership    A value. It counts no uses of files.
struct NameConfiguration {
  enum Kind : int {
    kNoConfiguration = 0,  ///< as made: nothing is loaded
    kDefaultNames = 1,     ///< the standard mode "Default Names"
    kGeneralMIDI = 2,      ///< the standard mode "General MIDI"
    kChosenMaster = 3,     ///< a master document that was chosen from outside
    kAutomaticMaster = 4,  ///< a master document that the library set
  };
  /// The document that the patches of one bank come from in place of the master's.
  struct Override {
    FileSpecification file;
    FileModDate date;
    UString patchList;

    bool operator==(Override const&) const = default;
  };

  /// From the properties of a destination.
  static NameConfiguration Read(ImplImpl const& peer);
  /// Into them. What else the Dict holds stays.
  void Store(ImplImpl& peer) const;

  bool HasMaster() const { return kind == kChosenMaster || kind == kAutomaticMaster; }
  /// "Default Names" or "General MIDI"; empty where a master document holds the names.
  UString StandardModeName() const;
  /// A master set by the library, without overrides.
  void SetMaster(FileSpecification const& file);
  /// One of the two standard modes, without overrides.
  void SetDefault(bool supportsGeneralMIDI);
  void SetOverride(UString const& bankName, FileSpecification const& file,
                   UString const& patchList);
  /// Every file that it refers to, once for each reference.
  std::vector<FileSpecification> GetFiles() const;

  bool operator==(NameConfiguration const&) const = default;

  Kind kind = kNoConfiguration;
  FileSpecification masterFile;
  FileModDate masterDate;
  sorted_vector_map<UString, Override> overrides;  // by bank name
};

}  // namespace Ostinet::Impl
