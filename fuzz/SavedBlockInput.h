// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

#include "core/SystemServices.h"
#include "model/NameFileStore.h"
#include "names/NamesCatalogImpl.h"
#include "ostinet/Setup.h"

namespace Ostinet::Fuzz {

/// A host that kept these bytes, whatever was asked for, and takes what is saved.
class KeptBlock : public PrefsHandler {
 public:
  KeptBlock(std::uint8_t const* bytes, std::size_t count) : bytes_(bytes, bytes + count) {}
  void Save(int, std::vector<unsigned char> const& bytes) override { bytes_ = bytes; }
  void Load(int, std::vector<unsigned char>& bytes) override { bytes = bytes_; }
  void GetFolder(Folder&) override {}
  std::vector<unsigned char> const& Bytes() const { return bytes_; }

 private:
  std::vector<unsigned char> bytes_;
};

/// Loads the bytes as the catalog's block, with both data folders at the root: a path in the block
/// is then any path of the machine. True if what is saved again loads as the same.
inline bool TryCatalogBlock(std::uint8_t const* bytes, std::size_t count) {
  SystemServices::SetEnvironment("OSTINET_USER_FOLDER", UString("/"));
  SystemServices::SetEnvironment("OSTINET_SYSTEM_FOLDER", UString("/"));
  Impl::NamesCatalogImpl catalog;
  KeptBlock block(bytes, count);
  catalog.LoadState(block);
  auto const documents = catalog.GetDocuments();
  catalog.SaveState(block);
  catalog.LoadState(block);
  return catalog.GetDocuments() == documents;
}

/// Loads the bytes as the block of written documents. Nothing is deleted: what waits is forgotten.
/// True if a store that knows of no file saves none.
inline bool TryFileStoreBlock(std::uint8_t const* bytes, std::size_t count) {
  KeptBlock block(bytes, count);
  Impl::NameFileStore store(&block);
  store.Load();
  store.Save();
  return block.Bytes() == std::vector<unsigned char>{1, 0, 0, 0, 0, 0, 0, 0};
}

}  // namespace Ostinet::Fuzz
