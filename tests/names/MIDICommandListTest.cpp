// SPDX-License-Identifier: MIT
#include <gmock/gmock.h>

#include "names/SmallTree.h"

namespace Ostinet::Testing {
namespace {

using Impl::MIDICommandList;
using Impl::SysexByte;
using ::testing::ElementsAre;
using ::testing::IsEmpty;

constexpr unsigned char kNoDeviceID = 255;

DataBuffer Generate(MIDICommandList const& list, short channel = 0,
                    unsigned char deviceID = kNoDeviceID, TimeStamp stamp = Clocks(1000)) {
  DataBuffer buffer;
  list.GenerateCommands(buffer, stamp, channel, deviceID);
  return buffer;
}

std::vector<unsigned> Numbers(MIDICommandList const& list) {
  return {list.PendingProgram(), list.PendingMSB(), list.PendingLSB()};
}

TEST(MIDICommandList, OfNothingHasNoNumbersAndSendsNothing) {
  MIDICommandList const list;
  EXPECT_TRUE(list.IsEmpty());
  EXPECT_THAT(Numbers(list), ElementsAre(255, 255, 255));
  EXPECT_TRUE(Generate(list).empty());
}

TEST(MIDICommandList, KeepsAProgramChangeAloneAsANumber) {
  MIDICommandList list;
  list.AddTwoBytes(0xC0, 5);
  EXPECT_THAT(Numbers(list), ElementsAre(5, 255, 255));
  EXPECT_THAT(list.Bytes(), IsEmpty());
  EXPECT_FALSE(list.IsEmpty());
  EXPECT_THAT(Packets(Generate(list, 9)), ElementsAre(Bytes{0xC9, 5}));
}

TEST(MIDICommandList, SendsBankSelectBeforeProgramWhateverTheOrderOfItsHalves) {
  MIDICommandList list;
  list.AddThreeBytes(0xB0, 32, 3);
  list.AddThreeBytes(0xB0, 0, 1);
  list.AddTwoBytes(0xC0, 5);
  EXPECT_THAT(Numbers(list), ElementsAre(5, 1, 3));
  EXPECT_THAT(list.Items(), IsEmpty());
  EXPECT_THAT(Packets(Generate(list, 2)),
              ElementsAre(Bytes{0xB2, 0, 1}, Bytes{0xB2, 32, 3}, Bytes{0xC2, 5}));
}

TEST(MIDICommandList, KeepsTheOrderOfADocumentThatChangesTheProgramFirst) {
  MIDICommandList list;
  list.AddTwoBytes(0xC0, 5);
  list.AddThreeBytes(0xB0, 0, 1);
  list.AddThreeBytes(0xB0, 32, 3);
  EXPECT_THAT(Numbers(list), ElementsAre(255, 255, 255));
  EXPECT_THAT(Packets(Generate(list)),
              ElementsAre(Bytes{0xC0, 5}, Bytes{0xB0, 0, 1}, Bytes{0xB0, 32, 3}));
}

TEST(MIDICommandList, HasNoNumbersOnceABankSelectIsRepeated) {
  MIDICommandList list;
  list.AddThreeBytes(0xB0, 32, 3);
  list.AddThreeBytes(0xB0, 0, 1);
  list.AddThreeBytes(0xB0, 0, 2);
  list.AddThreeBytes(0xB0, 32, 4);
  EXPECT_THAT(Numbers(list), ElementsAre(255, 255, 255));
  EXPECT_THAT(Packets(Generate(list)), ElementsAre(Bytes{0xB0, 0, 1}, Bytes{0xB0, 32, 3},
                                                   Bytes{0xB0, 0, 2}, Bytes{0xB0, 32, 4}));
}

TEST(MIDICommandList, HasNoNumbersOnceItHasASecondProgramChange) {
  MIDICommandList list;
  list.AddThreeBytes(0xB0, 0, 1);
  list.AddTwoBytes(0xC0, 5);
  list.AddTwoBytes(0xC0, 6);
  EXPECT_THAT(Numbers(list), ElementsAre(255, 255, 255));
  EXPECT_THAT(Packets(Generate(list)),
              ElementsAre(Bytes{0xB0, 0, 1}, Bytes{0xC0, 5}, Bytes{0xC0, 6}));
}

TEST(MIDICommandList, AnotherMessageMovesTheNumbersIntoTheScript) {
  MIDICommandList list;
  list.AddThreeBytes(0xB0, 0, 1);
  list.AddThreeBytes(0xB0, 7, 100);
  EXPECT_THAT(Numbers(list), ElementsAre(255, 255, 255));
  EXPECT_THAT(Packets(Generate(list, 3)), ElementsAre(Bytes{0xB3, 0, 1}, Bytes{0xB3, 7, 100}));
}

TEST(MIDICommandList, HasNoNumbersBehindADelayOrASysex) {
  MIDICommandList delayed;
  delayed.AddDelay(1);
  delayed.AddTwoBytes(0xC0, 5);
  EXPECT_THAT(Numbers(delayed), ElementsAre(255, 255, 255));
  EXPECT_THAT(Packets(Generate(delayed)), ElementsAre(Bytes{0xC0, 5}));

  MIDICommandList sysex;
  sysex.AddTwoBytes(0xC0, 5);
  sysex.BeginSysex();
  EXPECT_THAT(Numbers(sysex), ElementsAre(255, 255, 255));
}

TEST(MIDICommandList, DelaysWhatFollows) {
  MIDICommandList list;
  list.AddThreeBytes(0xB0, 7, 1);
  list.AddDelay(100);
  list.AddThreeBytes(0xB0, 7, 2);
  list.AddDelay(3);
  list.AddThreeBytes(0xB0, 7, 3);
  unsigned long long const hundred = NanosecondsToMIDITime(100000000).Value();
  EXPECT_THAT(Times(Generate(list)), ElementsAre(1000, 1000 + hundred, 1000 + hundred + 30000));
}

TEST(MIDICommandList, ADelayAloneSendsNothing) {
  MIDICommandList list;
  list.AddDelay(100);
  EXPECT_FALSE(list.IsEmpty());
  EXPECT_TRUE(Generate(list).empty());
}

TEST(MIDICommandList, NumbersCarryTheWholeStampAndScriptsItsClockAlone) {
  TimeStamp const stamp(Clocks(7), 48000.0);
  MIDICommandList numbers;
  numbers.AddThreeBytes(0xB0, 0, 1);
  numbers.AddTwoBytes(0xC0, 5);
  DataBuffer const pending = Generate(numbers, 0, kNoDeviceID, stamp);
  ASSERT_EQ(pending.size(), 2u);
  EXPECT_TRUE(pending[0].stamp.HaveSamps());
  EXPECT_TRUE(pending[1].stamp.HaveSamps());

  MIDICommandList script;
  script.AddThreeBytes(0xB0, 7, 1);
  DataBuffer const written = Generate(script, 0, kNoDeviceID, stamp);
  ASSERT_EQ(written.size(), 1u);
  EXPECT_EQ(written[0].stamp, stamp);
  EXPECT_FALSE(written[0].stamp.HaveSamps());
}

TEST(MIDICommandList, AppendsToWhatIsInTheBuffer) {
  MIDICommandList list;
  list.AddTwoBytes(0xC0, 5);
  DataBuffer buffer = Generate(list);
  list.GenerateCommands(buffer, Clocks(2000), 1, kNoDeviceID);
  EXPECT_THAT(Packets(buffer), ElementsAre(Bytes{0xC0, 5}, Bytes{0xC1, 5}));
  EXPECT_THAT(Times(buffer), ElementsAre(1000, 2000));
}

TEST(MIDICommandList, UsesTheLowByteOfTheChannel) {
  MIDICommandList list;
  list.AddTwoBytes(0xC0, 5);
  EXPECT_THAT(Packets(Generate(list, 0x103)), ElementsAre(Bytes{0xC3, 5}));
}

TEST(MIDICommandList, SendsABendOfOneDataByte) {
  MIDICommandList list;
  list.AddTwoBytes(0xE0, 64);
  EXPECT_THAT(Packets(Generate(list, 1)), ElementsAre(Bytes{0xE1, 64}));
}

MIDICommandList Sysex(SysexByte const& marker) {
  MIDICommandList list;
  list.BeginSysex();
  list.AddSysexByte(0xF0);
  list.AddSysexByte(0x41);
  list.AddSysexMarker(marker.value, marker.offset, marker.multiplier);
  list.AddSysexByte(0xF7);
  return list;
}

TEST(MIDICommandListSysex, PutsTheDeviceIDIn) {
  MIDICommandList const list = Sysex({SysexByte::kDeviceIDMarker, 0, 1});
  EXPECT_EQ(list.Items()[0].length, 4u);
  EXPECT_THAT(Packets(Generate(list, 0, 16)), ElementsAre(Bytes{0xF0, 0x41, 0x10, 0xF7}));
}

TEST(MIDICommandListSysex, PutsTheChannelIn) {
  MIDICommandList const list = Sysex({SysexByte::kChannelMarker, 1, 2});
  EXPECT_THAT(Packets(Generate(list, 3)), ElementsAre(Bytes{0xF0, 0x41, 8, 0xF7}));
}

// Authors count on eight bits that wrap around, and mask to seven bits themselves.
TEST(MIDICommandListSysex, CalculatesInEightBitsWithoutAMask) {
  EXPECT_THAT(Packets(Generate(Sysex({SysexByte::kDeviceIDMarker, 0xF8, 1}), 0, 16)),
              ElementsAre(Bytes{0xF0, 0x41, 0x08, 0xF7}));
  EXPECT_THAT(Packets(Generate(Sysex({SysexByte::kDeviceIDMarker, 0x7F, 1}), 0, 16)),
              ElementsAre(Bytes{0xF0, 0x41, 0x8F, 0xF7}));
  EXPECT_THAT(Packets(Generate(Sysex({SysexByte::kDeviceIDMarker, 0xF8, 0x42}), 0, 16)),
              ElementsAre(Bytes{0xF0, 0x41, 0x10, 0xF7}));
  EXPECT_THAT(Packets(Generate(Sysex({SysexByte::kDeviceIDMarker, 0, 1}), 0, 255)),
              ElementsAre(Bytes{0xF0, 0x41, 0xFF, 0xF7}));
}

TEST(MIDICommandListSysex, IsLongerThanOneMessageAndKeepsItsPlace) {
  MIDICommandList list = Sysex({SysexByte::kDeviceIDMarker, 0, 1});
  list.AddDelay(1);
  list.AddTwoBytes(0xC0, 5);
  EXPECT_THAT(Packets(Generate(list, 2, 16)),
              ElementsAre(Bytes{0xF0, 0x41, 0x10, 0xF7}, Bytes{0xC2, 5}));
}

TEST(MIDICommandListSysex, OfNoBytesIsAnEmptyPacketAmongOthers) {
  MIDICommandList list;
  list.BeginSysex();
  EXPECT_TRUE(Generate(list).empty());
  list.AddTwoBytes(0xC0, 5);
  EXPECT_THAT(Packets(Generate(list)), ElementsAre(IsEmpty(), Bytes{0xC0, 5}));
}

// There is no escape for the two marker bytes, so texts that hold them read their neighbours.
TEST(MIDICommandListSysex, TakesALiteralMarkerByteForAMarker) {
  MIDICommandList list;
  list.BeginSysex();
  for (unsigned char const byte : Bytes{0xF0, 0xFE, 0x01, 0x02, 0xF7}) {
    list.AddSysexByte(byte);
  }
  EXPECT_THAT(Packets(Generate(list, 0, 16)), ElementsAre(Bytes{0xF0, 0x22, 0xF7}));
}

TEST(MIDICommandListSysex, NeverReadsOperandsBehindItsItem) {
  MIDICommandList list;
  list.BeginSysex();
  list.AddSysexByte(0xF0);
  list.AddSysexByte(0xFE);
  list.AddSysexByte(0x01);
  list.AddThreeBytes(0xB0, 7, 100);
  EXPECT_THAT(Packets(Generate(list)), ElementsAre(Bytes{0xF0}, Bytes{0xB0, 7, 100}));

  MIDICommandList last;
  last.BeginSysex();
  last.AddSysexByte(0xFF);
  EXPECT_THAT(Packets(Generate(last)), ElementsAre(IsEmpty()));
}

TEST(MIDICommandWalk, GivesWhatWasRecorded) {
  MIDICommandList list = Sysex({SysexByte::kChannelMarker, 1, 2});
  list.AddThreeBytes(0x90, 60, 100);
  Impl::MIDICommandWalk walk(list);
  ASSERT_TRUE(walk.Next());
  ASSERT_EQ(walk.Item().kind, Impl::MIDICommandItem::kSysex);
  SysexByte byte;
  ASSERT_TRUE(walk.NextSysexByte(byte));
  EXPECT_EQ(byte.value, 0xF0);
  EXPECT_FALSE(byte.IsMarker());
  // The rest of the item is left out.
  ASSERT_TRUE(walk.Next());
  ASSERT_EQ(walk.Item().kind, Impl::MIDICommandItem::kMessage);
  EXPECT_EQ(Bytes(walk.Message(), walk.Message() + walk.Item().length), (Bytes{0x90, 60, 100}));
  EXPECT_FALSE(walk.Next());
}

}  // namespace
}  // namespace Ostinet::Testing
