// SPDX-License-Identifier: MIT
#include <cstdint>

#include "model/NameFileStore.h"
#include "support/StudioTest.h"

namespace Ostinet::Testing {
namespace {

using Impl::NameFileStore;
using ::testing::ElementsAre;

using Bytes = std::vector<unsigned char>;

void AddNumber(Bytes& bytes, std::uint32_t number) {
  for (int i = 0; i < 4; ++i, number >>= 8) {
    bytes.push_back(static_cast<unsigned char>(number));
  }
}

Bytes Block(std::uint32_t version, std::vector<UString> const& paths) {
  Bytes bytes;
  AddNumber(bytes, version);
  AddNumber(bytes, static_cast<std::uint32_t>(paths.size()));
  for (UString const& path : paths) {
    AddNumber(bytes, static_cast<std::uint32_t>(path.length()));
    for (char16_t const unit : path) {
      bytes.push_back(static_cast<unsigned char>(unit));
      bytes.push_back(static_cast<unsigned char>(unit >> 8));
    }
  }
  return bytes;
}

class NameFileStoreTest : public ::testing::Test {
 protected:
  static bool IsThere(UString const& path) { return FileSpecification(path).IsFile(); }

  MemoryPrefs prefs;
  UString const one = prefs.MakeFile("one.midnam");
  UString const two = prefs.MakeFile("two.midnam");
};

TEST_F(NameFileStoreTest, WhatNobodyClaimsIsDeletedAtSignOut) {
  prefs.blocks[0] = Block(1, {one, two});
  NameFileStore store(&prefs);
  store.Load();
  store.Retain(FileSpecification(one));
  store.DeleteWaiting();
  EXPECT_TRUE(IsThere(one));
  EXPECT_FALSE(IsThere(two));
  store.Save();
  EXPECT_EQ(prefs.blocks[0], Block(1, {one}));
}

TEST_F(NameFileStoreTest, TheBlockIsLittleEndian) {
  NameFileStore store(&prefs);
  store.Load();
  store.AddUses(FileSpecification(UString(u"/\u4e2d")), 1);
  store.Save();
  auto const separator = static_cast<unsigned char>(SystemPath("/")[0]);
  EXPECT_THAT(prefs.blocks[0],
              ElementsAre(1, 0, 0, 0, 1, 0, 0, 0, 2, 0, 0, 0, separator, 0, 0x2d, 0x4e));
}

TEST_F(NameFileStoreTest, ABlockOfAnotherVersionIsIgnored) {
  prefs.blocks[0] = Block(2, {one});
  NameFileStore store(&prefs);
  store.Load();
  store.DeleteWaiting();
  EXPECT_TRUE(IsThere(one));
}

TEST_F(NameFileStoreTest, FilesThatAreGoneDoNotWait) {
  UString const gone = prefs.FolderPath() + "/gone.midnam";
  prefs.blocks[0] = Block(1, {gone, one});
  NameFileStore store(&prefs);
  store.Load();
  store.Retain(FileSpecification(gone));
  store.Save();
  EXPECT_EQ(prefs.blocks[0], Block(1, {}));
}

// Sign-in goes on with what was read before the fault.
TEST_F(NameFileStoreTest, EveryPrefixOfABlockKeepsTheWholePathsInIt) {
  Bytes const whole = Block(1, {one, two});
  std::size_t const firstEnd = 8 + 4 + 2 * one.length();
  for (std::size_t size = 0; size <= whole.size(); ++size) {
    prefs.MakeFile("one.midnam");
    prefs.MakeFile("two.midnam");
    prefs.blocks[0] = Bytes(whole.begin(), whole.begin() + static_cast<std::ptrdiff_t>(size));
    NameFileStore store(&prefs);
    ASSERT_NO_THROW(store.Load());
    store.DeleteWaiting();
    EXPECT_EQ(IsThere(one), size < firstEnd) << size;
    EXPECT_EQ(IsThere(two), size < whole.size()) << size;
  }
}

TEST_F(NameFileStoreTest, ALengthBeyondTheBlockEndsTheReading) {
  prefs.blocks[0] = Block(1, {one, two});
  for (std::size_t i = 8; i < 12; ++i) {
    prefs.blocks[0][i] = 0xFF;
  }
  NameFileStore store(&prefs);
  store.Load();
  store.DeleteWaiting();
  EXPECT_TRUE(IsThere(one));
  EXPECT_TRUE(IsThere(two));
}

TEST_F(NameFileStoreTest, TheLastReleaseDeletesAtOnceOrAtSignOut) {
  NameFileStore store(&prefs);
  store.Load();
  store.AddUses(FileSpecification(one), 2);
  store.AddUses(FileSpecification(two), 2);
  store.Release(FileSpecification(one), true);
  EXPECT_TRUE(IsThere(one));
  store.Release(FileSpecification(one), true);
  EXPECT_FALSE(IsThere(one));
  store.Release(FileSpecification(two), false);
  store.Release(FileSpecification(two), true);
  EXPECT_TRUE(IsThere(two));
  store.DeleteWaiting();
  EXPECT_FALSE(IsThere(two));
}

TEST_F(NameFileStoreTest, AWaitingFileCanBeSaved) {
  NameFileStore store(&prefs);
  store.Load();
  store.AddUses(FileSpecification(one), 1);
  store.Release(FileSpecification(one), false);
  store.Retain(FileSpecification(one));
  store.DeleteWaiting();
  EXPECT_TRUE(IsThere(one));
  store.Release(FileSpecification(one), true);
  EXPECT_FALSE(IsThere(one));
}

TEST_F(NameFileStoreTest, UnknownFilesAreLeftAlone) {
  NameFileStore store(&prefs);
  store.Load();
  store.Retain(FileSpecification(one));
  store.Release(FileSpecification(one), true);
  store.DeleteWaiting();
  EXPECT_TRUE(IsThere(one));
}

class NewFileTest : public StudioTest {
 protected:
  UString PathOf(char const* name) const {
    return prefs.FolderPath() + "/MIDINameDocuments/" + name;
  }
  File Create(NameFileStore const& store, char const* destination) {
    File file;
    store.CreateFile(file, *Impl::ImplOf(setup.MakePort(destination)));
    return file;
  }
};

TEST_F(NewFileTest, IsNamedAfterTheDestinationAndANumberIfThatIsTaken) {
  NameFileStore const store(&prefs);
  EXPECT_EQ(Create(store, "Synth"), FileSpecification(PathOf("Synth.midnam")));
  EXPECT_EQ(Create(store, "Synth"), FileSpecification(PathOf("Synth 2.midnam")));
  EXPECT_TRUE(FileSpecification(PathOf("Synth.midnam")).IsFile());
}

TEST_F(NewFileTest, NeverLeavesItsFolder) {
  NameFileStore const store(&prefs);
  EXPECT_EQ(Create(store, "../In/Out"), FileSpecification(PathOf(".._In_Out.midnam")));
}

TEST_F(NewFileTest, CountsOnlyOnceItIsUsed) {
  NameFileStore store(&prefs);
  store.Load();
  File const file = Create(store, "Synth");
  store.Release(file, true);
  EXPECT_TRUE(file.IsFile());
  store.AddUses(file, 1);
  store.Release(file, true);
  EXPECT_FALSE(file.IsFile());
}

TEST_F(NewFileTest, NeedsAFolderOfTheHost) {
  EXPECT_THROW(Create(NameFileStore(nullptr), "Synth"), VantorError);
  class NoFolder : public PrefsHandler {
    void Save(int, std::vector<unsigned char> const&) override {}
    void Load(int, std::vector<unsigned char>&) override {}
    void GetFolder(Folder&) override {}
  } noFolder;
  EXPECT_THROW(Create(NameFileStore(&noFolder), "Synth"), VantorError);
}

class SessionFilesTest : public StudioTest {};

TEST_F(SessionFilesTest, AFileThatNothingUsedIsDeletedAtSignOut) {
  UString const used = prefs.MakeFile("used.midnam");
  UString const unused = prefs.MakeFile("unused.midnam");
  prefs.blocks[0] = Block(1, {used, unused});
  setup.SignIn("host", nullptr, &prefs);
  setup.GetNameFileStore()->AddUses(FileSpecification(used), 1);
  EXPECT_TRUE(FileSpecification(unused).IsFile());
  setup.SignOut(false);
  EXPECT_TRUE(FileSpecification(used).IsFile());
  EXPECT_FALSE(FileSpecification(unused).IsFile());
  EXPECT_EQ(prefs.blocks[0], Block(1, {used}));
}

}  // namespace
}  // namespace Ostinet::Testing
