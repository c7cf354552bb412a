// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <algorithm>
#include <string>
#include <vector>

#include "ostinet/core/UString.h"
#include "support/Printers.h"

namespace Ostinet {
namespace {

constexpr UString::CompareFlags kAllFlags[] = {UString::CompareFlags(0), UString::CompareFlags(1),
                                               UString::CompareFlags(12), UString::CompareFlags(15),
                                               UString::CompareFlags(32)};

TEST(CompareFlags, ZeroComparesCodeUnits) {
  EXPECT_TRUE(UString("a").equal("a", UString::CompareFlags(0)));
  EXPECT_FALSE(UString("a").equal("A", UString::CompareFlags(0)));
  EXPECT_TRUE(UString("B").less("a", UString::CompareFlags(0)));
}

TEST(CompareFlags, OneIgnoresCaseButNotWhiteSpace) {
  auto const flags = UString::CompareFlags(1);
  EXPECT_TRUE(UString(".MidNam").equal(".midnam", flags));
  EXPECT_FALSE(UString(". midnam").equal(".midnam", flags));
  EXPECT_TRUE(UString("a").less("B", flags));
}

TEST(CompareFlags, CatalogKeysIgnoreCaseAndAllWhiteSpace) {
  for (int const value : {12, 15}) {
    auto const flags = UString::CompareFlags(value);
    EXPECT_TRUE(UString(" General  MIDI\t").equal("generalmidi", flags));
    EXPECT_TRUE(UString(u"General\u00A0MIDI\u3000").equal("General MIDI", flags));
    EXPECT_FALSE(UString("General MIDI 2").equal("General MIDI", flags));
    EXPECT_TRUE(UString("General MIDI").less("generalmidi2", flags));
    EXPECT_TRUE(UString(" \t").equal("", flags));
  }
}

TEST(CompareFlags, FoldCaseInEveryScript) {
  auto const flags = UString::CompareFlags(1);
  EXPECT_TRUE(UString(u"\u00C4\u00D6\u00DC").equal(u"\u00E4\u00F6\u00FC", flags));
  EXPECT_TRUE(UString(u"\u0416").equal(u"\u0436", flags));
  EXPECT_TRUE(UString(u"Stra\u00DFe").equal(u"STRASSE", flags));
  EXPECT_TRUE(UString(u"\U00010400").equal(u"\U00010428", flags));
  EXPECT_FALSE(UString(u"\u00E4").equal(u"a", flags));
}

TEST(CompareFlags, PeopleSortNumbersAsNumbers) {
  std::vector<UString> models{"JX-10", "jx-8P", "JX-3P", "jx-100", "JX", "JX-08"};
  std::sort(models.begin(), models.end(),
            [](UString const& a, UString const& b) { return a.less(b, UString::kForPeople); });
  EXPECT_EQ(models, (std::vector<UString>{"JX", "JX-3P", "JX-08", "jx-8P", "JX-10", "jx-100"}));
}

TEST(CompareFlags, PeopleSortTiesByCodeUnit) {
  auto const flags = UString::CompareFlags(32);
  EXPECT_FALSE(UString("dx7").equal("DX7", flags));
  EXPECT_TRUE(UString("DX7").less("dx7", flags));
  EXPECT_TRUE(UString("DX007").less("DX7", flags));
  EXPECT_FALSE(UString("DX7").less("DX007", flags));
  EXPECT_FALSE(UString("DX 7").equal("DX7", flags));
}

TEST(CompareFlags, PeopleSortNumbersOfAnyLength) {
  auto const flags = UString::CompareFlags(32);
  EXPECT_TRUE(UString("99999999999999999999998").less("99999999999999999999999", flags));
  EXPECT_TRUE(UString("9").less("10000000000000000000000", flags));
  EXPECT_TRUE(UString("0").less("1", flags));
}

TEST(CompareFlags, EqualAndLessAgreeForEveryPair) {
  std::vector<UString> const texts{
      "",        " ",    "a",        "A",       "aB",       "Ab",      "a b",
      "1",       "01",   "10",       "9",       "a1",       "a01",     "a1b",
      u"\u00DF", u"ss",  u"SS",      "a-",      "a:",       "a/",      u"\xD800",
      u"\u4E2D", "\t\n", u"\u00A0a", u"\u0130", u"i\u0307", u"\uFF01", u"\U0001D11E"};
  for (auto const flags : kAllFlags) {
    for (UString const& a : texts) {
      for (UString const& b : texts) {
        bool const neitherIsLess = !a.less(b, flags) && !b.less(a, flags);
        EXPECT_EQ(a.equal(b, flags), neitherIsLess)
            << flags << " " << a.string() << " " << b.string();
        EXPECT_FALSE(a.less(b, flags) && b.less(a, flags));
        for (UString const& c : texts) {
          EXPECT_TRUE(!a.less(b, flags) || !b.less(c, flags) || a.less(c, flags));
        }
      }
    }
  }
}

// A text of a catalog is no reason to wait, however long it is.
TEST(CompareFlags, TakeTimeInProportionToTheText) {
  UString blanks;
  blanks.append(4'000'000, u' ');
  UString digits;
  digits.append(4'000'000, u'0');
  EXPECT_TRUE(blanks.equal("", UString::CompareFlags(12)));
  EXPECT_TRUE((digits + "1").less(digits + "2", UString::CompareFlags(32)));
}

}  // namespace
}  // namespace Ostinet
