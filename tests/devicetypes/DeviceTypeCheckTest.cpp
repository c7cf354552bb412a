// SPDX-License-Identifier: MIT
#include "devicetypes/TypeFolders.h"

namespace Ostinet::Testing {
namespace {

using ::testing::ElementsAre;
using ::testing::HasSubstr;
using ::testing::IsEmpty;
using ::testing::StartsWith;

class CheckingTypes : public TypeFolders {
 protected:
  DeviceTypeFileCheck Check(std::string const& text) const {
    return CheckDeviceTypeFile(Write("elsewhere/mine.middev", text));
  }
  /// "3: text", one for each note. The element stands on line 3 of the file.
  std::vector<std::string> Notes(std::string const& text) const {
    std::vector<std::string> notes;
    for (DeviceTypeFileNote const& note : Check(text).notes) {
      notes.push_back(std::to_string(note.line) + ": " + note.text.string());
    }
    return notes;
  }
  std::vector<std::string> NotesInType(std::string const& content) const {
    return Notes("<MIDIDeviceTypes>\n<MIDIDeviceType Manufacturer='Acme' Model='Synth'>\n" +
                 content + "\n</MIDIDeviceType></MIDIDeviceTypes>");
  }
};

TEST_F(CheckingTypes, AGoodFileHasNoNotes) {
  DeviceTypeFileCheck const check = Check(
      TypesFile(TypeElement("Acme", "Synth",
                            "<InquiryResponse Manufacturer='41' Family='00 01' Member='00 02'/>"
                            "<DeviceID Default='1' Min='1' Max='16' Base='1'/>"
                            "<MIDIPortGroup Name='A'><MIDIIn Name='I'/><MIDIOut/></MIDIPortGroup>"
                            "<Receives MaxChannels='16' Notes='true'/><Transmits MTC='false'/>",
                            "CanRoute='true'") +
                    TypeElement("Acme", "Other"),
                "Somebody"));
  EXPECT_THAT(check.notes, IsEmpty());
  EXPECT_EQ(check.author, UString("Somebody"));
  ASSERT_EQ(check.types.size(), 2U);
  EXPECT_EQ(check.types[1].GetModelName(), UString("Other"));
}

TEST_F(CheckingTypes, TellsUnknownElementsAndAttributesWithTheirLines) {
  EXPECT_THAT(NotesInType("<Receive/>\n<MIDIPortGroup name='A'>\n<MIDIThru/></MIDIPortGroup>"),
              ElementsAre("3: nothing is known of \"Receive\" inside \"MIDIDeviceType\": it is "
                          "skipped",
                          "4: \"MIDIPortGroup\" knows no attribute \"name\": it is skipped",
                          "5: nothing is known of \"MIDIThru\" inside \"MIDIPortGroup\": it is "
                          "skipped"));
  EXPECT_THAT(Notes("<MIDIDeviceTypes version='1'>\n<Autor/></MIDIDeviceTypes>"),
              ElementsAre(StartsWith("1: \"MIDIDeviceTypes\" knows no attribute \"version\""),
                          StartsWith("2: nothing is known of \"Autor\"")));
}

TEST_F(CheckingTypes, TellsThatNoAttributeStatesTheClock) {
  EXPECT_THAT(NotesInType("<Receives Clock='true'/><Transmits PanDisruptsStereo='true'/>"),
              ElementsAre(StartsWith("3: \"Receives\" knows no attribute \"Clock\""),
                          StartsWith("3: \"Transmits\" knows no attribute \"PanDisrupts")));
}

TEST_F(CheckingTypes, TellsValuesThatAreSkipped) {
  EXPECT_THAT(NotesInType("<Receives MaxChannels='17' Notes='yes'/>"),
              ElementsAre("3: \"MaxChannels\" is no number from 0 to 16: it is skipped",
                          "3: \"Notes\" is neither \"true\" nor \"false\": it is skipped"));
  EXPECT_THAT(NotesInType("<DeviceID Default='1' Min='1' Max='300' Base='1'/>"),
              ElementsAre("3: \"Max\" is no number from 0 to 255: the \"DeviceID\" is skipped"));
  EXPECT_THAT(NotesInType("<InquiryResponse Manufacturer='4a' Family='00 01' Member='00 02'/>"),
              ElementsAre(HasSubstr("\"Manufacturer\" is not one byte or three")));
  EXPECT_THAT(NotesInType("<InquiryResponse Manufacturer='41' Family='00 01' Member='00'/>"),
              ElementsAre(HasSubstr("\"Member\" is not two bytes")));
}

TEST_F(CheckingTypes, TellsWhatAnEarlierOneKeepsOut) {
  std::string const inquiry = "<InquiryResponse Manufacturer='41' Family='0001' Member='0002'/>\n";
  std::string const id = "<DeviceID Default='1' Min='1' Max='16' Base='1'/>\n";
  EXPECT_THAT(NotesInType(inquiry + inquiry + id + id),
              ElementsAre(StartsWith("4: the type has an \"InquiryResponse\" already"),
                          StartsWith("6: the type has a \"DeviceID\" already")));
}

TEST_F(CheckingTypes, TellsASecondTypeOfOneModel) {
  DeviceTypeFileCheck const check =
      Check("<MIDIDeviceTypes>" + TypeElement("Acme", "Synth") + "\n" +
            TypeElement("acme", "SYNTH") + "</MIDIDeviceTypes>");
  ASSERT_EQ(check.notes.size(), 1U);
  EXPECT_EQ(check.notes[0].line, 2);
  EXPECT_EQ(check.notes[0].text,
            UString("\"acme\" \"SYNTH\" stands above already: this one is skipped"));
  EXPECT_EQ(check.types.size(), 1U);
}

TEST_F(CheckingTypes, TellsATypeWithoutMakerOrModel) {
  EXPECT_THAT(Notes("<MIDIDeviceTypes>\n<MIDIDeviceType Model='A'/>\n<MIDIDeviceType "
                    "Manufacturer='Acme'/></MIDIDeviceTypes>"),
              ElementsAre("2: a type without \"Manufacturer\" is skipped with all that is in it",
                          "3: a type without \"Model\" is skipped with all that is in it"));
}

TEST_F(CheckingTypes, TellsNamesOfInputsThatNewDevicesDoNotGet) {
  std::string const some = "<MIDIPortGroup><MIDIIn Name='A'/><MIDIIn/></MIDIPortGroup>";
  std::string const none = "<MIDIPortGroup><MIDIIn/><MIDIIn/></MIDIPortGroup>";
  EXPECT_THAT(NotesInType(some + some + some + none),
              ElementsAre("2: input 2 of port group 2 has no name: new devices skip those of the "
                          "others, too"));
}

TEST_F(CheckingTypes, TellsAPictureThatIsNotInstalled) {
  std::string const text = TypesFile(TypeElement("Acme", "Synth", "", "Image='synth.png'"));
  EXPECT_THAT(Notes(text), ElementsAre(HasSubstr("the picture \"synth.png\" is not in")));
  Write("system/Images/synth.png", "");
  EXPECT_THAT(Notes(text), IsEmpty());
}

TEST_F(CheckingTypes, TellsWhereTheXMLBreaks) {
  DeviceTypeFileCheck const check =
      Check("<MIDIDeviceTypes>\n" + TypeElement("Acme", "Synth") + "\n<MIDIDeviceType></Oops>");
  ASSERT_EQ(check.notes.size(), 2U);
  EXPECT_EQ(check.notes[1].line, 3);
  EXPECT_THAT(check.notes[1].text.string(), StartsWith("nothing is read from here on: mismatched"));
  EXPECT_EQ(check.types.size(), 1U);
}

TEST_F(CheckingTypes, TellsAWrongRootAndAFileThatIsNotThere) {
  EXPECT_THAT(Notes("<Types/>"), ElementsAre("1: the root element is not \"MIDIDeviceTypes\": "
                                             "nothing is read"));
  DeviceTypeFileCheck const check =
      CheckDeviceTypeFile(File(FileSpecification(PathOf("none.middev"))));
  ASSERT_EQ(check.notes.size(), 1U);
  EXPECT_EQ(check.notes[0].line, 0);
  EXPECT_THAT(check.notes[0].text.string(), StartsWith("the file cannot be read: "));
}

}  // namespace
}  // namespace Ostinet::Testing
