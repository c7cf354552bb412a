// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include "ReadDocument.h"
#include "ostinet/NameDocument.h"
#include "support/TemporaryFolder.h"

namespace Ostinet::Testing {
namespace {

constexpr char kContent[] =
    "<CustomDeviceMode Name='M'><ChannelNameSetAssignments><ChannelNameSetAssign Channel='1' "
    "NameSet='S'/></ChannelNameSetAssignments></CustomDeviceMode>"
    "<SupportsStandardDeviceMode Name='GM'/><ChannelNameSet Name='S'><NoteNameList Name='N'>"
    "<Note Number='1' Name='x'/></NoteNameList><ControlNameList><Control Number='1' Name='c'/>"
    "</ControlNameList><PatchBank Name='B'><PatchNameList Name='L'><Patch Number='1' Name='p'/>"
    "</PatchNameList></PatchBank></ChannelNameSet>";

// A document of the content above for the devices that `owners` names.
std::string TextFor(std::string const& owners) {
  return "<MIDINameDocument><Author/><MasterDeviceNames>" + owners + kContent +
         "</MasterDeviceNames></MIDINameDocument>";
}

TEST(NameDocument, IsReadForItsFirstMakerAndModel) {
  TemporaryFolder const folder;
  NameDocument const document(folder.Write(
      "a.midnam", TextFor("<Manufacturer>Any</Manufacturer><Model>One</Model><Model>Two</Model>")));
  EXPECT_TRUE(document.IsWhole());
  ASSERT_EQ(document.CountModes(), 1);
  EXPECT_EQ(document.GetMode(0).GetName(), UString("M"));
  EXPECT_EQ(document.GetMode(0).GetNameSet(0), document.GetNameSet(0));
  EXPECT_EQ(document.CountSupportedStandardModes(), 1);
  EXPECT_EQ(document.GetSupportedStandardMode(0), UString("GM"));
  PatchBank const bank = document.GetNameSet(0).GetBank(0);
  EXPECT_EQ(NameDocument::GetListName(bank), UString("L"));
  EXPECT_EQ(NameDocument::GetDefaultNotes(document.GetNameSet(0)).GetName(), UString("N"));
  EXPECT_EQ(NameDocument::GetDefaultControls(document.GetNameSet(0)).CountControls(), 1);
  EXPECT_EQ(bank.GetPatch(0).GetNoteNames().GetNoteNameForPitch(1), UString("x"))
      << "a patch without a list has the default one";
}

TEST(NameDocument, IsReadForADeviceByItsNumber) {
  TemporaryFolder const folder;
  NameDocument const document(folder.Write("a.midnam", TextFor("<Device UniqueID='-4'/>")));
  EXPECT_EQ(document.CountModes(), 1);
}

// A number that cannot be read matches no device, so what stands behind it counts.
TEST(NameDocument, LooksBehindADeviceWithoutANumber) {
  TemporaryFolder const folder;
  NameDocument const document(folder.Write(
      "a.midnam", TextFor("<Device Name='x'/><Manufacturer>Any</Manufacturer><Model>One</Model>")));
  EXPECT_EQ(document.CountModes(), 1);
}

TEST(NameDocument, TellsAnEmptyListOfControlsFromNone) {
  TemporaryFolder const folder;
  NameDocument const document(folder.Write(
      "a.midnam",
      MasterText("<ChannelNameSet Name='S'><ControlNameList/><PatchBank><PatchNameList>"
                 "<Patch Number='1' Name='p'/></PatchNameList></PatchBank></ChannelNameSet>"
                 "<ChannelNameSet Name='T'><PatchBank><PatchNameList>"
                 "<Patch Number='1' Name='with'><ControlNameList/></Patch>"
                 "<Patch Number='2' Name='without'/></PatchNameList></PatchBank>"
                 "</ChannelNameSet>")));
  DestinationNameSet const with = document.GetNameSet(0);
  DestinationNameSet const without = document.GetNameSet(1);
  EXPECT_TRUE(NameDocument::HasControls(NameDocument::GetDefaultControls(with)));
  EXPECT_TRUE(NameDocument::HasControls(with.GetBank(0).GetPatch(0).GetControlNames()));
  EXPECT_FALSE(NameDocument::HasControls(NameDocument::GetDefaultControls(without)));
  EXPECT_TRUE(NameDocument::HasControls(without.GetBank(0).GetPatch(0).GetControlNames()));
  EXPECT_FALSE(NameDocument::HasControls(without.GetBank(0).GetPatch(1).GetControlNames()));
  EXPECT_FALSE(NameDocument::HasControls(ControlList()));
}

TEST(NameDocument, HasNothingWithoutAMaster) {
  TemporaryFolder const folder;
  for (char const* text :
       {"", "<Other/>", "<MIDINameDocument/>", "<MIDINameDocument><MasterDeviceNames/>",
        "<MIDINameDocument><StandardDeviceMode Name='GM'><ChannelNameSet Name='S'/>"
        "</StandardDeviceMode></MIDINameDocument>"}) {
    NameDocument const document(folder.Write("a.midnam", text));
    EXPECT_EQ(document.CountModes(), 0) << text;
    EXPECT_EQ(document.CountNameSets(), 0) << text;
    EXPECT_EQ(document.CountSupportedStandardModes(), 0) << text;
  }
}

TEST(NameDocument, TellsABrokenDocument) {
  TemporaryFolder const folder;
  std::string const text = MasterText(kContent);
  NameDocument const broken(
      folder.Write("a.midnam", text.substr(0, text.find("</MasterDeviceNames>"))));
  EXPECT_FALSE(broken.IsWhole());
  EXPECT_EQ(broken.CountModes(), 1);
  EXPECT_FALSE(NameDocument(folder.GetFolder().GetFile("missing")).IsWhole());
  EXPECT_FALSE(NameDocument(FileSpecification()).IsWhole());
}

TEST(NameDocument, AnswersOutOfRange) {
  NameDocument const document((FileSpecification()));
  EXPECT_EQ(document.GetMode(0), DestinationMode::kNoDestinationMode);
  EXPECT_EQ(document.GetMode(-1), DestinationMode::kNoDestinationMode);
  EXPECT_EQ(document.GetNameSet(0), DestinationNameSet::kNoDestinationNameSet);
  EXPECT_EQ(document.GetSupportedStandardMode(-1), UString());
  EXPECT_EQ(NameDocument::GetListName(PatchBank()), UString());
  EXPECT_FALSE(NameDocument::GetDefaultNotes(DestinationNameSet()).HasNames());
  EXPECT_EQ(NameDocument::GetDefaultControls(DestinationNameSet()).CountControls(), 0);
}

TEST(NameDocument, LeavesItsHandlesBehind) {
  TemporaryFolder const folder;
  Patch patch;
  PatchBank bank;
  DestinationMode mode;
  {
    NameDocument const document(folder.Write("a.midnam", MasterText(kContent)));
    bank = document.GetNameSet(0).GetBank(0);
    patch = bank.GetPatch(0);
    mode = document.GetMode(0);
  }
  EXPECT_EQ(patch.GetName(), UString("p"));
  EXPECT_EQ(bank.CountPatches(), 1);
  EXPECT_EQ(mode.GetName(), UString("M"));
}

}  // namespace
}  // namespace Ostinet::Testing
