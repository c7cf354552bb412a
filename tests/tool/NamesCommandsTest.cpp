// SPDX-License-Identifier: MIT
#include <gmock/gmock.h>

#include "RunTool.h"

namespace Ostinet::Tool {
namespace {

using testing::ElementsAre;
using testing::HasSubstr;

class NamesCommands : public ToolTest {
 protected:
  NamesCommands() {
    document = WriteFile("One.midnam", R"(<?xml version="1.0"?><MIDINameDocument><Author/>
 <MasterDeviceNames><Manufacturer></Manufacturer><Model></Model>
  <CustomDeviceMode Name="Normal"><ChannelNameSetAssignments>
   <ChannelNameSetAssign Channel="1" NameSet="Main"/></ChannelNameSetAssignments></CustomDeviceMode>
  <CustomDeviceMode Name="Multi"><DeviceModeEnable><MIDICommands><SysEx>F0 7D 01 F7</SysEx>
   </MIDICommands></DeviceModeEnable><ChannelNameSetAssignments/></CustomDeviceMode>
  <ChannelNameSet Name="Main">
   <PatchBank Name="A"><MIDICommands><ControlChange Control="0" Value="1"/></MIDICommands>
    <PatchNameList><Patch Number="1" Name="Piano" ProgramChange="5">
     <NoteNameList><NoteGroup Name="Low"><Note Number="36" Name="Kick"/>
      <Note Number="38" Name="Snare"/></NoteGroup></NoteNameList>
     <ControlNameList><Control Type="7bit" Number="74" Name="Cutoff"><Values Min="0" Max="127"
      Units="Hz"/></Control></ControlNameList>
    </Patch></PatchNameList></PatchBank>
   <PatchBank Name="B"><PatchNameList><Patch Number="1" Name="Organ" ProgramChange="6"/>
    </PatchNameList></PatchBank></ChannelNameSet></MasterDeviceNames></MIDINameDocument>)");
  }
  ToolRun Do(std::vector<std::string> const& arguments) { return RunOn(kCabledStudio, arguments); }
  json DoJSON(std::vector<std::string> arguments) {
    arguments.push_back("--json");
    ToolRun const run = Do(arguments);
    EXPECT_EQ(run.exitCode, kDone) << run.err;
    return run.exitCode == kDone ? json::parse(run.out) : json();
  }
  void ChooseDocument() {
    ToolRun const run = Do({"names", "Out 1", "--set", document});
    ASSERT_EQ(run.exitCode, kDone) << run.err;
  }

