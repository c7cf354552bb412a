// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include "platform/system/native/MemoryMusicBuffer.h"
#include "platform/system/native/NativeDirectMusic.h"
#include "system/native/FakeService.h"

namespace Ostinet::Testing {
namespace {

struct Releaser {
  void operator()(IUnknown* object) const { object->Release(); }
};

class MemoryMusicBuffer : public ::testing::Test {
 protected:
  DWORD Used() {
    DWORD used = 0;
    EXPECT_EQ(buffer_->GetUsedBytes(&used), S_OK);
    return used;
  }

  std::unique_ptr<IDirectMusicBuffer, Releaser> buffer_{new Impl::MemoryMusicBuffer(256, GUID{})};
};

TEST_F(MemoryMusicBuffer, TakesOneSysexOfSixAndNineShortMessages) {
  BYTE sysex[6] = {0xF0, 0x7E, 0x7F, 0x06, 0x01, 0xF7};
  EXPECT_EQ(buffer_->PackUnstructured(100, 0, sizeof sysex, sysex), S_OK);
  EXPECT_EQ(Used(), 32U);
  for (int i = 0; i < 9; ++i) EXPECT_EQ(buffer_->PackStructured(100, 0, 0x403C90), S_OK);
  EXPECT_EQ(Used(), 248U);
  EXPECT_EQ(static_cast<DWORD>(buffer_->PackStructured(100, 0, 0x403C90)), 0x88781136U);
  EXPECT_EQ(Used(), 248U);
}

TEST_F(MemoryMusicBuffer, RefusesAWordWithoutAStatus) {
  EXPECT_EQ(static_cast<DWORD>(buffer_->PackStructured(0, 0, 0x00403C10)), 0x8878113FU);
  EXPECT_EQ(Used(), 0U);
}

TEST_F(MemoryMusicBuffer, ReadsBackWhatWasPacked) {
  BYTE sysex[9] = {0xF0, 1, 2, 3, 4, 5, 6, 7, 0xF7};
  buffer_->PackStructured(1000, 1, 0x05C0);
  buffer_->PackUnstructured(1500, 2, sizeof sysex, sysex);
  REFERENCE_TIME time = 0;
  DWORD group = 0;
  DWORD length = 0;
  BYTE* data = nullptr;
  ASSERT_EQ(buffer_->GetNextEvent(&time, &group, &length, &data), S_OK);
  EXPECT_EQ(time, 1000);
  EXPECT_EQ(group, 1U);
  EXPECT_EQ(std::vector<BYTE>(data, data + length), (std::vector<BYTE>{0xC0, 0x05}));
  ASSERT_EQ(buffer_->GetNextEvent(&time, nullptr, &length, &data), S_OK);
  EXPECT_EQ(time, 1500);
  EXPECT_EQ(std::vector<BYTE>(data, data + length), std::vector<BYTE>(sysex, sysex + 9));
  EXPECT_EQ(buffer_->GetNextEvent(&time, nullptr, &length, &data), S_FALSE);
  buffer_->ResetReadPtr();
  EXPECT_EQ(buffer_->GetNextEvent(&time, nullptr, &length, &data), S_OK);
  buffer_->Flush();
  EXPECT_EQ(buffer_->GetNextEvent(&time, nullptr, &length, &data), S_FALSE);
}

TEST_F(MemoryMusicBuffer, AHostMayFillItRaw) {
  BYTE* raw = nullptr;
  ASSERT_EQ(buffer_->GetRawBufferPtr(&raw), S_OK);
  for (int i = 0; i < 256; ++i) raw[i] = 0xFF;  // an event of 4 GB
  EXPECT_EQ(buffer_->SetUsedBytes(256), S_OK);
  EXPECT_NE(buffer_->SetUsedBytes(257), S_OK);
  DWORD length = 0;
  BYTE* data = nullptr;
  EXPECT_EQ(buffer_->GetNextEvent(nullptr, nullptr, &length, &data), S_FALSE);
}

class NativeDirectMusic : public ::testing::Test {
 protected:
  std::shared_ptr<FakeService> service_ = std::make_shared<FakeService>();
  std::unique_ptr<IDirectMusic, Releaser> session_{
      new Impl::NativeDirectMusic(std::make_shared<Impl::PortTable>(
          std::vector<std::shared_ptr<Impl::MidiService>>{service_}))};
};

TEST_F(NativeDirectMusic, ListsEachPortAsAnEmulatedOneThatLeadsOutside) {
  service_->outputs = {{"a", "Keys"}};
  service_->inputs = {{"b", "Pads"}};
  DMUS_PORTCAPS caps[2] = {};
  ASSERT_EQ(session_->EnumPort(0, &caps[0]), S_OK);
  ASSERT_EQ(session_->EnumPort(1, &caps[1]), S_OK);
  DMUS_PORTCAPS none{};
  EXPECT_EQ(session_->EnumPort(2, &none), 1);
  EXPECT_EQ(std::u16string(caps[0].wszDescription), u"Keys [Emulated]");
  EXPECT_EQ(std::u16string(caps[1].wszDescription), u"Pads [Emulated]");
  EXPECT_EQ(caps[0].dwClass, 1U);
  EXPECT_EQ(caps[1].dwClass, 0U);
  for (auto const& port : caps) {
    EXPECT_EQ(port.dwSize, 308U);
    EXPECT_EQ(port.dwType, 0U);
    EXPECT_NE(port.dwFlags & DMUS_PC_EXTERNAL, 0U);
  }
  EXPECT_NE(caps[0].guidPort, caps[1].guidPort);
}

TEST_F(NativeDirectMusic, MakesBuffersOfTheSizeAskedFor) {
  DMUS_BUFFERDESC description{};
  description.dwSize = sizeof description;
  description.cbBuffer = 300;
  IDirectMusicBuffer* made = nullptr;
  ASSERT_EQ(session_->CreateMusicBuffer(&description, &made, nullptr), S_OK);
  std::unique_ptr<IDirectMusicBuffer, Releaser> const buffer(made);
  DWORD size = 0;
  buffer->GetMaxBytes(&size);
  EXPECT_EQ(size, 300U);
  description.cbBuffer = 0;
  EXPECT_EQ(session_->CreateMusicBuffer(&description, &made, nullptr), E_INVALIDARG);
  EXPECT_EQ(made, nullptr);
}

TEST_F(NativeDirectMusic, HasAClockThatMovesInSmallSteps) {
  IReferenceClock* made = nullptr;
  ASSERT_EQ(session_->GetMasterClock(nullptr, &made), S_OK);
  std::unique_ptr<IReferenceClock, Releaser> const clock(made);
  REFERENCE_TIME first = 0;
  ASSERT_EQ(clock->GetTime(&first), S_OK);
  EXPECT_GT(first, 0);
  REFERENCE_TIME next = first;
  for (int i = 0; i < 1000 && next == first; ++i) clock->GetTime(&next);
  EXPECT_GT(next, first);
}

TEST_F(NativeDirectMusic, OpensItsPortsThroughTheirDevicesOnly) {
  service_->outputs = {{"a", "Keys"}};
  DMUS_PORTCAPS caps{};
  ASSERT_EQ(session_->EnumPort(0, &caps), S_OK);
  DMUS_PORTPARAMS params{};
  IDirectMusicPort* port = nullptr;
  EXPECT_LT(session_->CreatePort(caps.guidPort, &params, &port, nullptr), 0);
  EXPECT_EQ(port, nullptr);
}

}  // namespace
}  // namespace Ostinet::Testing
