// SPDX-License-Identifier: MIT
#include <cstring>

#include "system/SimulatedTest.h"

namespace Ostinet::Impl::Simulated {
namespace {

class MusicPortTest : public SimulatedTest {
 protected:
  void SetUp() override {
    ASSERT_EQ(Sys().CreateDirectMusic(music_.Out()), S_OK);
    MakeBuffer(256);
  }
  void MakeBuffer(DWORD size) {
    DMUS_BUFFERDESC description{};
    description.dwSize = sizeof description;
    description.cbBuffer = size;
    buffer_.Reset();
    ASSERT_EQ(music_->CreateMusicBuffer(&description, buffer_.Out(), nullptr), S_OK);
  }
  HRESULT Open(DWORD index, Held<IDirectMusicPort>& port, bool active = true) {
    DMUS_PORTCAPS caps{};
    caps.dwSize = sizeof caps;
    HRESULT result = music_->EnumPort(index, &caps);
    if (result != S_OK) return result;
    DMUS_PORTPARAMS8 params{};
    params.dwSize = sizeof params;
    result = music_->CreatePort(caps.guidPort, &params, port.Out(), nullptr);
    if (result == S_OK && active) port->Activate(TRUE);
    return result;
  }
  std::vector<Bytes> ReadAll(IDirectMusicPort& port) {
    std::vector<Bytes> events;
    buffer_->Flush();
    while (port.Read(buffer_.Get()) == S_OK) {
      buffer_->ResetReadPtr();
      DWORD length = 0;
      LPBYTE data = nullptr;
      while (buffer_->GetNextEvent(&lastTime_, nullptr, &length, &data) == S_OK) {
        events.push_back({data, data + length});
      }
      buffer_->Flush();
    }
    return events;
  }
  SimulatedPort Native(PortKind kind) const {
    auto port = PortOf("Native", kind);
    port.external = true;
    return port;
  }

