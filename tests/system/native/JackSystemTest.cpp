// SPDX-License-Identifier: MIT
//
// The machine's system against a real JACK server that each test starts for itself.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <chrono>
#include <semaphore>
#include <thread>

#include "platform/system/SystemWaits.h"
#include "platform/system/native/JackService.h"
#include "platform/system/native/NativeSystem.h"
#include "support/Latch.h"
#include "system/native/JackPeer.h"
#include "system/native/JackServer.h"
#include "system/native/MidiHost.h"

namespace Ostinet::Testing {
namespace {

using ::testing::Contains;
using ::testing::Each;
using ::testing::Not;
using ::testing::Truly;

std::shared_ptr<Impl::NativeSystem> MakeJackSystem() {
  return std::make_shared<Impl::NativeSystem>(
      std::vector<std::shared_ptr<Impl::MidiService>>{std::make_shared<Impl::JackService>()},
      Impl::MakeSystemWaits());
}

Bytes MakeSysex(std::size_t size) {
  Bytes sysex(size);
  for (std::size_t i = 0; i < size; ++i) sysex[i] = static_cast<unsigned char>(i * 7 % 128);
  sysex.front() = 0xF0;
  sysex.back() = 0xF7;
  return sysex;
}

class JackSystem : public ::testing::Test {
 protected:
  void SetUp() override {
    std::string const why = server_.Start();
    if (!why.empty()) GTEST_SKIP() << "No JACK server to test against: " << why;
    system_ = MakeJackSystem();
  }

  HMIDIOUT OpenOutput(std::u16string const& name) {
    HMIDIOUT output = nullptr;
    int const device = FindOutput(*system_, name);
    EXPECT_GE(device, 0);
    EXPECT_EQ(system_->midiOutOpen(&output, static_cast<UINT>(device), 0, 0, CALLBACK_NULL), 0U);
    return output;
  }

  UINT Input(std::u16string const& name) {
    int const device = FindInput(*system_, name);
    EXPECT_GE(device, 0);
    return static_cast<UINT>(device);
  }

