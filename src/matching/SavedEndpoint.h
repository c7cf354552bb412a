// SPDX-License-Identifier: MIT
#pragma once

#include <optional>

#include "matching/EncodedText.h"
#include "ostinet/MatchData.h"

namespace Ostinet::Impl {

/// What a reference tells of an endpoint, as far as it can be read; the rest is at its default.
///
/// Ownership    The texts are views into the reference. Reading one allocates nothing.
struct SavedEndpoint {
  /// `backend` is the one in use: of section 1 another backend's reference is not read.
  SavedEndpoint(MatchData const& data, Properties::Implementation backend);

  bool isValid = false;
  Properties::Implementation implementation = Properties::kNoImplementation;
  MatchObjectID objectType = MatchObjectID(0);
  EncodedText name;

  int uniqueID = 0;
  int connectionUniqueID = 0;
  /// Whether the name is the one to show; else it is the endpoint's own "name".
  bool nameIsFull = true;

  EncodedText manufacturer;
  EncodedText model;
  std::optional<bool> isDirect;
  std::optional<bool> isSoftware;
  std::optional<bool> supportsGeneralMIDI;
  std::optional<bool> isInternalSoftware;
  std::optional<SlotID> slot;
};

}  // namespace Ostinet::Impl
