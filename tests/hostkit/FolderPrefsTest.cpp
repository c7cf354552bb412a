// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>

#include "ostinet/hostkit/FolderPrefs.h"
#include "support/TemporaryPath.h"

namespace Ostinet {
namespace {

namespace fs = std::filesystem;
using Block = std::vector<unsigned char>;

class Prefs : public testing::Test {
 protected:
  static Folder At(fs::path const& path) {
    return Folder(FileSpecification(UString(path.u16string())));
  }

  Block Loaded(FolderPrefs& prefs, int id) {
    Block block = {1, 2, 3};
    prefs.Load(id, block);
    return block;
  }

  Testing::TemporaryPath temporary_;
  fs::path const path_ = temporary_.Path() / "settings";
};

TEST_F(Prefs, KeepBlocksBetweenTwoLives) {
  {
    FolderPrefs prefs(At(path_));
    prefs.Save(0, {1, 2, 3});
    prefs.Save(1, {0, 255});
    EXPECT_EQ(prefs.LastError(), "");
  }
  FolderPrefs prefs(At(path_));
  EXPECT_EQ(Loaded(prefs, 0), (Block{1, 2, 3}));
  EXPECT_EQ(Loaded(prefs, 1), (Block{0, 255}));
}

TEST_F(Prefs, GiveAnEmptyBlockWhereNoneWasSaved) {
  FolderPrefs prefs(At(path_));
  EXPECT_TRUE(Loaded(prefs, 0).empty());
  EXPECT_EQ(prefs.LastError(), "");
  EXPECT_FALSE(fs::exists(path_));  // Only looking makes no folder.
}

TEST_F(Prefs, ReplaceABlockWhole) {
  FolderPrefs prefs(At(path_));
  prefs.Save(0, Block(1000, 7));
  prefs.Save(0, {});
  EXPECT_TRUE(Loaded(prefs, 0).empty());
  prefs.Save(0, {5});
  EXPECT_EQ(Loaded(prefs, 0), (Block{5}));
}

TEST_F(Prefs, LeaveNothingButTheBlocksInTheFolder) {
  FolderPrefs prefs(At(path_));
  prefs.EnsureFolder();
  prefs.Save(0, {1});
  prefs.Save(0, {2});
  int files = 0;
  for (auto const& entry : fs::directory_iterator(path_)) {
    EXPECT_EQ(entry.path().filename().string(), "block-0.bin");
    ++files;
  }
  EXPECT_EQ(files, 1);
}

TEST_F(Prefs, NameTheirFolder) {
  FolderPrefs prefs(At(path_));
  Folder folder;
  prefs.GetFolder(folder);
  EXPECT_EQ(folder.GetFullPath(), At(path_).GetFullPath());
}

TEST_F(Prefs, MakeTheFolderWithThoseAboveIt) {
  FolderPrefs const prefs(At(path_ / "a" / "b"));
  prefs.EnsureFolder();
  EXPECT_TRUE(fs::is_directory(path_ / "a" / "b"));
  prefs.EnsureFolder();
}

TEST_F(Prefs, TellAFolderThatCannotBeMade) {
  std::ofstream(path_) << "a file in the way";
  FolderPrefs prefs(At(path_));
  EXPECT_THROW(prefs.EnsureFolder(), std::exception);
  EXPECT_NO_THROW(prefs.Save(0, {1}));
  EXPECT_NE(prefs.LastError(), "");
  EXPECT_TRUE(Loaded(prefs, 0).empty());
}

TEST_F(Prefs, TellTheFirstError) {
  std::ofstream(path_) << "a file in the way";
  FolderPrefs prefs(At(path_));
  prefs.Save(0, {1});
  std::string const first = prefs.LastError();
  prefs.Save(1, {1});
  EXPECT_EQ(prefs.LastError(), first);
}

}  // namespace
}  // namespace Ostinet
