// SPDX-License-Identifier: MIT
#include "platform/system/simulated/SimulatedSystem.h"

#include "ostinet/core/Error.h"
#include "platform/system/simulated/Music.h"
#include "platform/system/simulated/WideText.h"

namespace Ostinet::Impl::Simulated {

DWORD SimulatedSystem::timeGetTime() {
  long long failure = 0;
  if (studio_->Book().Fails(Op::kTimeGetTime, failure)) return static_cast<DWORD>(failure);
  auto const now = static_cast<DWORD>(studio_->Clock().Now() / 10000);
  studio_->Book().Log(Op::kTimeGetTime, now);
  return now;
}

HRESULT SimulatedSystem::CreateDirectMusic(IDirectMusic** result) {
  long long failure = 0;
  *result = nullptr;
  if (studio_->Book().Fails(Op::kCreateDirectMusic, failure)) return static_cast<HRESULT>(failure);
  *result = new Music(studio_);
  studio_->Book().Log(Op::kCreateDirectMusic, S_OK);
  // A host has come: from now on things happen to its studio.
  studio_->StartTimeline();
  return S_OK;
}

HRESULT SimulatedSystem::CreateDirectMusicLoader(IDirectMusicLoader** result) {
  long long failure = 0;
  *result = nullptr;
  if (studio_->Book().Fails(Op::kCreateDirectMusicLoader, failure)) {
    return static_cast<HRESULT>(failure);
  }
  *result = new Loader(studio_);
  studio_->Book().Log(Op::kCreateDirectMusicLoader, S_OK);
  return S_OK;
}

std::vector<AudioSession> SimulatedSystem::SnapshotAudioSessions() {
  long long failure = 0;
  if (studio_->Book().Fails(Op::kSnapshotAudioSessions, failure)) {
    FailCOMError(static_cast<int>(failure));
  }
  std::vector<AudioSession> sessions;
  {
    std::lock_guard lock(studio_->Mutex());
    for (auto const& each : studio_->audioSessions) sessions.push_back({Widen(each)});
  }
  studio_->Book().Log(Op::kSnapshotAudioSessions, static_cast<long long>(sessions.size()));
  return sessions;
}

}  // namespace Ostinet::Impl::Simulated
