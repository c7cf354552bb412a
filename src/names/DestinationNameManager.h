// SPDX-License-Identifier: MIT
#pragma once

#include "names/DestinationTree.h"
#include "names/NameConfiguration.h"
#include "names/NamesSearches.h"

namespace Ostinet::Impl {

/// Chooses the names of one destination, loads them, and stores the choice in the destination's
/// properties.
///
/// A renewal only works out which documents are to be used; they are read when somebody first asks
/// for a name, so that a studio whose names nobody looks at costs no reading.
///
/// Of the documents that the library wrote, the configuration in use owns one use for each
/// reference to them; one that is being worked out owns none.
///
/// Ownership    The destination's.
/// Threads      The host's polling thread.
/// Errors       What cannot be read means fewer names. What cannot be written throws a
///              VantorError; names and configuration are then as before.
class DestinationNameManager final : public DestinationTree {
 public:
  explicit DestinationNameManager(DestinationImpl& destination);

  /// Null for a null handle, and for a destination without names.
  static DestinationNameManager* Of(Destination const& destination);

  bool Renew() override;
  void SaveEditedBanks() override;
  void WillRemove() override;

  Names GetNames() const;
  void SetNames(Names const& names);
  Names GetOverrideNames(PatchBankImpl const& bank) const;
  void SetOverrideNames(PatchBankImpl& bank, Names const& names);

  NameConfiguration const& GetConfiguration() const { return configuration_; }

 protected:
  void LoadTree(NameTree& tree) override;

 private:
  bool IsInStudio() const;
  /// True if the destination is of another maker or model than at the last look.
  bool RememberDevice();
  /// Asks the catalog for the device's master document; false without one.
  bool FindMasterFor(NameConfiguration& configuration) const;
  NameFileStore* Store();
  // Each claims the files that come before it lets go of those that leave.
  void Use(NameConfiguration const& next);
  void UseOverride(UString const& bankName, FileSpecification const& file,
                   UString const& patchList);
  void DropOverride(UString const& bankName);
  void UseNewMaster(UString const& modeName);
  void UseMasterOfStandardMode();
  void WriteEditedBanks();
  void TellNamesChanged();

  NameConfiguration configuration_;  // in use
  bool ownsUses_ = false;            // its files are counted
};

}  // namespace Ostinet::Impl
