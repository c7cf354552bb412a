// SPDX-License-Identifier: MIT
#include <fstream>
#include <iterator>

#include "fuzz/SetupFileInput.h"
#include "platform/PlatformTest.h"

namespace Ostinet::Testing {
namespace {

class SetupFileCorpus : public PlatformTest {};

// What the fuzz target starts from, and whatever it once tripped over.
TEST_F(SetupFileCorpus, EveryFileIsReadAndStaysAsItWasSaved) {
  int files = 0;
  for (auto const& entry : std::filesystem::directory_iterator(OSTINET_SETUP_FILE_CORPUS)) {
    std::ifstream stream(entry.path(), std::ios::binary);
    std::vector<char> const content((std::istreambuf_iterator<char>(stream)),
                                    std::istreambuf_iterator<char>());
    std::vector<std::uint8_t> const bytes(content.begin(), content.end());
    EXPECT_TRUE(Fuzz::TrySetupFile(setup, prefs, bytes.data(), bytes.size())) << entry.path();
    ++files;
  }
  EXPECT_GE(files, 5);
}

}  // namespace
}  // namespace Ostinet::Testing
