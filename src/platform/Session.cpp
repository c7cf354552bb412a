// SPDX-License-Identifier: MIT

#include "platform/Session.h"

#include "datapath/SysexStorage.h"
#include "datapath/TimeBase.h"
#include "ostinet/core/Error.h"

namespace Ostinet::Impl {

namespace {

class SessionClock : public MasterClock {
 public:
  explicit SessionClock(ComPtr<IReferenceClock> clock) : clock_(std::move(clock)) {}

  unsigned long long GetTime() const override {
    REFERENCE_TIME time = 0;
    FailWinError(clock_->GetTime(&time));
    return static_cast<unsigned long long>(time);
  }

 private:
  ComPtr<IReferenceClock> const clock_;
};

class MusicBufferStorage : public SysexStorage {
 public:
  explicit MusicBufferStorage(ComPtr<IDirectMusicBuffer> buffer) : buffer_(std::move(buffer)) {
    FailWinError(buffer_->GetRawBufferPtr(&bytes_));
  }
  unsigned char* RawBytes() const override { return bytes_; }
  void SetUsedBytes(std::size_t count) override {
    buffer_->SetUsedBytes(static_cast<DWORD>(count));
  }

 private:
  ComPtr<IDirectMusicBuffer> const buffer_;
  BYTE* bytes_ = nullptr;
};

class MusicBufferMaker : public SysexStorageMaker {
 public:
  explicit MusicBufferMaker(ComPtr<IDirectMusic> directMusic)
      : directMusic_(std::move(directMusic)) {}
  std::unique_ptr<SysexStorage> Make(std::size_t bufferBytes) override {
    return std::make_unique<MusicBufferStorage>(
        MakeMusicBuffer(*directMusic_.get(), static_cast<DWORD>(bufferBytes)));
  }

 private:
  ComPtr<IDirectMusic> const directMusic_;
};

}  // namespace

Session::Session(std::shared_ptr<System> system) : system_(std::move(system)) {
  FailWinError(system_->CreateDirectMusic(directMusic_.Receive()));
  // No sound output of the host's: DirectMusic makes its own.
  FailWinError(directMusic_->SetDirectSound(nullptr, nullptr));
  FailWinError(system_->CreateDirectMusicLoader(loader_.Receive()));
  pool_ = std::make_shared<BufferPool>(directMusic_);
  FailWinError(directMusic_->GetMasterClock(nullptr, clock_.Receive()));
}

void InstallSession(std::shared_ptr<Session> const& session) {
  SetMasterClock(std::make_unique<SessionClock>(session->Clock()));
  SetSysexStorageMaker(std::make_shared<MusicBufferMaker>(session->DirectMusic()));
}

void UninstallSession() {
  SetSysexStorageMaker(nullptr);
  SetMasterClock(nullptr);
}

unsigned long long MeasureClockTick() {
  constexpr int kPasses = 100;
  constexpr int kMoreReadings = 1000;
  constexpr int kClockStandsStill = -36;
  if (CurrentMIDITime().Value() == 0) {
    return 0;
  }
  unsigned long long sum = 0;
  for (int pass = 0; pass < kPasses; ++pass) {
    unsigned long long const start = CurrentMIDITime().Value();
    unsigned long long now = CurrentMIDITime().Value();
    for (int more = 0; now == start && more < kMoreReadings; ++more) {
      now = CurrentMIDITime().Value();
    }
    if (now == start) {
      FailOSErr(kClockStandsStill);
    }
    sum += now - start;
  }
  return (sum + kPasses - 1) / kPasses;
}

}  // namespace Ostinet::Impl
