// SPDX-License-Identifier: MIT
#pragma once

#include <vector>

#include "ostinet/core/Files.h"
#include "ostinet/core/UString.h"

namespace Ostinet::Impl {

/// What the catalog keeps of one name document.
struct NameDocumentDigest {
  /// One "MasterDeviceNames": any of the models means this entry.
  struct Master {
    UString manufacturer;
    std::vector<UString> models;

    bool Matches(UString const& wantedManufacturer, UString const& wantedModel) const;
    bool operator==(Master const&) const = default;
  };
  /// One "ExtendingDeviceNames".
  struct Extender : Master {
    std::vector<UString> patchLists;
    bool operator==(Extender const&) const = default;
  };

  FileSpecification file;
  bool inUserFolder = false;
  bool isParsed = false;  // what follows is valid, but for the date
  UString author;
  std::vector<Master> masters;
  std::vector<Extender> extenders;
  std::vector<UString> standardModes;
  FileModDate modDate;  // when the file was seen

  bool operator==(NameDocumentDigest const&) const = default;
};

/// Fills the digest from its file; from a file that is gone it stays empty, and is parsed too.
/// Throws a VantorError where the document breaks off; the digest is then as it was.
void ParseDigest(NameDocumentDigest& digest);

}  // namespace Ostinet::Impl
