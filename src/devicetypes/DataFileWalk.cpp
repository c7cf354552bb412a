// SPDX-License-Identifier: MIT
#include "ostinet/DeviceTypeCatalog.h"

namespace Ostinet::Impl {

namespace {

bool HasEnding(UString const& name, UString const& ending) {
  return name.size() >= ending.size() &&
         name.substr(name.size() - ending.size()).equal(ending, UString::kIgnoreCase);
}

void Walk(Folder const& folder, UString const& ending, XMLFilesVisitor& visitor,
          bool inUserFolder) {
  for (FolderIterator entry(folder); !entry.AtEnd(); ++entry) {
    if (entry.IsFolder()) {
      Walk(Folder(*entry), ending, visitor, inUserFolder);
    } else if (HasEnding(entry->GetFullPath(), ending)) {
      visitor.Visit(File(*entry), inUserFolder);
    }
  }
}

}  // namespace

XMLFilesVisitor::~XMLFilesVisitor() = default;

// The user's folder comes first, for where two files speak of one thing, the first one wins.
void VisitXMLFiles(XMLFilesVisitor& visitor, char const* extension) {
  UString const ending = "." + UString(extension);
  for (Folder::FindType const type : {Folder::kUserDeviceFiles, Folder::kSystemDeviceFiles}) {
    Folder const folder = Folder::Find(type, Folder::kDoNotCreate);
    if (folder.IsValid()) {
      Walk(folder, ending, visitor, type == Folder::kUserDeviceFiles);
    }
  }
}

}  // namespace Ostinet::Impl
