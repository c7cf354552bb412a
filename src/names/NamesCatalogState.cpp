// SPDX-License-Identifier: MIT
//
// The digests as the host keeps them from one session to the next. All numbers are little-endian
// and 32 bits wide; a text is its count of code units and those; a length covers itself too.
//
//   version, 6
//   section of the user's folder     length, then its records
//   section of the machine's folder  likewise
//
//   record: length
//           path, the part behind the folder's     text
//           author                                 text
//           masters     count, then for each: manufacturer; count, models
//           extenders   count, then for each: manufacturer; count, models; count, patch lists
//           modes       count, texts
//           date        of the file
#include <cstdint>

#include "model/PrefsBlock.h"
#include "names/NamesCatalogImpl.h"
#include "ostinet/Setup.h"
#include "ostinet/core/Error.h"

namespace Ostinet::Impl {

namespace {

constexpr int kBlockID = 1;
constexpr std::uint32_t kBlockVersion = 6;

using Texts = std::vector<UString>;

Folder FolderOf(bool inUserFolder) {
  return Folder::Find(inUserFolder ? Folder::kUserDeviceFiles : Folder::kSystemDeviceFiles,
                      Folder::kDoNotCreate);
}

std::uint32_t SizeOf(std::size_t size) { return static_cast<std::uint32_t>(size); }

void Write(PrefsBlockWriter& writer, Texts const& texts) {
  writer.WriteNumber(SizeOf(texts.size()));
  for (UString const& text : texts) {
    writer.WriteText(text);
  }
}

void Read(PrefsBlockReader& reader, Texts& texts) {
  for (std::uint32_t left = reader.ReadNumber(); left > 0; --left) {
    texts.push_back(reader.ReadText());
  }
}

void Write(PrefsBlockWriter& writer, NameDocumentDigest::Master const& entry) {
  writer.WriteText(entry.manufacturer);
  Write(writer, entry.models);
}

void Read(PrefsBlockReader& reader, NameDocumentDigest::Master& entry) {
  entry.manufacturer = reader.ReadText();
  Read(reader, entry.models);
}

void WriteRecord(PrefsBlockWriter& writer, NameDocumentDigest const& digest, UString const& path) {
  std::size_t const record = writer.BeginPart();
  writer.WriteText(path);
  writer.WriteText(digest.author);
  writer.WriteNumber(SizeOf(digest.masters.size()));
  for (NameDocumentDigest::Master const& master : digest.masters) {
    Write(writer, master);
  }
  writer.WriteNumber(SizeOf(digest.extenders.size()));
  for (NameDocumentDigest::Extender const& extender : digest.extenders) {
    Write(writer, extender);
    Write(writer, extender.patchLists);
  }
  Write(writer, digest.standardModes);
  writer.WriteNumber(digest.modDate.AsInt32());
  writer.EndPart(record);
}

// Behind the path, which the caller has read.
void ReadRecord(PrefsBlockReader& reader, NameDocumentDigest& digest) {
  digest.author = reader.ReadText();
  for (std::uint32_t left = reader.ReadNumber(); left > 0; --left) {
    Read(reader, digest.masters.emplace_back());
  }
  for (std::uint32_t left = reader.ReadNumber(); left > 0; --left) {
    NameDocumentDigest::Extender& extender = digest.extenders.emplace_back();
    Read(reader, extender);
    Read(reader, extender.patchLists);
  }
  Read(reader, digest.standardModes);
  digest.modDate = FileModDate(reader.ReadNumber());
  digest.isParsed = true;
}

}  // namespace

void NamesCatalogImpl::LoadState(PrefsHandler& prefs) {
  documents_.clear();
  lastScan_.reset();
  std::vector<unsigned char> bytes;
  prefs.Load(kBlockID, bytes);
  if (bytes.empty()) {
    return;
  }
  try {
    PrefsBlockReader reader(bytes);
    if (reader.ReadNumber() != kBlockVersion) {
      return;
    }
    LoadSection(reader.ReadPart(), true);
    LoadSection(reader.ReadPart(), false);
  } catch (VantorError const&) {
    documents_.clear();
  }
}

void NamesCatalogImpl::LoadSection(PrefsBlockReader section, bool inUserFolder) {
  Folder const folder = FolderOf(inUserFolder);
  if (!folder.IsValid()) {
    return;
  }
  while (!section.AtEnd()) {
    PrefsBlockReader record = section.ReadPart();
    NameDocumentDigest digest;
    digest.file = FileSpecification(folder.GetFullPath() + record.ReadText());
    digest.inUserFolder = inUserFolder;
    if (digest.file.IsFile()) {
      ReadRecord(record, digest);
      documents_.push_back(std::move(digest));
    }
  }
}

void NamesCatalogImpl::SaveState(PrefsHandler& prefs) const {
  PrefsBlockWriter writer;
  writer.WriteNumber(kBlockVersion);
  SaveSection(writer, true);
  SaveSection(writer, false);
  prefs.Save(kBlockID, writer.GetBytes());
}

void NamesCatalogImpl::SaveSection(PrefsBlockWriter& writer, bool inUserFolder) const {
  std::size_t const section = writer.BeginPart();
  UString const folder = FolderOf(inUserFolder).GetFullPath();
  for (NameDocumentDigest const& digest : documents_) {
    UString const path = digest.file.GetFullPath();
    std::size_t const place = folder.empty() ? UString::npos : path.find(folder);
    if (digest.isParsed && digest.inUserFolder == inUserFolder && place != UString::npos &&
        digest.file.IsFile()) {
      WriteRecord(writer, digest, path.substr(place + folder.length()));
    }
  }
  writer.EndPart(section);
}

}  // namespace Ostinet::Impl
