// SPDX-License-Identifier: MIT
#include "names/NameFolders.h"

namespace Ostinet::Testing {
namespace {

using Impl::NamesCatalogImpl;
using ::testing::IsEmpty;
using ::testing::SizeIs;

using Block = std::vector<unsigned char>;

constexpr int kBlock = 1;

void AddNumber(Block& bytes, std::size_t number) {
  for (int i = 0; i < 4; ++i, number >>= 8) {
    bytes.push_back(static_cast<unsigned char>(number));
  }
}

void AddText(Block& bytes, std::string const& text) {
  AddNumber(bytes, text.size());
  for (char const c : text) {
    bytes.push_back(static_cast<unsigned char>(c));
    bytes.push_back(0);
  }
}

/// What a length covers, behind the length.
Block Part(Block const& content) {
  Block part;
  AddNumber(part, content.size() + 4);
  part.insert(part.end(), content.begin(), content.end());
  return part;
}

Block operator+(Block a, Block const& b) {
  a.insert(a.end(), b.begin(), b.end());
  return a;
}

Block Version(unsigned version) {
  Block bytes;
  AddNumber(bytes, version);
  return bytes;
}

class NamesCatalogStateTest : public ::testing::Test {
 protected:
  void SearchAll() {
    std::vector<Names> out;
    NamesCatalog::Instance().FindStandardModes(out);
  }
  int CountParsedInSearch() {
    int const before = catalog.CountParsed();
    SearchAll();
    return catalog.CountParsed() - before;
  }
  void WriteSomeDocuments() {
    folders.Write("user/A.midnam",
                  NameDocument(Master("Acme", "One") + StandardMode("Mode"), "Acme"));
    folders.Write("user/deep/B.midnam",
                  NameDocument(Extender("Acme", "One", "<PatchNameList Name='x'/>")));
    folders.Write("system/C.midnam", NameDocument(Master("Bcme", "Two"), "Somebody"));
  }

