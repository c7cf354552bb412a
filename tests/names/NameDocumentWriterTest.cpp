// SPDX-License-Identifier: MIT
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "ReadDocument.h"
#include "names/CommandWriter.h"
#include "names/NameDocumentWriter.h"
#include "ostinet/NameDocument.h"
#include "support/StudioTest.h"
#include "support/TemporaryFolder.h"

namespace Ostinet::Testing {
namespace {

using ::testing::HasSubstr;
using ::testing::Not;

Impl::WrittenFor ForTests() {
  Impl::WrittenFor owner;
  owner.author = "Host";
  owner.deviceName = "Synth";
  owner.uniqueID = 7;
  return owner;
}

class NameDocumentWriterTest : public ::testing::Test {
 protected:
  /// A document's banks, with their lists, as destinations have them.
  void Load(std::string const& content) {
    reader = ReadMaster(MasterText(content));
    Impl::AssignLists(reader->tree, reader->uses);
  }

  Patch PatchAt(std::size_t nameSet, std::size_t bank, std::size_t patch) {
    return Patch(BankOf(reader, nameSet, bank).GetPatches().at(patch));
  }

  /// Writes all banks and gives the text between the device and the end.
  std::string Write() {
    std::vector<Impl::PatchBankImpl const*> banks;
    for (auto const& nameSet : reader->tree.nameSets) {
      for (auto const& bank : nameSet->GetBanks()) {
        banks.push_back(bank.get());
      }
    }
    file = folder.GetFolder().GetFile("a.midnam");
    written = Impl::WriteBanks(file, ForTests(), banks);
    std::string const text = folder.Read("a.midnam");
    std::string const device = "UniqueID=\"7\"/>";
    std::size_t const start = text.find(device) + device.size();
    return WithoutLayout(text.substr(start, text.find("</ExtendingDeviceNames>") - start));
  }

  static std::string WithoutLayout(std::string const& text) {
    std::string result;
    for (std::size_t i = 0; i < text.size(); ++i) {
      if (text[i] == '\n') {
        i = text.find_first_not_of("\n ", i) - 1;
      } else {
        result += text[i];
      }
    }
    return result;
  }

  bool IsStandard() const { return CheckNameDocument(file).isStandard; }

