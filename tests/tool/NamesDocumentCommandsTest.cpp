// SPDX-License-Identifier: MIT
#include <gmock/gmock.h>

#include "RunTool.h"

namespace Ostinet::Tool {
namespace {

using testing::HasSubstr;

constexpr char kDocument[] =
    "<MIDINameDocument><Author>A</Author><MasterDeviceNames>\n"
    "<Manufacturer>Maker</Manufacturer><Model>Model</Model>\n"
    "<CustomDeviceMode Name='M'><DeviceModeEnable><MIDICommands><SysEx>F0 7E <SysExDeviceID/> F7"
    "</SysEx></MIDICommands></DeviceModeEnable><ChannelNameSetAssignments>"
    "<ChannelNameSetAssign Channel='2' "
    "NameSet='S'/></ChannelNameSetAssignments></CustomDeviceMode>\n"
    "<SupportsStandardDeviceMode Name='General MIDI'/>\n"
    "<ChannelNameSet Name='S'><AvailableForChannels><AvailableChannel Channel='1'/>"
    "<AvailableChannel Channel='2'/></AvailableForChannels><NoteNameList Name='N'>"
    "<NoteGroup Name='G'><Note Number='35' Name='Kick'/><Note Number='36' Name='Kick "
    "2'/></NoteGroup>"
    "</NoteNameList><PatchBank Name='B'><MIDICommands><ControlChange Control='32' Value='3'/>"
    "</MIDICommands><PatchNameList Name='L'><Patch Number='A1' Name='Piano' ProgramChange='5'>"
    "<ControlNameList><Control Number='7' Name='Volume'><Values Min='0' Max='127'><ValueNameList>"
    "<Value Number='0' Name='Off'/></ValueNameList></Values></Control></ControlNameList></Patch>"
    "<Patch Number='A2' Name='Bass'/></PatchNameList></PatchBank></ChannelNameSet>\n"
    "</MasterDeviceNames></MIDINameDocument>\n";

class NamesDocumentCommands : public ToolTest {};

TEST_F(NamesDocumentCommands, ShowPrintsTheWholeTree) {
  ToolRun const run = RunBare({"names", "show", WriteFile("a.midnam", kDocument), "--json"});
  ASSERT_EQ(run.exitCode, kDone) << run.err;
  json const notes = json::parse(R"({"name": "N", "notes": [
      {"pitch": 35, "name": "Kick", "group": 1}, {"pitch": 36, "name": "Kick 2", "group": 1}],
      "groups": [{"id": 1, "name": "G", "pitches": [35, 36]}]})");
  json const controls = json::parse(R"({"name": "", "controls": [{"type": "7bit", "number": 7,
      "name": "Volume", "min": 0.0, "max": 127.0, "default": null, "units": "",
      "values": [{"number": 0, "name": "Off"}]}]})");
  json const expected = {
      {"modes",
       {{{"name", "M"},
         {"standard", false},
         {"enable", {"F0 7E 7E F7"}},
         {"disable", json::array()},
         {"channels", json::parse("[null, \"S\", null, null, null, null, null, null, null, null,"
                                  "null, null, null, null, null, null]")}}}},
      {"supportsStandardModes", {"General MIDI"}},
      {"nameSets",
       {{{"name", "S"},
         {"channels", 3},
         {"notes", notes},
         {"controls", nullptr},
         {"banks",
          {{{"name", "B"},
            {"listName", "L"},
            {"msb", nullptr},
            {"lsb", 3},
            {"command", {"B0 20 03"}},
            {"patches",
             {{{"number", "A1"},
               {"name", "Piano"},
               {"program", 5},
               {"msb", nullptr},
               {"lsb", 3},
               {"command", {"C0 05"}},
               {"notes", notes},
               {"controls", controls}},
              {{"number", "A2"},
               {"name", "Bass"},
               {"program", nullptr},
               {"msb", nullptr},
               {"lsb", 3},
               {"command", json::array()},
               {"notes", notes},
               {"controls", nullptr}}}}}}}}}}};
  EXPECT_EQ(json::parse(run.out), expected);
}

TEST_F(NamesDocumentCommands, ShowPrintsTheTreeForPeople) {
  ToolRun const run = RunBare({"names", "show", WriteFile("a.midnam", kDocument)});
  EXPECT_EQ(run.out,
            "Modes\n  M  [2: S]\n  General MIDI  (standard)\nName sets\n  S  (channels 1-2)\n"
            "    L  LSB 3\n      A1 Piano\n      A2 Bass\n");
}

