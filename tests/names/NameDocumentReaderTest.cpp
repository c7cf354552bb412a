// SPDX-License-Identifier: MIT
//
// Which part of a document is read, and what becomes of modes, name sets, banks and patches.
#include <gtest/gtest.h>

#include "ReadDocument.h"

namespace Ostinet::Testing {
namespace {

using Impl::NameDocumentOwner;

NameDocumentOwner Owner(char const* manufacturer, char const* model, int uniqueID = 0) {
  NameDocumentOwner owner;
  owner.manufacturer = manufacturer;
  owner.model = model;
  owner.uniqueID = uniqueID;
  return owner;
}

std::size_t CountSupported(std::string const& head, NameDocumentOwner const& owner = TestOwner()) {
  return ReadMaster(DocumentText("<MasterDeviceNames>" + head +
                                 "<SupportsStandardDeviceMode Name='GM'/></MasterDeviceNames>"),
                    owner)
      ->standardModeNames.size();
}

TEST(DeviceMatch, TakesMakerAndModelWithoutRegardToCaseAndWhiteSpace) {
  EXPECT_EQ(CountSupported("<Manufacturer> MA KER</Manufacturer><Model>model\n</Model>"), 1U);
  EXPECT_EQ(CountSupported("<Manufacturer>Maker</Manufacturer><Model>Model 2</Model>"), 0U);
  EXPECT_EQ(CountSupported("<Manufacturer>Makers</Manufacturer><Model>Model</Model>"), 0U);
}

TEST(DeviceMatch, TakesAnyOfSeveralModels) {
  std::string const head =
      "<Manufacturer>Maker</Manufacturer><Model>A</Model><Model>B</Model><Model>C</Model>";
  EXPECT_EQ(CountSupported(head, Owner("Maker", "B")), 1U);
  EXPECT_EQ(CountSupported(head, Owner("Maker", "C")), 1U);
  EXPECT_EQ(CountSupported(head, Owner("Maker", "D")), 0U);
}

TEST(DeviceMatch, TakesADeviceByItsNumberAlone) {
  EXPECT_EQ(CountSupported("<Device Name='other' UniqueID='7'/>"), 1U);
  EXPECT_EQ(CountSupported("<Device Name='x' UniqueID='8'/>"), 0U);
  EXPECT_EQ(CountSupported("<Device Name='x'/>"), 0U);
  EXPECT_EQ(CountSupported("<Device Name='x' UniqueID='seven'/>"), 0U);
  EXPECT_EQ(CountSupported("<Device UniqueID='-12'/>", Owner("", "", -12)), 1U);
  EXPECT_EQ(CountSupported("<Device UniqueID='-2147483648'/>", Owner("", "", -2147483647 - 1)), 1U);
  EXPECT_EQ(CountSupported("<Device UniqueID='0'/>", Owner("", "")), 1U);
}

// Hosts have documents whose device was written for one destination and whose maker and model
// serve all others.
TEST(DeviceMatch, GoesOnBehindADeviceOfAnotherNumber) {
  EXPECT_EQ(CountSupported("<Manufacturer>Maker</Manufacturer><Device UniqueID='9'/>"
                           "<Model>Model</Model>"),
            1U);
  EXPECT_EQ(CountSupported("<Device UniqueID='9'/><Manufacturer>Maker</Manufacturer>"
                           "<Model>Model</Model>"),
            1U);
}

TEST(DeviceMatch, LosesWhatStandsBeforeItsEnd) {
  auto const reader =
      ReadMaster(DocumentText("<MasterDeviceNames><Manufacturer>Maker</Manufacturer>"
                              "<SupportsStandardDeviceMode Name='lost'/><Model>Model</Model>"
                              "<SupportsStandardDeviceMode Name='kept'/></MasterDeviceNames>"));
  EXPECT_EQ(reader->standardModeNames, std::vector<UString>{"kept"});
}

TEST(MasterReader, TakesTheFirstElementThatFitsAndNoFurtherOne) {
  auto const reader = ReadMaster(
      DocumentText("<MasterDeviceNames><Manufacturer>Other</Manufacturer><Model>Model</Model>"
                   "<SupportsStandardDeviceMode Name='1'/></MasterDeviceNames>"
                   "<MasterDeviceNames><Manufacturer>Maker</Manufacturer><Model>Model</Model>"
                   "<SupportsStandardDeviceMode Name='2'/></MasterDeviceNames>"
                   "<MasterDeviceNames><Manufacturer>Maker</Manufacturer><Model>Model</Model>"
                   "<SupportsStandardDeviceMode Name='3'/></MasterDeviceNames>"));
  EXPECT_EQ(reader->standardModeNames, std::vector<UString>{"2"});
}

TEST(MasterReader, GivesNothingForOtherDocuments) {
  EXPECT_TRUE(ReadMaster("<Other/>")->tree.modes.empty());
  EXPECT_TRUE(ReadMaster("")->tree.modes.empty());
  EXPECT_TRUE(ReadMaster("no XML")->tree.nameSets.empty());
  EXPECT_TRUE(ReadMaster(DocumentText("<StandardDeviceMode Name='A'/>"))->tree.modes.empty());
}

TEST(MasterReader, ReadsModesInOrderWithTheirCommands) {
  auto const reader = ReadMaster(MasterText(
      "<CustomDeviceMode Name='One'><DeviceModeEnable><MIDICommands><SysEx>F0 01 F7</SysEx>"
      "</MIDICommands></DeviceModeEnable><DeviceModeDisable><MIDICommands>"
      "<AllNotesOff/></MIDICommands></DeviceModeDisable></CustomDeviceMode>"
      "<CustomDeviceMode/><CustomDeviceMode Name='Two'><DeviceModeEnable><AllNotesOff/>"
      "</DeviceModeEnable></CustomDeviceMode>"));
  ASSERT_EQ(reader->tree.modes.size(), 2U);
  Impl::DestModeImpl const& one = *reader->tree.modes[0];
  EXPECT_EQ(one.GetName(), UString("One"));
  EXPECT_FALSE(one.IsStandard());
  EXPECT_EQ(Messages(one.EnableCommands()), "F0 01 F7;");
  EXPECT_EQ(Messages(one.DisableCommands()), "B0 7B 00;");
  EXPECT_EQ(Messages(reader->tree.modes[1]->EnableCommands()), "");
}

TEST(MasterReader, KeepsTheFirstAssignmentOfAChannel) {
  auto const reader = ReadMaster(MasterText(
      "<CustomDeviceMode Name='M'><ChannelNameSetAssignments>"
      "<ChannelNameSetAssign Channel='1' NameSet='A'/><ChannelNameSetAssign Channel='1' "
      "NameSet='B'/>"
      "<ChannelNameSetAssign Channel='16' NameSet=' a'/><ChannelNameSetAssign Channel='17' "
      "NameSet='C'/>"
      "<ChannelNameSetAssign Channel='0' NameSet='C'/><ChannelNameSetAssign NameSet='C'/>"
      "<ChannelNameSetAssign Channel='2'/></ChannelNameSetAssignments></CustomDeviceMode>"));
  Impl::DestModeImpl const& mode = *reader->tree.modes.at(0);
  ASSERT_EQ(reader->tree.nameSets.size(), 1U) << "what is not assigned makes no name set";
  EXPECT_EQ(mode.GetNameSet(0), reader->tree.nameSets[0].get());
  EXPECT_EQ(mode.GetNameSet(15), mode.GetNameSet(0)) << "names are compared loosely";
  EXPECT_EQ(mode.GetNameSet(1), nullptr);
}

TEST(MasterReader, IgnoresListsInAModeOfTheDevicesOwn) {
  auto const reader = ReadMaster(
      MasterText("<CustomDeviceMode Name='M'><PatchNameList Name='L'><Patch Number='1' Name='A'/>"
                 "</PatchNameList></CustomDeviceMode><ChannelNameSet Name='S'><PatchBank>"
                 "<UsesPatchNameList Name='L'/></PatchBank></ChannelNameSet>"));
  EXPECT_EQ(PatchNames(BankOf(reader)), "");
}

TEST(NameSetReader, KnowsItsChannels) {
  auto const reader = ReadMaster(MasterText(
      "<ChannelNameSet Name='S'><AvailableForChannels><AvailableChannel Channel='1'/>"
      "<AvailableChannel Channel='2' Available='true'/><AvailableChannel Channel='3'/>"
      "<AvailableChannel Channel='3' Available='false'/>"
      "<AvailableChannel Channel='4' Available='perhaps'/><AvailableChannel Channel='16'/>"
      "<AvailableChannel/></AvailableForChannels></ChannelNameSet><ChannelNameSet Name='T'/>"));
  EXPECT_EQ(reader->tree.nameSets.at(0)->GetChannels(), 0x800B);
  EXPECT_EQ(reader->tree.nameSets.at(1)->GetChannels(), 0);
}

TEST(NameSetReader, KeepsTheBanksOfTheFirstDefinition) {
  std::string const first = "<ChannelNameSet Name='S'><PatchBank Name='1'/></ChannelNameSet>";
  std::string const second =
      "<ChannelNameSet Name='s '><AvailableForChannels><AvailableChannel Channel='1'/>"
      "</AvailableForChannels><PatchBank Name='2'/></ChannelNameSet>";
  auto const reader = ReadMaster(MasterText(first + second));
  ASSERT_EQ(reader->tree.nameSets.size(), 1U);
  EXPECT_EQ(reader->tree.nameSets[0]->GetBanks().size(), 1U);
  EXPECT_EQ(reader->tree.nameSets[0]->GetChannels(), 0) << "nothing of the second is read";
  EXPECT_EQ(BankOf(reader).GetBankName(), UString("1"));
}

TEST(NameSetReader, FillsASetThatHasNoBanksYet) {
  auto const reader = ReadMaster(
      MasterText("<ChannelNameSet Name='S'><AvailableForChannels><AvailableChannel Channel='1'/>"
                 "</AvailableForChannels></ChannelNameSet>"
                 "<ChannelNameSet Name='S'><PatchBank Name='2'/></ChannelNameSet>"));
  EXPECT_EQ(reader->tree.nameSets.at(0)->GetBanks().size(), 1U);
  EXPECT_EQ(reader->tree.nameSets.at(0)->GetChannels(), 1);
}

constexpr char kListA[] = "<PatchNameList Name='A'><Patch Number='1' Name='p'/></PatchNameList>";
constexpr char kUsesA[] =
    "<ChannelNameSet Name='S'><PatchBank Name='B'><UsesPatchNameList Name='A'/></PatchBank>"
    "</ChannelNameSet>";

TEST(BankReader, TakesAListThatStandsBehindOrBefore) {
  for (std::string const& content : {std::string(kUsesA) + kListA, std::string(kListA) + kUsesA}) {
    auto const reader = ReadMaster(MasterText(content));
    EXPECT_EQ(PatchNames(BankOf(reader)), "p;");
    EXPECT_EQ(BankOf(reader).GetName(), UString("A"));
    EXPECT_EQ(BankOf(reader).GetBankName(), UString("B"));
  }
}

TEST(BankReader, TakesTheFirstOfTwoListsOfOneName) {
  auto const reader = ReadMaster(
      MasterText(std::string(kListA) +
                 "<PatchNameList Name=' a'><Patch Number='2' Name='q'/></PatchNameList>" + kUsesA));
  EXPECT_EQ(PatchNames(BankOf(reader)), "p;");
}

TEST(BankReader, ReadsASecondDefinitionOfAListThatIsStillEmpty) {
  auto const reader =
      ReadMaster(MasterText("<PatchNameList Name='A'/>" + std::string(kListA) + kUsesA));
  EXPECT_EQ(PatchNames(BankOf(reader)), "p;");
}

TEST(BankReader, GivesEachBankOfAListPatchesOfItsOwn) {
  auto const reader = ReadMaster(MasterText(
      std::string(kListA) +
      "<ChannelNameSet Name='S'><PatchBank Name='1'><MIDICommands>"
      "<ControlChange Control='0' Value='1'/></MIDICommands><UsesPatchNameList "
      "Name='A'/></PatchBank>"
      "<PatchBank Name='2'><MIDICommands><ControlChange Control='0' Value='2'/></MIDICommands>"
      "<UsesPatchNameList Name='A'/></PatchBank></ChannelNameSet>"));
  auto const& first = BankOf(reader, 0, 0);
  auto const& second = BankOf(reader, 0, 1);
  EXPECT_EQ(PatchNames(first), PatchNames(second));
  EXPECT_NE(first.GetPatches().at(0), second.GetPatches().at(0));
  EXPECT_EQ(second.GetPatches().at(0)->GetBank(), &second);
  EXPECT_EQ(second.GetPatches().at(0)->GetNumbers().msb, 2);
}

TEST(BankReader, TakesOnlyTheFirstOfItsListForms) {
  auto const reader = ReadMaster(
      MasterText(std::string(kListA) +
                 "<ChannelNameSet Name='S'><PatchBank><PatchNameList Name='In'><Patch Number='1' "
                 "Name='x'/></PatchNameList><UsesPatchNameList Name='A'/></PatchBank>"
                 "<PatchBank><UsesPatchNameList/><UsesPatchNameList Name='A'/><PatchNameList/>"
                 "</PatchBank></ChannelNameSet>"));
  EXPECT_EQ(PatchNames(BankOf(reader, 0, 0)), "x;");
  EXPECT_EQ(BankOf(reader, 0, 0).GetListName(), UString("In"));
  EXPECT_EQ(PatchNames(BankOf(reader, 0, 1)), "p;");
}

TEST(BankReader, KeepsAnInlineListOutOfOtherBanksReach) {
  auto const reader = ReadMaster(
      MasterText("<ChannelNameSet Name='S'><PatchBank><PatchNameList Name='In'><Patch Number='1' "
                 "Name='x'/></PatchNameList></PatchBank><PatchBank Name='B'><UsesPatchNameList "
                 "Name='In'/></PatchBank></ChannelNameSet>"));
  EXPECT_EQ(PatchNames(BankOf(reader, 0, 1)), "");
  EXPECT_EQ(BankOf(reader, 0, 1).GetListName(), UString());
}

TEST(BankReader, AddsUpItsCommands) {
  auto const reader = ReadMaster(MasterText(
      "<ChannelNameSet Name='S'><PatchBank><MIDICommands><ControlChange Control='0' Value='5'/>"
      "</MIDICommands><MIDICommands><ControlChange Control='32' Value='6'/></MIDICommands>"
      "<Patch/></PatchBank></ChannelNameSet>"));
  EXPECT_TRUE(BankOf(reader).HasNumbers(5, 6));
  EXPECT_EQ(BankOf(reader).GetBankName(), UString());
}

TEST(PatchReader, WantsNameAndNumberAsTexts) {
  auto const reader = ReadMaster(
      PatchesText("<Patch Number='A1' Name='One'/><Patch Number='2'/><Patch Name='Three'/>"
                  "<Patch Number='' Name=''/><Other Number='1' Name='x'/>"));
  auto const& patches = BankOf(reader).GetPatches();
  ASSERT_EQ(patches.size(), 2U);
  EXPECT_EQ(patches[0]->GetNumberAndName(), UString("A1 One"));
  EXPECT_EQ(patches[0]->GetNumbers().program, 255);
  EXPECT_EQ(patches[1]->GetNumberAndName(), UString(" "));
}

TEST(PatchReader, TakesAProgramUpTo127) {
  auto const reader =
      ReadMaster(PatchesText("<Patch Number='1' Name='a' ProgramChange='0'/><Patch Number='1' "
                             "Name='b' ProgramChange='127'/>"
                             "<Patch Number='1' Name='c' ProgramChange='128'/><Patch Number='1' "
                             "Name='d' ProgramChange=''/>"
                             "<Patch Number='1' Name='e' ProgramChange=' 12x'/>"));
  std::vector<int> programs;
  for (auto const& patch : BankOf(reader).GetPatches()) {
    programs.push_back(patch->GetNumbers().program);
  }
  EXPECT_EQ(programs, (std::vector<int>{0, 127, 255, 255, 12}));
}

// A bank select in "MIDICommands" of a patch was never read: the library's own documents have it
// there, and hosts count on finding those patches under the numbers of their banks.
TEST(PatchReader, ReadsPatchCommandsAndNoOthers) {
  auto const reader = ReadMaster(PatchesText(
      "<Patch Number='1' Name='a'><PatchMIDICommands><ControlChange Control='0' Value='9'/>"
      "<SysEx>F0 F7</SysEx><ProgramChange Number='3'/></PatchMIDICommands></Patch>"
      "<Patch Number='2' Name='b'><MIDICommands><ProgramChange "
      "Number='3'/></MIDICommands></Patch>"));
  auto const& patches = BankOf(reader).GetPatches();
  EXPECT_EQ(Messages(patches.at(0)->Commands()), "B0 00 09;C0 03;");
  EXPECT_EQ(Messages(patches.at(1)->Commands()), "");
}

TEST(PatchReader, KeepsAssignmentsOfNameSets) {
  auto const reader = ReadMaster(PatchesText(
      "<Patch Number='1' Name='a'><ChannelNameSetAssignments>"
      "<ChannelNameSetAssign Channel='2' NameSet='Drums'/>"
      "<ChannelNameSetAssign Channel='2' NameSet='Set'/></ChannelNameSetAssignments></Patch>"
      "<Patch Number='2' Name='b'><ChannelNameSetAssignments/></Patch>"));
  auto const& patches = BankOf(reader).GetPatches();
  ASSERT_NE(patches.at(0)->GetChannelNameSets(), nullptr);
  EXPECT_EQ((*patches[0]->GetChannelNameSets())[1]->GetName(), UString("Drums"));
  EXPECT_EQ((*patches[0]->GetChannelNameSets())[0], nullptr);
  EXPECT_EQ(patches.at(1)->GetChannelNameSets(), nullptr);
}

TEST(MasterReader, KeepsWhatStandsBeforeAFault) {
  std::string const text = MasterText(
      std::string(kListA) +
      "<ChannelNameSet Name='S'><PatchBank Name='1'><UsesPatchNameList Name='A'/></PatchBank>"
      "<PatchBank Name='2'><MIDICommands><ControlChange Control='0' Value='5'/></MIDICommands>");
  auto const reader = ReadMaster(text.substr(0, text.find("</MasterDeviceNames>")) + "<broken");
  ASSERT_EQ(reader->tree.nameSets.at(0)->GetBanks().size(), 2U);
  EXPECT_EQ(PatchNames(BankOf(reader, 0, 0)), "p;");
  EXPECT_TRUE(BankOf(reader, 0, 1).HasNumbers(5, 255));
  EXPECT_FALSE(reader->isTemporary);
}

// Every beginning of a document reads without harm, and never gives more than the whole.
TEST(MasterReader, ReadsEveryBeginningOfADocument) {
  std::string const text = MasterText(
      "<CustomDeviceMode Name='M'><ChannelNameSetAssignments><ChannelNameSetAssign Channel='1' "
      "NameSet='S'/></ChannelNameSetAssignments></CustomDeviceMode>" +
      std::string(kUsesA) + kListA +
      "<NoteNameList Name='N'><Note Number='1' Name='n'/></NoteNameList>");
  for (std::size_t length = 0; length <= text.size(); ++length) {
    auto const reader = ReadMaster(text.substr(0, length));
    EXPECT_LE(reader->tree.modes.size(), 1U);
    EXPECT_LE(reader->tree.nameSets.size(), 1U);
  }
}

TEST(StandardModeReader, ReadsTheModeOfThatName) {
  auto const reader = ReadStandardMode(
      DocumentText("<StandardDeviceMode Name='Other'><ChannelNameSetAssignments>"
                   "<ChannelNameSetAssign Channel='1' NameSet='X'/></ChannelNameSetAssignments>"
                   "</StandardDeviceMode>"
                   "<StandardDeviceMode Name='gm'><ChannelNameSetAssignments>"
                   "<ChannelNameSetAssign Channel='1' NameSet='S'/></ChannelNameSetAssignments>" +
                   std::string(kUsesA) + kListA +
                   "</StandardDeviceMode><StandardDeviceMode Name='GM'>"
                   "<ChannelNameSetAssignments><ChannelNameSetAssign Channel='2' NameSet='T'/>"
                   "</ChannelNameSetAssignments></StandardDeviceMode>"),
      "G M");
  ASSERT_EQ(reader->tree.modes.size(), 1U);
  Impl::DestModeImpl const& mode = *reader->tree.modes[0];
  EXPECT_TRUE(mode.IsStandard());
  EXPECT_EQ(mode.GetName(), UString("G M")) << "the name that was asked for";
  EXPECT_NE(mode.GetNameSet(0), nullptr);
  EXPECT_EQ(mode.GetNameSet(1), nullptr) << "a later element finds the mode assigned";
  EXPECT_EQ(PatchNames(BankOf(reader)), "p;");
}

TEST(StandardModeReader, GivesTheModeAlsoWhereTheDocumentHasItNot) {
  auto const reader = ReadStandardMode(DocumentText(""), "GM");
  ASSERT_EQ(reader->tree.modes.size(), 1U);
  EXPECT_FALSE(reader->tree.modes[0]->HasNameSets());
}

/// An extending document for the owner of the tests.
std::string ExtendingText(std::string const& content, std::string const& prolog = "") {
  return "<?xml version='1.0'?>" + prolog +
         "<MIDINameDocument><Author/><ExtendingDeviceNames><Device UniqueID='7'/>" + content +
         "</ExtendingDeviceNames></MIDINameDocument>";
}

struct Extended {
  RCPtrMT<Impl::PatchBankImpl> bank{new Impl::PatchBankImpl("Bank")};
  Reader reader;
};

Extended ReadExtending(std::string const& text, char const* listName = "A") {
  Extended result;
  result.reader = ReadText(text, [&](Impl::NameDocumentReader& reader, XMLLib::Parser& parser) {
    reader.ReadExtending(parser, {{result.bank, UString(listName)}});
  });
  return result;
}

TEST(ExtendingReader, FillsTheBanksThatAskForALists) {
  auto const result = ReadExtending(
      ExtendingText(std::string(kListA) +
                    "<PatchNameList Name='B'><Patch Number='1' Name='q'><NoteNameList>"
                    "<Note Number='1' Name='n'/></NoteNameList></Patch></PatchNameList>"));
  EXPECT_EQ(PatchNames(*result.bank), "p;");
  EXPECT_EQ(result.bank->GetListName(), UString("A"));
  EXPECT_TRUE(result.reader->uses.patchNotes.empty()) << "nobody asked for B";
  EXPECT_FALSE(result.bank->IsTemporary());
}

TEST(ExtendingReader, LeavesABankAsItIsWhereTheListIsMissing) {
  auto const result = ReadExtending(ExtendingText(kListA), "missing");
  EXPECT_EQ(PatchNames(*result.bank), "");
  EXPECT_EQ(result.bank->GetListName(), UString());
}

TEST(ExtendingReader, TakesTheFirstElementThatFits) {
  auto const result = ReadExtending(
      "<MIDINameDocument><ExtendingDeviceNames><Device UniqueID='9'/><PatchNameList Name='A'>"
      "<Patch Number='1' Name='no'/></PatchNameList></ExtendingDeviceNames><ExtendingDeviceNames>"
      "<Manufacturer>Maker</Manufacturer><Model>Model</Model><Model>M2</Model>" +
      std::string(kListA) + "</ExtendingDeviceNames></MIDINameDocument>");
  EXPECT_EQ(PatchNames(*result.bank), "p;");
}

TEST(ExtendingReader, KnowsTheLibrarysOwnDocuments) {
  auto const isTemporary = [](std::string const& prolog, std::string const& inside = "") {
    return ReadExtending(ExtendingText(inside + kListA, prolog)).bank->IsTemporary();
  };
  EXPECT_TRUE(isTemporary("<?com_vantor_LM temp=\"yes\"?>"));
  EXPECT_TRUE(isTemporary("<?com_vantor temp=\"yes\"?>"));
  EXPECT_TRUE(isTemporary("<?other a?><?com_vantor_LM no?>", "<?com_vantor_LM temp=\"yes\"?>"));
  EXPECT_FALSE(isTemporary(""));
  EXPECT_FALSE(isTemporary("<?com_vantor_LM temp='yes'?>"));
  EXPECT_FALSE(isTemporary("<?com_vantor_LM temp=\"no\"?>"));
  EXPECT_FALSE(isTemporary("<?org_vantor temp=\"yes\"?>"));
}

TEST(MasterReader, DoesNotLookForTheMarkOfTheLibrarysDocuments) {
  std::string text = MasterText(std::string(kListA) + kUsesA);
  text.insert(text.find("<MIDINameDocument>"), "<?com_vantor_LM temp=\"yes\"?>");
  EXPECT_FALSE(BankOf(ReadMaster(text)).IsTemporary());
}

// What documents in use have taught.

TEST(MasterReader, TakesDocumentsWithoutAnXMLDeclarationOrADoctype) {
  std::string const text = MasterText("<SupportsStandardDeviceMode Name='GM'/>");
  EXPECT_EQ(ReadMaster(text.substr(text.find("<MIDI")))->standardModeNames.size(), 1U);
  EXPECT_EQ(ReadMaster("\xEF\xBB\xBF" + text)->standardModeNames.size(), 1U);
}

TEST(MasterReader, NeverFetchesTheDoctypeOfADocument) {
  std::string text = MasterText("<SupportsStandardDeviceMode Name='GM'/>");
  text.insert(text.find("<MIDINameDocument>"),
              "<!DOCTYPE MIDINameDocument PUBLIC \"-//MIDI Manufacturers Association//DTD "
              "MIDINameDocument 1.0//EN\" \"https://example.invalid/MIDINameDocument10.dtd\">");
  EXPECT_EQ(ReadMaster(text)->standardModeNames.size(), 1U);
}

TEST(MasterReader, ReadsOtherEncodings) {
  std::string text = PatchesText("<Patch Number='1' Name='Fl\xFCgel'/>");
  text.replace(0, text.find('\n'), "<?xml version='1.0' encoding='iso-8859-1'?>");
  EXPECT_EQ(PatchNames(BankOf(ReadMaster(text))), "Fl\xC3\xBCgel;");
}

TEST(NameSetReader, TakesItsListsInAnyOrderAndWithoutBanks) {
  auto const reader = ReadMaster(
      MasterText("<ChannelNameSet Name='S'><UsesControlNameList Name='C'/><!-- <PatchBank/> -->"
                 "<UsesNoteNameList Name=''/></ChannelNameSet>"
                 "<ControlNameList Name='C'><Control Number='0' Name='c'/></ControlNameList>"));
  auto const& nameSet = reader->tree.nameSets.at(0);
  EXPECT_TRUE(nameSet->GetBanks().empty());
  EXPECT_EQ(reader->uses.nameSetControls.at(nameSet)->controls.size(), 1U);
  EXPECT_TRUE(reader->uses.nameSetNotes.at(nameSet)->notes.empty());
}

TEST(MasterReader, KeepsANameSetThatNobodyDefines) {
  auto const reader =
      ReadMaster(MasterText("<CustomDeviceMode Name='M'><ChannelNameSetAssignments>"
                            "<ChannelNameSetAssign Channel='1' NameSet='(null)'/>"
                            "</ChannelNameSetAssignments></CustomDeviceMode>"
                            "<ChannelNameSet Name='S'><PatchBank/></ChannelNameSet>"));
  ASSERT_EQ(reader->tree.nameSets.size(), 2U);
  EXPECT_EQ(reader->tree.nameSets[0]->GetName(), UString("(null)"));
  EXPECT_TRUE(reader->tree.nameSets[0]->GetBanks().empty());
}

TEST(PatchReader, TakesEntitiesAndBlanksInNamesAsTheyStand) {
  auto const reader =
      ReadMaster(PatchesText("<Patch Number='001' Name=' Rock &amp; &lt;Roll&gt; '/>"
                             "<Patch Number='002' Name='&#x2192;'/>"));
  EXPECT_EQ(PatchNames(BankOf(reader)), " Rock & <Roll> ;\xE2\x86\x92;");
}

}  // namespace
}  // namespace Ostinet::Testing
