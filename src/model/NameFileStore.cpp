// SPDX-License-Identifier: MIT
//
// The block, all numbers little-endian:
//
//   offset  size  what
//        0     4  version, 1
//        4     4  count of paths
//        8     4  length of the first path in code units
//       12   2*n  its code units; then the next path
#include "model/NameFileStore.h"

#include <cstdint>

#include "model/ObjectImpl.h"
#include "model/PrefsBlock.h"
#include "ostinet/Setup.h"
#include "ostinet/core/Error.h"

namespace Ostinet::Impl {

namespace {

constexpr int kBlockID = 0;
constexpr std::uint32_t kBlockVersion = 1;
constexpr char const* kFolderName = "MIDINameDocuments";
constexpr std::uint32_t kTextFileType = 0x54455854;     // "TEXT"
constexpr std::uint32_t kTextFileCreator = 0x74747874;  // "ttxt"
constexpr int kNoSuchFolder = -43;

using Bytes = std::vector<unsigned char>;

void DeleteFile(FileSpecification const& file) {
  try {
    if (file.IsFile()) {
      File(file).Delete();
    }
  } catch (VantorError const&) {
  }
}

}  // namespace

NameFileStore::NameFileStore(PrefsHandler* prefs) : prefs_(prefs) {}

void NameFileStore::Load() {
  isLoaded_ = true;
  if (prefs_ == nullptr) {
    return;
  }
  Bytes bytes;
  prefs_->Load(kBlockID, bytes);
  try {
    PrefsBlockReader reader(bytes);
    if (reader.ReadNumber() != kBlockVersion) {
      return;
    }
    for (std::uint32_t left = reader.ReadNumber(); left > 0; --left) {
      FileSpecification const file(reader.ReadText());
      if (file.IsFile()) {
        waiting_.insert(file);
      }
    }
  } catch (VantorError const&) {
  }
}

void NameFileStore::Save() const {
  if (prefs_ == nullptr || !isLoaded_) {
    return;
  }
  PrefsBlockWriter writer;
  writer.WriteNumber(kBlockVersion);
  writer.WriteNumber(static_cast<std::uint32_t>(inUse_.size()));
  for (auto const& [file, use] : inUse_) {
    writer.WriteText(file.GetFullPath());
  }
  prefs_->Save(kBlockID, writer.GetBytes());
}

void NameFileStore::CreateFile(File& out, ObjectImpl const& object) const {
  Folder settings;
  if (prefs_ != nullptr) {
    prefs_->GetFolder(settings);
  }
  if (!settings.IsValid()) {
    FailOSErr(kNoSuchFolder);
  }
  out = settings.DemandSubFolder(kFolderName)
            .CreateFileInFolder(object.GetName() + ".midnam", kTextFileType, kTextFileCreator,
                                Folder::kAdjustName);
}

void NameFileStore::DeleteWaiting() {
  for (FileSpecification const& file : waiting_) {
    DeleteFile(file);
  }
  waiting_.clear();
}

void NameFileStore::AddUses(FileSpecification const& file, int count) {
  inUse_[file].count += count;
  waiting_.erase(file);
}

void NameFileStore::Retain(FileSpecification const& file) {
  auto const place = inUse_.find(file);
  if (place != inUse_.end()) {
    ++place->second.count;
  } else if (waiting_.erase(file) != 0) {
    inUse_[file].count = 1;
  }
}

void NameFileStore::Release(FileSpecification const& file, bool deleteNow) {
  auto const place = inUse_.find(file);
  if (place == inUse_.end()) {
    return;
  }
  Use& use = place->second;
  --use.count;
  use.mayDeleteNow = use.mayDeleteNow && deleteNow;
  if (use.count >= 1) {
    return;
  }
  if (use.mayDeleteNow) {
    DeleteFile(file);
  } else {
    waiting_.insert(file);
  }
  inUse_.erase(place);
}

}  // namespace Ostinet::Impl
