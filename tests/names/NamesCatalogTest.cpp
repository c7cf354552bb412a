// SPDX-License-Identifier: MIT
#include "names/NameFolders.h"
#include "names/NamesSearches.h"
#include "ostinet/NameDocument.h"
#include "ostinet/core/Error.h"

namespace Ostinet::Testing {
namespace {

using Impl::NamesCatalogImpl;
using ::testing::ElementsAre;
using ::testing::IsEmpty;

class NamesCatalogTest : public ::testing::Test {
 protected:
  Names FindMaster() { return catalog.FindMaster("Acme", "One"); }
  std::vector<Names> FindMasters() {
    std::vector<Names> out;
    catalog.FindMasters("Acme", "One", out);
    return out;
  }
  std::vector<Names> FindOverrides() {
    std::vector<Names> out;
    catalog.FindOverrides("Acme", "One", out);
    return out;
  }
  std::vector<Names> FindStandardModes() {
    std::vector<Names> out;
    catalog.FindStandardModes(out);
    return out;
  }
  /// How many documents are opened while `work` runs.
  template <class Work>
  static int CountParsed(Work const& work) {
    int const before = NamesCatalogImpl::Instance().CountParsed();
    work();
    return NamesCatalogImpl::Instance().CountParsed() - before;
  }

