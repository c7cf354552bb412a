// SPDX-License-Identifier: MIT
//
// The records in which plug-ins of the host's engine take their MIDI.
#include <gmock/gmock.h>

#include <limits>
#include <numeric>

#include "platform/PlatformTest.h"
#include "platform/PluginRecords.h"
#include "support/FakePlugin.h"

namespace Ostinet::Testing {
namespace {

using ::testing::Each;

class PluginRecords : public ::testing::Test {
 protected:
  PluginRecords() { OstinetCallbackAPI::gInstance = &callbacks_; }
  ~PluginRecords() override { OstinetCallbackAPI::gInstance = nullptr; }

  static Bytes Counting(std::size_t size) {
    Bytes bytes(size);
    std::iota(bytes.begin(), bytes.end(), static_cast<unsigned char>(1));
    return bytes;
  }
  void SendShort(Bytes const& bytes, TimeStamp const& stamp) {
    SendMIDIPacketToSYNAPDestination({bytes.data(), bytes.size(), stamp}, &end);
  }
  void SendLong(Bytes bytes, TimeStamp const& stamp = kNoTimeStamp) {
    SendSysexToSYNAPDestination(stamp, bytes.data(), static_cast<int>(bytes.size()), &end);
  }
  std::vector<std::size_t> Counts() const {
    std::vector<std::size_t> counts;
    for (PluginRecord const& record : end.records) {
      counts.push_back(record.Count());
    }
    return counts;
  }
  std::vector<int> Kinds() const {
    std::vector<int> kinds;
    for (PluginRecord const& record : end.records) {
      kinds.push_back(record.Kind());
    }
    return kinds;
  }
  Bytes Joined() const {
    Bytes all;
    for (PluginRecord const& record : end.records) {
      Bytes const bytes = record.Bytes();
      all.insert(all.end(), bytes.begin(), bytes.end());
    }
    return all;
  }

  FakePluginEnd end;

