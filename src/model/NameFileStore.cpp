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

#include "ostinet/Setup.h"
#include "ostinet/core/Error.h"

namespace Ostinet::Impl {

namespace {

constexpr int kBlockID = 0;
constexpr std::uint32_t kBlockVersion = 1;
constexpr int kEndOfFile = -39;

using Bytes = std::vector<unsigned char>;

class BlockReader {
 public:
  explicit BlockReader(Bytes const& bytes) : bytes_(bytes) {}

  std::uint32_t ReadNumber() {
    Demand(4);
    std::uint32_t number = 0;
    for (unsigned shift = 0; shift < 32; shift += 8) {
      number |= static_cast<std::uint32_t>(bytes_[position_++]) << shift;
    }
    return number;
  }

  UString ReadText() {
    std::size_t const length = ReadNumber();
    Demand(length * 2);
    std::u16string units;
    units.reserve(length);
    for (std::size_t i = 0; i < length; ++i, position_ += 2) {
      units.push_back(static_cast<char16_t>(bytes_[position_] | bytes_[position_ + 1] << 8));
    }
    return UString(units);
  }

 private:
  void Demand(std::size_t count) const {
    if (bytes_.size() - position_ < count) {
      FailOSErr(kEndOfFile);
    }
  }

  Bytes const& bytes_;
  std::size_t position_ = 0;
};

void WriteNumber(Bytes& bytes, std::uint32_t number) {
  for (unsigned shift = 0; shift < 32; shift += 8) {
    bytes.push_back(static_cast<unsigned char>(number >> shift));
  }
}

void WriteText(Bytes& bytes, UString const& text) {
  WriteNumber(bytes, static_cast<std::uint32_t>(text.length()));
  for (char16_t const unit : text) {
    bytes.push_back(static_cast<unsigned char>(unit));
    bytes.push_back(static_cast<unsigned char>(unit >> 8));
  }
}

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
    BlockReader reader(bytes);
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
  Bytes bytes;
  WriteNumber(bytes, kBlockVersion);
  WriteNumber(bytes, static_cast<std::uint32_t>(inUse_.size()));
  for (auto const& [file, use] : inUse_) {
    WriteText(bytes, file.GetFullPath());
  }
  prefs_->Save(kBlockID, bytes);
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
