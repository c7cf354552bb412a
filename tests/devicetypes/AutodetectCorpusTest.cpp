// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>
#include <iterator>
#include <vector>

#include "fuzz/AutodetectInput.h"

namespace Ostinet {
namespace {

// What the fuzz target starts from, and whatever it once tripped over.
TEST(AutodetectCorpus, EveryFileIsRead) {
  int files = 0;
  for (auto const& entry : std::filesystem::directory_iterator(OSTINET_AUTODETECT_CORPUS)) {
    std::ifstream stream(entry.path(), std::ios::binary);
    std::vector<char> const content((std::istreambuf_iterator<char>(stream)),
                                    std::istreambuf_iterator<char>());
    std::vector<std::uint8_t> const bytes(content.begin(), content.end());
    EXPECT_TRUE(Fuzz::TryAutodetectFile(bytes.data(), bytes.size())) << entry.path();
    ++files;
  }
  EXPECT_GE(files, 6);
}

}  // namespace
}  // namespace Ostinet
