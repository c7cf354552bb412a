// SPDX-License-Identifier: MIT
#include <cstring>

#include "system/SimulatedTest.h"

namespace Ostinet::Impl::Simulated {
namespace {

class MusicBufferTest : public SimulatedTest {
 protected:
  void SetUp() override {
    ASSERT_EQ(Sys().CreateDirectMusic(music_.Out()), S_OK);
    DMUS_BUFFERDESC description{};
    description.dwSize = sizeof description;
    description.cbBuffer = 256;
    ASSERT_EQ(music_->CreateMusicBuffer(&description, buffer_.Out(), nullptr), S_OK);
  }
  DWORD Used() const {
    DWORD used = 0;
    buffer_->GetUsedBytes(&used);
    return used;
  }
  HRESULT PackNote(REFERENCE_TIME time = 1) const {
    return buffer_->PackStructured(time, 0, 0x403C90);
  }
  HRESULT PackSysex(DWORD size, REFERENCE_TIME time = 1) const {
    std::vector<BYTE> bytes(size, 0x11);
    return buffer_->PackUnstructured(time, 0, size, bytes.data());
  }

  Held<IDirectMusic> music_;
  Held<IDirectMusicBuffer> buffer_;
};

TEST_F(MusicBufferTest, TakesAsMuchAsAskedFor) {
  DWORD size = 0;
  EXPECT_EQ(buffer_->GetMaxBytes(&size), S_OK);
  EXPECT_EQ(size, 256u);
}

TEST_F(MusicBufferTest, EventsTakeTheirHeaderAndAMultipleOfEight) {
  PackNote();
  EXPECT_EQ(Used(), 24u);
  PackSysex(6);
  EXPECT_EQ(Used(), 24u + 32u);
  PackSysex(4);
  EXPECT_EQ(Used(), 24u + 32u + 24u);
  PackSysex(5);
  EXPECT_EQ(Used(), 24u + 32u + 24u + 32u);
}

TEST_F(MusicBufferTest, OneShortSysexAndNineNotesFillIt) {
  EXPECT_EQ(PackSysex(6), S_OK);
  for (int i = 0; i < 9; ++i) EXPECT_EQ(PackNote(), S_OK);
  EXPECT_EQ(Code(PackNote()), 0x88781136u);
  EXPECT_EQ(Used(), 248u);
}

TEST_F(MusicBufferTest, TheLongestSysexHas236Bytes) {
  EXPECT_EQ(Code(PackSysex(237)), 0x88781136u);
  EXPECT_EQ(Code(PackSysex(0xFFFFFFF0 & 0xFFFFF)), 0x88781136u);
  EXPECT_EQ(PackSysex(236), S_OK);
  EXPECT_EQ(Used(), 256u);
}

TEST_F(MusicBufferTest, AWordWithoutAStatusIsNoEvent) {
  EXPECT_EQ(Code(buffer_->PackStructured(1, 0, 0x003C)), 0x8878113Fu);
  EXPECT_EQ(Used(), 0u);
}

TEST_F(MusicBufferTest, GivesItsEventsBackInOrder) {
  PackNote(500);
  buffer_->PackStructured(700, 0, 0x05C1);
  BYTE sysex[] = {0xF0, 1, 0xF7};
  buffer_->PackUnstructured(400, 0, 3, sysex);
  std::vector<std::pair<REFERENCE_TIME, Bytes>> events;
  REFERENCE_TIME time = 0;
  DWORD length = 0;
  LPBYTE data = nullptr;
  buffer_->ResetReadPtr();
  while (buffer_->GetNextEvent(&time, nullptr, &length, &data) == S_OK) {
    events.push_back({time, {data, data + length}});
  }
  EXPECT_EQ(events, (std::vector<std::pair<REFERENCE_TIME, Bytes>>{
                        {500, {0x90, 0x3C, 0x40}}, {700, {0xC1, 5}}, {400, {0xF0, 1, 0xF7}}}));
  EXPECT_EQ(buffer_->GetNextEvent(&time, nullptr, &length, &data), S_FALSE);
}

TEST_F(MusicBufferTest, FlushEmptiesIt) {
  PackNote(500);
  EXPECT_EQ(buffer_->Flush(), S_OK);
  EXPECT_EQ(Used(), 0u);
  EXPECT_EQ(buffer_->GetNextEvent(nullptr, nullptr, nullptr, nullptr), S_FALSE);
}

// Hosts that fill the memory themselves rely on this layout.
TEST_F(MusicBufferTest, LaysEventsOutWithTimesRelativeToItsStart) {
  PackNote(500);
  PackNote(501);
  LPBYTE raw = nullptr;
  REFERENCE_TIME start = 0;
  ASSERT_EQ(buffer_->GetRawBufferPtr(&raw), S_OK);
  ASSERT_EQ(buffer_->GetStartTime(&start), S_OK);
  EXPECT_EQ(start, 500);
  DMUS_EVENTHEADER header;
  std::memcpy(&header, raw + 24, sizeof header);
  EXPECT_EQ(header.cbEvent, 3u);
  EXPECT_EQ(header.rtDelta, 1);
  EXPECT_EQ(header.dwFlags, DWORD{DMUS_EVENT_STRUCTURED});
  EXPECT_EQ(raw[24 + 20], 0x90);
}

TEST_F(MusicBufferTest, AHostFilledBufferThatLiesAboutItsLengthEndsEarly) {
  LPBYTE raw = nullptr;
  buffer_->GetRawBufferPtr(&raw);
  DMUS_EVENTHEADER header{};
  header.cbEvent = 0xFFFFFFF0;
  std::memcpy(raw, &header, sizeof header);
  EXPECT_EQ(buffer_->SetUsedBytes(256), S_OK);
  EXPECT_EQ(buffer_->GetNextEvent(nullptr, nullptr, nullptr, nullptr), S_FALSE);
  EXPECT_EQ(Code(buffer_->SetUsedBytes(257)), 0x88781136u);
}

TEST_F(MusicBufferTest, WrongDescriptionsAreRefused) {
  DMUS_BUFFERDESC description{};
  description.cbBuffer = 256;
  Held<IDirectMusicBuffer> other;
  EXPECT_EQ(music_->CreateMusicBuffer(&description, other.Out(), nullptr), E_INVALIDARG);
  description.dwSize = sizeof description;
  description.cbBuffer = 0;
  EXPECT_EQ(music_->CreateMusicBuffer(&description, other.Out(), nullptr), E_INVALIDARG);
  EXPECT_EQ(music_->CreateMusicBuffer(nullptr, other.Out(), nullptr), E_POINTER);
}

}  // namespace
}  // namespace Ostinet::Impl::Simulated
