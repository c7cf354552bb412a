// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <numeric>
#include <vector>

#include "datapath/MemorySysexStorage.h"
#include "datapath/SysexImpl.h"
#include "ostinet/SysexRef.h"

namespace Ostinet {
namespace {

using Testing::Bytes;
using Testing::BytesOf;
using Sizes = std::vector<std::size_t>;

class SysexEditRefTest : public testing::Test {
 protected:
  static SysexEditRef Make(Bytes const& bytes) { return SysexEditRef(bytes.data(), bytes.size()); }

  // The length in the header, and the used bytes that the system was told.
  void ExpectHeaderOf(SysexRefBase const& ref) {
    unsigned char const* const raw = ref.GetImpl()->Storage().RawBytes();
    EXPECT_EQ(raw[0] | raw[1] << 8, static_cast<int>(ref.size()));
    EXPECT_EQ(session_.Record().usedBytes, (ref.size() + 27) & ~std::size_t{7});
  }

  Testing::SysexSession session_;
};

TEST_F(SysexEditRefTest, ResetsToANewMessage) {
  SysexEditRef edit = Make({1, 2, 3});
  SysexRef const old(edit);
  edit.Reset(5);
  EXPECT_EQ(edit.size(), 5u);
  EXPECT_TRUE(edit != old);
  EXPECT_EQ(BytesOf(old), (Bytes{1, 2, 3}));
  edit.Reset(0);
  EXPECT_TRUE(edit.IsNull());
}

TEST_F(SysexEditRefTest, CopiesFromAnotherReference) {
  SysexRef const other(Make({1, 2, 3}));
  SysexEditRef edit;
  edit.CopyFrom(other);
  EXPECT_TRUE(edit != other);
  EXPECT_EQ(BytesOf(edit), (Bytes{1, 2, 3}));
  edit.CopyFrom(edit);
  EXPECT_EQ(BytesOf(edit), (Bytes{1, 2, 3}));
  edit.CopyFrom(SysexRef());
  EXPECT_TRUE(edit.IsNull());
}

TEST_F(SysexEditRefTest, CopiesToAFinishedMessage) {
  SysexEditRef const edit = Make({1, 2, 3});
  SysexRef const finished = edit.CopyToSysexRef();
  EXPECT_TRUE(finished != edit);
  EXPECT_EQ(BytesOf(finished), (Bytes{1, 2, 3}));
  EXPECT_TRUE(SysexEditRef().CopyToSysexRef().IsNull());
}

TEST_F(SysexEditRefTest, ReleasesItsMessageToTheTarget) {
  SysexEditRef edit = Make({1, 2, 3});
  unsigned char* const bytes = edit.begin();
  SysexRef target;
  edit.ReleaseTo(target);
  EXPECT_TRUE(edit.IsNull());
  EXPECT_EQ(edit.size(), 0u);
  EXPECT_EQ(target.begin(), bytes);
  EXPECT_EQ(session_.Record().made.size(), 1u);
}

TEST_F(SysexEditRefTest, ShrinksAndRegrowsInPlace) {
  SysexEditRef const edit = Make({1, 2, 3, 4});
  edit.resize(2);
  EXPECT_EQ(BytesOf(edit), (Bytes{1, 2}));
  ExpectHeaderOf(edit);
  edit.resize(4);
  EXPECT_EQ(BytesOf(edit), (Bytes{1, 2, 3, 4}));
  ExpectHeaderOf(edit);
  EXPECT_EQ(session_.Record().made, (Sizes{24}));
}

TEST_F(SysexEditRefTest, ResizesToTheExactCapacity) {
  SysexEditRef const edit = Make({1, 2, 3, 4});
  edit.resize(10);
  EXPECT_EQ(edit.size(), 10u);
  EXPECT_EQ(edit.GetImpl()->Capacity(), 10u);
  EXPECT_EQ(Bytes(edit.begin(), edit.begin() + 4), (Bytes{1, 2, 3, 4}));
  ExpectHeaderOf(edit);
  EXPECT_EQ(session_.Record().made, (Sizes{24, 32}));
  EXPECT_EQ(session_.Record().alive, 1u);
}

TEST_F(SysexEditRefTest, MayBecomeEmptyWithoutBecomingNull) {
  SysexEditRef const edit = Make({1, 2});
  edit.resize(0);
  EXPECT_TRUE(edit.empty());
  EXPECT_FALSE(edit.IsNull());
  ExpectHeaderOf(edit);
  edit.insert(edit.begin(), 7);
  EXPECT_EQ(BytesOf(edit), (Bytes{7}));
}

TEST_F(SysexEditRefTest, InsertsInPlaceWhileThereIsRoom) {
  SysexEditRef const edit = Make({1, 2, 3, 4});
  edit.resize(2);
  unsigned char* const place = edit.insert(edit.begin() + 1, 9);
  EXPECT_EQ(place, edit.begin() + 1);
  EXPECT_EQ(BytesOf(edit), (Bytes{1, 9, 2}));
  ExpectHeaderOf(edit);
  EXPECT_EQ(session_.Record().made, (Sizes{24}));
}

TEST_F(SysexEditRefTest, DoublesItsRoomWhenItInserts) {
  SysexEditRef const edit = Make({1, 2, 3});
  unsigned char* const place = edit.insert(edit.begin() + 1, 9);
  EXPECT_EQ(place, edit.begin() + 1);
  EXPECT_EQ(BytesOf(edit), (Bytes{1, 9, 2, 3}));
  EXPECT_EQ(edit.GetImpl()->Capacity(), 6u);
  edit.insert(edit.end(), 9, 8);
  EXPECT_EQ(BytesOf(edit), (Bytes{1, 9, 2, 3, 8, 8, 8, 8, 8, 8, 8, 8, 8}));
  EXPECT_EQ(edit.GetImpl()->Capacity(), 24u);
  ExpectHeaderOf(edit);
}

TEST_F(SysexEditRefTest, InsertsAtBothEnds) {
  SysexEditRef const edit = Make({5});
  edit.insert(edit.begin(), 2, 4);
  edit.insert(edit.end(), 2, 6);
  edit.insert(edit.end(), 0, 7);
  EXPECT_EQ(BytesOf(edit), (Bytes{4, 4, 5, 6, 6}));
}

TEST_F(SysexEditRefTest, BuildsAMessageByteByByte) {
  SysexEditRef const edit = Make({0});
  for (int i = 1; i < 200; ++i) {
    edit.insert(edit.end(), static_cast<unsigned char>(i));
  }
  Bytes expected(200);
  std::iota(expected.begin(), expected.end(), static_cast<unsigned char>(0));
  EXPECT_EQ(BytesOf(edit), expected);
  EXPECT_EQ(session_.Record().made.size(), 9u);  // 1, 2, 4 ... 256
  EXPECT_EQ(session_.Record().alive, 1u);
}

TEST_F(SysexEditRefTest, ErasesOneByteOrARange) {
  SysexEditRef const edit = Make({1, 2, 3, 4, 5, 6});
  EXPECT_EQ(edit.erase(edit.begin() + 1), edit.begin() + 1);
  EXPECT_EQ(BytesOf(edit), (Bytes{1, 3, 4, 5, 6}));
  EXPECT_EQ(edit.erase(edit.begin() + 1, edit.begin() + 3), edit.begin() + 1);
  EXPECT_EQ(BytesOf(edit), (Bytes{1, 5, 6}));
  ExpectHeaderOf(edit);
  EXPECT_EQ(edit.erase(edit.begin(), edit.begin()), edit.begin());
  EXPECT_EQ(edit.size(), 3u);
  edit.erase(edit.begin(), edit.end());
  EXPECT_TRUE(edit.empty());
  EXPECT_FALSE(edit.IsNull());
  ExpectHeaderOf(edit);
}

TEST_F(SysexEditRefTest, ShowsItsChangesToEveryHolder) {
  SysexEditRef const edit = Make({1, 2, 3});
  SysexRef const holder(edit);
  edit.insert(edit.end(), 10, 4);
  EXPECT_EQ(holder.size(), 13u);
  EXPECT_EQ(holder.begin(), edit.begin());
  edit.erase(edit.begin());
  EXPECT_EQ(holder[0], 2);
}

TEST_F(SysexEditRefTest, LeavesTheMessageForPlacesOutsideIt) {
  SysexEditRef const edit = Make({1, 2, 3, 4});
  edit.resize(2);
  unsigned char elsewhere = 0;
  EXPECT_EQ(edit.insert(edit.begin() - 1, 9), edit.end());
  EXPECT_EQ(edit.insert(edit.end() + 1, 9), edit.end());
  edit.insert(&elsewhere, 3, 9);
  EXPECT_EQ(edit.erase(edit.end()), edit.end());
  EXPECT_EQ(edit.erase(nullptr), edit.end());
  EXPECT_EQ(edit.erase(edit.begin(), edit.end() + 1), edit.end());
  EXPECT_EQ(edit.erase(edit.begin() + 1, edit.begin()), edit.end());
  EXPECT_EQ(BytesOf(edit), (Bytes{1, 2}));
}

TEST_F(SysexEditRefTest, DoesNothingOnANullReference) {
  SysexEditRef const edit;
  edit.resize(3);
  unsigned char elsewhere = 0;
  EXPECT_EQ(edit.insert(nullptr, 1), nullptr);
  edit.insert(&elsewhere, 2, 1);
  EXPECT_EQ(edit.erase(nullptr), nullptr);
  EXPECT_EQ(edit.erase(&elsewhere, &elsewhere + 1), nullptr);
  EXPECT_TRUE(edit.IsNull());
}

TEST_F(SysexEditRefTest, KeepsItsMessageWhenGrowingFails) {
  SysexEditRef edit = Make({1, 2, 3});
  auto const failNext = [&] { session_.Record().failAt = 1; };
  failNext();
  EXPECT_THROW(edit.resize(4), VantorError);
  failNext();
  EXPECT_THROW(edit.insert(edit.begin(), 9), VantorError);
  failNext();
  EXPECT_THROW(edit.Reset(2), VantorError);
  failNext();
  EXPECT_THROW(edit.CopyFrom(edit), VantorError);
  EXPECT_THROW(edit.insert(edit.begin(), static_cast<size_t>(-1), 9), VantorError);
  EXPECT_THROW(edit.resize(static_cast<size_t>(-1)), VantorError);
  EXPECT_EQ(BytesOf(edit), (Bytes{1, 2, 3}));
  ExpectHeaderOf(edit);
}

TEST_F(SysexEditRefTest, EditsInPlaceAfterTheSession) {
  SysexEditRef const edit = Make({1, 2, 3, 4});
  session_.SignOut();
  edit.resize(2);
  edit.insert(edit.begin(), 9);
  EXPECT_EQ(BytesOf(edit), (Bytes{9, 1, 2}));
  EXPECT_THROW(edit.resize(5), VantorError);
  EXPECT_EQ(BytesOf(edit), (Bytes{9, 1, 2}));
}

}  // namespace
}  // namespace Ostinet
