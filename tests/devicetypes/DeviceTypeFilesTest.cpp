// SPDX-License-Identifier: MIT
#include "devicetypes/TypeFolders.h"

namespace Ostinet::Testing {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;

/// Which of several files of one model wins; each names itself in the picture.
class DeviceTypeFiles : public TypeFolders {
 protected:
  void Define(std::string const& file, std::string const& author,
              std::string const& model = "Synth", std::string const& maker = "Acme") const {
    Write(file, TypesFile(TypeElement(maker, model, "", "Image='" + file + "'"), author));
  }
  std::vector<std::string> Winners() const {
    Impl::DeviceTypeCatalogImpl const catalog;
    std::vector<std::string> images;
    for (auto const& type : catalog.GetTypes()) {
      images.push_back(type->image.string());
    }
    return images;
  }
};

TEST_F(DeviceTypeFiles, NoFoldersAreNoTypes) { EXPECT_THAT(CatalogNames(), IsEmpty()); }

TEST_F(DeviceTypeFiles, AreFoundInAllFoldersAndInAnyCase) {
  Define("user/A.middev", "", "A");
  Define("user/deep/er/B.MIDDEV", "", "B");
  Define("system/x/.middev", "", "C");
  Define("system/D.middev.xml", "", "D");
  Define("system/Emiddev", "", "E");
  EXPECT_THAT(CatalogNames(), ElementsAre("Acme A", "Acme B", "Acme C"));
}

TEST_F(DeviceTypeFiles, AreSortedByMakerAndModelWithoutCaseAndWhiteSpace) {
  Define("user/1.middev", "", "b", "acme");
  Define("user/2.middev", "", "C", "ACME");
  Define("user/3.middev", "", "A 2", "Ac me");
  Define("user/4.middev", "", "a1", "Acme");
  Define("user/5.middev", "", "Z", "Aardvark");
  EXPECT_THAT(CatalogNames(),
              ElementsAre("Aardvark Z", "Acme a1", "Ac me A 2", "acme b", "ACME C"));
}

TEST_F(DeviceTypeFiles, TheFirstOfOneModelWins) {
  Define("user/1.middev", "");
  Define("user/2.middev", "Somebody");
  EXPECT_THAT(Winners(), ElementsAre("user/1.middev"));
}

TEST_F(DeviceTypeFiles, TheUsersWinAgainstTheMachines) {
  Define("system/0.middev", "");
  Define("user/9.middev", "");
  EXPECT_THAT(Winners(), ElementsAre("user/9.middev"));
}

TEST_F(DeviceTypeFiles, AFolderIsWalkedWhereItIsMet) {
  Define("user/b/z.middev", "");
  Define("user/c.middev", "");
  EXPECT_THAT(Winners(), ElementsAre("user/b/z.middev"));
  Define("user/a.middev", "");
  EXPECT_THAT(Winners(), ElementsAre("user/a.middev"));
}

TEST_F(DeviceTypeFiles, TheMakersOwnFileWinsAgainstAllOthers) {
  Define("user/1.middev", "");
  Define("user/2.middev", "Somebody");
  Define("user/3.middev", "Acme");
  EXPECT_THAT(Winners(), ElementsAre("user/3.middev"));
}

TEST_F(DeviceTypeFiles, TheFirstOfTheMakersOwnFilesStays) {
  Define("user/1.middev", "");
  Define("user/3.middev", " a c m e");
  Define("user/4.middev", "Acme");
  Define("system/0.middev", "ACME");
  EXPECT_THAT(Winners(), ElementsAre("user/3.middev"));
}

TEST_F(DeviceTypeFiles, TheMakersFileOfTheMachineWinsAgainstTheUsers) {
  Define("user/1.middev", "");
  Define("system/1.middev", "Acme");
  EXPECT_THAT(Winners(), ElementsAre("system/1.middev"));
}

TEST_F(DeviceTypeFiles, CaseAndWhiteSpaceTellNoModelsApart) {
  Define("user/1.middev", "", "Synth 1");
  Define("user/2.middev", "", "SYNTH1", "a cme");
  EXPECT_THAT(CatalogNames(), ElementsAre("Acme Synth 1"));
}

TEST_F(DeviceTypeFiles, TheFirstOfOneModelInOneFileStays) {
  std::string const twice = TypeElement("Acme", "Synth", "", "Image='first'") +
                            TypeElement("acme", "synth", "", "Image='second'");
  Write("user/1.middev", TypesFile(twice, "Acme"));
  EXPECT_THAT(Winners(), ElementsAre("first"));
  Write("user/1.middev", TypesFile(twice));
  EXPECT_THAT(Winners(), ElementsAre("first"));
}

TEST_F(DeviceTypeFiles, ALoserIsDroppedWhole) {
  Write("user/1.middev", TypesFile(TypeElement("Acme", "Synth", "<Receives MTC='true'/>")));
  Write("user/2.middev", TypesFile(TypeElement("Acme", "Synth", "<Receives Notes='true'/>")));
  Impl::DeviceTypeCatalogImpl const catalog;
  ASSERT_EQ(catalog.GetTypes().size(), 1U);
  EXPECT_EQ(catalog.GetTypes()[0]->receives.flags[2], Impl::TriBool::kUnset);
}

TEST_F(DeviceTypeFiles, OneBadFileCostsNobodyElse) {
  Write("user/1.middev", "no XML");
  Write("user/2.middev", "");
  Write("user/3.middev", "<MIDIDeviceTypes>" + TypeElement("Acme", "Before") + "<Broken");
  Define("user/4.middev", "", "After");
  EXPECT_THAT(CatalogNames(), ElementsAre("Acme After", "Acme Before"));
}

TEST_F(DeviceTypeFiles, AFaultDoesNotTakeTheAuthorBack) {
  Define("user/1.middev", "");
  Write("user/2.middev", "<MIDIDeviceTypes><Author>Acme</Author>" +
                             TypeElement("Acme", "Synth", "", "Image='maker'") + "<Broken");
  EXPECT_THAT(Winners(), ElementsAre("maker"));
}

/// Notes what it is shown.
class RecordingVisitor : public Impl::XMLFilesVisitor {
 public:
  void Visit(File const& file, bool inUserFolder) override {
    seen.push_back((inUserFolder ? "user " : "system ") + file.GetName().string());
  }
  std::vector<std::string> seen;
};

class DataFileWalk : public TypeFolders {};

TEST_F(DataFileWalk, ShowsTheUsersFilesFirst) {
  for (char const* name : {"system/a.midnam", "system/b/c.MidNam", "user/z.midnam",
                           "user/other.middev", "user/y/.midnam", "user/midnam"}) {
    Write(name, "");
  }
  RecordingVisitor visitor;
  Impl::VisitXMLFiles(visitor, "midnam");
  EXPECT_THAT(visitor.seen,
              ElementsAre("user .midnam", "user z.midnam", "system a.midnam", "system c.MidNam"));
}

}  // namespace
}  // namespace Ostinet::Testing