  JackServer server_;
  std::shared_ptr<Impl::NativeSystem> system_;
};

TEST_F(JackSystem, ShowsEachPortAsADeviceUnderClientAndPort) {
  JackPeer peer("Peer");
  EXPECT_THAT(OutputNames(*system_), Contains(u"Peer:in"));
  EXPECT_THAT(InputNames(*system_), Contains(u"Peer:out"));
}

TEST_F(JackSystem, HidesTheLibrarysOwnClients) {
  JackPeer peer("Peer");
  HMIDIOUT const output = OpenOutput(u"Peer:in");
  InputHost input(*system_, Input(u"Peer:out"));
  auto const isOwn = [](std::u16string const& name) { return name.starts_with(u"ostinet"); };
  EXPECT_THAT(OutputNames(*system_), Each(Not(Truly(isOwn))));
  EXPECT_THAT(InputNames(*system_), Each(Not(Truly(isOwn))));
  system_->midiOutClose(output);
}

TEST_F(JackSystem, TellsOfNewRenamedAndLeavingPorts) {
  std::counting_semaphore<> told{0};
  auto const watch = system_->WatchDeviceChanges([&told] { told.release(); });
  auto const wasTold = [&told] { return told.try_acquire_for(std::chrono::seconds(30)); };
  auto peer = std::make_unique<JackPeer>("Peer");
  EXPECT_TRUE(wasTold());
  EXPECT_GE(FindInput(*system_, u"Peer:out"), 0);
  peer->RenameOut("keys");
  do {
    ASSERT_TRUE(wasTold());
  } while (FindInput(*system_, u"Peer:keys") < 0);
  EXPECT_EQ(FindInput(*system_, u"Peer:out"), -1);
  peer.reset();
  do {
    ASSERT_TRUE(wasTold());
  } while (FindInput(*system_, u"Peer:keys") >= 0 || FindOutput(*system_, u"Peer:in") >= 0);
}

TEST_F(JackSystem, SendsMessagesOfEachLengthInOrder) {
  JackPeer peer("Peer");
  HMIDIOUT const output = OpenOutput(u"Peer:in");
  EXPECT_EQ(system_->midiOutShortMsg(output, 0x403C90), 0U);
  EXPECT_EQ(system_->midiOutShortMsg(output, 0x05C1), 0U);
  EXPECT_EQ(SendLong(*system_, output, {0xF0, 0x7E, 0x7F, 0x06, 0x01, 0xF7}), 0U);
  EXPECT_EQ(system_->midiOutShortMsg(output, 0xF8), 0U);
  EXPECT_EQ(SendLong(*system_, output, {0x90, 0x3C, 0x40, 0x80, 0x3C, 0x00}), 0U);
  std::vector<Bytes> const expected = {
      {0x90, 0x3C, 0x40}, {0xC1, 0x05},      {0xF0, 0x7E, 0x7F, 0x06, 0x01, 0xF7}, {0xF8},
      {0x90, 0x3C, 0x40}, {0x80, 0x3C, 0x00}};
  EXPECT_EQ(peer.WaitForEvents(expected.size()), expected);
  EXPECT_EQ(system_->midiOutClose(output), 0U);
}

TEST_F(JackSystem, LosesNoneOfTenThousandMessagesSentAtOnce) {
  constexpr std::size_t kCount = 10000;
  JackPeer peer("Peer");
  HMIDIOUT const output = OpenOutput(u"Peer:in");
  for (std::size_t i = 0; i < kCount; ++i) {
    auto const message = static_cast<DWORD>(0xE0 | (i & 0x7F) << 8 | (i >> 7) << 16);
    ASSERT_EQ(system_->midiOutShortMsg(output, message), 0U);
  }
  std::vector<Bytes> const events = peer.WaitForEvents(kCount);
  ASSERT_EQ(events.size(), kCount);
  for (std::size_t i = 0; i < kCount; ++i) {
    ASSERT_EQ(events[i], (Bytes{0xE0, static_cast<unsigned char>(i & 0x7F),
                                static_cast<unsigned char>(i >> 7)}));
  }
  system_->midiOutClose(output);
}

TEST_F(JackSystem, SendsALongSysexWhole) {
  JackPeer peer("Peer");
  HMIDIOUT const output = OpenOutput(u"Peer:in");
  Bytes const sysex = MakeSysex(15000);
  EXPECT_EQ(SendLong(*system_, output, sysex), 0U);
  EXPECT_EQ(peer.WaitForEvents(1), std::vector<Bytes>{sysex});
  system_->midiOutClose(output);
}

TEST_F(JackSystem, CutsASysexThatNoCycleHolds) {
  JackPeer peer("Peer");
  HMIDIOUT const output = OpenOutput(u"Peer:in");
  Bytes const sysex = MakeSysex(40000);
  EXPECT_EQ(SendLong(*system_, output, sysex), 0U);
  EXPECT_EQ(system_->midiOutShortMsg(output, 0xFA), 0U);
  Bytes expected = sysex;
  expected.push_back(0xFA);
  EXPECT_EQ(peer.WaitForBytes(expected.size()), expected);
  system_->midiOutClose(output);
}

TEST_F(JackSystem, ReceivesShortMessagesAndSysexInOrder) {
  JackPeer peer("Peer");
  InputHost input(*system_, Input(u"Peer:out"));
  ASSERT_EQ(input.OpenResult(), 0U);
  Bytes const sysex = MakeSysex(600);
  peer.Play({0x90, 0x3C, 0x40});
  peer.Play(sysex);
  peer.Play({0xC1, 0x05});
  peer.Play({0xFE});
  auto const pieces = input.WaitForPieces(6);
  ASSERT_EQ(pieces.size(), 6U);
  EXPECT_EQ(pieces[0].bytes, (Bytes{0x90, 0x3C, 0x40}));
  EXPECT_FALSE(pieces[0].isLong);
  Bytes joined;
  for (std::size_t i : {1U, 2U, 3U}) {
    EXPECT_TRUE(pieces[i].isLong);
    joined.insert(joined.end(), pieces[i].bytes.begin(), pieces[i].bytes.end());
  }
  EXPECT_EQ(pieces[1].bytes.size(), 256U);
  EXPECT_EQ(joined, sysex);
  EXPECT_EQ(pieces[4].bytes, (Bytes{0xC1, 0x05, 0}));
  EXPECT_EQ(pieces[5].bytes, (Bytes{0xFE, 0, 0}));
  auto const earlier = [](auto const& a, auto const& b) { return a.time < b.time; };
  EXPECT_TRUE(std::is_sorted(pieces.begin(), pieces.end(), earlier));
  EXPECT_EQ(input.Close(), 0U);
  EXPECT_THAT(input.Events(), ::testing::ElementsAre(MIM_OPEN, MIM_CLOSE));
}

TEST_F(JackSystem, ReceivesAsOneWhatWasSentInCuts) {
  JackPeer peer("Peer");
  InputHost input(*system_, Input(u"Peer:out"));
  Bytes const sysex = MakeSysex(500);
  peer.Play(Bytes(sysex.begin(), sysex.begin() + 300));
  peer.Play(Bytes(sysex.begin() + 300, sysex.end()));
  auto const pieces = input.WaitForPieces(2);
  ASSERT_EQ(pieces.size(), 2U);
  Bytes joined = pieces[0].bytes;
  joined.insert(joined.end(), pieces[1].bytes.begin(), pieces[1].bytes.end());
  EXPECT_EQ(pieces[0].bytes.size(), 256U);
  EXPECT_EQ(joined, sysex);
}

TEST_F(JackSystem, ResetEndsTheNotesThatSound) {
  JackPeer peer("Peer");
  HMIDIOUT const output = OpenOutput(u"Peer:in");
  system_->midiOutShortMsg(output, 0x403C92);
  peer.WaitForEvents(1);
  system_->midiOutReset(output);
  std::vector<Bytes> const expected = {{0x92, 0x3C, 0x40}, {0x82, 0x3C, 0x40}};
  EXPECT_EQ(peer.WaitForEvents(2), expected);
  system_->midiOutClose(output);
}

TEST_F(JackSystem, OutlivesAServerThatIsKilledInMidSend) {
  auto peer = std::make_unique<JackPeer>("Peer");
  HMIDIOUT const output = OpenOutput(u"Peer:in");
  InputHost input(*system_, Input(u"Peer:out"));
  Testing::Latch begun(1);
  std::thread player([&] {
    // A full lane is no reason to stop, a dead server is.
    do {
      system_->midiOutShortMsg(output, 0x403C90);
      if (peer->CountHeard() > 0 && !begun.try_wait()) begun.count_down();
    } while (FindOutput(*system_, u"Peer:in") >= 0);
  });
  begun.wait();
  for (int i = 0; i < 20000; ++i) system_->midiOutShortMsg(output, 0x403C90);
  server_.Kill();
  player.join();
  EXPECT_EQ(system_->midiOutShortMsg(output, 0x403C90), MIDIERR_NOTREADY);
  EXPECT_EQ(system_->midiOutReset(output), 0U);
  EXPECT_EQ(system_->midiOutClose(output), 0U);
  EXPECT_EQ(input.Close(), 0U);
}

TEST_F(JackSystem, FindsItsPortsAgainOnANewServer) {
  auto peer = std::make_unique<JackPeer>("Peer");
  int const before = FindOutput(*system_, u"Peer:in");
  HMIDIOUT const stale = OpenOutput(u"Peer:in");
  peer.reset();
  server_.Stop();
  EXPECT_EQ(FindOutput(*system_, u"Peer:in"), -1);
  EXPECT_EQ(system_->midiOutClose(stale), 0U);
  EXPECT_EQ(FindOutput(*system_, u"Peer:in"), -1);
  std::string const why = server_.Start();
  if (!why.empty()) GTEST_SKIP() << "The JACK server does not start again: " << why;
  JackPeer again("Peer");
  EXPECT_EQ(FindOutput(*system_, u"Peer:in"), before);
  HMIDIOUT const output = OpenOutput(u"Peer:in");
  system_->midiOutShortMsg(output, 0x403C90);
  EXPECT_EQ(again.WaitForEvents(1), (std::vector<Bytes>{{0x90, 0x3C, 0x40}}));
  system_->midiOutClose(output);
}

}  // namespace
}  // namespace Ostinet::Testing
