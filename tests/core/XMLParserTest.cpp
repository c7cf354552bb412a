// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <optional>
#include <string>
#include <vector>

#include "ostinet/core/Error.h"
#include "ostinet/core/XML.h"
#include "support/Printers.h"
#include "support/TemporaryFolder.h"

namespace Ostinet::XMLLib {
namespace {

using Testing::TemporaryFolder;

/// A parser with its document.
class Document {
 public:
  explicit Document(std::string text)
      : text_(std::move(text)), parser_(text_.data(), text_.size()) {}
  Parser* operator->() { return &parser_; }
  Parser& operator*() { return parser_; }

 private:
  std::string const text_;
  Parser parser_;
};

std::vector<std::string> NamesOfChildren(Parser& parser) {
  std::vector<std::string> names;
  while (parser.DownToChild()) {
    names.push_back(parser.CurrentElement().Text());
    parser.UpToParent();
  }
  return names;
}

std::string Attribute(Parser& parser, char const* name) {
  UString value("left over");
  return parser.ReadAttribute(name, value) ? value.string() : "(absent)" + value.string();
}

std::string Repeat(int count, std::string const& text) {
  std::string result;
  for (int i = 0; i < count; ++i) {
    result += text;
  }
  return result;
}

/// The text of the error that a call throws.
template <class Call>
std::string ErrorOf(Call call) {
  try {
    call();
  } catch (VantorError const& error) {
    EXPECT_EQ(error.Domain(), "XML");
    return error.Text();
  }
  return "(none)";
}

TEST(XMLParser, StartsAboveTheRoot) {
  Document document("<Root/>");
  EXPECT_TRUE(document->CurrentElement().empty());
  EXPECT_EQ(Attribute(*document, "a"), "(absent)");
  ASSERT_TRUE(document->DownToChild());
  EXPECT_EQ(document->CurrentElement(), Name("Root"));
  EXPECT_FALSE(document->DownToChild());
  document->UpToParent();
  EXPECT_TRUE(document->CurrentElement().empty());
  EXPECT_FALSE(document->DownToChild());
  document->UpToParent();
  EXPECT_FALSE(document->DownToChild());
}

TEST(XMLParser, ReadsFromAFile) {
  TemporaryFolder const folder;
  Parser parser(folder.Write("a.xml", "<Root a='1'/>"), Parser::Validate(0));
  ASSERT_TRUE(parser.DownToReqChildNounexp("Root"));
  EXPECT_EQ(Attribute(parser, "a"), "1");
}

TEST(XMLParser, ThrowsForAFileThatIsNotThere) {
  TemporaryFolder const folder;
  EXPECT_THROW(Parser(folder.GetFolder().GetFile("missing.xml")), VantorError);
  EXPECT_THROW(Parser{File(folder.GetFolder())}, VantorError);
  EXPECT_THROW(Parser{File()}, VantorError);
}

TEST(XMLParser, GoesOnBehindTheChildLastLeft) {
  Document document("<R><A><x/></A><B/>text<A/></R>");
  document->DownToChild();
  EXPECT_EQ(NamesOfChildren(*document), (std::vector<std::string>{"A", "B", "A"}));
  EXPECT_FALSE(document->DownToChild());
  EXPECT_EQ(document->CurrentElement(), Name("R"));
}

TEST(XMLParser, PassesOverWhatIsUnreadOnTheWayUp) {
  Document document("<R><A><B><C/></B><D/></A><E/></R>");
  document->DownToChild();
  document->DownToChild();
  document->DownToChild();
  EXPECT_EQ(document->CurrentElement(), Name("B"));
  document->UpToParent();
  document->UpToParent();
  ASSERT_TRUE(document->DownToChild());
  EXPECT_EQ(document->CurrentElement(), Name("E"));
}

TEST(XMLParser, FindsChildrenByName) {
  Document document("<R><A n='1'/><B><A n='no'/></B><A n='2'/></R>");
  document->DownToChild();
  ASSERT_TRUE(document->DownToChild("A"));
  EXPECT_EQ(Attribute(*document, "n"), "1");
  document->UpToParent();
  ASSERT_TRUE(document->DownToChildNounexp("A"));
  EXPECT_EQ(Attribute(*document, "n"), "2");
  document->UpToParent();
  EXPECT_FALSE(document->DownToReqChildNounexp("A"));
  EXPECT_EQ(document->CurrentElement(), Name("R"));
}

TEST(XMLParser, ComparesNamesWithTheirCase) {
  Document document("<R><a/></R>");
  document->DownToChild();
  EXPECT_FALSE(document->DownToChild("A"));
}

TEST(XMLParser, LoopsOverRequiredChildren) {
  Document document("<R><A/><B/><A/></R>");
  document->DownToChild();
  bool found = false;
  int count = 0;
  for (; document->DownToReqChildrenNounexp("A", found); document->UpToParent()) {
    ++count;
  }
  EXPECT_EQ(count, 2);
  EXPECT_TRUE(found);
  found = false;
  EXPECT_FALSE(document->DownToReqChildrenNounexp("A", found));
  EXPECT_FALSE(found);
}

TEST(XMLParser, PassesOverTheRestOfAnElementWithoutLeavingIt) {
  Document document("<R><A><B/><C/></A><D/></R>");
  document->DownToChild();
  document->DownToChild();
  document->Nounexp();
  EXPECT_FALSE(document->DownToChild());
  EXPECT_EQ(document->CurrentElement(), Name("A"));
  document->UpToParent();
  EXPECT_TRUE(document->DownToChild("D"));
}

// Elements without names of their own read into one text, and rely on its being cleared.
TEST(XMLParser, ClearsTheTargetOfAnAbsentAttribute) {
  Document document("<R a='1' empty=''/>");
  document->DownToChild();
  UString value;
  EXPECT_TRUE(document->ReadReqAttribute("a", value));
  EXPECT_EQ(value, UString("1"));
  EXPECT_FALSE(document->ReadReqAttribute("b", value));
  EXPECT_EQ(value, UString());
  value = "x";
  EXPECT_TRUE(document->ReadAttribute("empty", value));
  EXPECT_EQ(value, UString());
}

TEST(XMLParser, KeepsTheAttributesOfAParent) {
  Document document("<R a='1'><A a='2'><B/></A></R>");
  document->DownToChild();
  document->DownToChild();
  EXPECT_EQ(Attribute(*document, "a"), "2");
  document->DownToChild();
  EXPECT_EQ(Attribute(*document, "a"), "(absent)");
  document->UpToParent();
  EXPECT_EQ(Attribute(*document, "a"), "2");
  document->UpToParent();
  EXPECT_EQ(Attribute(*document, "a"), "1");
}

TEST(XMLParser, ReadsBooleansByTheirWords) {
  Document document("<R t='true' f='false' other='yes' upper='TRUE'/>");
  document->DownToChild();
  bool value = false;
  EXPECT_TRUE(document->ReadAttribute("t", kBoolAttribute, value));
  EXPECT_TRUE(value);
  EXPECT_TRUE(document->ReadReqAttribute("f", kBoolAttribute, value));
  EXPECT_FALSE(value);
  value = true;
  EXPECT_FALSE(document->ReadAttribute("other", kBoolAttribute, value));
  EXPECT_FALSE(document->ReadAttribute("upper", kBoolAttribute, value));
  EXPECT_FALSE(document->ReadAttribute("absent", kBoolAttribute, value));
  EXPECT_TRUE(value);
}

TEST(XMLParser, ReadsTextAsItStands) {
  Document document("<R> a&amp;b&#233;<![CDATA[<c>]]><!-- no --><?no no?>\r\nd </R>");
  document->DownToChild();
  EXPECT_EQ(document->ReadText(), UString(u" a&b\u00E9<c>\nd "));
  EXPECT_EQ(document->ReadText(), UString());
}

TEST(XMLParser, ReadsTextBetweenChildren) {
  Document document("<SysEx>F0 41 <ID Offset='1'>in</ID> 42<ID/>F7</SysEx>");
  document->DownToChild();
  EXPECT_EQ(document->ReadText(), UString("F0 41 "));
  ASSERT_TRUE(document->DownToChild());
  EXPECT_EQ(Attribute(*document, "Offset"), "1");
  document->UpToParent();
  EXPECT_EQ(document->ReadText(), UString(" 42"));
  ASSERT_TRUE(document->DownToChild());
  document->UpToParent();
  EXPECT_EQ(document->ReadText(), UString("F7"));
  EXPECT_FALSE(document->DownToChild());
}

TEST(XMLParser, TellsTheLineOfTheCurrentElement) {
  Document document("<?xml version='1.0'?>\n<R>\n\n  <A\n a='1'/>\n</R>");
  EXPECT_EQ(document->CurrentLine(), 1);
  document->DownToChild();
  EXPECT_EQ(document->CurrentLine(), 2);
  document->DownToChild();
  EXPECT_EQ(document->CurrentLine(), 4);
  document->UpToParent();
  EXPECT_EQ(document->CurrentLine(), 2);
}

TEST(XMLParser, NamesInANamespaceEqualNoBareOnes) {
  Document document("<R xmlns:n='urn:n'><n:A/><A/><B xmlns='urn:n'/></R>");
  document->DownToChild();
  EXPECT_EQ(NamesOfChildren(*document), (std::vector<std::string>{"urn:n A", "A", "urn:n B"}));
}

TEST(XMLParser, KeepsInstructionsOfTheProlog) {
  Document document(
      "<?xml version='1.0'?><?one first?><!DOCTYPE R><?two temp=\"yes\"?><R><?three x?></R>");
  document->DownToChild();
  EXPECT_FALSE(document->DownToChild());
  UString target;
  UString data;
  ASSERT_TRUE(document->GetProcessingInstruction(target, data));
  EXPECT_EQ(target, UString("one"));
  EXPECT_EQ(data, UString("first"));
  ASSERT_TRUE(document->GetProcessingInstruction(target, data));
  EXPECT_EQ(target, UString("two"));
  EXPECT_EQ(data, UString("temp=\"yes\""));
  EXPECT_FALSE(document->GetProcessingInstruction(target, data));
}

TEST(XMLParser, KeepsInstructionsBehindTheStartWhenAskedTo) {
  Document document("<R><?a 1?><A><?b 2?></A><?c 3?><B/><?d 4?></R><?e 5?>");
  document->CollectProcessingInstructions(true);
  document->DownToChild();
  document->DownToChild();
  document->UpToParent();
  document->DownToChild();
  document->CollectProcessingInstructions(false);
  document->UpToParent();
  document->UpToParent();
  EXPECT_FALSE(document->DownToChild());
  std::string targets;
  UString target;
  UString data;
  while (document->GetProcessingInstruction(target, data)) {
    targets += target.string();
  }
  EXPECT_EQ(targets, "abc");
}

TEST(XMLParser, KeepsAProlongedPrologInBounds) {
  Document document(Repeat(10000, "<?a b?>") + "<R/>");
  EXPECT_TRUE(document->DownToChild());
  UString target;
  UString data;
  int count = 0;
  while (document->GetProcessingInstruction(target, data)) {
    ++count;
  }
  EXPECT_EQ(count, 64);
}

TEST(XMLParser, KeepsWhatWasReadBeforeAFault) {
  Document document("<R a='1'>\n<A a='2'/>\n<B></C>\n<D/></R>");
  ASSERT_TRUE(document->DownToChild());
  ASSERT_TRUE(document->DownToChild());
  EXPECT_EQ(Attribute(*document, "a"), "2");
  document->UpToParent();
  ASSERT_TRUE(document->DownToChild());
  EXPECT_EQ(document->CurrentElement(), Name("B"));
  EXPECT_EQ(ErrorOf([&] { document->UpToParent(); }), "line 3: mismatched tag");
  EXPECT_EQ(ErrorOf([&] { document->DownToChild(); }), "line 3: mismatched tag");
  EXPECT_EQ(ErrorOf([&] { document->ReadText(); }), "line 3: mismatched tag");
  EXPECT_EQ(document->CurrentElement(), Name("B"));
}

// Every place at which a document may break off: no call reads on, none hangs.
TEST(XMLParser, ThrowsAtTheEndOfEveryDocumentThatBreaksOff) {
  std::string const whole =
      "<?xml version='1.0'?><!DOCTYPE R [<!ENTITY e 'x'>]><?p i?><R a='1'><A>t&e;</A><!-- --></R>";
  for (std::size_t length = 0; length < whole.size(); ++length) {
    Document document(whole.substr(0, length));
    EXPECT_NE(ErrorOf([&] {
                while (document->DownToChild()) {
                }
                document->UpToParent();
                document->UpToParent();
                document->Nounexp();
              }),
              "(none)")
        << length;
  }
}

TEST(XMLParser, ThrowsForContentBehindTheRoot) {
  Document document("<R/><S/>");
  ASSERT_TRUE(document->DownToChild());
  document->UpToParent();
  EXPECT_NE(ErrorOf([&] { document->DownToChild(); }), "(none)");
}

TEST(XMLParser, RefusesDeepNesting) {
  Document allowed(Repeat(256, "<a>") + Repeat(256, "</a>"));
  int depth = 0;
  while (allowed->DownToChild()) {
    ++depth;
  }
  EXPECT_EQ(depth, 256);

  Document refused(Repeat(257, "<a>") + Repeat(257, "</a>"));
  for (int i = 0; i < 256; ++i) {
    ASSERT_TRUE(refused->DownToChild());
  }
  EXPECT_EQ(ErrorOf([&] { refused->DownToChild(); }),
            "line 1: elements are nested deeper than 256");
}

TEST(XMLParser, ExpandsNoEntityBomb) {
  std::string text = "<!DOCTYPE R [<!ENTITY e0 '0123456789'>";
  for (int i = 1; i <= 12; ++i) {
    std::string const before = "&e" + std::to_string(i - 1) + ";";
    text += "<!ENTITY e" + std::to_string(i) + " '" + Repeat(10, before) + "'>";
  }
  Document document(text + "]><R>&e12;</R>");
  ASSERT_TRUE(document->DownToChild());
  EXPECT_NE(ErrorOf([&] { document->ReadText(); }), "(none)");
}

TEST(XMLParser, FetchesNothingFromOutside) {
  TemporaryFolder const folder;
  folder.Write("secret.txt", "secret");
  std::string const path = folder.GetFolder().GetFile("secret.txt").GetFullPath().string();
  Document document("<!DOCTYPE R SYSTEM '" + path + "' [<!ENTITY e SYSTEM '" + path +
                    "'>]><R>a&e;b</R>");
  ASSERT_TRUE(document->DownToChild());
  EXPECT_EQ(document->ReadText(), UString("ab"));
}

TEST(XMLParser, ReadsInnerEntitiesOfADocument) {
  Document document("<!DOCTYPE R [<!ENTITY maker 'A &amp; B'>]><R a='&maker;'>&maker;</R>");
  document->DownToChild();
  EXPECT_EQ(Attribute(*document, "a"), "A & B");
  EXPECT_EQ(document->ReadText(), UString("A & B"));
}

struct Encoded {
  char const* declaration;
  char const* byteText;
  char16_t const* text;
};

class XMLParserEncodings : public testing::TestWithParam<Encoded> {};

TEST_P(XMLParserEncodings, AreRead) {
  Encoded const& encoded = GetParam();
  std::string const declaration = encoded.declaration;
  Document document("<?xml version='1.0' encoding='" + declaration + "'?><R>" + encoded.byteText +
                    "</R>");
  ASSERT_TRUE(document->DownToChild());
  EXPECT_EQ(document->ReadText(), UString(encoded.text));
}

INSTANTIATE_TEST_SUITE_P(Declared, XMLParserEncodings,
                         testing::Values(Encoded{"UTF-8", "\xC3\xA9", u"\u00E9"},
                                         Encoded{"ISO-8859-1", "\xE9\x85", u"\u00E9\u0085"},
                                         Encoded{"US-ASCII", "e", u"e"},
                                         Encoded{"Windows-1252", "\xE9\x80\x85",
                                                 u"\u00E9\u20AC\u2026"},
                                         Encoded{"ISO-8859-15", "\xA4", u"\u20AC"},
                                         Encoded{"macintosh", "\x8E\xA5", u"\u00E9\u2022"},
                                         Encoded{"X-Mac-Roman", "\xDE", u"\uFB01"}));

TEST(XMLParser, ReadsUTF16OfBothByteOrders) {
  std::u16string const text = u"\uFEFF<R>\u00E9\U0001D11E</R>";
  std::string little;
  std::string big;
  for (char16_t const unit : text) {
    char const low = static_cast<char>(unit & 0xFF);
    char const high = static_cast<char>(unit >> 8);
    little += {low, high};
    big += {high, low};
  }
  for (std::string const& bytes : {little, big}) {
    Document document(bytes);
    ASSERT_TRUE(document->DownToChild());
    EXPECT_EQ(document->ReadText(), UString(u"\u00E9\U0001D11E"));
  }
}

TEST(XMLParser, ThrowsForAnEncodingThatItDoesNotKnow) {
  Document document("<?xml version='1.0' encoding='EBCDIC-9'?><R/>");
  EXPECT_NE(ErrorOf([&] { document->DownToChild(); }), "(none)");
}

TEST(XMLParser, ThrowsForBytesThatAreNoText) {
  Document document("<R><A>\xFF</A></R>");
  ASSERT_TRUE(document->DownToChild());
  ASSERT_TRUE(document->DownToChild());
  EXPECT_NE(ErrorOf([&] { document->ReadText(); }), "(none)");
}

TEST(XMLParser, ReadsLongDocumentsAndLongTexts) {
  std::string const text = Repeat(100'000, "0123456789");
  TemporaryFolder const folder;
  File const file = folder.Write(
      "long.xml", "<R a='" + text + "'>" + Repeat(50'000, "<A n='1'>x</A>\n") + text + "<B/></R>");
  Parser parser(file);
  ASSERT_TRUE(parser.DownToChild());
  EXPECT_EQ(Attribute(parser, "a").size(), text.size());
  int count = 0;
  for (; parser.DownToChild() && parser.CurrentElement() == Name("A"); parser.UpToParent()) {
    EXPECT_EQ(parser.ReadText(), UString("x"));
    ++count;
  }
  EXPECT_EQ(count, 50'000);
  EXPECT_EQ(parser.CurrentElement(), Name("B"));
  EXPECT_EQ(parser.CurrentLine(), 50'001);
}

TEST(XMLParser, TakesAllTheTextBetweenTwoChildrenAtOnce) {
  std::string const text = Repeat(100'000, "0123456789");
  Document document("<R><A/>" + text + "<B/>" + text + "</R>");
  document->DownToChild();
  ASSERT_TRUE(document->DownToChild());
  document->UpToParent();
  EXPECT_EQ(document->ReadText().length(), text.size());
  ASSERT_TRUE(document->DownToChild());
  document->UpToParent();
  EXPECT_EQ(document->ReadText().string(), text);
}

TEST(XMLParser, ListsTheNamesOfAttributesInTheOrderOfTheDocument) {
  Document document("<R b='1' a='2' c=''><A/></R>");
  EXPECT_TRUE(document->AttributeNames().empty());
  document->DownToChild();
  std::vector<Name> const expected{"b", "a", "c"};
  EXPECT_EQ(document->AttributeNames(), expected);
  document->DownToChild();
  EXPECT_TRUE(document->AttributeNames().empty());
  document->UpToParent();
  EXPECT_EQ(document->AttributeNames(), expected);
}

TEST(XMLParser, KnowsWhitespace) {
  for (unsigned short unit = 0; unit < 0x3100; ++unit) {
    bool const expected = unit == 0x20 || unit == 0x09 || unit == 0x0A || unit == 0x0D;
    EXPECT_EQ(Parser::IsWhitespace(unit), expected) << unit;
  }
}

}  // namespace
}  // namespace Ostinet::XMLLib
