// SPDX-License-Identifier: MIT
//
// Lists of notes, controls and values, and the commands of banks, patches and modes.
#include <gtest/gtest.h>

#include "ReadDocument.h"
#include "names/DocumentNumbers.h"

namespace Ostinet::Testing {
namespace {

RCPtrMT<Impl::NoteNameData> NotesOf(std::string const& content) {
  auto const reader = ReadMaster(PatchesText("<Patch Number='1' Name='p'><NoteNameList Name='N'>" +
                                             content + "</NoteNameList></Patch>"));
  return reader->uses.patchNotes.at(BankOf(reader).GetPatches().at(0));
}

/// "60=C4/1;": pitch, name and group.
std::string NotesText(std::string const& content) {
  std::string text;
  auto const list = NotesOf(content);
  for (auto const& note : list->notes) {
    text += std::to_string(note.pitch) + "=" + note.name.string() +
            (note.group != 0 ? "/" + std::to_string(note.group) : "") + ";";
  }
  return text;
}

RCPtrMT<Impl::ControlNameData> ControlsOf(std::string const& content,
                                          std::string const& lists = "") {
  auto const reader = ReadMaster(MasterText(
      "<ChannelNameSet Name='Set'><PatchBank><PatchNameList><Patch Number='1' Name='p'>"
      "<ControlNameList>" +
      content + "</ControlNameList></Patch></PatchNameList></PatchBank></ChannelNameSet>" + lists));
  return reader->uses.patchControls.at(BankOf(reader).GetPatches().at(0));
}

std::string CommandsOf(std::string const& content) {
  auto const reader =
      ReadMaster(MasterText("<ChannelNameSet Name='S'><PatchBank><MIDICommands>" + content +
                            "</MIDICommands></PatchBank></ChannelNameSet>"));
  return Messages(BankOf(reader).Commands());
}

TEST(NoteReader, ReadsNumbers) {
  EXPECT_EQ(NotesText("<Note Number='60' Name='a'/>"), "60=a;");
  EXPECT_EQ(NotesText("<Note Number=' 0 ' Name='a'/>"), "0=a;");
  EXPECT_EQ(NotesText("<Note Number='127' Name='a'/>"), "127=a;");
  EXPECT_EQ(NotesText("<Note Number='36 (C2)' Name='a'/>"), "36=a;");
}

// Users' edits are stored under the pitches that came out of this, so it stays.
TEST(NoteReader, TakesTheFirstCharacterWhereThereIsNoNumber) {
  EXPECT_EQ(NotesText("<Note Number='C3' Name='a'/>"), "67=a;");
  EXPECT_EQ(NotesText("<Note Number='200' Name='a'/>"), "50=a;");
  EXPECT_EQ(NotesText("<Note Number='128' Name='a'/>"), "49=a;");
  EXPECT_EQ(NotesText("<Note Number='-1' Name='a'/>"), "45=a;");
  EXPECT_EQ(NotesText("<Note Number='&#xE9;1' Name='a'/>"), "");
  EXPECT_EQ(NotesText("<Note Number='' Name='a'/>"), "");
  EXPECT_EQ(NotesText("<Note Name='a'/>"), "");
}

TEST(NoteReader, WantsANameThatMayBeEmpty) {
  EXPECT_EQ(NotesText("<Note Number='1'/><Note Number='2' Name=''/>"), "2=;");
}

TEST(NoteReader, SortsAndLetsALaterNoteReplaceOneOfItsPitch) {
  EXPECT_EQ(NotesText("<Note Number='9' Name='a'/><NoteGroup Name='G'><Note Number='3' Name='b'/>"
                      "<Note Number='9' Name='c'/></NoteGroup>"),
            "3=b/1;9=c/1;");
  EXPECT_EQ(
      NotesText("<NoteGroup><Note Number='9' Name='c'/></NoteGroup><Note Number='9' Name=''/>"),
      "9=;");
}

TEST(NoteReader, CountsGroupsFromOne) {
  auto const list = NotesOf(
      "<NoteGroup Name='Toms'><Note Number='1' Name='a'/></NoteGroup><NoteGroup/>"
      "<NoteGroup Name='Toms'><Note Number='2' Name='b'/></NoteGroup>");
  EXPECT_EQ(list->groupNames, (std::vector<UString>{"Toms", "", "Toms"}));
  EXPECT_EQ(list->notes.at(1).group, 3);
  EXPECT_EQ(list->name, UString("N"));
  EXPECT_FALSE(list->isNamed);
}

TEST(NoteReader, SharesNamedLists) {
  std::string const uses = "<UsesNoteNameList Name='Kit'/>";
  auto const reader = ReadMaster(MasterText(
      "<ChannelNameSet Name='S'>" + uses + "<PatchBank><PatchNameList><Patch Number='1' Name='a'>" +
      uses +
      "</Patch><Patch Number='2' Name='b'><UsesNoteNameList/></Patch></PatchNameList></PatchBank>"
      "</ChannelNameSet><NoteNameList Name='kit'><Note Number='1' Name='x'/></NoteNameList>"
      "<NoteNameList Name='Kit'><Note Number='2' Name='y'/></NoteNameList>"));
  auto const& nameSet = reader->tree.nameSets.at(0);
  auto const& list = reader->uses.nameSetNotes.at(nameSet);
  EXPECT_EQ(list, reader->uses.patchNotes.at(BankOf(reader).GetPatches().at(0)));
  EXPECT_EQ(reader->uses.patchNotes.size(), 1U);
  EXPECT_TRUE(list->isNamed);
  EXPECT_EQ(list->name, UString("Kit")) << "whoever comes first makes it";
  ASSERT_EQ(list->notes.size(), 1U);
  EXPECT_EQ(list->notes[0].name, UString("x"));
}

TEST(NameLists, GoWithTheCopiesOfAPatch) {
  auto const reader = ReadMaster(MasterText(
      "<PatchNameList Name='L'><Patch Number='1' Name='a'><NoteNameList><Note Number='1' Name='x'/>"
      "</NoteNameList><ControlNameList><Control Number='1' Name='c'/></ControlNameList></Patch>"
      "</PatchNameList><ChannelNameSet Name='S'><PatchBank><UsesPatchNameList "
      "Name='L'/></PatchBank>"
      "<PatchBank><UsesPatchNameList Name='L'/></PatchBank></ChannelNameSet>"));
  EXPECT_EQ(reader->uses.patchNotes.size(), 2U);
  EXPECT_EQ(reader->uses.patchControls.size(), 2U);
  EXPECT_EQ(reader->uses.patchNotes.at(BankOf(reader, 0, 0).GetPatches().at(0)),
            reader->uses.patchNotes.at(BankOf(reader, 0, 1).GetPatches().at(0)));
}

TEST(NameLists, TakeBothFormsInANameSet) {
  auto const reader = ReadMaster(MasterText(
      "<ChannelNameSet Name='S'><NoteNameList Name='N'><Note Number='1' Name='x'/></NoteNameList>"
      "<ControlNameList><Control Number='1' "
      "Name='c'/></ControlNameList><PatchBank/></ChannelNameSet>"
      "<ChannelNameSet Name='T'><UsesControlNameList Name='C'/><PatchBank/></ChannelNameSet>"
      "<ControlNameList Name='C'><Control Number='2' Name='d'/></ControlNameList>"
      "<ControlNameList><Control Number='2' Name='d'/></ControlNameList>"));
  auto const& sets = reader->tree.nameSets;
  EXPECT_EQ(reader->uses.nameSetNotes.at(sets.at(0))->notes.size(), 1U);
  EXPECT_FALSE(reader->uses.nameSetControls.at(sets.at(0))->isNamed);
  EXPECT_TRUE(reader->uses.nameSetControls.at(sets.at(1))->isNamed);
  EXPECT_EQ(reader->uses.nameSetControls.at(sets.at(1))->controls.size(), 1U);
}

TEST(ControlReader, ReadsTypesAndNumbers) {
  auto const list = ControlsOf(
      "<Control Type='NRPN' Number='65535' Name='d'/><Control Type='RPN' Number='0' Name='c'/>"
      "<Control Type='14bit' Number='1' Name='b'/><Control Number='1' Name='a'/>"
      "<Control Type='8bit' Number='2' Name='e'/><Control Number='65536' Name='x'/>"
      "<Control Number='x' Name='x'/><Control Name='x'/><Control Number='3'/>"
      "<Control Number='1000' Name='f'/><Other Number='4' Name='x'/>");
  std::string text;
  for (Control const& control : list->controls) {
    text += std::to_string(control.GetType()) + ":" + std::to_string(control.GetNumber()) + "=" +
            control.GetName().string() + ";";
  }
  EXPECT_EQ(text, "0:1=a;0:2=e;0:1000=f;1:1=b;2:0=c;3:65535=d;");
}

TEST(ControlReader, KeepsTheFirstOfItsTypeAndNumber) {
  auto const list = ControlsOf(
      "<Control Number='1' Name='a'/><Control Number='1' Name='b'><Values Min='0' Max='1'/>"
      "</Control>");
  ASSERT_EQ(list->controls.size(), 1U);
  EXPECT_EQ(list->controls.nth(0).GetName(), UString("a"));
  EXPECT_FALSE(list->controls.nth(0).HasValueRange());
}

Control ControlWith(std::string const& values, std::string const& lists = "") {
  return ControlsOf("<Control Number='1' Name='a'>" + values + "</Control>", lists)
      ->controls.nth(0);
}

TEST(ControlReader, ReadsRanges) {
  Control const control = ControlWith("<Values Min='-1.5' Max='1e3' Default='+2' Units='Hz'/>");
  EXPECT_EQ(control.GetMinValue(), -1.5);
  EXPECT_EQ(control.GetMaxValue(), 1000);
  EXPECT_TRUE(control.HasDefaultValue());
  EXPECT_EQ(control.GetDefaultValue(), 2);
  EXPECT_EQ(control.GetUnits(), UString("Hz"));
}

TEST(ControlReader, HasNoDefaultWhereNoneStands) {
  Control const control = ControlWith("<Values Min='0' Max='127' Default=''/>");
  EXPECT_TRUE(control.HasValueRange());
  EXPECT_FALSE(control.HasDefaultValue());
  EXPECT_EQ(control.GetDefaultValue(), 0);
}

TEST(ControlReader, IgnoresARangeWithoutBothEnds) {
  EXPECT_FALSE(ControlWith("<Values Min='0'/>").HasValueRange());
  EXPECT_FALSE(ControlWith("<Values Max='0'/>").HasValueRange());
  EXPECT_FALSE(ControlWith("<Values Min='inf' Max='nan'/>").HasValueRange());
  Control const control = ControlWith(
      "<Values Min='0'><ValueNameList><Value Number='1' Name='x'/></ValueNameList></Values>");
  EXPECT_EQ(control.CountValueNames(), 0);
}

TEST(ControlReader, TakesTheFirstChildOfARangeForItsValues) {
  Control const control = ControlWith(
      "<Values Min='0' Max='9'><ValueNameList Name='V'><Value Number='5' Name='five'/>"
      "<Value Number='1' Name='one'/><Value Number='5' Name='again'/><Value Number='70000' "
      "Name='x'/>"
      "<Value Number='2'/></ValueNameList><UsesValueNameList Name='W'/></Values>");
  ASSERT_EQ(control.CountValueNames(), 2);
  EXPECT_EQ(control.GetNameForValue(5), UString("five"));
  EXPECT_EQ(ControlWith("<Values Min='0' Max='9'><Other/><ValueNameList><Value Number='5' "
                        "Name='five'/></ValueNameList></Values>")
                .CountValueNames(),
            0);
}

TEST(ControlReader, SharesNamedValuesWhereverTheyStand) {
  Control const control =
      ControlWith("<Values Min='0' Max='9'><UsesValueNameList Name='W'/></Values>",
                  "<ValueNameList Name='w'><Value Number='1' Name='x'/></ValueNameList>"
                  "<ValueNameList Name='W'><Value Number='1' Name='y'/></ValueNameList>");
  EXPECT_EQ(control.GetNameForValue(1), UString("x"));
}

TEST(CommandReader, KnowsEveryChannelMessage) {
  EXPECT_EQ(
      CommandsOf("<NoteOn Note='1' Velocity='2'/><NoteOff Note='3' Velocity='4'/>"
                 "<PolyKeyPressure Note='5' Pressure='6'/><ControlChange Control='7' Value='8'/>"
                 "<ProgramChange Number='9'/><ChannelKeyPressure Pressure='10'/>"
                 "<PitchBendChange Value='11'/>"),
      "90 01 02;80 03 04;A0 05 06;B0 07 08;C0 09;D0 0A;E0 0B;");
  EXPECT_EQ(CommandsOf("<AllSoundOff/><ResetAllControllers/><LocalControl Value='on'/>"
                       "<LocalControl Value='off'/><AllNotesOff/><OmniOff/><OmniOn/>"
                       "<MonoMode Value='4'/><PolyMode/>"),
            "B0 78 00;B0 79 00;B0 7A 7F;B0 7A 00;B0 7B 00;B0 7C 00;B0 7D 00;B0 7E 00;B0 7F 00;");
}

TEST(CommandReader, AddsNothingForAMessageThatLacksSomething) {
  EXPECT_EQ(CommandsOf("<NoteOn Note='1'/><NoteOn Note='1' Velocity='128'/><NoteOn Velocity='1'/>"
                       "<ControlChange Control='x' Value='1'/><ProgramChange/><LocalControl/>"
                       "<LocalControl Value='On'/><ChannelKeyPressure Pressure='-1'/>"
                       "<MIDIDelay/><MIDIDelay Milliseconds='-5'/>"),
            "");
}

TEST(CommandReader, PassesOverWhatHasNoHandling) {
  EXPECT_EQ(CommandsOf("<ControlChange14 Control='1' Value='2'/><RPNChange RPN='1' Value='2'/>"
                       "<NRPNChange NRPN='1' Value='2'/><SongSelect Number='1'/><TuneRequest/>"
                       "<TimingClock/><Start/><Continue/><Stop/><ActiveSensing/><SystemReset/>"
                       "<MTCQuarterFrame MessageType='FrameLSNibble' DataNibble='1'/>"
                       "<SongPositionPointer Position='1'/><Other/>"),
            "");
}

TEST(CommandReader, IgnoresTheChannelOfAMessage) {
  EXPECT_EQ(CommandsOf("<NoteOn Channel='5' Note='1' Velocity='2'/>"), "90 01 02;");
}

TEST(CommandReader, KeepsDelays) {
  auto const reader = ReadMaster(
      MasterText("<ChannelNameSet Name='S'><PatchBank><MIDICommands><ControlChange Control='1' "
                 "Value='1'/><MIDIDelay Milliseconds='100'/><ControlChange Control='1' Value='2'/>"
                 "</MIDICommands></PatchBank></ChannelNameSet>"));
  auto const& items = BankOf(reader).Commands().Items();
  ASSERT_EQ(items.size(), 3U);
  EXPECT_EQ(items[1].delay.Value(), NanosecondsToMIDITime(Nanos(100'000'000)).Value());
}

TEST(SysexReader, PairsDigitsAndPassesOverTheRest) {
  EXPECT_EQ(CommandsOf("<SysEx>F0 7E 0G 12 F7</SysEx>"), "F0 7E 01 2F;");
  EXPECT_EQ(CommandsOf("<SysEx>f0,7e\n09-01 0xF7</SysEx>"), "F0 7E 09 01 0F;");
  EXPECT_EQ(CommandsOf("<SysEx>F0 41 F</SysEx>"), "F0 41;");
}

TEST(SysexReader, DropsHalfAByteBeforeAChild) {
  EXPECT_EQ(CommandsOf("<SysEx>F0 4<SysExDeviceID/>1 F7</SysEx>"), "F0 10 1F;");
  EXPECT_EQ(CommandsOf("<SysEx>F0 4<Other/>1F7</SysEx>"), "F0 1F;");
}

TEST(SysexReader, ReadsMarkersInHexadecimal) {
  EXPECT_EQ(CommandsOf("<SysEx>F0 <SysExDeviceID/> F7</SysEx>"), "F0 10 F7;");
  EXPECT_EQ(CommandsOf("<SysEx>F0 <SysExDeviceID Offset='10' Multiplier='2'/> F7</SysEx>"),
            "F0 40 F7;");
  EXPECT_EQ(CommandsOf("<SysEx>F0 <SysExChannel Offset='1' Multiplier='2'/> F7</SysEx>"),
            "F0 02 F7;");
  EXPECT_EQ(CommandsOf("<SysEx>F0 <SysExDeviceID Offset='1FF' Multiplier=''/> F7</SysEx>"),
            "F0 0F F7;");
  EXPECT_EQ(CommandsOf("<SysEx>F0 <SysExDeviceID Offset='0x1' Multiplier='-1'/> F7</SysEx>"),
            "F0 10 F7;");
}

TEST(SysexReader, TakesSeveralAndEmptyOnes) {
  EXPECT_EQ(CommandsOf("<SysEx>F0 01 F7</SysEx><SysEx/><SysEx>F0 02 F7</SysEx>"),
            "F0 01 F7;;F0 02 F7;");
}

TEST(DocumentNumbers, ReadDecimalNumbers) {
  unsigned number = 99;
  EXPECT_TRUE(Impl::ReadUnsigned("\t\n 12ab", 20, number));
  EXPECT_EQ(number, 12U);
  for (char const* text : {"", " ", "x", "+1", "-1", "21", "99999999999999999999999999"}) {
    EXPECT_FALSE(Impl::ReadUnsigned(text, 20, number)) << text;
  }
  EXPECT_EQ(number, 12U) << "a failure leaves the number as it was";
  EXPECT_TRUE(Impl::ReadUnsigned("4294967295", 4294967295U, number));
  EXPECT_EQ(number, 4294967295U);
  int value = 0;
  EXPECT_TRUE(Impl::ReadSigned(" -2147483648", value));
  EXPECT_EQ(value, -2147483647 - 1);
  EXPECT_FALSE(Impl::ReadSigned("2147483648", value));
  EXPECT_FALSE(Impl::ReadSigned("--1", value));
  EXPECT_FALSE(Impl::ReadSigned("- 1", value));
}

TEST(DocumentNumbers, ReadDoublesWithoutRegardToTheLocale) {
  double number = 0;
  EXPECT_TRUE(Impl::ReadDouble(" -0.25Hz", number));
  EXPECT_EQ(number, -0.25);
  EXPECT_TRUE(Impl::ReadDouble("1,5", number));
  EXPECT_EQ(number, 1);
  EXPECT_TRUE(Impl::ReadDouble(".5", number));
  EXPECT_EQ(number, 0.5);
  for (char const* text : {"", "inf", "-nan", "+", "-", "x1", "1e999"}) {
    EXPECT_FALSE(Impl::ReadDouble(text, number)) << text;
  }
}

}  // namespace
}  // namespace Ostinet::Testing
