// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <filesystem>
#include <string>
#include <vector>

#include "core/Paths.h"
#include "ostinet/core/Error.h"
#include "ostinet/core/Files.h"
#include "support/Printers.h"
#include "support/TemporaryFolder.h"

namespace Ostinet {
namespace {

using Testing::TemporaryFolder;

std::vector<std::string> NamesIn(Folder const& folder, int options = 0) {
  std::vector<std::string> names;
  for (FolderIterator entry(folder, FolderIterator::IteratorOptions(options)); !entry.AtEnd();
       ++entry) {
    names.push_back((*entry).GetName().string() + (entry.IsFolder() ? "/" : ""));
  }
  return names;
}

TEST(FileSpecification, IsInvalidWithoutAPath) {
  FileSpecification const none;
  EXPECT_FALSE(none.IsValid());
  EXPECT_FALSE(none.IsFile());
  EXPECT_FALSE(none.IsFolder());
  EXPECT_EQ(none.GetName(), UString());
  EXPECT_EQ(none.GetFullPath(), UString());
}

TEST(FileSpecification, TellsFilesFromFolders) {
  TemporaryFolder const folder;
  File const file = folder.Write("a.txt", "x");
  EXPECT_TRUE(file.IsValid());
  EXPECT_TRUE(file.IsFile());
  EXPECT_FALSE(file.IsFolder());
  EXPECT_EQ(file.GetName(), UString("a.txt"));
  EXPECT_TRUE(file.ParentFolder().IsFolder());
  EXPECT_EQ(file.ParentFolder(), folder.GetFolder());
  FileSpecification const missing = folder.GetFolder().GetFile("b.txt");
  EXPECT_TRUE(missing.IsValid());
  EXPECT_FALSE(missing.IsFile());
}

TEST(FileSpecification, DropsASeparatorAtTheEnd) {
  TemporaryFolder const folder;
  UString const path = folder.GetFolder().GetFullPath();
  EXPECT_EQ(FileSpecification(path + "/").GetFullPath(), path);
  EXPECT_EQ(FileSpecification(path + "/").GetName(), folder.GetFolder().GetName());
}

TEST(FileSpecification, IsOrderedByPath) {
  FileSpecification const a{UString("/a")};
  FileSpecification const b{UString("/b")};
  EXPECT_LT(a, b);
  EXPECT_FALSE(b < a);
  EXPECT_NE(a, b);
  EXPECT_EQ(a, FileSpecification(UString("/a")));
}

TEST(File, ReadsAndReplacesItsContent) {
  TemporaryFolder const folder;
  File const file = folder.Write("a.bin", std::string("\0\xFF\r\n", 4));
  EXPECT_EQ(file.Read(), (std::vector<unsigned char>{0, 0xFF, '\r', '\n'}));
  file.Replace("", 0);
  EXPECT_TRUE(file.Read().empty());
}

TEST(File, ThrowsWhenThereIsNothingToRead) {
  TemporaryFolder const folder;
  EXPECT_THROW(folder.GetFolder().GetFile("missing").Read(), VantorError);
  EXPECT_THROW(File(folder.GetFolder()).Read(), VantorError);
}

TEST(File, TellsItsDateInSeconds) {
  TemporaryFolder const folder;
  File const file = folder.Write("a.txt", "x");
  auto const path = Impl::ToPath(file);
  std::filesystem::last_write_time(path, std::filesystem::file_time_type::clock::now());
  FileModDate const now = file.GetModDate();
  std::filesystem::last_write_time(
      path, std::filesystem::last_write_time(path) - std::chrono::seconds(100));
  EXPECT_EQ(file.GetModDate(), FileModDate(now.AsInt32() - 100));
  EXPECT_LT(file.GetModDate(), now);
  EXPECT_NE(file.GetModDate(), FileModDate());
  EXPECT_THROW(folder.GetFolder().GetFile("missing").GetModDate(), VantorError);
}

TEST(File, IsDeletedOnceAndForAll) {
  TemporaryFolder const folder;
  File const file = folder.Write("a.txt", "x");
  file.Delete();
  EXPECT_FALSE(file.IsFile());
  EXPECT_NO_THROW(file.Delete());
}

TEST(Folder, IsDeletedWithItsContent) {
  TemporaryFolder const folder;
  folder.Write("sub/deep/a.txt", "x");
  folder.GetFolder().GetSubFolder("sub").Delete();
  EXPECT_EQ(folder.CountEntries(), 0U);
}

TEST(Folder, NamesWhatIsNotThere) {
  TemporaryFolder const folder;
  EXPECT_FALSE(folder.GetFolder().GetSubFolder("sub").IsFolder());
  EXPECT_FALSE(folder.GetFolder().GetFile("a").IsFile());
  EXPECT_EQ(folder.CountEntries(), 0U);
}

TEST(Folder, CreatesWhatIsDemanded) {
  TemporaryFolder const folder;
  Folder const sub = folder.GetFolder().DemandSubFolder("sub");
  EXPECT_TRUE(sub.IsFolder());
  EXPECT_EQ(folder.GetFolder().DemandSubFolder("sub"), sub);
  File const file = sub.GetSubFolder("deeper").DemandFileInFolder("a.txt", 0, 0);
  EXPECT_TRUE(file.IsFile());
  EXPECT_TRUE(file.Read().empty());
}

TEST(Folder, KeepsAFileThatIsDemanded) {
  TemporaryFolder const folder;
  folder.Write("a.txt", "kept");
  folder.GetFolder().DemandFileInFolder("a.txt", 0, 0);
  EXPECT_EQ(folder.Read("a.txt"), "kept");
}

TEST(Folder, ThrowsWhenWhatIsDemandedCannotBe) {
  TemporaryFolder const folder;
  folder.Write("file", "x");
  EXPECT_THROW(folder.GetFolder().DemandSubFolder("file"), VantorError);
  EXPECT_THROW(folder.GetFolder().GetSubFolder("file").DemandFileInFolder("a", 0, 0), VantorError);
}

UString Create(TemporaryFolder const& folder, UString const& name) {
  return folder.GetFolder().CreateFileInFolder(name, 0, 0, Folder::AdjustName(1)).GetName();
}

TEST(CreateFileInFolder, NumbersATakenName) {
  TemporaryFolder const folder;
  EXPECT_EQ(Create(folder, "Synth.midnam"), UString("Synth.midnam"));
  EXPECT_EQ(Create(folder, "Synth.midnam"), UString("Synth 2.midnam"));
  EXPECT_EQ(Create(folder, "Synth.midnam"), UString("Synth 3.midnam"));
  EXPECT_EQ(Create(folder, "bare"), UString("bare"));
  EXPECT_EQ(Create(folder, "bare"), UString("bare 2"));
}

TEST(CreateFileInFolder, NumbersANameThatAFolderHas) {
  TemporaryFolder const folder;
  folder.GetFolder().DemandSubFolder("a.b");
  EXPECT_EQ(Create(folder, "a.b"), UString("a 2.b"));
}

TEST(CreateFileInFolder, ReplacesWhatNoFileNameHolds) {
  TemporaryFolder const folder;
  EXPECT_EQ(Create(folder, "In/Out\\1:2\x01\n\x7F.midnam"), UString("In_Out_1_2___.midnam"));
  EXPECT_EQ(Create(folder, "../../up"), UString(".._.._up"));
  EXPECT_EQ(Create(folder, ".."), UString(".._"));
  EXPECT_EQ(Create(folder, ""), UString("_"));
  EXPECT_EQ(Create(folder, "dot."), UString("dot._"));
  EXPECT_EQ(Create(folder, "CON.midnam"), UString("_CON.midnam"));
  EXPECT_EQ(Create(folder, "com1"), UString("_com1"));
  EXPECT_EQ(Create(folder, "compact"), UString("compact"));
}

TEST(CreateFileInFolder, CutsANameThatIsTooLong) {
  TemporaryFolder const folder;
  UString name;
  name.append(1000, u'\u4E2D');
  UString const first = Create(folder, name + ".midnam");
  UString const second = Create(folder, name + ".midnam");
  EXPECT_TRUE(first.ends_with(".midnam"));
  EXPECT_TRUE(second.ends_with(" 2.midnam"));
  EXPECT_EQ(folder.CountEntries(), 2U);
}

TEST(CreateFileInFolder, ThrowsForATakenNameThatIsToBeKept) {
  TemporaryFolder const folder;
  folder.Write("a", "kept");
  EXPECT_THROW(folder.GetFolder().CreateFileInFolder("a", 0, 0, Folder::AdjustName(0)),
               VantorError);
  EXPECT_EQ(folder.Read("a"), "kept");
}

TEST(CreateFileInFolder, ThrowsInAFolderThatIsNotThere) {
  TemporaryFolder const folder;
  EXPECT_THROW(
      folder.GetFolder().GetSubFolder("no").CreateFileInFolder("a", 0, 0, Folder::AdjustName(1)),
      VantorError);
}

TEST(FolderIterator, WalksFilesAndFoldersInTheOrderOfTheirNames) {
  TemporaryFolder const folder;
  folder.Write("b.txt", "");
  folder.Write("a.txt", "");
  folder.Write("c/deep.txt", "");
  folder.Write("B.txt2", "");
  EXPECT_EQ(NamesIn(folder.GetFolder()),
            (std::vector<std::string>{"B.txt2", "a.txt", "b.txt", "c/"}));
  EXPECT_EQ(NamesIn(folder.GetFolder(), FolderIterator::kFilesOnly),
            (std::vector<std::string>{"B.txt2", "a.txt", "b.txt"}));
  EXPECT_EQ(NamesIn(folder.GetFolder(), FolderIterator::kFoldersOnly),
            (std::vector<std::string>{"c/"}));
}

TEST(FolderIterator, IsAtItsEndWhereThereIsNothing) {
  TemporaryFolder const folder;
  EXPECT_TRUE(FolderIterator(folder.GetFolder()).AtEnd());
  EXPECT_TRUE(FolderIterator(folder.GetFolder().GetSubFolder("missing")).AtEnd());
  EXPECT_TRUE(FolderIterator(Folder(folder.Write("file", ""))).AtEnd());
  EXPECT_TRUE(FolderIterator(Folder()).AtEnd());
}

// A link to a folder above would never let a walk end.
TEST(FolderIterator, FollowsLinksToFilesButNotToFolders) {
  TemporaryFolder const folder;
  folder.Write("file", "");
  std::error_code error;
  std::filesystem::create_directory_symlink(folder.Path(), folder.Path() / "loop", error);
  if (error) {
    GTEST_SKIP() << "links cannot be made here: " << error.message();
  }
  std::filesystem::create_symlink(folder.Path() / "file", folder.Path() / "link");
  std::filesystem::create_symlink(folder.Path() / "nowhere", folder.Path() / "dangling");
  EXPECT_EQ(NamesIn(folder.GetFolder()), (std::vector<std::string>{"file", "link"}));
}

TEST(FolderIterator, ReadsNamesOfEveryScript) {
  TemporaryFolder const folder;
  UString const name(u"\u00E9\u4E2D\U0001D11E.txt");
  folder.GetFolder().DemandFileInFolder(name, 0, 0);
  FolderIterator const entry(folder.GetFolder());
  ASSERT_FALSE(entry.AtEnd());
  EXPECT_EQ(entry->GetName(), name);
  EXPECT_TRUE(entry->IsFile());
}

TEST(SearchFolder, FindsTheNearestFileOfAName) {
  TemporaryFolder const folder;
  folder.Write("a/deep/image.png", "");
  folder.Write("b/image.png", "");
  FileSpecification found;
  ASSERT_TRUE(folder.GetFolder().SearchFolder("image.png", found));
  EXPECT_EQ(found, folder.GetFolder().GetSubFolder("b").GetFile("image.png"));
}

TEST(SearchFolder, TakesAnotherCaseWhereNoNameIsTheSame) {
  TemporaryFolder const folder;
  folder.Write("a/Image.PNG", "");
  FileSpecification found;
  ASSERT_TRUE(folder.GetFolder().SearchFolder("image.png", found));
  EXPECT_EQ(found.GetName(), UString("Image.PNG"));
  folder.Write("b/c/image.png", "");
  ASSERT_TRUE(folder.GetFolder().SearchFolder("image.png", found));
  EXPECT_EQ(found.GetName(), UString("image.png"));
}

TEST(SearchFolder, FindsNoFoldersAndNothingOutside) {
  TemporaryFolder const folder;
  folder.Write("sub/image.png/x", "");
  folder.Write("outside.png", "");
  FileSpecification found;
  EXPECT_FALSE(folder.GetFolder().SearchFolder("image.png", found));
  EXPECT_FALSE(folder.GetFolder().GetSubFolder("sub").SearchFolder("../outside.png", found));
  EXPECT_FALSE(found.IsValid());
}

}  // namespace
}  // namespace Ostinet
