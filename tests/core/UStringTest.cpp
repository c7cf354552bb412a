// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <stdexcept>
#include <string>
#include <unordered_set>

#include "ostinet/core/UString.h"
#include "support/Printers.h"

namespace Ostinet {
namespace {

TEST(UString, IsEmptyByDefault) {
  EXPECT_TRUE(UString().empty());
  EXPECT_EQ(UString(), UString::kEmptyString);
  EXPECT_EQ(UString().length(), 0U);
}

TEST(UString, IsMadeFromEachFormOfText) {
  unsigned short const units[] = {'a', 'b', 'c', 0};
  unsigned char const pascal[] = {3, 'a', 'b', 'c', 'x'};
  UString const abc("abc");
  EXPECT_EQ(UString(units), abc);
  EXPECT_EQ(UString(pascal, UString::kASCII), abc);
  EXPECT_EQ(UString(L"abc"), abc);
  EXPECT_EQ(UString(u"abc"), abc);
  EXPECT_EQ(UString(std::string("abc")), abc);
  EXPECT_EQ(UString(std::u16string(u"abc")), abc);
  EXPECT_EQ(UString('a'), UString("a"));
  EXPECT_EQ(UString(static_cast<unsigned short>(0xE9)), UString(u"\u00E9"));
  EXPECT_EQ(UString(abc, 1, 1), UString("b"));
  EXPECT_EQ(UString(abc, 1), UString("bc"));
}

TEST(UString, TakesNullForAnEmptyText) {
  EXPECT_TRUE(UString(static_cast<char const*>(nullptr)).empty());
  EXPECT_TRUE(UString(static_cast<unsigned short const*>(nullptr)).empty());
  EXPECT_TRUE(UString(static_cast<char16_t const*>(nullptr)).empty());
  EXPECT_TRUE(UString(static_cast<wchar_t const*>(nullptr)).empty());
  EXPECT_TRUE(UString(static_cast<unsigned char const*>(nullptr), UString::kLatin1).empty());
}

TEST(UString, ReadsBytesAsUTF8UnlessToldOtherwise) {
  EXPECT_EQ(UString("\xC3\xA9"), UString(u"\u00E9"));
  EXPECT_EQ(UString("\xC3\xA9", UString::kLatin1), UString(u"\u00C3\u00A9"));
  EXPECT_EQ(UString("a\xE9", UString::kASCII), UString(u"a\uFFFD"));
}

TEST(UString, ReadsCharactersBeyond16BitsAsPairs) {
  UString const clef("\xF0\x9D\x84\x9E");
  EXPECT_EQ(clef.length(), 2U);
  EXPECT_EQ(clef[0], 0xD834);
  EXPECT_EQ(clef[1], 0xDD1E);
  EXPECT_EQ(clef.string(), "\xF0\x9D\x84\x9E");
  EXPECT_EQ(UString(L"\U0001D11E"), clef);
}

struct Malformed {
  char const* bytes;
  char16_t const* units;
};

class UStringMalformed : public testing::TestWithParam<Malformed> {};

TEST_P(UStringMalformed, BecomesReplacementCharacters) {
  EXPECT_EQ(UString(GetParam().bytes), UString(GetParam().units));
}

INSTANTIATE_TEST_SUITE_P(
    Sequences, UStringMalformed,
    testing::Values(Malformed{"\x80", u"\uFFFD"},                      // nothing to follow
                    Malformed{"\xC3", u"\uFFFD"},                      // cut off at the end
                    Malformed{"\xC3z", u"\uFFFDz"},                    // cut off before more
                    Malformed{"\xE2\x82z", u"\uFFFDz"},                // cut off in the third
                    Malformed{"\xC0\xAF", u"\uFFFD\uFFFD"},            // overlong
                    Malformed{"\xE0\x9F\xBF", u"\uFFFD\uFFFD\uFFFD"},  // overlong
                    Malformed{"\xED\xA0\x80", u"\uFFFD\uFFFD\uFFFD"},  // half a pair
                    Malformed{"\xF4\x90\x80\x80", u"\uFFFD\uFFFD\uFFFD\uFFFD"},  // too high
                    Malformed{"\xFF", u"\uFFFD"}));

TEST(UString, WritesHalfAPairAsReplacementCharacter) {
  EXPECT_EQ(UString(u"a\xD834z").string(), "a\xEF\xBF\xBDz");
  EXPECT_EQ(UString(u"\xDD1E").string(), "\xEF\xBF\xBD");
}

TEST(UString, ReplacesOrLeavesOutWhatAnEncodingCannotHold) {
  UString const text(u"a\u00E9\u4E2D\U0001D11Ez");
  EXPECT_EQ(text.string(UString::kLatin1, '?'), "a\xE9??z");
  EXPECT_EQ(text.string(UString::kASCII, '-'), "a---z");
  EXPECT_EQ(text.string(UString::kASCII, '-', true), "az");
}

TEST(UString, ComesBackFromUTF8AsItWas) {
  UString const text(u"\u00E9 \u4E2D \uFFFF \U0010FFFF");
  EXPECT_EQ(UString(text.string()), text);
}

TEST(UString, WritesALengthPrefixedText) {
  unsigned char out[8] = {9, 9, 9, 9, 9, 9, 9, 9};
  EXPECT_EQ(UString(u"ab\u4E2D").pstring(out, 7, UString::kLatin1, '?'), out);
  EXPECT_EQ(out[0], 3);
  EXPECT_EQ(out[3], '?');
  EXPECT_EQ(out[4], 9);
}

TEST(UString, CutsALengthPrefixedTextBetweenCharacters) {
  unsigned char out[256];
  UString(u"a\u4E2D").pstring(out, 3, UString::kUTF8);
  EXPECT_EQ(out[0], 1);
  UString(u"abc").pstring(out, 0);
  EXPECT_EQ(out[0], 0);
  UString(u"abc").pstring(out, -1);
  EXPECT_EQ(out[0], 0);
  UString text;
  text.append(300, u'x');
  text.pstring(out, 300);
  EXPECT_EQ(out[0], 255);
}

TEST(UString, FindsTextsAndUnits) {
  UString const text("abcabc");
  EXPECT_EQ(text.find("bc"), 1U);
  EXPECT_EQ(text.find("bc", 2), 4U);
  EXPECT_EQ(text.find(u'c'), 2U);
  EXPECT_EQ(text.rfind("bc"), 4U);
  EXPECT_EQ(text.rfind(u'a', 2), 0U);
  EXPECT_EQ(text.find_first_of("xc"), 2U);
  EXPECT_TRUE(text.starts_with("ab"));
  EXPECT_FALSE(text.starts_with("abcabcd"));
  EXPECT_TRUE(text.ends_with("bc"));
  EXPECT_FALSE(text.ends_with("xabcabc"));
}

TEST(UString, GivesTheLargestSizeForAFailedSearch) {
  UString const text("abc");
  EXPECT_EQ(text.find("x"), UString::npos);
  EXPECT_EQ(text.rfind("x"), UString::npos);
  EXPECT_EQ(text.find_first_of("xyz"), UString::npos);
  EXPECT_EQ(UString::npos, static_cast<std::size_t>(-1));
}

TEST(UString, IsEdited) {
  UString text("ab");
  text += "cd";
  text += u'e';
  EXPECT_EQ(text.append("xyz", 1, 1), UString("abcdey"));
  EXPECT_EQ(text.assign("hello", 1, 3), UString("ell"));
  text.resize(5, u'-');
  EXPECT_EQ(text, UString("ell--"));
  text[0] = u'E';
  EXPECT_EQ(text.erase(3), UString("Ell"));
  text.clear();
  EXPECT_TRUE(text.empty());
}

TEST(UString, AppendsItself) {
  UString text("ab");
  EXPECT_EQ(text.append(text), UString("abab"));
}

TEST(UString, ThrowsForAPositionBehindTheEnd) {
  UString const text("abc");
  EXPECT_THROW(text.at(3), std::out_of_range);
  EXPECT_THROW(text.substr(4), std::out_of_range);
  EXPECT_EQ(text.substr(3), UString());
}

TEST(UString, IsWalkedBothWays) {
  UString const text("abc");
  EXPECT_EQ(std::u16string(text.begin(), text.end()), u"abc");
  EXPECT_EQ(std::u16string(text.rbegin(), text.rend()), u"cba");
}

TEST(UString, SortsByCodeUnitNotByCharacter) {
  EXPECT_LT(UString("B"), UString("a"));
  EXPECT_LT(UString("a"), UString("aa"));
  // A pair starts with a unit below this one, though its character is higher.
  EXPECT_LT(UString(u"\U0001D11E"), UString(u"\uFF01"));
  EXPECT_NE(UString("a"), UString("b"));
}

TEST(UString, HashesByContent) {
  std::unordered_set<UString> texts{UString("a"), UString("b"), UString(u"a")};
  EXPECT_EQ(texts.size(), 2U);
}

TEST(UString, JoinsTextsAndLiterals) {
  UString const name("Port");
  EXPECT_EQ(name + " " + "1", UString("Port 1"));
  EXPECT_EQ("Old " + name, UString("Old Port"));
}

}  // namespace
}  // namespace Ostinet
