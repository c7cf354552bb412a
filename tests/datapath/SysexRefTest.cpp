// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <limits>
#include <vector>

#include "datapath/MemorySysexStorage.h"
#include "datapath/SysexImpl.h"
#include "ostinet/SysexRef.h"

namespace Ostinet {
namespace {

using Testing::Bytes;
using Testing::BytesOf;

Bytes const kMessage{0xF0, 0x7E, 0x7F, 6, 1, 0xF7};

SysexRef MakeMessage() { return SysexRef(kMessage.data(), kMessage.size()); }

class SysexRefTest : public testing::Test {
 protected:
  Testing::SysexSession session_;
};

using UnsafeSysexRefTest = SysexRefTest;

void ExpectNull(SysexRefBase const& ref) {
  EXPECT_TRUE(ref.IsNull());
  EXPECT_TRUE(ref.empty());
  EXPECT_EQ(ref.size(), 0u);
  EXPECT_EQ(ref.begin(), nullptr);
  EXPECT_EQ(ref.end(), nullptr);
  EXPECT_TRUE(ref.rbegin() == ref.rend());
  EXPECT_EQ(ref.max_size(), std::numeric_limits<size_t>::max());
  EXPECT_TRUE(ref == SysexRefBase::kNullSysexRef);
}

TEST_F(SysexRefTest, IsNullAtFirst) {
  ExpectNull(SysexRefBase::kNullSysexRef);
  ExpectNull(SysexRefBase());
  ExpectNull(SysexRef());
  ExpectNull(SysexEditRef());
  ExpectNull(SysexRef(RCPtrMT<Impl::SysexImpl>()));
  ExpectNull(SysexRef().Copy());
}

TEST_F(SysexRefTest, IsNullForAnEmptyMessage) {
  ExpectNull(SysexRefBase(0));
  ExpectNull(SysexRef(0));
  ExpectNull(SysexEditRef(0));
  ExpectNull(SysexRef(kMessage.data(), 0));
  ExpectNull(SysexEditRef(kMessage.data(), 0));
  EXPECT_TRUE(session_.Record().made.empty());
}

TEST_F(SysexRefTest, HoldsACopyOfTheBytes) {
  Bytes bytes = kMessage;
  SysexRef const ref(bytes.data(), bytes.size());
  bytes[0] = 0;
  EXPECT_EQ(BytesOf(ref), kMessage);
  EXPECT_EQ(ref.size(), 6u);
  EXPECT_FALSE(ref.empty());
  EXPECT_FALSE(ref.IsNull());
  EXPECT_EQ(ref[5], 0xF7);
  EXPECT_EQ(Bytes(ref.rbegin(), ref.rend()), Bytes(kMessage.rbegin(), kMessage.rend()));
  EXPECT_EQ(ref.max_size(), std::numeric_limits<size_t>::max());
}

TEST_F(SysexRefTest, ChecksNoByteOfTheMessage) {
  Bytes const bytes{1, 2, 3};
  EXPECT_EQ(BytesOf(SysexRef(bytes.data(), bytes.size())), bytes);
}

TEST_F(SysexRefTest, MakesRoomForASizeWithoutBytes) {
  SysexRef const ref(7);
  EXPECT_EQ(ref.size(), 7u);
  EXPECT_EQ(SysexRef(nullptr, 9).size(), 9u);
}

TEST_F(SysexRefTest, SharesTheMessageInCopies) {
  SysexRef const ref = MakeMessage();
  SysexRef const copy = ref;
  SysexRefBase base;
  base.AssignTo(ref);
  SysexRefBase other;
  other.AssignTo(ref.GetImpl());
  SysexRef assigned;
  assigned = ref;
  SysexRef const fromImpl(ref.GetImpl());
  EXPECT_TRUE(copy == ref);
  EXPECT_TRUE(base == ref);
  EXPECT_TRUE(other == ref);
  EXPECT_TRUE(assigned == ref);
  EXPECT_TRUE(fromImpl == ref);
  EXPECT_TRUE(SysexRef(base) == ref);
  copy[0] = 1;
  EXPECT_EQ(ref[0], 1);
  EXPECT_EQ(session_.Record().alive, 1u);
}

TEST_F(SysexRefTest, CopiesIntoAMessageThatIsNotEqual) {
  SysexRef const ref = MakeMessage();
  SysexRef const copy = ref.Copy();
  EXPECT_FALSE(copy == ref);
  EXPECT_TRUE(copy != ref);
  EXPECT_EQ(BytesOf(copy), BytesOf(ref));
}

TEST_F(SysexRefTest, FreesTheMessageWithTheLastReference) {
  {
    SysexRef const ref = MakeMessage();
    SysexRef copy = ref;
    copy = SysexRef();
    EXPECT_EQ(session_.Record().alive, 1u);
  }
  EXPECT_EQ(session_.Record().alive, 0u);
}

TEST_F(SysexRefTest, SurvivesAssignmentToItself) {
  SysexRef ref = MakeMessage();
  SysexRef const& same = ref;
  ref = same;
  ref.AssignTo(same);
  EXPECT_EQ(BytesOf(ref), kMessage);
}

// Hosts wait for false before they touch a message again.
TEST_F(SysexRefTest, IsNeverSending) {
  EXPECT_FALSE(SysexRef().IsSending());
  SysexRef const ref = MakeMessage();
  SysexRef const elsewhere = ref;
  EXPECT_FALSE(ref.IsSending());
}

TEST_F(SysexRefTest, StandsBehindAnEventHeader) {
  SysexRef const ref = MakeMessage();
  unsigned char const* const raw = ref.GetImpl()->Storage().RawBytes();
  EXPECT_EQ(raw + 20, ref.begin());
  EXPECT_EQ(Bytes(raw, raw + 20),
            (Bytes{6, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0}));
}

TEST_F(SysexRefTest, CountsTheHeadersLengthInFourBytes) {
  SysexRef const ref(0x10203);
  unsigned char const* const raw = ref.GetImpl()->Storage().RawBytes();
  EXPECT_EQ(Bytes(raw, raw + 4), (Bytes{3, 2, 1, 0}));
}

TEST_F(SysexRefTest, RoundsTheBufferUpToEight) {
  SysexRef const one(1);
  SysexRef const four(4);
  SysexRef const five(5);
  SysexRef const six(6);
  EXPECT_EQ(session_.Record().made, (std::vector<std::size_t>{24, 24, 32, 32}));
  EXPECT_EQ(session_.Record().usedBytes, 32u);
}

TEST_F(SysexRefTest, FailsWithoutASession) {
  SysexRef const before = MakeMessage();
  session_.SignOut();
  EXPECT_THROW(SysexRef(1), VantorError);
  EXPECT_THROW(MakeMessage(), VantorError);
  EXPECT_THROW(before.Copy(), VantorError);
  ExpectNull(SysexRef(0));
  EXPECT_EQ(BytesOf(before), kMessage);
}

TEST_F(SysexRefTest, FailsWhereTheSessionHasNoRoom) {
  session_.Record().failAt = 1;
  EXPECT_THROW(MakeMessage(), VantorError);
  EXPECT_EQ(BytesOf(MakeMessage()), kMessage);
}

TEST_F(SysexRefTest, FailsForMoreThanTheHeaderCounts) {
  EXPECT_THROW(SysexRef(Impl::SysexImpl::kMaxBytes + 1), VantorError);
  EXPECT_THROW(SysexRef{std::numeric_limits<size_t>::max()}, VantorError);
  EXPECT_TRUE(session_.Record().made.empty());
}

TEST_F(UnsafeSysexRefTest, IsNullAtFirst) {
  UnsafeSysexRef unsafe;
  EXPECT_EQ(unsafe._get_as_void_pointer(), nullptr);
  unsafe.Release();
  ExpectNull(SysexRef(unsafe));
  unsafe.SetTo(SysexRef());
  EXPECT_EQ(unsafe._get_as_void_pointer(), nullptr);
}

TEST_F(UnsafeSysexRefTest, CarriesAMessageThroughAPointer) {
  SysexRef ref = MakeMessage();
  UnsafeSysexRef sent;
  sent.SetTo(ref);
  void* const pointer = sent._get_as_void_pointer();
  ref = SysexRef();
  EXPECT_EQ(session_.Record().alive, 1u);  // SetTo added a count

  UnsafeSysexRef received;
  received._set_from_void_pointer(pointer);
  EXPECT_TRUE(received == sent);
  {
    SysexRef const taken(received);
    EXPECT_EQ(BytesOf(taken), kMessage);
  }
  EXPECT_EQ(session_.Record().alive, 1u);  // the SysexRef gave back its own count alone
  SysexRef kept;
  kept = received;
  received.Release();
  EXPECT_EQ(received._get_as_void_pointer(), nullptr);
  EXPECT_EQ(session_.Record().alive, 1u);
  kept = SysexRef();
  EXPECT_EQ(session_.Record().alive, 0u);
}

TEST_F(UnsafeSysexRefTest, CountsNothingInCopies) {
  SysexRef ref = MakeMessage();
  UnsafeSysexRef const unsafe = [&] {
    UnsafeSysexRef made;
    made._set_from_void_pointer(ref.GetImpl().get());
    return made;
  }();
  UnsafeSysexRef copy;
  copy = unsafe;
  EXPECT_TRUE(copy == unsafe);
  EXPECT_FALSE(copy == UnsafeSysexRef());
  ref = SysexRef();
  EXPECT_EQ(session_.Record().alive, 0u);
}

TEST_F(UnsafeSysexRefTest, KeepsTheCountOfAMessageThatItForgets) {
  SysexRef const first = MakeMessage();
  SysexRef const second = MakeMessage();
  UnsafeSysexRef unsafe;
  unsafe.SetTo(first);
  void* const forgotten = unsafe._get_as_void_pointer();
  unsafe.SetTo(second);
  unsafe.Release();
  // The count added for the first is still owed.
  UnsafeSysexRef owed;
  owed._set_from_void_pointer(forgotten);
  owed.Release();
  EXPECT_EQ(session_.Record().alive, 2u);
  EXPECT_EQ(BytesOf(first), kMessage);
}

}  // namespace
}  // namespace Ostinet
