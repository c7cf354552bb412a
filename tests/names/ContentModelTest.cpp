// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <sstream>

#include "names/ContentModel.h"

namespace Ostinet::Impl {
namespace {

/// Whether an element of this model may have just these children, given with blanks between.
bool Allows(char const* text, std::string const& children) {
  ContentModel const model(text);
  ContentModel::Walk walk(model);
  std::istringstream stream(children);
  for (std::string child; stream >> child;) {
    if (!walk.Take(child)) {
      return false;
    }
  }
  return walk.IsComplete();
}

TEST(ContentModel, KnowsSequencesAndChoices) {
  EXPECT_TRUE(Allows("a,b", "a b"));
  EXPECT_FALSE(Allows("a,b", "a"));
  EXPECT_FALSE(Allows("a,b", "b a"));
  EXPECT_FALSE(Allows("a,b", "a b b"));
  EXPECT_TRUE(Allows("a|b", "a"));
  EXPECT_TRUE(Allows("a|b", "b"));
  EXPECT_FALSE(Allows("a|b", "a b"));
  EXPECT_FALSE(Allows("a|b", ""));
}

TEST(ContentModel, KnowsHowOften) {
  EXPECT_TRUE(Allows("a?", ""));
  EXPECT_FALSE(Allows("a?", "a a"));
  EXPECT_TRUE(Allows("a*", "a a a"));
  EXPECT_TRUE(Allows("a*", ""));
  EXPECT_TRUE(Allows("a+", "a a"));
  EXPECT_FALSE(Allows("a+", ""));
  EXPECT_TRUE(Allows("(a|b)+", "b a b"));
  EXPECT_TRUE(Allows("(a,b)*", "a b a b"));
  EXPECT_FALSE(Allows("(a,b)*", "a b a"));
  EXPECT_TRUE(Allows("(a?,b*)+", ""));
}

TEST(ContentModel, KnowsGroupsInGroups) {
  char const* const model = "((m,n+)?|d),(x|y)+";
  EXPECT_TRUE(Allows(model, "m n n x y"));
  EXPECT_TRUE(Allows(model, "d y"));
  EXPECT_TRUE(Allows(model, "x"));
  EXPECT_FALSE(Allows(model, "m x"));
  EXPECT_FALSE(Allows(model, "m n d x"));
  EXPECT_FALSE(Allows(model, "d"));
}

TEST(ContentModel, OfNothingAllowsNothing) {
  EXPECT_TRUE(Allows("", ""));
  EXPECT_FALSE(Allows("", "a"));
}

TEST(ContentModel, TellsWhatIsExpected) {
  ContentModel const model("a,(b|c|d)*");
  ContentModel::Walk walk(model);
  EXPECT_EQ(walk.Expected(), "a");
  EXPECT_FALSE(walk.Take("b"));
  EXPECT_EQ(walk.Expected(), "a") << "what may not stand there moves nothing";
  EXPECT_TRUE(walk.Take("a"));
  EXPECT_EQ(walk.Expected(), "b, c or d");
  EXPECT_EQ(ContentModel::Walk(ContentModel("")).Expected(), "");
}

}  // namespace
}  // namespace Ostinet::Impl
