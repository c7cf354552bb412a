// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <stdexcept>
#include <string>

#include "ostinet/core/Error.h"
#include "ostinet/core/XML.h"
#include "support/Printers.h"
#include "support/TemporaryFolder.h"

namespace Ostinet::XMLLib {
namespace {

constexpr char kDeclaration[] = "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n";

class XMLWriter : public testing::Test {
 protected:
  File GetFile() const { return folder_.GetFolder().GetFile("a.xml"); }
  /// What the file holds behind the XML declaration.
  std::string Body() const {
    std::string const text = folder_.Read("a.xml");
    EXPECT_EQ(text.substr(0, sizeof kDeclaration - 1), kDeclaration);
    return text.substr(std::min(text.size(), sizeof kDeclaration - 1));
  }
  /// What comes back of a text, as content and as an attribute.
  std::pair<UString, UString> RoundTrip(UString const& text) const {
    {
      Writer writer(GetFile());
      writer.StartElement("R");
      writer.Attribute("a", text);
      writer.Write(text);
    }
    Parser parser(GetFile());
    EXPECT_TRUE(parser.DownToChild());
    std::pair<UString, UString> result;
    EXPECT_TRUE(parser.ReadAttribute("a", result.second));
    result.first = parser.ReadText();
    return result;
  }