  Held<IDirectMusic> music_;
  Held<IDirectMusicBuffer> buffer_;
  REFERENCE_TIME lastTime_ = 0;
};

TEST_F(MusicPortTest, PlaysEachEventAtItsOwnTime) {
  studio_.AddPort(Native(PortKind::kDirectMusicOut));
  Held<IDirectMusicPort> port;
  ASSERT_EQ(Open(0, port), S_OK);
  buffer_->PackStructured(900, 0, 0x403C90);
  buffer_->PackStructured(1500, 0, 0x003C90);
  buffer_->PackStructured(1200, 0, 0x413D90);
  EXPECT_EQ(port->PlayBuffer(buffer_.Get()), S_OK);
  EXPECT_EQ(BytesOf(studio_.Sent()), (std::vector<Bytes>{{0x90, 0x3C, 0x40}}));
  EXPECT_EQ(studio_.CountScheduled(), 2);
  studio_.AdvanceClocks(10000);
  auto const sent = studio_.Sent("Native");
  ASSERT_EQ(sent.size(), 3u);
  EXPECT_EQ(sent[1].bytes, (Bytes{0x90, 0x3D, 0x41}));
  EXPECT_EQ(sent[1].left, 1200);
  EXPECT_EQ(sent[2].left, 1500);
  EXPECT_EQ(sent[2].handedOver, 1000);
}

TEST_F(MusicPortTest, PlayingAnEmptyBufferFails) {
  studio_.AddPort(Native(PortKind::kDirectMusicOut));
  Held<IDirectMusicPort> port;
  ASSERT_EQ(Open(0, port), S_OK);
  EXPECT_EQ(Code(port->PlayBuffer(buffer_.Get())), 0x88781135u);
}

TEST_F(MusicPortTest, PlaysABufferThatTheHostFilled) {
  studio_.AddPort(Native(PortKind::kDirectMusicOut));
  Held<IDirectMusicPort> port;
  ASSERT_EQ(Open(0, port), S_OK);
  LPBYTE raw = nullptr;
  buffer_->GetRawBufferPtr(&raw);
  DMUS_EVENTHEADER header{};
  header.cbEvent = 2;
  header.rtDelta = 50;
  std::memcpy(raw, &header, sizeof header);
  raw[20] = 0xC0;
  raw[21] = 9;
  buffer_->SetStartTime(1000);
  buffer_->SetUsedBytes(24);
  EXPECT_EQ(port->PlayBuffer(buffer_.Get()), S_OK);
  studio_.AdvanceClocks(50);
  ASSERT_EQ(studio_.Sent().size(), 1u);
  EXPECT_EQ(studio_.Sent()[0].bytes, (Bytes{0xC0, 9}));
  EXPECT_EQ(studio_.Sent()[0].left, 1050);
}

TEST_F(MusicPortTest, ClosingDropsWhatIsStillToPlay) {
  studio_.AddPort(Native(PortKind::kDirectMusicOut));
  Held<IDirectMusicPort> port;
  ASSERT_EQ(Open(0, port), S_OK);
  buffer_->PackStructured(5000, 0, 0x403C90);
  port->PlayBuffer(buffer_.Get());
  port->Activate(FALSE);
  EXPECT_EQ(studio_.CountScheduled(), 0);
}

TEST_F(MusicPortTest, ReadsWhatArrivedWithItsTime) {
  studio_.AddPort(Native(PortKind::kDirectMusicIn));
  Held<IDirectMusicPort> port;
  ASSERT_EQ(Open(0, port), S_OK);
  HANDLE const event = Sys().GetWaits().CreateEventW();
  EXPECT_EQ(port->SetReadNotificationHandle(event), S_OK);
  EXPECT_EQ(Sys().GetWaits().WaitForSingleObject(event, 0), DWORD{WAIT_TIMEOUT});
  studio_.Inject("Native", {0x90, 1, 2, 3, 4, 0xF0, 5, 0xF7});
  EXPECT_EQ(Sys().GetWaits().WaitForSingleObject(event, 0), DWORD{WAIT_OBJECT_0});
  EXPECT_EQ(ReadAll(*port.Get()),
            (std::vector<Bytes>{{0x90, 1, 2}, {0x90, 3, 4}, {0xF0, 5, 0xF7}}));
  EXPECT_EQ(lastTime_, 1000);
  EXPECT_EQ(port->Read(buffer_.Get()), S_FALSE);
  Sys().GetWaits().CloseHandle(event);
}

TEST_F(MusicPortTest, ASysexThatFitsNoBufferComesInPieces) {
  studio_.AddPort(Native(PortKind::kDirectMusicIn));
  Held<IDirectMusicPort> port;
  ASSERT_EQ(Open(0, port), S_OK);
  Bytes sysex(600, 0x22);
  sysex.front() = 0xF0;
  sysex.back() = 0xF7;
  studio_.Inject("Native", sysex);
  Bytes joined;
  auto const pieces = ReadAll(*port.Get());
  for (auto const& piece : pieces) joined.insert(joined.end(), piece.begin(), piece.end());
  EXPECT_EQ(joined, sysex);
  EXPECT_EQ(pieces.front().size(), 236u);
}

TEST_F(MusicPortTest, HearsOnlyWhileActive) {
  studio_.AddPort(Native(PortKind::kDirectMusicIn));
  Held<IDirectMusicPort> port;
  ASSERT_EQ(Open(0, port, false), S_OK);
  studio_.Inject("Native", {0x90, 1, 2});
  EXPECT_TRUE(ReadAll(*port.Get()).empty());
  port->Activate(TRUE);
  studio_.Inject("Native", {0x90, 1, 2});
  EXPECT_EQ(ReadAll(*port.Get()).size(), 1u);
}

TEST_F(MusicPortTest, EachDirectionRefusesTheOther) {
  studio_.AddPort(Native(PortKind::kDirectMusicIn));
  studio_.AddPort(Native(PortKind::kDirectMusicOut));
  Held<IDirectMusicPort> in, out;
  ASSERT_EQ(Open(0, in), S_OK);
  ASSERT_EQ(Open(1, out), S_OK);
  buffer_->PackStructured(1, 0, 0x403C90);
  EXPECT_EQ(in->PlayBuffer(buffer_.Get()), DMUS_E_PORT_NOT_RENDER);
  EXPECT_EQ(out->Read(buffer_.Get()), DMUS_E_PORT_NOT_CAPTURE);
}

TEST_F(MusicPortTest, TheLatencyClockRunsAhead) {
  auto spec = Native(PortKind::kDirectMusicOut);
  spec.latencyMicroseconds = 1499;
  studio_.AddPort(spec);
  Held<IDirectMusicPort> port;
  ASSERT_EQ(Open(0, port), S_OK);
  Held<IReferenceClock> clock;
  ASSERT_EQ(port->GetLatencyClock(clock.Out()), S_OK);
  REFERENCE_TIME time = 0;
  EXPECT_EQ(clock->GetTime(&time), S_OK);
  EXPECT_EQ(time, 1000 + 14990);
}

class Downloads : public MusicPortTest {
 protected:
  void SetUp() override {
    MusicPortTest::SetUp();
    auto synth = PortOf("Synth", PortKind::kDirectMusicOut);
    synth.dls = true;
    studio_.AddPort(synth);
    ASSERT_EQ(Open(0, port_), S_OK);
    ASSERT_EQ(Sys().CreateDirectMusicLoader(loader_.Out()), S_OK);
    DMUS_OBJECTDESC description{};
    description.dwSize = sizeof description;
    description.dwValidData = DMUS_OBJ_OBJECT | DMUS_OBJ_CLASS;
    description.guidClass = CLSID_DirectMusicCollection;
    description.guidObject = GUID_DefaultGMCollection;
    void* object = nullptr;
    ASSERT_EQ(loader_->GetObject(&description, IID_IDirectMusicCollection, &object), S_OK);
    *collection_.Out() = static_cast<IDirectMusicCollection*>(object);
  }

