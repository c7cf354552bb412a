// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>
#include <iterator>
#include <vector>

#include "fuzz/SavedBlockInput.h"

namespace Ostinet {
namespace {

using Try = bool (*)(std::uint8_t const*, std::size_t);

// What the fuzz targets start from, and whatever they once tripped over. The count of files.
int TryAll(std::filesystem::path const& folder, Try tryBlock) {
  int files = 0;
  for (auto const& entry : std::filesystem::directory_iterator(folder)) {
    std::ifstream stream(entry.path(), std::ios::binary);
    std::vector<char> const content((std::istreambuf_iterator<char>(stream)),
                                    std::istreambuf_iterator<char>());
    std::vector<std::uint8_t> const bytes(content.begin(), content.end());
    EXPECT_TRUE(tryBlock(bytes.data(), bytes.size())) << entry.path();
    ++files;
  }
  return files;
}

TEST(SavedBlocksCorpus, EveryCatalogBlockIsReadOrRefused) {
  EXPECT_GE(TryAll(OSTINET_BLOCK_CORPORA "/catalog_block", Fuzz::TryCatalogBlock), 10);
  SystemServices::SetEnvironment("OSTINET_USER_FOLDER", UString());
  SystemServices::SetEnvironment("OSTINET_SYSTEM_FOLDER", UString());
}

TEST(SavedBlocksCorpus, EveryBlockOfWrittenDocumentsIsReadOrRefused) {
  EXPECT_GE(TryAll(OSTINET_BLOCK_CORPORA "/file_store_block", Fuzz::TryFileStoreBlock), 9);
}

}  // namespace
}  // namespace Ostinet