  NameFolders folders;
  NamesCatalog& catalog = NamesCatalog::Instance();
};

TEST_F(NamesCatalogTest, FindsAMasterByManufacturerAndAnyOfItsModels) {
  File const file = folders.Write(
      "user/Acme.midnam",
      NameDocument("<MasterDeviceNames><Manufacturer>Acme</Manufacturer><Model>Zero</Model>"
                   "<Model>One</Model></MasterDeviceNames>"));
  EXPECT_EQ(FindMaster(), Names(Names::kMasterNames, file));
  EXPECT_EQ(FindMaster().GetName(), UString("Acme"));
  EXPECT_TRUE(catalog.FindMaster("Acme", "Zero").Exists());
  EXPECT_FALSE(catalog.FindMaster("Acme", "Two").Exists());
}

// The reader takes a document of another spelling where a user chose it; the catalog offers none.
TEST_F(NamesCatalogTest, ComparesCodeUnitByCodeUnit) {
  folders.Write("user/Acme.midnam", NameDocument(Master("ACME", "One") + Extender("Acme ", "One") +
                                                 StandardMode("general midi")));
  EXPECT_FALSE(FindMaster().Exists());
  EXPECT_THAT(FindMasters(), IsEmpty());
  EXPECT_THAT(FindOverrides(), IsEmpty());
  EXPECT_FALSE(catalog.FindStandardMode("General MIDI").Exists());
}

TEST_F(NamesCatalogTest, ScansAtMostOnceAMinute) {
  EXPECT_FALSE(FindMaster().Exists());
  folders.Write("user/Acme.midnam", NameDocument(Master("Acme", "One")));
  folders.PassSeconds(59.9);
  EXPECT_FALSE(FindMaster().Exists());
  folders.PassSeconds(0.1);
  EXPECT_TRUE(FindMaster().Exists());
}

// Also right after the machine was started, where the time line begins at 0.
TEST_F(NamesCatalogTest, TheFirstSearchAlwaysScans) {
  folders.Write("user/Acme.midnam", NameDocument(Master("Acme", "One")));
  EXPECT_TRUE(FindMaster().Exists());
}

TEST_F(NamesCatalogTest, ALoadedStateIsCheckedByTheNextSearch) {
  EXPECT_FALSE(FindMaster().Exists());
  folders.Write("user/Acme.midnam", NameDocument(Master("Acme", "One")));
  NameFolders::ForgetCatalog();
  EXPECT_TRUE(FindMaster().Exists());
}

TEST_F(NamesCatalogTest, ATouchedDocumentIsParsedAgainAndAnUntouchedOneIsNot) {
  folders.Write("user/A.midnam", NameDocument(Master("Acme", "Two")));
  folders.Write("user/B.midnam", NameDocument(Master("Acme", "Two")));
  EXPECT_EQ(CountParsed([&] { FindMaster(); }), 2);
  EXPECT_EQ(CountParsed([&] { FindMaster(); }), 0);
  folders.Write("user/B.midnam", NameDocument(Master("Acme", "One")));
  folders.Touch("user/B.midnam");
  folders.PassSeconds(60);
  EXPECT_EQ(CountParsed([&] { EXPECT_TRUE(FindMaster().Exists()); }), 1);
}

TEST_F(NamesCatalogTest, DocumentsThatComeAndGoLeaveTheOthersParsed) {
  for (char const* path : {"user/B.midnam", "user/D.midnam", "user/F.midnam", "system/B.midnam"}) {
    folders.Write(path, NameDocument(Master("Acme", "Two")));
  }
  FindMaster();
  folders.Write("user/A.midnam", NameDocument(Master("Acme", "Two")));
  folders.Write("user/E.midnam", NameDocument(Master("Acme", "One")));
  folders.Remove("user/D.midnam");
  folders.PassSeconds(60);
  EXPECT_EQ(CountParsed([&] { EXPECT_TRUE(FindMaster().Exists()); }), 2);
  folders.Remove("user/B.midnam");
  folders.PassSeconds(60);
  EXPECT_EQ(CountParsed([&] { FindMaster(); }), 0);
  EXPECT_EQ(NamesCatalogImpl::Instance().GetDocuments().size(), 4U);
}

TEST_F(NamesCatalogTest, ADocumentIsOpenedOnlyWhenASearchReachesIt) {
  folders.Write("user/A.midnam", NameDocument(StandardMode("General MIDI")));
  folders.Write("user/B.midnam", NameDocument(Master("Acme", "One")));
  EXPECT_EQ(CountParsed([&] { catalog.FindStandardMode("General MIDI"); }), 1);
  EXPECT_EQ(CountParsed([&] { FindMaster(); }), 1);
}

TEST_F(NamesCatalogTest, TheManufacturersOwnDocumentWinsAndEndsTheSearch) {
  folders.Write("user/A.midnam", NameDocument(Master("Acme", "One"), "Somebody"));
  File const own = folders.Write("user/B.midnam", NameDocument(Master("Acme", "One"), "Acme"));
  folders.Write("user/C.midnam", NameDocument(Master("Acme", "One"), "Acme"));
  EXPECT_EQ(CountParsed([&] { EXPECT_EQ(FindMaster().GetFile(), own); }), 2);
}

TEST_F(NamesCatalogTest, ElseTheFirstOfTheWalkWinsOfAllDocuments) {
  folders.Write("system/A.midnam", NameDocument(Master("Acme", "One"), "Somebody"));
  File const first = folders.Write("user/B.midnam", NameDocument(Master("Acme", "One"), "Other"));
  folders.Write("user/deep/C.midnam", NameDocument(Master("Acme", "One"), "Third"));
  EXPECT_EQ(CountParsed([&] { EXPECT_EQ(FindMaster().GetFile(), first); }), 3);
}

TEST_F(NamesCatalogTest, ListsEachMatchingMasterEntry) {
  File const twice =
      folders.Write("user/A.midnam", NameDocument(Master("Acme", "One") + Master("Acme", "One")));
  File const once = folders.Write("user/B.midnam", NameDocument(Master("Acme", "One"), "Acme"));
  EXPECT_THAT(FindMasters(),
              ElementsAre(Names(Names::kMasterNames, twice), Names(Names::kMasterNames, twice),
                          Names(Names::kMasterNames, once)));
}

TEST_F(NamesCatalogTest, SearchesAppendToWhatIsThere) {
  File const file = folders.Write("user/A.midnam", NameDocument(Master("Acme", "One")));
  std::vector<Names> out(1);
  catalog.FindMasters("Acme", "One", out);
  EXPECT_THAT(out, ElementsAre(Names(), Names(Names::kMasterNames, file)));
}

TEST_F(NamesCatalogTest, ListsThePatchListsOfTheFirstEntryThatExtendsAModel) {
  File const file = folders.Write(
      "user/A.midnam",
      NameDocument(Extender("Acme", "Two", "<PatchNameList Name='no'/>") +
                   Extender("Acme", "One",
                            "<PatchNameList Name='x'/><PatchNameList/><PatchNameList Name='y'/>") +
                   Extender("Acme", "One", "<PatchNameList Name='second'/>")));
  EXPECT_THAT(FindOverrides(), ElementsAre(Names(Names::kOverrideNames, file, "x"),
                                           Names(Names::kOverrideNames, file, "y")));
}

TEST_F(NamesCatalogTest, ListsAStandardModeOnceWithItsFirstDocument) {
  File const mine = folders.Write("user/A.midnam", NameDocument(StandardMode("General MIDI")));
  File const theirs = folders.Write(
      "system/A.midnam",
      NameDocument(StandardMode("General MIDI") + StandardMode("Other") + "<StandardDeviceMode/>"));
  EXPECT_THAT(FindStandardModes(),
              ElementsAre(Names(Names::kStandardModeNames, mine, "General MIDI"),
                          Names(Names::kStandardModeNames, theirs, "Other")));
  EXPECT_EQ(catalog.FindStandardMode("General MIDI"),
            Names(Names::kStandardModeNames, mine, "General MIDI"));
}

TEST_F(NamesCatalogTest, ListsAllThatItCanFind) {
  folders.Write("user/A.midnam",
                NameDocument(Master("Acme", "One</Model><Model>Two") + Master("Acme", "One") +
                             "<MasterDeviceNames><Device UniqueID='3'/></MasterDeviceNames>"));
  folders.Write("user/B.midnam",
                NameDocument(Extender("Acme", "One", "<PatchNameList Name='x'/>") +
                             Extender("Acme", "One", "<PatchNameList Name='second'/>") +
                             Extender("Other", "Three", "<PatchNameList Name='y'/>")));
  folders.Write("user/C.midnam", NameDocument(StandardMode("Mode")));
  folders.Write("user/D.midnam", NameDocument(StandardMode("Mode")));
  std::vector<std::string> all;
  std::vector<FileSpecification> unreadable;
  for (NameDocumentOffer const& offer : ListNameDocuments(unreadable)) {
    all.push_back(offer.manufacturer.string() + "/" + offer.model.string() + "/" +
                  offer.names.GetName().string() + "/" + std::to_string(offer.names.GetType()));
  }
  EXPECT_THAT(all, ElementsAre("Acme/One/A/1", "Acme/Two/A/1", "Acme/One/x/3", "Other/Three/y/3",
                               "//Mode/2"));
  EXPECT_THAT(unreadable, IsEmpty());
  folders.Remove("user/A.midnam");
  EXPECT_EQ(ListNameDocuments(unreadable).size(), 3u);
}

TEST_F(NamesCatalogTest, TakesTheFirstManufacturerThatSaysSomething) {
  folders.Write("user/A.midnam",
                NameDocument("<MasterDeviceNames><Manufacturer/><Manufacturer>Acme</Manufacturer>"
                             "<Manufacturer>Bcme</Manufacturer><Device Name='x' UniqueID='7'/>"
                             "<Model>One</Model><PatchNameList Name='x'/></MasterDeviceNames>"));
  EXPECT_TRUE(FindMaster().Exists());
  EXPECT_FALSE(catalog.FindMaster("Bcme", "One").Exists());
}

TEST_F(NamesCatalogTest, TakesTheLastAuthor) {
  folders.Write("user/A.midnam", NameDocument(Master("Acme", "One")));
  File const file = folders.Write(
      "user/B.midnam", NameDocument(Master("Acme", "One") + "<Author>Acme</Author>", "Somebody"));
  EXPECT_EQ(FindMaster().GetFile(), file);
}

TEST_F(NamesCatalogTest, ADocumentThatLosesItsFileMatchesNothing) {
  folders.Write("user/A.midnam", NameDocument(Master("Acme", "One") +
                                              Extender("Acme", "One", "<PatchNameList Name='x'/>") +
                                              StandardMode("General MIDI")));
  EXPECT_TRUE(FindMaster().Exists());
  folders.Remove("user/A.midnam");
  EXPECT_FALSE(FindMaster().Exists());
  EXPECT_THAT(FindMasters(), IsEmpty());
  EXPECT_THAT(FindOverrides(), IsEmpty());
  EXPECT_FALSE(catalog.FindStandardMode("General MIDI").Exists());
  EXPECT_THAT(FindStandardModes(), IsEmpty());
  folders.PassSeconds(60);
  EXPECT_FALSE(FindMaster().Exists());
  EXPECT_THAT(NamesCatalogImpl::Instance().GetDocuments(), IsEmpty());
}

TEST_F(NamesCatalogTest, ADocumentThatIsGoneBeforeItIsParsedIsEmpty) {
  folders.Write("user/A.midnam", NameDocument(StandardMode("General MIDI")));
  folders.Write("user/B.midnam", NameDocument(Master("Acme", "One")));
  catalog.FindStandardMode("General MIDI");
  folders.Remove("user/B.midnam");
  EXPECT_EQ(CountParsed([&] { EXPECT_FALSE(FindMaster().Exists()); }), 1);
  EXPECT_EQ(CountParsed([&] { EXPECT_FALSE(FindMaster().Exists()); }), 0);
}

TEST_F(NamesCatalogTest, OtherXMLIsPassedOver) {
  folders.Write("user/A.midnam",
                "<MIDIDeviceTypes>" + Master("Acme", "One") + "</MIDIDeviceTypes>");
  EXPECT_FALSE(FindMaster().Exists());
}

class BrokenDocumentTest : public NamesCatalogTest {
 protected:
  BrokenDocumentTest() {
    folders.Write("user/A.midnam", "<MIDINameDocument>" + Master("Acme", "One") + "<Author");
    good = folders.Write("user/B.midnam", NameDocument(Master("Acme", "One")));
  }
  File good;
};

TEST_F(BrokenDocumentTest, StopsAHostsSearchAndIsTriedAgain) {
  EXPECT_THROW(FindMaster(), VantorError);
  EXPECT_THROW(FindMasters(), VantorError);
  folders.Write("user/A.midnam", NameDocument(""));
  EXPECT_EQ(FindMaster().GetFile(), good);
}

// One bad file must not stop a poll or a start.
TEST_F(BrokenDocumentTest, IsPassedOverByTheLibrarysOwnSearches) {
  EXPECT_EQ(Impl::FindMasterNames("Acme", "One").GetFile(), good);
  EXPECT_FALSE(Impl::FindStandardModeNames("General MIDI").Exists());
}

TEST_F(BrokenDocumentTest, StopsNoListOfAllAndIsNamedThere) {
  std::vector<FileSpecification> unreadable;
  EXPECT_FALSE(ListNameDocuments(unreadable).empty());
  EXPECT_EQ(unreadable.size(), 1u);
}

TEST_F(BrokenDocumentTest, LeavesNothingOfWhatWasReadOfIt) {
  EXPECT_THROW(FindMaster(), VantorError);
  EXPECT_TRUE(NamesCatalogImpl::Instance().GetDocuments().front().masters.empty());
}

}  // namespace
}  // namespace Ostinet::Testing
