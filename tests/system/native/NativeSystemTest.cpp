// SPDX-License-Identifier: MIT
//
// The machine's system over a service in memory.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <semaphore>
#include <thread>

#include "platform/system/SystemWaits.h"
#include "platform/system/native/NativeSystem.h"
#include "system/native/FakeService.h"
#include "system/native/MidiHost.h"

namespace Ostinet::Testing {
namespace {

using Bytes = std::vector<unsigned char>;
using ::testing::ElementsAre;

class NativeSystem : public ::testing::Test {
 protected:
  NativeSystem() {
    service_->outputs = {{"o", "Keys"}};
    service_->inputs = {{"i", "Pads"}};
    system_ = std::make_unique<Impl::NativeSystem>(
        std::vector<std::shared_ptr<Impl::MidiService>>{service_}, Impl::MakeSystemWaits());
  }

  void Arrive(Bytes const& bytes) { service_->sink(bytes.data(), bytes.size()); }

  std::shared_ptr<FakeService> service_ = std::make_shared<FakeService>();
  std::unique_ptr<Impl::NativeSystem> system_;
};

TEST_F(NativeSystem, DescribesAnOutputAsAPortThatLeadsOutside) {
  MIDIOUTCAPSW caps{};
  ASSERT_EQ(system_->midiOutGetDevCapsW(0, &caps, sizeof caps), MMSYSERR_NOERROR);
  EXPECT_EQ(std::u16string(caps.szPname), u"Keys");
  EXPECT_EQ(caps.wTechnology, MOD_MIDIPORT);
  EXPECT_EQ(system_->midiOutGetDevCapsW(1, &caps, sizeof caps), MMSYSERR_BADDEVICEID);
  EXPECT_EQ(system_->midiOutGetDevCapsW(~UINT_PTR{0}, &caps, sizeof caps), MMSYSERR_BADDEVICEID);
}

TEST_F(NativeSystem, RefusesStrangeHandles) {
  auto const strange = reinterpret_cast<HMIDIOUT>(std::uintptr_t{1});
  MIDIHDR header{};
  EXPECT_EQ(system_->midiOutShortMsg(strange, 0x90), MMSYSERR_INVALHANDLE);
  EXPECT_EQ(system_->midiOutClose(nullptr), MMSYSERR_INVALHANDLE);
  EXPECT_EQ(system_->midiOutUnprepareHeader(strange, &header, sizeof header), MMSYSERR_INVALHANDLE);
  EXPECT_EQ(system_->midiInStart(nullptr), MMSYSERR_INVALHANDLE);
  EXPECT_EQ(system_->midiInClose(nullptr), MMSYSERR_INVALHANDLE);
}

TEST_F(NativeSystem, OpensNothingThatIsAway) {
  HMIDIOUT output = nullptr;
  EXPECT_EQ(system_->midiOutOpen(&output, 5, 0, 0, CALLBACK_NULL), MMSYSERR_BADDEVICEID);
  service_->outputs.clear();  // gone since the last look
  EXPECT_EQ(system_->midiOutOpen(&output, 0, 0, 0, CALLBACK_NULL), MMSYSERR_NODRIVER);
  EXPECT_EQ(output, nullptr);
  service_->inputs.clear();
  InputHost input(*system_, 0);
  EXPECT_EQ(input.OpenResult(), MMSYSERR_NODRIVER);
}

TEST_F(NativeSystem, ReportsOpenDoneAndClose) {
  std::vector<UINT> messages;
  auto const callback = [](HDRVR, UINT message, DWORD_PTR self, DWORD_PTR, DWORD_PTR) {
    reinterpret_cast<std::vector<UINT>*>(self)->push_back(message);
  };
  HMIDIOUT output = nullptr;
  ASSERT_EQ(system_->midiOutOpen(&output, 0, reinterpret_cast<DWORD_PTR>(+callback),
                                 reinterpret_cast<DWORD_PTR>(&messages), CALLBACK_FUNCTION),
            MMSYSERR_NOERROR);
  EXPECT_EQ(SendLong(*system_, output, {0xF0, 1, 0xF7}), MMSYSERR_NOERROR);
  EXPECT_EQ(system_->midiOutClose(output), MMSYSERR_NOERROR);
  EXPECT_THAT(messages, ElementsAre(MOM_OPEN, MOM_DONE, MOM_CLOSE));
  EXPECT_EQ(service_->line->WaitForPieces(1), (std::vector<Bytes>{{0xF0, 1, 0xF7}}));
}

TEST_F(NativeSystem, SendsShortMessagesInTheirOwnLength) {
  HMIDIOUT output = nullptr;
  system_->midiOutOpen(&output, 0, 0, 0, CALLBACK_NULL);
  EXPECT_EQ(system_->midiOutShortMsg(output, 0x11223C90), MMSYSERR_NOERROR);
  EXPECT_EQ(system_->midiOutShortMsg(output, 0x112233C5), MMSYSERR_NOERROR);
  EXPECT_EQ(system_->midiOutShortMsg(output, 0x00003C40), MMSYSERR_INVALPARAM);
  EXPECT_EQ(service_->line->WaitForPieces(2),
            (std::vector<Bytes>{{0x90, 0x3C, 0x22}, {0xC5, 0x33}}));
  system_->midiOutClose(output);
}

TEST_F(NativeSystem, ALongMessageHasToBePrepared) {
  HMIDIOUT output = nullptr;
  system_->midiOutOpen(&output, 0, 0, 0, CALLBACK_NULL);
  char bytes[3] = {static_cast<char>(0xF0), 1, static_cast<char>(0xF7)};
  MIDIHDR header{};
  header.lpData = bytes;
  header.dwBufferLength = sizeof bytes;
  EXPECT_EQ(system_->midiOutLongMsg(output, &header, sizeof header), MIDIERR_UNPREPARED);
  EXPECT_EQ(system_->midiOutPrepareHeader(output, &header, 4), MMSYSERR_INVALPARAM);
  EXPECT_EQ(system_->midiOutPrepareHeader(output, &header, sizeof header), MMSYSERR_NOERROR);
  EXPECT_EQ(system_->midiOutLongMsg(output, &header, sizeof header), MMSYSERR_NOERROR);
  EXPECT_NE(header.dwFlags & MHDR_DONE, 0U);
  EXPECT_EQ(system_->midiOutUnprepareHeader(output, &header, sizeof header), MMSYSERR_NOERROR);
  system_->midiOutClose(output);
}

TEST_F(NativeSystem, CutsIncomingSysexIntoTheHostsBuffers) {
  InputHost input(*system_, 0);
  Bytes sysex(300, 5);
  sysex.front() = 0xF0;
  sysex.back() = 0xF7;
  Arrive({0x90, 0x3C, 0x40});
  Arrive(sysex);
  Arrive({0xD0, 0x07});
  auto const pieces = input.WaitForPieces(4);
  ASSERT_EQ(pieces.size(), 4U);
  EXPECT_EQ(pieces[1].bytes, Bytes(sysex.begin(), sysex.begin() + 256));
  EXPECT_EQ(pieces[2].bytes, Bytes(sysex.begin() + 256, sysex.end()));
  EXPECT_EQ(pieces[3].bytes, (Bytes{0xD0, 0x07, 0}));
}

TEST_F(NativeSystem, LosesSysexThatFindsNoBuffer) {
  InputHost input(*system_, 0, 0);
  Arrive({0xF0, 1, 0xF7});
  Arrive({0xFE});
  auto const pieces = input.WaitForPieces(1);
  ASSERT_EQ(pieces.size(), 1U);
  EXPECT_EQ(pieces[0].bytes, (Bytes{0xFE, 0, 0}));
}

TEST_F(NativeSystem, StaysSilentUntilStartedAndOnceStopped) {
  InputHost input(*system_, 0);
  system_->midiInStop(input.Handle());
  Arrive({0x90, 1, 2});
  system_->midiInStart(input.Handle());
  Arrive({0x90, 3, 4});
  auto const pieces = input.WaitForPieces(1);
  ASSERT_EQ(pieces.size(), 1U);
  EXPECT_EQ(pieces[0].bytes, (Bytes{0x90, 3, 4}));
}

TEST_F(NativeSystem, ResetGivesEveryBufferBackEmptyBeforeTheDeviceCloses) {
  struct Host {
    std::vector<MIDIHDR*> returned;
  } host;
  auto const callback = [](HDRVR, UINT message, DWORD_PTR self, DWORD_PTR header, DWORD_PTR) {
    if (message != MIM_LONGDATA) return;
    reinterpret_cast<Host*>(self)->returned.push_back(reinterpret_cast<MIDIHDR*>(header));
  };
  HMIDIIN input = nullptr;
  ASSERT_EQ(system_->midiInOpen(&input, 0, reinterpret_cast<DWORD_PTR>(+callback),
                                reinterpret_cast<DWORD_PTR>(&host), CALLBACK_FUNCTION),
            MMSYSERR_NOERROR);
  char bytes[2][16];
  MIDIHDR headers[2] = {};
  for (int i = 0; i < 2; ++i) {
    headers[i].lpData = bytes[i];
    headers[i].dwBufferLength = sizeof bytes[i];
    EXPECT_EQ(system_->midiInAddBuffer(input, &headers[i], sizeof headers[i]), MIDIERR_UNPREPARED);
    EXPECT_EQ(system_->midiInPrepareHeader(input, &headers[i], sizeof headers[i]),
              MMSYSERR_NOERROR);
    EXPECT_EQ(system_->midiInAddBuffer(input, &headers[i], sizeof headers[i]), MMSYSERR_NOERROR);
  }
  EXPECT_EQ(system_->midiInAddBuffer(input, &headers[0], sizeof headers[0]), MIDIERR_STILLPLAYING);
  EXPECT_EQ(system_->midiInUnprepareHeader(input, &headers[0], sizeof headers[0]),
            MIDIERR_STILLPLAYING);
  EXPECT_EQ(system_->midiInClose(input), MIDIERR_STILLPLAYING);
  EXPECT_EQ(system_->midiInReset(input), MMSYSERR_NOERROR);
  EXPECT_THAT(host.returned, ElementsAre(&headers[0], &headers[1]));
  EXPECT_EQ(headers[0].dwBytesRecorded, 0U);
  EXPECT_EQ(system_->midiInClose(input), MMSYSERR_NOERROR);
}

// The host frees what its callback uses as soon as the device has stopped.
TEST_F(NativeSystem, StoppingWaitsForACallbackInProgress) {
  struct Host {
    std::binary_semaphore entered{0};
    std::binary_semaphore mayLeave{0};
    std::atomic<bool> left{false};
  } host;
  auto const callback = [](HDRVR, UINT message, DWORD_PTR self, DWORD_PTR, DWORD_PTR) {
    if (message != MIM_DATA) return;
    auto* const waiting = reinterpret_cast<Host*>(self);
    waiting->entered.release();
    waiting->mayLeave.acquire();
    waiting->left = true;
  };
  HMIDIIN input = nullptr;
  system_->midiInOpen(&input, 0, reinterpret_cast<DWORD_PTR>(+callback),
                      reinterpret_cast<DWORD_PTR>(&host), CALLBACK_FUNCTION);
  system_->midiInStart(input);
  Arrive({0x90, 1, 2});
  host.entered.acquire();
  std::thread helper([&host] { host.mayLeave.release(); });
  system_->midiInStop(input);
  EXPECT_TRUE(host.left);
  helper.join();
  EXPECT_EQ(system_->midiInClose(input), MMSYSERR_NOERROR);
}

TEST_F(NativeSystem, TellsOfAChangeAtAHint) {
  std::binary_semaphore told{0};
  auto const watch = system_->WatchDeviceChanges([&told] { told.release(); });
  service_->outputs.push_back({"o2", "More Keys"});
  service_->hint();
  EXPECT_TRUE(told.try_acquire_for(std::chrono::seconds(10)));
}

TEST_F(NativeSystem, KnowsTheMillisecondsOfItsClock) {
  DWORD const before = system_->timeGetTime();
  EXPECT_LT(system_->timeGetTime() - before, 10000U);
  EXPECT_TRUE(system_->SnapshotAudioSessions().empty());
}

}  // namespace
}  // namespace Ostinet::Testing