 private:
  TestCallbacks callbacks_;
};

TEST_F(PluginRecords, AShortMessageIsOneRecordToTheByte) {
  SendShort({0x90, 60, 100}, TimeStamp(Clocks(1), -2.0));
  ASSERT_EQ(end.records.size(), 1u);
  Bytes expected(270);
  std::fill_n(expected.begin(), 8, static_cast<unsigned char>(0xFF));
  expected[0] = 0xFE;
  expected[10] = 3;
  expected[12] = 2;
  expected[14] = 0x90;
  expected[15] = 60;
  expected[16] = 100;
  EXPECT_EQ(end.records[0].raw, expected);
}

TEST_F(PluginRecords, TheCountTakesTwoBytes) {
  SendShort(Counting(256), kNoTimeStamp);
  EXPECT_EQ(end.records.at(0).raw[10], 0);
  EXPECT_EQ(end.records.at(0).raw[11], 1);
  EXPECT_EQ(end.records.at(0).Bytes(), Counting(256));
}

TEST_F(PluginRecords, AShortMessageIsCutWhereItsRecordEnds) {
  Bytes const bytes = Counting(300);
  SendShort(bytes, kNoTimeStamp);
  EXPECT_THAT(Counts(), ::testing::ElementsAre(256u));
  EXPECT_EQ(end.records[0].Bytes(), Bytes(bytes.begin(), bytes.begin() + 256));
}

TEST_F(PluginRecords, TheSampleCountOfAStampIsTruncated) {
  SendShort({0xF8}, TimeStamp(Clocks(5), 1234.9));
  SendShort({0xF8}, TimeStamp(Clocks(5), -1234.9));
  EXPECT_EQ(end.records.at(0).SampleTime(), 1234);
  EXPECT_EQ(end.records.at(1).SampleTime(), -1234);
}

TEST_F(PluginRecords, AStampWithoutSamplesAsksTheHost) {
  SendShort({0xF8}, At(777));
  EXPECT_EQ(end.records.at(0).SampleTime(), 777);  // as these callbacks count
}

TEST_F(PluginRecords, AStampWithoutATimeHasTheSampleTimeForNone) {
  SendShort({0xF8}, kNoTimeStamp);
  SendLong({0xF0, 0xF7});
  EXPECT_EQ(end.records.at(0).SampleTime(), -100000);
  EXPECT_EQ(end.records.at(1).SampleTime(), -100000);
}

TEST_F(PluginRecords, ASampleCountBeyondAllBoundsGoesToTheLastOneThereIs) {
  double const huge = std::numeric_limits<double>::infinity();
  for (double const samples : {huge, -huge, std::numeric_limits<double>::quiet_NaN()}) {
    SendShort({0xF8}, TimeStamp(Clocks(5), samples));
  }
  EXPECT_EQ(end.records.at(0).SampleTime(), std::numeric_limits<long long>::max());
  EXPECT_EQ(end.records.at(1).SampleTime(), std::numeric_limits<long long>::min());
  EXPECT_EQ(end.records.at(2).SampleTime(), std::numeric_limits<long long>::min());
}

TEST_F(PluginRecords, ALongMessageOf256BytesIsOneRecord) {
  SendLong(Counting(256));
  EXPECT_THAT(Counts(), ::testing::ElementsAre(256u));
  EXPECT_THAT(Kinds(), ::testing::ElementsAre(0));
}

TEST_F(PluginRecords, ALongMessageOf257BytesIsTwoRecords) {
  SendLong(Counting(257));
  EXPECT_THAT(Counts(), ::testing::ElementsAre(256u, 1u));
  EXPECT_THAT(Kinds(), ::testing::ElementsAre(0, 1));
  EXPECT_EQ(Joined(), Counting(257));
}

TEST_F(PluginRecords, AllOfALongMessageGoesInOneCallFromTheStartOfAPage) {
  for (std::size_t const size : {1u, 255u, 1000u, 70000u}) {
    end.records.clear();
    end.sends = 0;
    SendLong(Counting(size), TimeStamp(Clocks(1), 9.0));
    EXPECT_EQ(end.sends, 1) << size;
    EXPECT_EQ(end.pageOffset, 0u) << size;
    EXPECT_EQ(end.records.size(), (size + 255) / 256) << size;
    EXPECT_EQ(Joined(), Counting(size)) << size;
    for (PluginRecord const& record : end.records) {
      EXPECT_EQ(record.SampleTime(), 9) << size;
      EXPECT_TRUE(record.RestIsZero()) << size;
    }
  }
}

TEST_F(PluginRecords, NothingOrLessSendsNothing) {
  unsigned char byte = 0;
  SendSysexToSYNAPDestination(kNoTimeStamp, &byte, 0, &end);
  SendSysexToSYNAPDestination(kNoTimeStamp, &byte, -1, &end);
  SendSysexToSYNAPDestination(kNoTimeStamp, &byte, std::numeric_limits<int>::min(), &end);
  SendSysexToSYNAPDestination(kNoTimeStamp, nullptr, 5, &end);
  SendShort({}, kNoTimeStamp);
  SendMIDIPacketToSYNAPDestination({nullptr, 3, kNoTimeStamp}, &end);
  EXPECT_EQ(end.sends, 0);
}

TEST_F(PluginRecords, NowhereToSendIsNoHarm) {
  unsigned char byte = 0xF8;
  SendMIDIPacketToSYNAPDestination({&byte, 1, kNoTimeStamp}, nullptr);
  SendSysexToSYNAPDestination(kNoTimeStamp, &byte, 1, nullptr);
}

TEST_F(PluginRecords, HoldNoReferenceAndCallNothingElse) {
  SendShort({0xF8}, kNoTimeStamp);
  SendLong(Counting(600));
  EXPECT_EQ(end.references, 0);
  EXPECT_EQ(end.hostOperations + end.flushes, 0);
}

}  // namespace
}  // namespace Ostinet::Testing
