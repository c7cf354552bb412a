// SPDX-License-Identifier: MIT
#include "names/NameDocumentDigest.h"

#include <algorithm>

#include "names/DocumentNames.h"
#include "ostinet/core/XML.h"

namespace Ostinet::Impl {

namespace {

using XMLLib::Name;
using XMLLib::Parser;
using namespace DocumentNames;

// `patchLists` is null where such lists do not count.
void ReadDeviceNames(Parser& parser, NameDocumentDigest::Master& entry,
                     std::vector<UString>* patchLists) {
  while (parser.DownToChild()) {
    Name const& element = parser.CurrentElement();
    if (element == kManufacturer) {
      if (entry.manufacturer.empty()) {
        entry.manufacturer = parser.ReadText();
      }
    } else if (element == kModel) {
      entry.models.push_back(parser.ReadText());
    } else if (element == kPatchNameList && patchLists != nullptr) {
      UString name;
      if (parser.ReadReqAttribute(kName, name)) {
        patchLists->push_back(name);
      }
    }
    parser.UpToParent();
  }
}

void ReadDocumentChild(Parser& parser, NameDocumentDigest& digest) {
  Name const& element = parser.CurrentElement();
  if (element == kAuthor) {
    digest.author = parser.ReadText();
  } else if (element == kMasterDeviceNames) {
    ReadDeviceNames(parser, digest.masters.emplace_back(), nullptr);
  } else if (element == kExtendingDeviceNames) {
    NameDocumentDigest::Extender& extender = digest.extenders.emplace_back();
    ReadDeviceNames(parser, extender, &extender.patchLists);
  } else if (element == kStandardDeviceMode) {
    UString name;
    if (parser.ReadReqAttribute(kName, name)) {
      digest.standardModes.push_back(name);
    }
  }
}

}  // namespace

// Exact, where the reader of a document is lenient: the catalog offers what was written for this
// very device, the reader takes what the user chose for it.
bool NameDocumentDigest::Master::Matches(UString const& wantedManufacturer,
                                         UString const& wantedModel) const {
  return manufacturer == wantedManufacturer &&
         std::find(models.begin(), models.end(), wantedModel) != models.end();
}

void ParseDigest(NameDocumentDigest& digest) {
  NameDocumentDigest parsed;
  parsed.file = digest.file;
  parsed.inUserFolder = digest.inUserFolder;
  parsed.modDate = digest.modDate;
  parsed.isParsed = true;
  if (parsed.file.IsFile()) {
    Parser parser{File(parsed.file)};
    if (parser.DownToReqChildNounexp(kDocument)) {
      while (parser.DownToChild()) {
        ReadDocumentChild(parser, parsed);
        parser.UpToParent();
      }
    }
  }
  digest = std::move(parsed);
}

}  // namespace Ostinet::Impl
