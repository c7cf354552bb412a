// SPDX-License-Identifier: MIT
#include "model/UniqueIDIndex.h"
#include "support/StudioTest.h"

namespace Ostinet::Testing {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;

class PropertyStoreTest : public StudioTest {
 protected:
  TestPeer parent{setup};
  TestPeer peer{setup, &parent};
};

TEST_F(PropertyStoreTest, KeepsAValueOfEachKind) {
  Impl::PropertyDict dict;
  dict.entries["a"] = UString("b");
  EXPECT_TRUE(peer.SetInt("int", -5));
  EXPECT_TRUE(peer.SetString("string", "s"));
  EXPECT_TRUE(peer.SetIntList("list", {1, 2}));
  EXPECT_TRUE(peer.SetDict("dict", dict));
  EXPECT_TRUE(peer.SetFile("file", "/a/b"));
  int number = 0;
  UString text;
  UString path;
  std::vector<int> list;
  Impl::PropertyDict read;
  EXPECT_TRUE(peer.GetInt("int", number));
  EXPECT_TRUE(peer.GetString("string", text));
  EXPECT_TRUE(peer.GetIntList("list", list));
  EXPECT_TRUE(peer.GetDict("dict", read));
  EXPECT_TRUE(peer.GetFile("file", path));
  EXPECT_EQ(number, -5);
  EXPECT_EQ(text, UString("s"));
  EXPECT_THAT(list, ElementsAre(1, 2));
  EXPECT_TRUE(read == dict);
  EXPECT_EQ(path, UString("/a/b"));
}

TEST_F(PropertyStoreTest, AMissingKeyIsAskedOfTheParent) {
  parent.SetString("key", "parent's");
  UString text;
  EXPECT_TRUE(peer.GetString("key", text));
  EXPECT_EQ(text, UString("parent's"));
  EXPECT_FALSE(peer.GetString("other", text));
}

TEST_F(PropertyStoreTest, AValueOfAnotherKindEndsTheSearchAndLeavesTheOutput) {
  parent.SetString("key", "parent's");
  peer.SetInt("key", 1);
  UString text = "as it was";
  EXPECT_FALSE(peer.GetString("key", text));
  EXPECT_EQ(text, UString("as it was"));
  peer.SetFile("key", "/a");
  EXPECT_FALSE(peer.GetString("key", text));
  peer.SetString("key", "/a");
  EXPECT_FALSE(peer.GetFile("key", text));
}

TEST_F(PropertyStoreTest, WritingReplacesTheKind) {
  peer.SetInt("key", 1);
  peer.SetString("key", "now a text");
  int number = 0;
  EXPECT_FALSE(peer.GetInt("key", number));
}

TEST_F(PropertyStoreTest, WritesGoToThePeerItselfOnly) {
  parent.SetInt("key", 1);
  peer.SetInt("key", 2);
  int number = 0;
  EXPECT_TRUE(parent.GetInt("key", number));
  EXPECT_EQ(number, 1);
}

TEST_F(PropertyStoreTest, WritingTheStoredValueAgainIsAChangeToo) {
  peer.SetInt("key", 1);
  peer.SetInt("key", 1);
  EXPECT_THAT(peer.changedKeys, ElementsAre(UString("key"), UString("key")));
}

TEST_F(PropertyStoreTest, RemovingShowsTheParentsValueAndIsAChange) {
  parent.SetInt("key", 1);
  peer.SetInt("key", 2);
  peer.changedKeys.clear();
  peer.RemoveProperty("key");
  int number = 0;
  EXPECT_TRUE(peer.GetInt("key", number));
  EXPECT_EQ(number, 1);
  EXPECT_THAT(peer.changedKeys, ElementsAre(UString("key")));
  peer.RemoveProperty("key");
  EXPECT_EQ(peer.changedKeys.size(), 2U);
}

TEST_F(PropertyStoreTest, AKeyMayBeTheStoresOwn) {
  peer.SetInt("uniqueID", 31);
  UString const& own = peer.OwnProperties().begin()->first;
  peer.SetInt(own, 32);
  EXPECT_FALSE(Impl::IsUniqueIDStored(31));
  EXPECT_TRUE(Impl::IsUniqueIDStored(32));
  peer.changedKeys.clear();
  peer.RemoveProperty(own);
  EXPECT_THAT(peer.changedKeys, ElementsAre(UString("uniqueID")));
  EXPECT_FALSE(Impl::IsUniqueIDStored(32));
}

TEST_F(PropertyStoreTest, TouchingDoesNothing) {
  peer.SetInt("key", 1);
  peer.changedKeys.clear();
  peer.TouchProperty("key");
  EXPECT_THAT(peer.changedKeys, IsEmpty());
}

TEST_F(PropertyStoreTest, AdoptingTakesWhatIsMissingInSilence) {
  TestPeer other(setup);
  other.SetInt("a", 1);
  other.SetInt("b", 2);
  peer.SetInt("a", 10);
  peer.changedKeys.clear();
  peer.AdoptMissingProperties(other);
  int number = 0;
  EXPECT_TRUE(peer.GetInt("a", number));
  EXPECT_EQ(number, 10);
  EXPECT_TRUE(peer.GetInt("b", number));
  EXPECT_EQ(number, 2);
  EXPECT_THAT(peer.changedKeys, IsEmpty());
}

TEST_F(PropertyStoreTest, CopyingTakesAPropertyOrItsAbsenceInSilence) {
  TestPeer other(setup);
  other.SetInt("a", 1);
  peer.SetInt("b", 2);
  peer.changedKeys.clear();
  peer.CopyProperty(other, "a");
  peer.CopyProperty(other, "b");
  EXPECT_TRUE(peer.OwnProperties() == other.OwnProperties());
  EXPECT_THAT(peer.changedKeys, IsEmpty());
}

TEST_F(PropertyStoreTest, AFreshValueIsTheNumber0) {
  Impl::PropertyValue const fresh{};
  EXPECT_TRUE(fresh == Impl::PropertyValue(0));
  EXPECT_EQ(Impl::PropertyValue(UString()).which(), 1);
  EXPECT_EQ(Impl::PropertyValue(std::vector<int>()).which(), 2);
  EXPECT_EQ(Impl::PropertyValue(Impl::PropertyDict()).which(), 3);
  EXPECT_EQ(Impl::PropertyValue(Impl::PropertyPath()).which(), 4);
}

}  // namespace
}  // namespace Ostinet::Testing