  NameFolders folders;
  MemoryPrefs prefs;
  NamesCatalogImpl& catalog = NamesCatalogImpl::Instance();
};

TEST_F(NamesCatalogStateTest, TheBlockIsWrittenByteForByte) {
  File const file = folders.Write(
      "user/A.midnam",
      NameDocument(
          Master("M", "N") + Extender("E", "F", "<PatchNameList Name='L'/>") + StandardMode("S"),
          "W"));
  std::filesystem::create_directories(folders.PathOf("system"));
  SearchAll();
  catalog.SaveState(prefs);

  Block record;
  AddText(record, file.GetFullPath().string().substr(folders.PathOf("user").string().size()));
  AddText(record, "W");
  AddNumber(record, 1);  // masters
  AddText(record, "M");
  AddNumber(record, 1);
  AddText(record, "N");
  AddNumber(record, 1);  // extenders
  AddText(record, "E");
  AddNumber(record, 1);
  AddText(record, "F");
  AddNumber(record, 1);
  AddText(record, "L");
  AddNumber(record, 1);  // standard modes
  AddText(record, "S");
  AddNumber(record, file.GetModDate().AsInt32());
  EXPECT_EQ(prefs.blocks[kBlock], Version(6) + Part(Part(record)) + Part({}));
}

TEST_F(NamesCatalogStateTest, AnUntouchedDocumentIsNotParsedInTheNextSession) {
  WriteSomeDocuments();
  EXPECT_EQ(CountParsedInSearch(), 3);
  auto const before = catalog.GetDocuments();
  catalog.SaveState(prefs);
  catalog.LoadState(prefs);
  EXPECT_EQ(CountParsedInSearch(), 0);
  EXPECT_EQ(catalog.GetDocuments(), before);
  folders.Touch("user/deep/B.midnam");
  catalog.SaveState(prefs);
  catalog.LoadState(prefs);
  EXPECT_EQ(CountParsedInSearch(), 1);
}

TEST_F(NamesCatalogStateTest, ADocumentOfTheBlockWithoutItsFileIsDroppedAtLoad) {
  WriteSomeDocuments();
  SearchAll();
  catalog.SaveState(prefs);
  folders.Remove("user/A.midnam");
  catalog.LoadState(prefs);
  EXPECT_THAT(catalog.GetDocuments(), SizeIs(2));
}

TEST_F(NamesCatalogStateTest, WhatWasNotParsedOrIsGoneIsNotSaved) {
  WriteSomeDocuments();
  NamesCatalog::Instance().FindStandardMode("Mode");  // ends at the first document
  catalog.SaveState(prefs);
  catalog.LoadState(prefs);
  EXPECT_THAT(catalog.GetDocuments(), SizeIs(1));
  SearchAll();
  folders.Remove("user/A.midnam");
  catalog.SaveState(prefs);
  folders.Write("user/A.midnam", "");
  catalog.LoadState(prefs);
  EXPECT_THAT(catalog.GetDocuments(), SizeIs(2));
}

TEST_F(NamesCatalogStateTest, ABlockOfAnotherVersionIsIgnored) {
  WriteSomeDocuments();
  SearchAll();
  catalog.SaveState(prefs);
  prefs.blocks[kBlock][0] = 5;
  catalog.LoadState(prefs);
  EXPECT_THAT(catalog.GetDocuments(), IsEmpty());
  EXPECT_EQ(CountParsedInSearch(), 3);
}

TEST_F(NamesCatalogStateTest, AnEmptyBlockEmptiesTheCatalog) {
  WriteSomeDocuments();
  SearchAll();
  catalog.LoadState(prefs);
  EXPECT_THAT(catalog.GetDocuments(), IsEmpty());
}

TEST_F(NamesCatalogStateTest, AFolderThatIsNotThereHasAnEmptySectionAndIsSkipped) {
  WriteSomeDocuments();
  SearchAll();
  catalog.SaveState(prefs);
  std::filesystem::remove_all(folders.PathOf("user"));
  catalog.LoadState(prefs);
  ASSERT_THAT(catalog.GetDocuments(), SizeIs(1));
  EXPECT_FALSE(catalog.GetDocuments().front().inUserFolder);
  SearchAll();
  std::filesystem::remove_all(folders.PathOf("system"));
  catalog.SaveState(prefs);
  EXPECT_EQ(prefs.blocks[kBlock], Version(6) + Part({}) + Part({}));
}

// A part that is longer than what is known of it may come from a later library.
TEST_F(NamesCatalogStateTest, WhatStandsBehindARecordsFieldsIsPassedOver) {
  WriteSomeDocuments();
  Block record;
  AddText(record, "/A.midnam");
  AddText(record, "author");
  for (int i = 0; i < 4; ++i) {
    AddNumber(record, 0);
  }
  AddNumber(record, 4711);
  prefs.blocks[kBlock] = Version(6) + Part(Part(record) + Part(record)) + Part({});
  catalog.LoadState(prefs);
  ASSERT_THAT(catalog.GetDocuments(), SizeIs(2));
  EXPECT_EQ(catalog.GetDocuments().back().author, UString("author"));
}

TEST_F(NamesCatalogStateTest, EveryPrefixOfABlockGivesNothing) {
  WriteSomeDocuments();
  SearchAll();
  catalog.SaveState(prefs);
  Block const whole = prefs.blocks[kBlock];
  for (std::size_t size = 0; size < whole.size(); ++size) {
    prefs.blocks[kBlock].assign(whole.begin(), whole.begin() + static_cast<std::ptrdiff_t>(size));
    ASSERT_NO_THROW(catalog.LoadState(prefs)) << size;
    EXPECT_THAT(catalog.GetDocuments(), IsEmpty()) << size;
  }
}

TEST_F(NamesCatalogStateTest, NoChangedByteReadsOutsideTheBlock) {
  WriteSomeDocuments();
  SearchAll();
  catalog.SaveState(prefs);
  Block const whole = prefs.blocks[kBlock];
  for (std::size_t place = 0; place < whole.size(); ++place) {
    for (unsigned char const value : Block{0x00, 0x01, 0x7F, 0xFF}) {
      prefs.blocks[kBlock] = whole;
      prefs.blocks[kBlock][place] = value;
      ASSERT_NO_THROW(catalog.LoadState(prefs)) << place;
      EXPECT_LE(catalog.GetDocuments().size(), 3U) << place;
    }
  }
}

TEST_F(NamesCatalogStateTest, ALengthThatDoesNotMoveOnEndsTheLoading) {
  WriteSomeDocuments();
  prefs.blocks[kBlock] = Version(6) + Part(Block(8)) + Part({});
  catalog.LoadState(prefs);
  EXPECT_THAT(catalog.GetDocuments(), IsEmpty());
}

}  // namespace
}  // namespace Ostinet::Testing