// A patch that hides every default control has a list all the same.
TEST_F(NamesDocumentCommands, ShowTellsAnEmptyListFromNone) {
  std::string const path =
      WriteFile("a.midnam",
                "<MIDINameDocument><Author/><MasterDeviceNames><Manufacturer>M</Manufacturer>"
                "<Model>N</Model><ChannelNameSet Name='S'><ControlNameList Name='C'>"
                "<Control Number='1' Name='c'/></ControlNameList><PatchBank><PatchNameList>"
                "<Patch Number='1' Name='p'><ControlNameList><Control Number='1' Name=''/>"
                "</ControlNameList></Patch></PatchNameList></PatchBank></ChannelNameSet>"
                "<ChannelNameSet Name='T'/></MasterDeviceNames></MIDINameDocument>");
  json const sets = json::parse(RunBare({"names", "show", "--json", path}).out)["nameSets"];
  EXPECT_EQ(sets[0]["banks"][0]["patches"][0]["controls"],
            json::parse(R"({"name": "", "controls": []})"));
  EXPECT_TRUE(sets[1]["controls"].is_null());
}

TEST_F(NamesDocumentCommands, ShowPrintsEmptyListsWithoutAMaster) {
  ToolRun const run = RunBare({"names", "show", "--json",
                               WriteFile("a.midnam",
                                         "<MIDINameDocument><StandardDeviceMode Name='M'/>"
                                         "</MIDINameDocument>")});
  EXPECT_EQ(run.exitCode, kDone);
  EXPECT_EQ(json::parse(run.out), json::parse(R"({"modes": [], "supportsStandardModes": [],
                                                  "nameSets": []})"));
}

TEST_F(NamesDocumentCommands, ShowTellsABrokenAndAMissingDocument) {
  std::string const broken = std::string(kDocument).substr(0, sizeof kDocument - 30);
  ToolRun const run = RunBare({"names", "show", WriteFile("a.midnam", broken), "--json"});
  EXPECT_EQ(run.exitCode, kFailed);
  EXPECT_EQ(json::parse(run.out)["modes"].size(), 1U);
  EXPECT_EQ(RunBare({"names", "show", "missing.midnam"}).exitCode, kFailed);
  EXPECT_EQ(RunBare({"names", "show"}).exitCode, kUsage);
}

TEST_F(NamesDocumentCommands, CheckTellsWhatIsNotStandardAndWhatIsNotRead) {
  std::string const good = WriteFile("good.midnam", kDocument);
  std::string const bad = WriteFile(
      "bad.midnam",
      "<MIDINameDocument><Author/>\n<MasterDeviceNames><Manufacturer/><Model/>\n"
      "<SupportsStandardDeviceMode Name='M'/>\n<NoteNameList>\n<Note Number='1' Name='n'/>"
      "</NoteNameList></MasterDeviceNames></MIDINameDocument>");
  std::string const broken = WriteFile("broken.midnam", "<MIDINameDocument>\n\n<");
  ToolRun const run = RunBare({"names", "check", good, bad, broken, "--json"});
  EXPECT_EQ(run.exitCode, kFailed);
  json const checks = json::parse(run.out);
  ASSERT_EQ(checks.size(), 3U);
  EXPECT_EQ(
      checks[0],
      json({{"file", good}, {"wellFormed", true}, {"valid", true}, {"findings", json::array()}}));
  EXPECT_EQ(checks[1]["valid"], true);
  EXPECT_EQ(checks[1]["findings"], json::parse(R"([{"line": 4, "kind": "passedOver",
                             "text": "NoteNameList is passed over: \"Name\" is missing"}])"));
  EXPECT_EQ(checks[2]["wellFormed"], false);
  EXPECT_EQ(checks[2]["findings"][0]["kind"], "malformed");
  EXPECT_EQ(checks[2]["findings"][0]["line"], 3);
}

TEST_F(NamesDocumentCommands, CheckIsDoneWithGoodDocuments) {
  std::string const good = WriteFile("good.midnam", kDocument);
  ToolRun const run = RunBare({"names", "check", good});
  EXPECT_EQ(run.exitCode, kDone);
  EXPECT_EQ(run.out, good + ": as the standard wants it\n");
  EXPECT_EQ(RunBare({"names", "check"}).exitCode, kUsage);
  ToolRun const missing = RunBare({"names", "check", "missing.midnam"});
  EXPECT_EQ(missing.exitCode, kFailed);
  EXPECT_THAT(missing.out, HasSubstr("missing.midnam: cannot be read"));
}

}  // namespace
}  // namespace Ostinet::Tool
