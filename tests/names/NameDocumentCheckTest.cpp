// SPDX-License-Identifier: MIT
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "ReadDocument.h"
#include "ostinet/NameDocument.h"
#include "support/TemporaryFolder.h"

namespace Ostinet::Testing {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;

NameDocumentCheck Check(std::string const& text) {
  TemporaryFolder const folder;
  return CheckNameDocument(folder.Write("a.midnam", text));
}

/// "S3: text" for what is not standard, "P3: text" for what is passed over, "M" for a fault.
std::vector<std::string> FindingsOf(std::string const& text) {
  std::vector<std::string> lines;
  for (auto const& finding : Check(text).findings) {
    lines.push_back(std::string(1, "MSP"[finding.kind]) + std::to_string(finding.line) + ": " +
                    finding.text.string());
  }
  return lines;
}

/// A valid document with these lists behind its name set; they start in line 10.
std::string Valid(std::string const& lists, std::string const& bank = "<PatchNameList/>") {
  return "<?xml version='1.0'?>\n<MIDINameDocument><Author>A</Author>\n<MasterDeviceNames>\n"
         "<Manufacturer>Maker</Manufacturer><Model>Model</Model>\n"
         "<CustomDeviceMode Name='M'><ChannelNameSetAssignments>\n"
         "<ChannelNameSetAssign Channel='1' NameSet='S'/></ChannelNameSetAssignments>"
         "</CustomDeviceMode>\n<ChannelNameSet Name='S'><AvailableForChannels>\n"
         "<AvailableChannel Channel='1'/></AvailableForChannels>\n<PatchBank Name='B'>" +
         bank + "</PatchBank></ChannelNameSet>\n" + lists +
         "</MasterDeviceNames></MIDINameDocument>";
}

TEST(NameDocumentCheck, HasNothingToSayOfAGoodDocument) {
  NameDocumentCheck const check =
      Check(Valid("<NoteNameList Name='N'><NoteGroup><Note Number='1' Name=''/></NoteGroup>"
                  "</NoteNameList><ControlNameList Name='C'><Control Number='1' Name='c'>"
                  "<Values Min='0' Max='-1.5'/></Control></ControlNameList>"));
  EXPECT_TRUE(check.isWellFormed);
  EXPECT_TRUE(check.isStandard);
  EXPECT_THAT(check.findings, IsEmpty());
}

TEST(NameDocumentCheck, TellsTheLineOfAFault) {
  NameDocumentCheck const check = Check("<MIDINameDocument>\n<Author>A</Author>\n</Other>");
  EXPECT_FALSE(check.isWellFormed);
  EXPECT_FALSE(check.isStandard);
  ASSERT_EQ(check.findings.size(), 1U);
  EXPECT_EQ(check.findings[0].kind, NameDocumentFinding::kMalformed);
  EXPECT_EQ(check.findings[0].line, 3);
}

TEST(NameDocumentCheck, CannotReadWhatIsNotThere) {
  TemporaryFolder const folder;
  NameDocumentCheck const check = CheckNameDocument(folder.GetFolder().GetFile("missing.midnam"));
  EXPECT_FALSE(check.isWellFormed);
  ASSERT_EQ(check.findings.size(), 1U);
  EXPECT_EQ(check.findings[0].line, 0);
  EXPECT_FALSE(CheckNameDocument(FileSpecification()).isWellFormed);
  EXPECT_FALSE(CheckNameDocument(folder.GetFolder()).isWellFormed);
}

TEST(NameDocumentCheck, KnowsOtherDocuments) {
  EXPECT_THAT(FindingsOf("<Other/>"),
              ElementsAre("S1: the document is none of names: its root is Other",
                          "P1: nothing is read: the root is not MIDINameDocument"));
}

TEST(NameDocumentCheck, FindsWhatTheFormatHasNot) {
  EXPECT_THAT(FindingsOf(Valid("<NoteNameList Name='N' Note='1'>\n<Note Name='n' Number='C 3'/>\n"
                               "</NoteNameList>\n<PatchNameList Name='L'>text</PatchNameList>")),
              ElementsAre("S10: the format has no \"Note\" of NoteNameList",
                          "S11: \"Number\" of Note may not be \"C 3\"",
                          "P11: Note \"n\" has no number from 0 to 127, and the code of its first "
                          "character is taken",
                          "S13: PatchNameList may hold no text"));
}

TEST(NameDocumentCheck, FindsWhatIsMissing) {
  EXPECT_THAT(FindingsOf(Valid("<ControlNameList Name='C'/>\n<ControlNameList Name='D'>\n"
                               "<Control Name='c'/></ControlNameList>")),
              ElementsAre("S10: ControlNameList lacks Control", "S12: Control lacks \"Number\"",
                          "P12: Control \"c\" is passed over: \"Number\" is missing"));
}

TEST(NameDocumentCheck, TellsOneViolationOfTheOrder) {
  EXPECT_THAT(FindingsOf(Valid("<NoteNameList Name='N'>\n<Other><Deep/></Other>\n<Else/>\n"
                               "<Note Number='1' Name='n'/></NoteNameList>")),
              ElementsAre("S11: Other may not stand here in NoteNameList, but NoteGroup or Note",
                          "P11: Other is not read here", "P12: Else is not read here"));
}

TEST(NameDocumentCheck, FindsReferencesToNothing) {
  EXPECT_THAT(FindingsOf(Valid("", "<UsesPatchNameList Name='L'/>")),
              ElementsAre("P9: UsesPatchNameList \"L\" names a list without patches"));
  EXPECT_THAT(
      FindingsOf(Valid("<PatchNameList Name='L'>\n<Patch Number='1' Name='p'>"
                       "<ChannelNameSetAssignments><ChannelNameSetAssign Channel='1' "
                       "NameSet='X'/></ChannelNameSetAssignments>\n"
                       "<UsesNoteNameList Name='N'/>\n<UsesControlNameList Name='C'/></Patch>"
                       "</PatchNameList>",
                       "<UsesPatchNameList Name='L'/>")),
      ElementsAre("P11: ChannelNameSetAssign names a set of names that has no banks",
                  "P12: UsesNoteNameList \"N\" names a list without notes",
                  "P13: UsesControlNameList \"C\" names a list without controls"));
}

TEST(NameDocumentCheck, FindsWhatAnEarlierOneLeavesNoRoomFor) {
  EXPECT_THAT(
      FindingsOf(Valid("<PatchNameList Name='L'><Patch Number='1' Name='p'/></PatchNameList>\n"
                       "<PatchNameList Name='l'/>\n<ControlNameList Name='C'>\n"
                       "<Control Number='1' Name='a'/>\n<Control Number='1' Name='b'/>"
                       "</ControlNameList>")),
      ElementsAre("P11: PatchNameList \"l\" is not read, as a list of this name stands before it",
                  "P14: Control \"b\" is passed over: a control of its type and number stands "
                  "before it"));
}

TEST(NameDocumentCheck, FindsPartsForWhoseDevicesAnEarlierOneStands) {
  auto const part = [](char const* models) {
    return std::string("\n<ExtendingDeviceNames><Manufacturer>Acme</Manufacturer>") + models +
           "<PatchNameList Name='L'/></ExtendingDeviceNames>";
  };
  EXPECT_THAT(
      FindingsOf("<MIDINameDocument><Author/>" + part("<Model>One</Model><Model>Two</Model>") +
                 part("<Model>Two</Model><Model>Three</Model>") + part("<Model>t w o</Model>") +
                 part("<Model>Four</Model>") + "</MIDINameDocument>"),
      ElementsAre("P4: ExtendingDeviceNames is not read, as one for its devices stands before it"));
  EXPECT_THAT(FindingsOf("<MIDINameDocument><Author/>\n<MasterDeviceNames><Manufacturer/><Model/>"
                         "<SupportsStandardDeviceMode Name='M'/></MasterDeviceNames>\n"
                         "<MasterDeviceNames><Manufacturer/><Model/>"
                         "<SupportsStandardDeviceMode Name='M'/></MasterDeviceNames>"
                         "</MIDINameDocument>"),
              ElementsAre("P3: MasterDeviceNames is not read, as one for its devices stands before "
                          "it"));
}

TEST(NameDocumentCheck, FindsAStandardModeThatStandsTwice) {
  auto const mode = [](char const* name) {
    return "\n<StandardDeviceMode Name='" + std::string(name) +
           "'><ChannelNameSetAssignments><ChannelNameSetAssign Channel='1' NameSet='S'/>"
           "</ChannelNameSetAssignments><ChannelNameSet Name='S'><AvailableForChannels>"
           "<AvailableChannel Channel='1'/></AvailableForChannels><PatchBank><PatchNameList/>"
           "</PatchBank></ChannelNameSet></StandardDeviceMode>";
  };
  EXPECT_THAT(
      FindingsOf("<MIDINameDocument><Author/>" + mode("M") + mode("N") + mode(" m") +
                 "</MIDINameDocument>"),
      ElementsAre("P4: StandardDeviceMode \" m\" is not read, as a mode of this name stands "
                  "before it"));
}

// Of what may stand once, the reader takes the first.
TEST(NameDocumentCheck, FindsWhatStandsBehindTheOnlyOneThatIsRead) {
  std::vector<std::string> const findings =
      FindingsOf(Valid("<ControlNameList Name='C'><Control Number='1' Name='c'>"
                       "<Values Min='0' Max='1'><ValueNameList><Value Number='1' Name='v'/>"
                       "</ValueNameList>\n<ValueNameList/></Values>\n<Values/></Control>"
                       "</ControlNameList>",
                       "<MIDICommands><PolyMode/></MIDICommands><PatchNameList/>"));
  EXPECT_THAT(findings,
              ::testing::IsSupersetOf({"P11: ValueNameList is passed over: one stands before it",
                                       "P12: Values is passed over: one stands before it"}));
  std::vector<std::string> const ofMode = FindingsOf(
      "<MIDINameDocument><Author/><StandardDeviceMode Name='M'><DeviceModeEnable><MIDICommands>"
      "<PolyMode/></MIDICommands>\n<MIDICommands/></DeviceModeEnable></StandardDeviceMode>"
      "</MIDINameDocument>");
  EXPECT_THAT(ofMode, ::testing::Contains("P2: MIDICommands is passed over: one stands before it"));
}

TEST(NameDocumentCheck, FindsAttributesThatNobodyReads) {
  EXPECT_THAT(FindingsOf(Valid("",
                               "<MIDICommands>\n<NoteOn Channel='1' Note='1' Velocity='1'/>\n"
                               "<MonoMode Value='1'/></MIDICommands><PatchNameList/>")),
              ElementsAre("P10: \"Channel\" of NoteOn is not read",
                          "P11: \"Value\" of MonoMode is not read"));
}

TEST(NameDocumentCheck, FindsWhatFitsNoDestination) {
  EXPECT_THAT(
      FindingsOf("<MIDINameDocument><Author/>\n<ExtendingDeviceNames><PatchNameList Name='L'/>"
                 "</ExtendingDeviceNames>\n<ExtendingDeviceNames><Device Name='d' UniqueID='x'/>"
                 "<PatchNameList Name='L'/></ExtendingDeviceNames></MIDINameDocument>"),
      ElementsAre("P2: PatchNameList \"L\" is not read, as it stands before maker and model",
                  "P2: ExtendingDeviceNames fits no destination: it names neither maker and model "
                  "nor a device with a number",
                  "P3: Device \"d\" is not read, as it stands before maker and model",
                  "P3: PatchNameList \"L\" is not read, as it stands before maker and model",
                  "P3: ExtendingDeviceNames fits no destination: it names neither maker and model "
                  "nor a device with a number"));
}

TEST(NameDocumentCheck, LooksAtEveryPart) {
  EXPECT_THAT(
      FindingsOf(
          "<MIDINameDocument><Author/>\n<ExtendingDeviceNames><Device Name='a' UniqueID='1'/>"
          "<PatchNameList Name='L'><Patch Number='1'/></PatchNameList></ExtendingDeviceNames>\n"
          "<ExtendingDeviceNames><Device Name='b' UniqueID='2'/>"
          "<PatchNameList Name='L'><Patch Name='p'/></PatchNameList></ExtendingDeviceNames>"
          "</MIDINameDocument>"),
      ElementsAre("S2: Patch lacks \"Name\"", "P2: Patch is passed over: \"Name\" is missing",
                  "S3: Patch lacks \"Number\"",
                  "P3: Patch \"p\" is passed over: \"Number\" is missing"));
}

TEST(NameDocumentCheck, KnowsTokensAndWords) {
  auto const isStandard = [](std::string const& attributes) {
    return Check(Valid("<ControlNameList Name='C'><Control Name='c' " + attributes +
                       "/></ControlNameList>"))
        .isStandard;
  };
  EXPECT_TRUE(isStandard("Number=' 1 ' Type='NRPN'"));
  EXPECT_TRUE(isStandard("Number='1.5-x_:' Type='7bit'"));
  EXPECT_TRUE(isStandard("Number='&#xE9;'"));
  EXPECT_FALSE(isStandard("Number=''"));
  EXPECT_FALSE(isStandard("Number='1 2'"));
  EXPECT_FALSE(isStandard("Number='+1'"));
  EXPECT_FALSE(isStandard("Number='1' Type='7BIT'"));
  EXPECT_FALSE(isStandard("Number='1' Type=''"));
  EXPECT_FALSE(isStandard("Number='1' Type='RPN|NRPN'"));
}

TEST(NameDocumentCheck, TakesNoNestingForEndless) {
  std::string text = "<MIDINameDocument>";
  for (int i = 0; i < 1000; ++i) {
    text += "<NoteGroup>";
  }
  EXPECT_FALSE(Check(text).isWellFormed);
}

}  // namespace
}  // namespace Ostinet::Testing
