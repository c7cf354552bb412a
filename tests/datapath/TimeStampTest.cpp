// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include "datapath/TimeBase.h"
#include "ostinet/Setup.h"
#include "ostinet/TimeStamp.h"

namespace Ostinet {
namespace {

class SampleHost : public OstinetCallbackAPI {
 public:
  double GetSampleTime(unsigned long long hostClocks) override {
    ++asked;
    return static_cast<double>(hostClocks) * 2.0;
  }
  Provider<Impl::WinMIDIDevicesListener>* GetDevicesProvider() override { return nullptr; }

  int asked = 0;
};

class TimeStampSamples : public testing::Test {
 protected:
  TimeStampSamples() {
    Impl::SetTimeBaseOffsets({});
    OstinetCallbackAPI::gInstance = &host_;
  }
  ~TimeStampSamples() override {
    OstinetCallbackAPI::gInstance = nullptr;
    Impl::SetTimeBaseOffsets({});
  }

  SampleHost host_;
};

TEST(TimeStamp, IsAllZeroesAtFirst) {
  TimeStamp const stamp;
  EXPECT_EQ(stamp.AsMIDITime().Value(), 0u);
  EXPECT_FALSE(stamp.HaveSamps());
  EXPECT_EQ(kNoTimeStamp.AsMIDITime().Value(), 0u);
}

TEST(TimeStamp, HoldsClocksAndSamples) {
  EXPECT_EQ(TimeStamp(Clocks(7)).AsMIDITime().Value(), 7u);
  EXPECT_FALSE(TimeStamp(Clocks(7)).HaveSamps());
  TimeStamp const stamp(Clocks(7), 44100.5);
  EXPECT_EQ(stamp.AsMIDITime().Value(), 7u);
  EXPECT_TRUE(stamp.HaveSamps());
  EXPECT_EQ(stamp.AsSampleCount(), 44100.5);
}

TEST(TimeStamp, IsMadeFromMIDITimeAndSeconds) {
  EXPECT_EQ(TimeStamp::TimeStampWithMIDITime(7).AsMIDITime().Value(), 7u);
  EXPECT_FALSE(TimeStamp::TimeStampWithMIDITime(7).HaveSamps());
  EXPECT_EQ(TimeStamp::TimeStampWithSeconds(2.5).AsMIDITime().Value(), 25000000u);
  EXPECT_FALSE(TimeStamp::TimeStampWithSeconds(2.5).HaveSamps());
  TimeStamp const stamp = TimeStamp::TimeStampWithSecondsAndSamples(2.5, 8.0);
  EXPECT_EQ(stamp.AsMIDITime().Value(), 25000000u);
  EXPECT_EQ(stamp.AsSampleCount(), 8.0);
}

TEST(TimeStamp, IsMadeByTheFreeFunctionsLikewise) {
  EXPECT_EQ(TimeStampWithMIDITime(7).AsMIDITime().Value(), 7u);
  EXPECT_EQ(TimeStampWithSeconds(2.5).AsMIDITime().Value(), 25000000u);
  TimeStamp const stamp = TimeStampWithSecondsAndSamples(2.5, 8.0);
  EXPECT_EQ(stamp.AsMIDITime().Value(), 25000000u);
  EXPECT_EQ(stamp.AsSampleCount(), 8.0);
}

TEST(TimeStamp, CutsSecondsToWholeClocks) {
  EXPECT_EQ(TimeStampWithSeconds(99e-9).AsMIDITime().Value(), 0u);
  EXPECT_EQ(TimeStampWithSeconds(199e-9).AsMIDITime().Value(), 1u);
}

TEST(TimeStamp, TellsItsTimeInSeconds) {
  EXPECT_EQ(TimeStamp(Clocks(25000000)).AsSeconds().Value(), 2.5);
}

TEST(TimeStamp, ComparesByClocksAlone) {
  EXPECT_TRUE(TimeStamp(Clocks(5), 1.0) == TimeStamp(Clocks(5), 2.0));
  EXPECT_FALSE(TimeStamp(Clocks(5), 1.0) != TimeStamp(Clocks(5)));
  EXPECT_FALSE(TimeStamp(Clocks(5), 1.0) < TimeStamp(Clocks(5), 2.0));
  EXPECT_TRUE(TimeStamp(Clocks(5)) < TimeStamp(Clocks(6)));
  EXPECT_TRUE(TimeStamp(Clocks(5)) != TimeStamp(Clocks(6)));
  EXPECT_TRUE(TimeStamp(Clocks(0), 3.0) == kNoTimeStamp);
}

TEST(TimeStamp, ComparesClocksUnsigned) {
  EXPECT_TRUE(TimeStamp(Clocks(1)) < TimeStamp(Clocks(1ull << 63)));
  EXPECT_FALSE(TimeStamp(Clocks(1ull << 63)) < TimeStamp(Clocks(1)));
}

TEST_F(TimeStampSamples, AreAskedOfTheHostOnce) {
  TimeStamp const stamp(Clocks(21));
  EXPECT_EQ(stamp.AsSampleCount(), 42.0);
  EXPECT_TRUE(stamp.HaveSamps());
  EXPECT_EQ(stamp.AsSampleCount(), 42.0);
  EXPECT_EQ(host_.asked, 1);
}

TEST_F(TimeStampSamples, AreDemandedAnewEachTime) {
  TimeStamp const stamp(Clocks(21), 5.0);
  EXPECT_EQ(stamp.AsSampleCount(), 5.0);
  stamp.DemandSampleTime();
  EXPECT_EQ(stamp.AsSampleCount(), 42.0);
  stamp.DemandSampleTime();
  EXPECT_EQ(host_.asked, 2);
}

TEST_F(TimeStampSamples, AreAskedForInHostClocks) {
  Impl::SetTimeBaseOffsets({0.0, 1000.0});
  EXPECT_EQ(TimeStamp(Clocks(21)).AsSampleCount(), 2042.0);
}

TEST_F(TimeStampSamples, AreAFixedNumberForStampsWithoutATime) {
  EXPECT_EQ(kNoTimeStamp.AsSampleCount(), -100000.0);
  EXPECT_EQ(TimeStamp(Clocks(~0ull)).AsSampleCount(), -100000.0);
  EXPECT_EQ(host_.asked, 0);
  TimeStamp const stamp(Clocks(0), 3.0);
  EXPECT_EQ(stamp.AsSampleCount(), 3.0);
  stamp.DemandSampleTime();
  EXPECT_EQ(stamp.AsSampleCount(), -100000.0);
}

TEST_F(TimeStampSamples, AreThatNumberWithoutAHostToo) {
  OstinetCallbackAPI::gInstance = nullptr;
  TimeStamp const stamp(Clocks(21));
  EXPECT_EQ(stamp.AsSampleCount(), -100000.0);
  EXPECT_TRUE(stamp.HaveSamps());
}

}  // namespace
}  // namespace Ostinet