  TemporaryFolder const folder;
  Reader reader;
  File file;
  std::vector<Impl::WrittenBank> written;
};

std::string Bank(std::string const& name, std::string const& patches) {
  return "<PatchBank Name='" + name + "'><PatchNameList>" + patches +
         "</PatchNameList></PatchBank>";
}

std::string Set(std::string const& banks) {
  return "<ChannelNameSet Name='S'>" + banks + "</ChannelNameSet>";
}

TEST_F(NameDocumentWriterTest, WritesAMasterForAStandardMode) {
  file = folder.GetFolder().GetFile("a.midnam");
  Impl::WriteStandardModeMaster(file, ForTests(), "General MIDI");
  EXPECT_EQ(folder.Read("a.midnam"),
            "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n"
            "<!DOCTYPE MIDINameDocument PUBLIC \"-//MIDI Manufacturers Association//DTD "
            "MIDINameDocument 1.0//EN\" \"http://www.midi.org/dtds/MIDINameDocument10.dtd\">\n"
            "<?com_vantor_LM temp=\"yes\"?>\n"
            "<MIDINameDocument>\n"
            "  <Author>Host</Author>\n"
            "  <MasterDeviceNames>\n"
            "    <Device Name=\"Synth\" UniqueID=\"7\"/>\n"
            "    <SupportsStandardDeviceMode Name=\"General MIDI\"/>\n"
            "  </MasterDeviceNames>\n"
            "</MIDINameDocument>\n");
  EXPECT_TRUE(IsStandard());
  Impl::NameDocumentReader again(TestOwner());
  EXPECT_TRUE(again.LoadMaster(file));
  EXPECT_EQ(again.standardModeNames, std::vector<UString>{"General MIDI"});
}

TEST_F(NameDocumentWriterTest, WritesAProgramAloneAsAnAttribute) {
  Load(Set(Bank("B",
                "<Patch Number='A1' Name='p' ProgramChange='5'/>"
                "<Patch Number='2' Name='q'/>")));
  EXPECT_EQ(Write(),
            "<PatchNameList Name=\"B\"><Patch Number=\"A1\" Name=\"p\" ProgramChange=\"5\"/>"
            "<Patch Number=\"2\" Name=\"q\"/></PatchNameList>");
  EXPECT_TRUE(IsStandard());
}

// Such a patch loses its commands when the document is read: hosts have stored it under the
// numbers of its bank.
TEST_F(NameDocumentWriterTest, WritesOtherCommandsWhereNobodyReadsThem) {
  Load(Set(Bank("B",
                "<Patch Number='1' Name='p'><PatchMIDICommands><ControlChange Control='0' "
                "Value='9'/><ProgramChange Number='3'/></PatchMIDICommands></Patch>")));
  EXPECT_EQ(Write(),
            "<PatchNameList Name=\"B\"><Patch Number=\"1\" Name=\"p\"><MIDICommands>"
            "<ControlChange Control=\"0\" Value=\"9\"/><ProgramChange Number=\"3\"/></MIDICommands>"
            "</Patch></PatchNameList>");
  EXPECT_FALSE(IsStandard());
  RCPtrMT<Impl::PatchBankImpl> const bank(new Impl::PatchBankImpl("B"));
  Impl::NameDocumentReader again(TestOwner());
  again.LoadExtending(file, {{bank, "B"}});
  EXPECT_EQ(Messages(bank->GetPatches().at(0)->Commands()), "");
}

TEST_F(NameDocumentWriterTest, MarksItsDocuments) {
  Load(Set(Bank("B", "<Patch Number='1' Name='p'/>")));
  Write();
  RCPtrMT<Impl::PatchBankImpl> const bank(new Impl::PatchBankImpl("B"));
  Impl::NameDocumentReader again(TestOwner());
  EXPECT_TRUE(again.LoadExtending(file, {{bank, "B"}}));
  EXPECT_TRUE(bank->IsTemporary());
  EXPECT_EQ(PatchNames(*bank), "p;");
}

TEST_F(NameDocumentWriterTest, GivesEachListANameOfItsOwn) {
  Load("<PatchNameList Name='L'><Patch Number='1' Name='p'/></PatchNameList>" +
       Set("<PatchBank Name='1'><UsesPatchNameList Name='L'/></PatchBank>"
           "<PatchBank Name='2'><UsesPatchNameList Name='L'/></PatchBank>" +
           Bank("l", "<Patch Number='1' Name='q'/>") + Bank("A", "")));
  Write();
  std::vector<Impl::WrittenBank> const expected{{"A", "A"}, {"L", "1"}, {"L2", "2"}, {"l3", "l"}};
  EXPECT_TRUE(written == expected) << written.size();
  EXPECT_TRUE(IsStandard());
}

TEST_F(NameDocumentWriterTest, WritesASharedTableOnce) {
  Load(Set(Bank("B",
                "<Patch Number='1' Name='p'><UsesNoteNameList Name='N'/></Patch>"
                "<Patch Number='2' Name='q'><UsesNoteNameList Name='N'/></Patch>")) +
       "<NoteNameList Name='N'><Note Number='1' Name='x'/></NoteNameList>");
  EXPECT_EQ(Write(),
            "<PatchNameList Name=\"B\"><Patch Number=\"1\" Name=\"p\"><UsesNoteNameList "
            "Name=\"N\"/></Patch><Patch Number=\"2\" Name=\"q\"><UsesNoteNameList Name=\"N\"/>"
            "</Patch></PatchNameList><NoteNameList Name=\"N\"><Note Number=\"1\" Name=\"x\"/>"
            "</NoteNameList>");
}

TEST_F(NameDocumentWriterTest, NamesSharedTablesThatHaveNoName) {
  Load("<ChannelNameSet Name='S'><NoteNameList><Note Number='1' Name='x'/></NoteNameList>" +
       Bank("B",
            "<Patch Number='1' Name='p'><NoteNameList><Note Number='2' Name='y'/>"
            "</NoteNameList></Patch><Patch Number='2' Name='q'/>") +
       "</ChannelNameSet>");
  std::string const text = Write();
  EXPECT_THAT(text, HasSubstr("<UsesNoteNameList Name=\"2\"/>"));
  EXPECT_THAT(text, HasSubstr("<NoteNameList Name=\"2\"><Note Number=\"2\" Name=\"y\"/>"));
  EXPECT_THAT(text, HasSubstr("<NoteNameList Name=\"3\"><NoteGroup/></NoteNameList>"))
      << "what is inherited is left out, and the format wants something in a list";
  EXPECT_TRUE(IsStandard());
}

TEST_F(NameDocumentWriterTest, WritesAnEditedTableInline) {
  Load(Set(Bank("B", "<Patch Number='1' Name='p'><UsesNoteNameList Name='N'/></Patch>")) +
       "<NoteNameList Name='N'><Note Number='1' Name='x'/></NoteNameList>");
  PatchAt(0, 0, 0).GetNoteNames().SetNoteName(2, "y");
  EXPECT_EQ(Write(),
            "<PatchNameList Name=\"B\"><Patch Number=\"1\" Name=\"p\"><NoteNameList Name=\"N\">"
            "<Note Number=\"1\" Name=\"x\"/><Note Number=\"2\" Name=\"y\"/></NoteNameList></Patch>"
            "</PatchNameList>");
}

TEST_F(NameDocumentWriterTest, WritesANewTableWithoutAName) {
  Load(Set(Bank("B", "<Patch Number='1' Name='p'/>")));
  PatchAt(0, 0, 0).GetNoteNames().SetNoteName(2, "y");
  EXPECT_THAT(Write(), HasSubstr("<NoteNameList><Note Number=\"2\" Name=\"y\"/></NoteNameList>"));
}

TEST_F(NameDocumentWriterTest, WritesGroupsThenNotesThenWhatIsHidden) {
  Load(
      "<ChannelNameSet Name='S'><NoteNameList Name='D'><NoteGroup Name='inherited'>"
      "<Note Number='1' Name='a'/><Note Number='2' Name='b'/></NoteGroup><Note Number='3' "
      "Name='c'/>"
      "</NoteNameList>" +
      Bank("B", "<Patch Number='1' Name='p'/>") + "</ChannelNameSet>");
  NoteNameList const notes = PatchAt(0, 0, 0).GetNoteNames();
  notes.ClearNoteName(3);
  notes.SetNoteName(9, "n");
  notes.PutNoteInGroup(11, 5, "Own");
  notes.PutNoteInGroup(10, 5, "");
  notes.SetNoteName(10, "ten");
  EXPECT_EQ(
      Write(),
      "<PatchNameList Name=\"B\"><Patch Number=\"1\" Name=\"p\"><NoteNameList Name=\"D\">"
      "<NoteGroup Name=\"Own\"><Note Number=\"11\" Name=\"\"/><Note Number=\"10\" Name=\"ten\"/>"
      "</NoteGroup><Note Number=\"9\" Name=\"n\"/><Note Number=\"3\" Name=\"\"/></NoteNameList>"
      "</Patch></PatchNameList>");
  EXPECT_TRUE(IsStandard());
}

TEST_F(NameDocumentWriterTest, WritesControlsThatThePatchHasOfItsOwn) {
  Load(
      "<ChannelNameSet Name='S'><ControlNameList Name='D'><Control Number='1' Name='a'/>"
      "<Control Type='RPN' Number='1' Name='b'/></ControlNameList>" +
      Bank("B", "<Patch Number='1' Name='p'/><Patch Number='2' Name='q'/>") + "</ChannelNameSet>");
  ControlList const controls = PatchAt(0, 0, 0).GetControlNames();
  controls.ClearControl(ControlType(2), 1);
  controls.SetControl(Control(ControlType(1), 7, "c", -1.5, 2, 0.25, UString("Hz")));
  EXPECT_EQ(
      Write(),
      "<PatchNameList Name=\"B\"><Patch Number=\"1\" Name=\"p\"><ControlNameList Name=\"D\">"
      "<Control Type=\"14bit\" Number=\"7\" Name=\"c\"><Values Min=\"-1.5\" Max=\"2\" "
      "Default=\"0.25\" Units=\"Hz\"/></Control><Control Type=\"RPN\" Number=\"1\" Name=\"\"/>"
      "</ControlNameList></Patch><Patch Number=\"2\" Name=\"q\"/></PatchNameList>")
      << "the second patch has the default list alone";
  EXPECT_TRUE(IsStandard());
}

TEST_F(NameDocumentWriterTest, WritesValueListsInlineOrByName) {
  Load(Set(Bank("B", "<Patch Number='1' Name='p'><UsesControlNameList Name='C'/></Patch>")) +
       "<ControlNameList Name='C'><Control Number='1' Name='a'><Values Min='0' Max='1'>"
       "<UsesValueNameList Name='V'/></Values></Control><Control Number='2' Name='b'>"
       "<Values Min='0' Max='1'><ValueNameList><Value Number='1' "
       "Name='in'/></ValueNameList></Values>"
       "</Control></ControlNameList><ValueNameList Name='V'><Value Number='0' Name='off'/>"
       "</ValueNameList>");
  EXPECT_EQ(
      Write(),
      "<PatchNameList Name=\"B\"><Patch Number=\"1\" Name=\"p\"><UsesControlNameList "
      "Name=\"C\"/></Patch></PatchNameList><ControlNameList Name=\"C\"><Control Type=\"7bit\" "
      "Number=\"1\" Name=\"a\"><Values Min=\"0\" Max=\"1\"><UsesValueNameList Name=\"V\"/>"
      "</Values></Control><Control Type=\"7bit\" Number=\"2\" Name=\"b\"><Values Min=\"0\" "
      "Max=\"1\"><ValueNameList><Value Number=\"1\" Name=\"in\"/></ValueNameList></Values>"
      "</Control></ControlNameList><ValueNameList Name=\"V\"><Value Number=\"0\" "
      "Name=\"off\"/></ValueNameList>");
  EXPECT_TRUE(IsStandard());
}

TEST_F(NameDocumentWriterTest, WritesAssignmentsOfNameSets) {
  Load(Set(Bank("B",
                "<Patch Number='1' Name='p'><ChannelNameSetAssignments><ChannelNameSetAssign "
                "Channel='10' NameSet='Drums'/></ChannelNameSetAssignments></Patch>")));
  EXPECT_THAT(Write(), HasSubstr("<ChannelNameSetAssignments><ChannelNameSetAssign Channel=\"10\" "
                                 "NameSet=\"Drums\"/></ChannelNameSetAssignments>"));
  EXPECT_TRUE(IsStandard());
}

TEST_F(NameDocumentWriterTest, ThrowsAndKeepsTheOldFileWhereTheDiskRefuses) {
  Load(Set(Bank("B", "")));
  File const nowhere = folder.GetFolder().GetSubFolder("missing").GetFile("a.midnam");
  EXPECT_THROW(Impl::WriteBanks(nowhere, ForTests(), {&BankOf(reader)}), VantorError);
  EXPECT_THROW(Impl::WriteStandardModeMaster(nowhere, ForTests(), "GM"), VantorError);
}

/// The commands of a bank with this content, as they are written.
std::string WrittenCommands(std::string const& content) {
  TemporaryFolder const folder;
  auto const reader =
      ReadMaster(MasterText("<ChannelNameSet Name='S'><PatchBank><MIDICommands>" + content +
                            "</MIDICommands></PatchBank></ChannelNameSet>"));
  {
    XMLLib::Writer writer(folder.GetFolder().GetFile("a.xml"));
    writer.SetMode(XMLLib::Writer::kOnOneLine);
    Impl::WriteCommands(writer, "C", BankOf(reader).Commands());
    writer.Close();
  }
  std::string const text = folder.Read("a.xml");
  std::size_t const start = text.find("<C>");
  return start == std::string::npos ? "" : text.substr(start + 3, text.find("</C>") - start - 3);
}

TEST(CommandWriter, WritesPendingNumbersInTheOrderOfTheWire) {
  EXPECT_EQ(WrittenCommands("<ControlChange Control='32' Value='2'/>"
                            "<ControlChange Control='0' Value='1'/><ProgramChange Number='3'/>"),
            "<ControlChange Control=\"0\" Value=\"1\"/><ControlChange Control=\"32\" Value=\"2\"/>"
            "<ProgramChange Number=\"3\"/>");
}

TEST(CommandWriter, WritesWhatTheReaderReads) {
  for (std::string const commands :
       {"<NoteOff Note=\"1\" Velocity=\"2\"/><NoteOn Note=\"1\" Velocity=\"2\"/>"
        "<PolyKeyPressure Note=\"5\" Pressure=\"6\"/><ControlChange Control=\"7\" Value=\"8\"/>"
        "<ProgramChange Number=\"9\"/><ChannelKeyPressure Pressure=\"10\"/>"
        "<PitchBendChange Value=\"11\"/>",
        "<AllSoundOff/><ResetAllControllers/><LocalControl Value=\"on\"/>"
        "<LocalControl Value=\"off\"/><AllNotesOff/><OmniOff/><OmniOn/><MonoMode/><PolyMode/>",
        "<SysEx>F0 7E <SysExDeviceID Offset=\"00\" Multiplier=\"01\"/> 09 <SysExChannel "
        "Offset=\"1F\" Multiplier=\"02\"/> F7</SysEx><MIDIDelay Milliseconds=\"100\"/>"
        "<NoteOn Note=\"0\" Velocity=\"127\"/><MIDIDelay Milliseconds=\"2147483647\"/>"}) {
    EXPECT_EQ(WrittenCommands(commands), commands);
  }
}

TEST(CommandWriter, TakesLocalControlForOnFrom64) {
  EXPECT_EQ(
      WrittenCommands("<NoteOn Note='1' Velocity='1'/><ControlChange Control='122' Value='64'/>"
                      "<ControlChange Control='122' Value='63'/>"),
      "<NoteOn Note=\"1\" Velocity=\"1\"/><LocalControl Value=\"on\"/>"
      "<LocalControl Value=\"off\"/>");
}

TEST(CommandWriter, WritesModeMessagesWhateverTheirValue) {
  EXPECT_EQ(
      WrittenCommands("<NoteOn Note='1' Velocity='1'/><ControlChange Control='123' Value='9'/>"),
      "<NoteOn Note=\"1\" Velocity=\"1\"/><AllNotesOff/>");
}

class WrittenForTest : public StudioTest {};

TEST_F(WrittenForTest, NamesTheDeviceAndTheNumberOfTheDestination) {
  Device const device = setup.MakeDevice("The Device");
  Entity const entity = setup.MakeEntity(device, "Port", 0, 1);
  Destination const inDevice = entity.GetDestination(0);
  Impl::WrittenFor const forDevice(*Impl::ImplOf(inDevice), "Host");
  EXPECT_EQ(forDevice.deviceName, UString("The Device"));
  EXPECT_EQ(forDevice.uniqueID, inDevice.GetUniqueID());
  EXPECT_EQ(forDevice.author, UString("Host"));
  Destination const port = setup.MakePort("Bare");
  EXPECT_EQ(Impl::WrittenFor(*Impl::ImplOf(port), "").deviceName, UString("Bare"));
}

}  // namespace
}  // namespace Ostinet::Testing