  Testing::TemporaryFolder const folder_;
};

TEST_F(XMLWriter, WritesEachElementOnALineOfItsOwn) {
  {
    Writer writer(GetFile(), Name(), UString(), UString());
    writer.StartElement("Ostinet");
    writer.StartElement("Source");
    writer.Attribute("direct", kBoolAttribute, true);
    writer.Attribute("software", kBoolAttribute, false);
    writer.Element("String", "text");
    writer.Element("Empty");
    writer.Element("Empty", "");
    writer.Element("Path", "type", "Absolute");
    writer.EndElement();
    writer.EndElement();
  }
  EXPECT_EQ(Body(),
            "<Ostinet>\n"
            "  <Source direct=\"true\" software=\"false\">\n"
            "    <String>text</String>\n"
            "    <Empty/>\n"
            "    <Empty/>\n"
            "    <Path type=\"Absolute\"/>\n"
            "  </Source>\n"
            "</Ostinet>\n");
}

TEST_F(XMLWriter, WritesADoctypeAndInstructionsInFrontOfTheRoot) {
  {
    Writer writer(GetFile(), "MIDINameDocument", "-//Public//Name", "http://system/name.dtd");
    writer.ProcessingInstruction("com_vantor_LM", "temp=\"yes\"");
    writer.StartElement("MIDINameDocument");
  }
  EXPECT_EQ(Body(),
            "<!DOCTYPE MIDINameDocument PUBLIC \"-//Public//Name\" \"http://system/name.dtd\">\n"
            "<?com_vantor_LM temp=\"yes\"?>\n"
            "<MIDINameDocument/>\n");
}

TEST_F(XMLWriter, WritesADoctypeWithoutAPublicIdentifier) {
  {
    Writer writer(GetFile(), "R", UString(), "a\"b");
    writer.StartElement("R");
  }
  EXPECT_EQ(Body(), "<!DOCTYPE R SYSTEM \"a%22b\">\n<R/>\n");
}

TEST_F(XMLWriter, KeepsTextOnItsLine) {
  {
    Writer writer(GetFile());
    writer.StartElement("R");
    writer.StartElement("SysEx");
    writer.SetMode(Writer::Mode(1));
    writer.StartElement("SysExDeviceID");
    writer.Attribute("Offset", "00");
    writer.EndElement();
    writer.Write("F0 ");
    writer.Element("SysExChannel");
    writer.Write(" F7");
    writer.ResetMode();
    writer.EndElement();
    writer.Element("Next");
  }
  EXPECT_EQ(Body(),
            "<R>\n"
            "  <SysEx><SysExDeviceID Offset=\"00\"/>F0 <SysExChannel/> F7</SysEx>\n"
            "  <Next/>\n"
            "</R>\n");
}

TEST_F(XMLWriter, RestoresTheLayoutStepByStep) {
  {
    Writer writer(GetFile());
    writer.StartElement("R");
    writer.StartElement("A");
    writer.SetMode(Writer::kOnOneLine);
    writer.SetMode(Writer::kIndented);
    writer.ResetMode();
    writer.Element("x");
    writer.ResetMode();
    writer.ResetMode();
    writer.EndElement();
    writer.Element("B");
  }
  EXPECT_EQ(Body(), "<R>\n  <A><x/></A>\n  <B/>\n</R>\n");
}

TEST_F(XMLWriter, AddsNothingBesideText) {
  {
    Writer writer(GetFile());
    writer.StartElement("R");
    writer.Write("a");
    writer.Element("B");
    writer.Write("c");
  }
  EXPECT_EQ(Body(), "<R>a<B/>c</R>\n");
}

TEST_F(XMLWriter, BringsBackEveryTextThatXMLCanHold) {
  for (char16_t const* const text :
       {u"<a href=\"x\">&amp;</a>", u" \t\n\r\n two  words ", u"'\"", u"]]>", u"-->",
        u"\u00E9\u4E2D\U0001D11E\U0010FFFF", u"\u0085\u2028\u007F", u"\n", u" "}) {
    auto const [content, attribute] = RoundTrip(text);
    EXPECT_EQ(content, UString(text));
    EXPECT_EQ(attribute, UString(text));
  }
}

TEST_F(XMLWriter, LeavesOutWhatXMLCannotHold) {
  UString text;
  for (char16_t unit = 0; unit < 0x21; ++unit) {
    text.push_back(unit);
  }
  text += UString(u"\uFFFE\uFFFF\xD800z");
  auto const [content, attribute] = RoundTrip(text);
  EXPECT_EQ(content, UString(u"\t\n\r \uFFFDz"));
  EXPECT_EQ(attribute, UString(u"\t\n\r \uFFFDz"));
}

TEST_F(XMLWriter, LetsNoInstructionEndTooSoon) {
  {
    Writer writer(GetFile());
    writer.StartElement("R");
    writer.ProcessingInstruction("p", "a?>?>b&c");
  }
  Parser parser(GetFile());
  parser.CollectProcessingInstructions(true);
  ASSERT_TRUE(parser.DownToChild());
  EXPECT_FALSE(parser.DownToChild());
  UString target;
  UString data;
  ASSERT_TRUE(parser.GetProcessingInstruction(target, data));
  EXPECT_EQ(data, UString("a? >? >b&c"));
}

TEST_F(XMLWriter, EndsWhatIsOpenWhenItCloses) {
  Writer writer(GetFile());
  writer.StartElement("R");
  writer.StartElement("A");
  writer.Close();
  EXPECT_EQ(Body(), "<R>\n  <A/>\n</R>\n");
  EXPECT_NO_THROW(writer.Close());
}

TEST_F(XMLWriter, PassesOverAnEndWithoutAStart) {
  {
    Writer writer(GetFile());
    writer.EndElement();
    writer.Write("no place for text");
    writer.StartElement("R");
  }
  EXPECT_EQ(Body(), "<R/>\n");
}

TEST_F(XMLWriter, ThrowsForAnAttributeBehindContent) {
  Writer writer(GetFile());
  writer.StartElement("R");
  writer.Write("x");
  EXPECT_THROW(writer.Attribute("a", "1"), VantorError);
}

// What is written deeper could not be read back.
TEST_F(XMLWriter, RefusesDeepNesting) {
  Writer writer(GetFile());
  for (int i = 0; i < Parser::kMaxDepth; ++i) {
    writer.StartElement("a");
  }
  EXPECT_THROW(writer.StartElement("a"), VantorError);
}

TEST_F(XMLWriter, KeepsTheOldFileUntilItCloses) {
  folder_.Write("a.xml", "<Old/>");
  Writer writer(GetFile());
  writer.StartElement("New");
  EXPECT_EQ(folder_.Read("a.xml"), "<Old/>");
  writer.Close();
  EXPECT_EQ(Body(), "<New/>\n");
  EXPECT_EQ(folder_.CountEntries(), 1U);
}

TEST_F(XMLWriter, KeepsTheOldFileWhenAnExceptionTakesItDown) {
  folder_.Write("a.xml", "<Old/>");
  auto const breakOff = [this] {
    Writer writer(GetFile());
    writer.StartElement("New");
    throw std::runtime_error("no more");
  };
  EXPECT_THROW(breakOff(), std::runtime_error);
  EXPECT_EQ(folder_.Read("a.xml"), "<Old/>");
  EXPECT_EQ(folder_.CountEntries(), 1U);
}

TEST_F(XMLWriter, ThrowsWhereNoFileCanBe) {
  EXPECT_THROW(Writer(folder_.GetFolder().GetSubFolder("missing").GetFile("a.xml")), VantorError);
}

}  // namespace
}  // namespace Ostinet::XMLLib