  std::string document;
};

TEST_F(NamesCommands, AreTheDefaultNamesAtFirst) {
  json const names = DoJSON({"names", "Out 1"});
  EXPECT_EQ(names["destination"], "Out 1");
  EXPECT_EQ(names["names"]["type"], "standard");
  EXPECT_EQ(names["names"]["name"], "Default Names");
  EXPECT_EQ(names["mode"], "Default Names");
  EXPECT_EQ(names["channels"].size(), 16u);
}

TEST_F(NamesCommands, KeepWhatWasChosen) {
  EXPECT_EQ(Do({"names", "Out 1", "--standard", "general"}).exitCode, kDone);
  EXPECT_EQ(DoJSON({"names", "Out 1"})["names"]["name"], "General MIDI");
  EXPECT_EQ(DoJSON({"banks", "Out 1"})["banks"][0]["patchCount"], 8);
}

TEST_F(NamesCommands, ListModesBanksAndPatchesOfADocument) {
  ChooseDocument();
  json const modes = DoJSON({"modes", "Out 1"})["modes"];
  ASSERT_EQ(modes.size(), 2u);
  EXPECT_EQ(modes[0]["current"], true);
  EXPECT_EQ(modes[0]["channels"][0], "Main");
  EXPECT_EQ(modes[1]["selectableWithMIDI"], true);
  EXPECT_TRUE(modes[1]["channels"][0].is_null());
  json const banks = DoJSON({"patches", "Out 1"})["banks"];
  ASSERT_EQ(banks.size(), 2u);
  EXPECT_EQ(banks[0]["name"], "A");
  EXPECT_EQ(banks[0]["msb"], 1);
  EXPECT_TRUE(banks[0]["lsb"].is_null());
  EXPECT_EQ(banks[0]["patches"][0]["program"], 5);
  EXPECT_EQ(banks[0]["patches"][0]["msb"], 1);
  EXPECT_EQ(DoJSON({"patches", "Out 1", "--bank", "B"})["banks"].size(), 1u);
  EXPECT_THAT(Do({"banks", "Out 1", "-c", "2"}).err, HasSubstr("no names on channel 2"));
}

TEST_F(NamesCommands, ListNotesAndControlsOfAPatch) {
  ChooseDocument();
  json const notes = DoJSON({"notes", "Out 1", "Piano"});
  EXPECT_EQ(notes["notes"][0]["pitch"], 36);
  EXPECT_EQ(notes["groups"].at(0)["name"], "Low");
  EXPECT_THAT(Do({"notes", "Out 1"}).Lines(),
              ElementsAre("36 C2  Kick  (Low)", "38 D2  Snare  (Low)"));
  json const controls = DoJSON({"controls", "Out 1", "Piano"})["controls"];
  EXPECT_EQ(controls[0]["type"], "7bit");
  EXPECT_EQ(controls[0]["max"], 127.0);
  EXPECT_TRUE(controls[0]["default"].is_null());
  EXPECT_THAT(Do({"controls", "Out 1"}).Lines(), ElementsAre("74  Cutoff  (0 to 127 Hz)"));
}

TEST_F(NamesCommands, SelectAPatchByNumberOrName) {
  ChooseDocument();
  json const patch = DoJSON({"select", "Out 1", "1", "org"});
  EXPECT_EQ(patch["name"], "Organ");
  EXPECT_EQ(patch["bank"], "B");
  EXPECT_EQ(DoJSON({"select", "Out 1", "1", "1", "--bank", "A"})["name"], "Piano");
  ToolRun const ambiguous = Do({"select", "Out 1", "1", "1"});
  EXPECT_EQ(ambiguous.exitCode, kFailed);
  EXPECT_THAT(ambiguous.err, HasSubstr("several banks have a patch 1"));
  EXPECT_EQ(DoJSON({"select", "Out 1", "1", "001", "--bank", "B"})["name"], "Organ");
  EXPECT_EQ(Do({"select", "Out 1", "17", "Piano"}).exitCode, kUsage);
  EXPECT_EQ(Do({"select", "Out 1", "1", "Flute"}).exitCode, kFailed);
}

TEST_F(NamesCommands, KeepAMode) {
  ChooseDocument();
  EXPECT_EQ(Do({"mode", "Out 1", "multi"}).exitCode, kDone);
  EXPECT_EQ(DoJSON({"names", "Out 1"})["mode"], "Multi");
}

// Other names have the old mode or not; none is guessed.
TEST_F(NamesCommands, AskForAModeWhereTheStoredOneIsGone) {
  ChooseDocument();
  ASSERT_EQ(Do({"mode", "Out 1", "multi"}).exitCode, kDone);
  ASSERT_EQ(Do({"names", "Out 1", "--standard", "General MIDI"}).exitCode, kDone);
  EXPECT_TRUE(DoJSON({"names", "Out 1"})["mode"].is_null());
  EXPECT_THAT(Do({"banks", "Out 1"}).err, HasSubstr("before a mode is chosen"));
  ASSERT_EQ(Do({"mode", "Out 1", "General"}).exitCode, kDone);
  EXPECT_EQ(Do({"banks", "Out 1"}).exitCode, kDone);
}

TEST_F(NamesCommands, KeepTheNameOfANote) {
  ChooseDocument();
  EXPECT_EQ(Do({"note-name", "Out 1", "Organ", "C4", "Bell"}).exitCode, kDone);
  EXPECT_THAT(Do({"note-name", "Out 1", "Organ", "60"}).Lines(), ElementsAre("Bell"));
  EXPECT_EQ(Do({"note-name", "Out 1", "Organ", "60", "--clear"}).exitCode, kDone);
  EXPECT_EQ(DoJSON({"note-name", "Out 1", "Organ", "60"})["name"], "");
}

TEST_F(NamesCommands, ListTheStandardModesOfTheMachine) {
  json const documents = DoJSON({"names", "list"})["documents"];
  ASSERT_EQ(documents.size(), 2u);
  EXPECT_EQ(documents[0]["type"], "standard");
  EXPECT_TRUE(documents[0]["manufacturer"].is_null());
  EXPECT_EQ(Do({"names", "list", "No such maker", "x"}).exitCode, kFailed);
}

// A model needs no device type to be listed, and a broken document keeps no other from it.
TEST_F(NamesCommands, ListTheDocumentsOfAMakerAndAModel) {
  WriteFile("Broken.midnam", "<MIDINameDocument");
  WriteFile("Two.midnam",
            "<MIDINameDocument><Author/><MasterDeviceNames><Manufacturer>Acme</Manufacturer>"
            "<Model>Two</Model><Model>Three</Model></MasterDeviceNames></MIDINameDocument>");
  WriteFile("More.midnam",
            "<MIDINameDocument><Author/><ExtendingDeviceNames><Manufacturer>Acme</Manufacturer>"
            "<Model>Two</Model><PatchNameList Name='Kits'/></ExtendingDeviceNames>"
            "</MIDINameDocument>");
  auto const list = [this](std::string const& words) {
    return RunShell((IsPOSIX() ? "OSTINET_USER_FOLDER=\"" + PathOf("") + "\" "
                               : "set \"OSTINET_USER_FOLDER=" + PathOf("") + "\"&& ") +
                    "PROGRAM names list --json " + words);
  };
  ToolRun const all = list("");
  EXPECT_EQ(all.exitCode, kDone);
  EXPECT_THAT(all.err, HasSubstr("Broken.midnam\" cannot be read"));
  EXPECT_EQ(json::parse(all.out)["documents"].size(), 6u) << "with One.midnam and two modes";
  json const ofModel = json::parse(list("acme two").out)["documents"];
  ASSERT_EQ(ofModel.size(), 2u);
  EXPECT_EQ(ofModel[0]["type"], "override");
  EXPECT_EQ(ofModel[0]["name"], "Kits");
  EXPECT_EQ(ofModel[1]["type"], "master");
  EXPECT_EQ(ofModel[1]["manufacturer"], "Acme");
  EXPECT_EQ(ofModel[1]["model"], "Two");
  EXPECT_EQ(json::parse(list("acme").out)["documents"].size(), 3u);
  EXPECT_EQ(list("acme four").exitCode, kFailed);
}

TEST_F(NamesCommands, RefuseADocumentForAnotherDevice) {
  std::string const other = WriteFile(
      "Other.midnam",
      "<MIDINameDocument><Author/><MasterDeviceNames><Manufacturer>Acme</Manufacturer>"
      "<Model>Two</Model><CustomDeviceMode Name='M'/></MasterDeviceNames></MIDINameDocument>");
  ToolRun const run = Do({"names", "Out 1", "--set", other});
  EXPECT_EQ(run.exitCode, kFailed);
  EXPECT_EQ(run.out, "");
  EXPECT_THAT(run.err, HasSubstr("has no names for \"Out 1\""));
  EXPECT_EQ(DoJSON({"names", "Out 1"})["names"]["name"], "Default Names");
}

// The studio's file holds no ports that software makes.
TEST_F(NamesCommands, SayWhereNothingWouldBeKept) {
  auto const onSynth = [this](std::vector<std::string> const& arguments) {
    return RunOn(R"({"ports": [{"name": "Soft", "kind": "directmusic-out", "dls": true}]})",
                 arguments);
  };
  EXPECT_EQ(onSynth({"names", "Soft"}).exitCode, kDone);
  EXPECT_EQ(onSynth({"note-name", "Soft", "1", "60"}).exitCode, kDone);
  for (auto const& edit :
       std::vector<std::vector<std::string>>{{"names", "Soft", "--standard", "Default Names"},
                                             {"names", "Soft", "--set", document},
                                             {"note-name", "Soft", "1", "60", "Bell"},
                                             {"note-name", "Soft", "1", "60", "--clear"}}) {
    ToolRun const run = onSynth(edit);
    EXPECT_EQ(run.exitCode, kFailed) << edit[0];
    EXPECT_EQ(run.out, "") << edit[0];
    EXPECT_THAT(run.err, HasSubstr("cannot be kept")) << edit[0];
  }
}

// The numbers of a bank tell it from another of its name.
TEST_F(NamesCommands, TakeABankByItsNumbers) {
  ChooseDocument();
  EXPECT_EQ(DoJSON({"select", "Out 1", "1", "1", "--bank", "1/-"})["name"], "Piano");
  EXPECT_EQ(Do({"select", "Out 1", "1", "1", "--bank", "1/0"}).exitCode, kFailed);
  EXPECT_THAT(Do({"banks", "Out 1"}).Lines(),
              ElementsAre("A  (bank 1/-)  1 patches", "B  1 patches"));
}

TEST_F(NamesCommands, TellWrongUse) {
  EXPECT_EQ(Do({"names"}).exitCode, kUsage);
  EXPECT_EQ(Do({"names", "Out 1", "--set", "a", "--standard", "b"}).exitCode, kUsage);
  EXPECT_THAT(Do({"names", "Out 1", "--set", "nowhere"}).err, HasSubstr("there is no file"));
  EXPECT_EQ(Do({"names", "Out 1", "--standard", "nowhere"}).exitCode, kFailed);
  EXPECT_EQ(Do({"names", "Nobody"}).exitCode, kFailed);
}

}  // namespace
}  // namespace Ostinet::Tool