  Held<IDirectMusicPort> port_;
  Held<IDirectMusicLoader> loader_;
  Held<IDirectMusicCollection> collection_;
};

TEST_F(Downloads, TheDefaultCollectionHasAnInstrumentForEachPatch) {
  studio_.SetCollection({0, 24, 0x80000000});
  std::vector<DWORD> patches;
  DWORD patch = 0;
  for (DWORD i = 0; collection_->EnumInstrument(i, &patch, nullptr, 0) == S_OK; ++i) {
    patches.push_back(patch);
  }
  EXPECT_EQ(patches, (std::vector<DWORD>{0, 24, 0x80000000}));
  Held<IDirectMusicInstrument> none;
  EXPECT_NE(collection_->GetInstrument(1, none.Out()), S_OK);
  EXPECT_EQ(none.Get(), nullptr);
}

TEST_F(Downloads, AreCountedUntilTheyAreUnloaded) {
  Held<IDirectMusicInstrument> instrument;
  Held<IDirectMusicDownloadedInstrument> downloaded;
  ASSERT_EQ(collection_->GetInstrument(5, instrument.Out()), S_OK);
  ASSERT_EQ(port_->DownloadInstrument(instrument.Get(), downloaded.Out(), nullptr, 0), S_OK);
  EXPECT_EQ(studio_.CountDownloaded("Synth"), 1);
  EXPECT_EQ(port_->UnloadInstrument(downloaded.Get()), S_OK);
  EXPECT_EQ(studio_.CountDownloaded("Synth"), 0);
  EXPECT_EQ(Code(port_->UnloadInstrument(downloaded.Get())), 0x88781120u);
}

TEST_F(Downloads, OnlySynthesizersTakeInstruments) {
  studio_.AddPort(Native(PortKind::kDirectMusicOut));
  Held<IDirectMusicPort> native;
  ASSERT_EQ(Open(1, native), S_OK);
  Held<IDirectMusicInstrument> instrument;
  Held<IDirectMusicDownloadedInstrument> downloaded;
  collection_->GetInstrument(5, instrument.Out());
  EXPECT_TRUE(FAILED(native->DownloadInstrument(instrument.Get(), downloaded.Out(), nullptr, 0)));
}

TEST_F(Downloads, EveryObjectIsCountedWhileItLives) {
  EXPECT_EQ(studio_.CountObjects("IDirectMusicCollection"), 1);
  EXPECT_EQ(studio_.CountObjects("IDirectMusicPort"), 1);
  port_->AddRef();
  port_->Release();
  port_.Reset();
  collection_.Reset();
  loader_.Reset();
  buffer_.Reset();
  EXPECT_EQ(studio_.CountObjects("IDirectMusicPort"), 0);
  EXPECT_EQ(studio_.CountObjects(), 1);
  music_.Reset();
  EXPECT_EQ(studio_.CountObjects(), 0);
  EXPECT_THROW(studio_.CountObjects("IWhatever"), std::invalid_argument);
}

TEST_F(Downloads, EndlessAnswersDoNotEnd) {
  studio_.SetEndless("EnumInstrument", true);
  studio_.SetEndless("EnumPort", true);
  DWORD patch = 0;
  EXPECT_EQ(collection_->EnumInstrument(1000000, &patch, nullptr, 0), S_OK);
  DMUS_PORTCAPS caps{};
  caps.dwSize = sizeof caps;
  EXPECT_EQ(music_->EnumPort(1000000, &caps), S_OK);
  studio_.AddPort(Native(PortKind::kDirectMusicIn));
  Held<IDirectMusicPort> in;
  ASSERT_EQ(Open(1, in), S_OK);
  studio_.SetEndless("Read", true);
  for (int i = 0; i < 1000; ++i) {
    buffer_->Flush();
    ASSERT_EQ(in->Read(buffer_.Get()), S_OK);
  }
}

}  // namespace
}  // namespace Ostinet::Impl::Simulated
