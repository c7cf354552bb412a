// SPDX-License-Identifier: MIT

#include "platform/WinMIDISetup.h"

#include <algorithm>

#include "core/Time.h"
#include "datapath/TimeBase.h"
#include "model/DestinationImpl.h"
#include "model/PropertyKeys.h"
#include "names/NamesInstallation.h"
#include "ostinet/core/Error.h"
#include "platform/PortAttacher.h"
#include "platform/Reconciliation.h"
#include "platform/SetupFile.h"
#include "platform/ports/WinDMusMIDIInPort.h"
#include "platform/ports/WinLegacyMIDIInPort.h"
#include "platform/ports/WinMIDIVirtSource.h"

namespace Ostinet {

Setup& Setup::Instance() {
  static Impl::WinMIDISetup setup;
  return setup;
}

namespace Impl {

WinMIDISetup::WinMIDISetup()
    : pollThread_(std::make_shared<VantorJobThread>(UString("MIDI Setup Polling Thread"), 0)) {
  InstallNames();
  pollThread_->Start();
  if (OstinetCallbackAPI::gInstance != nullptr) {
    if (auto* const provider = OstinetCallbackAPI::gInstance->GetDevicesProvider()) {
      provider->AddDependent(*this);
    }
  }
}

WinMIDISetup::~WinMIDISetup() {
  if (IsSignedIn()) {
    SignOut(true);
  }
  // No notification may find the thread half gone.
  LeaveProviders();
  pollThread_->Terminate();
}

std::shared_ptr<Session> WinMIDISetup::GetSession() const {
  MutexHolder const lock(sessionMutex_);
  return session_;
}

bool WinMIDISetup::IsSignedIn() { return GetSession() != nullptr; }

int WinMIDISetup::PlatformSignIn(UString const&) {
  try {
    StartSession();
    unsigned long long const tick = MeasureClockTick();
    if (tick == 0) {
      return kSignInNoMasterClock;
    }
    constexpr unsigned long long kMillisecond = 1000000;
    if (tick > NanosecondsToMIDITime(Nanos(kMillisecond)).Value()) {
      return kSignInCoarseMasterClock;
    }
    return kSignInOK;
  } catch (...) {
    StopSession();
    return kSignInPlatformError;
  }
}

void WinMIDISetup::StartSession() {
  auto session = std::make_shared<Session>(CurrentSystem());
  InstallSession(session);
  MutexHolder const lock(sessionMutex_);
  session_ = std::move(session);
}

void WinMIDISetup::StopSession() {
  UninstallSession();
  std::shared_ptr<Session> session;
  MutexHolder const lock(sessionMutex_);
  session_.swap(session);
  pollFuture_.reset();
}

void WinMIDISetup::SaveDevices() {
  // A studio that was never loaded must not take the place of the one in the file.
  if (isLoaded_) {
    SaveSetupFile(*this);
  }
}

void WinMIDISetup::PlatformSignOut() {
  isLoaded_ = false;
  for (auto const& source : activeSources_) {
    if (WinMIDIPort* const port = WinMIDIPort::Of(*source)) {
      port->Detach();
    }
  }
  activeSources_.clear();
  inActiveSources_.clear();
  {
    MutexHolder const lock(virtualSourcesMutex_);
    virtualSources_.clear();
  }
  StopSession();
  pendingChanges_.Clear();
}

void WinMIDISetup::PlatformLoadSetup() {
  std::shared_ptr<Session> const session = GetSession();
  System& system = session->GetSystem();
  // Opening a synthesizer makes audio sessions of this process: those that came in between.
  std::vector<AudioSession> const before = system.SnapshotAudioSessions();
  LoadSetupFile(*this);
  isLoaded_ = true;
  PortAttacher attacher(*this, session);
  for (PortInfo const& port : EnumeratePorts(system, *session->DirectMusic().get())) {
    attacher.Attach(port);
  }
  MarkOfflinePorts();
  system.SnapshotAudioSessions();
}

void WinMIDISetup::MarkOfflinePorts() {
  auto const mark = [](auto const& endpoints) {
    for (auto const& endpoint : endpoints) {
      if (endpoint->IsDirect() && !endpoint->IsVirtual() && !endpoint->IsInternalSoftware()) {
        WinMIDIPort const* const port = WinMIDIPort::Of(*endpoint);
        bool const isOnline = port != nullptr && port->GetActiveImpl() != nullptr;
        endpoint->Peer()->SetInt(Keys::kOffline, isOnline ? 0 : 1);
      }
    }
  };
  mark(Lists().sources);
  mark(Lists().destinations);
}

void WinMIDISetup::PropChanged(DeviceObjectImpl* object, UString const& key) {
  pendingChanges_.Add(object, key);
}

void WinMIDISetup::DevicesChanged() {
  MutexHolder const lock(sessionMutex_);
  if (session_ == nullptr) {
    return;
  }
  // The newest answer alone is ever collected.
  pollFuture_ = pollThread_->Post<PortList>([session = session_] {
    return EnumeratePorts(session->GetSystem(), *session->DirectMusic().get());
  });
}

bool WinMIDISetup::HasListedPorts() const {
  MutexHolder const lock(sessionMutex_);
  return pollFuture_ != nullptr && pollFuture_->IsComplete();
}

std::optional<PortList> WinMIDISetup::CollectPorts() {
  std::shared_ptr<VantorFuture<PortList>> future;
  {
    MutexHolder const lock(sessionMutex_);
    if (pollFuture_ == nullptr || !pollFuture_->IsComplete()) {
      return std::nullopt;
    }
    future.swap(pollFuture_);
  }
  return future->Try(0);
}

bool WinMIDISetup::PlatformPollSetupChanges(bool& connectionsChanged) {
  std::shared_ptr<Session> const session = GetSession();
  if (session == nullptr) {
    return false;
  }
  connectionsChanged = setupChanged_;
  if (std::optional<PortList> const ports = CollectPorts()) {
    PortAttacher attacher(*this, session);
    connectionsChanged |= Reconcile(*this, attacher, *ports);
  }
  bool notify = connectionsChanged;
  notify |= HandlePendingChanges(connectionsChanged);
  DropRemovedSources();
  setupChanged_ = false;
  return notify;
}

bool WinMIDISetup::HandlePendingChanges(bool& connectionsChanged) {
  // What the objects do may change properties anew: those wait for the next round.
  bool notify = false;
  std::vector<PendingChanges::Change> changes = pendingChanges_.Take();
  for (auto const& [object, keys] : changes) {
    if (object->Exists()) {
      notify = true;
      connectionsChanged |= object->HandlePropertyChanges(keys);
    }
  }
  pendingChanges_.GiveBack(std::move(changes));
  return notify;
}

void WinMIDISetup::AddActiveSource(RCPtrMT<EndpointImpl> const& source) {
  if (inActiveSources_.insert(source.get()).second) {
    activeSources_.push_back(source);
  }
}

void WinMIDISetup::DropRemovedSources() {
  auto const isRemoved = [this](RCPtrMT<EndpointImpl> const& source) {
    return !source->Exists() && inActiveSources_.erase(source.get()) != 0;
  };
  activeSources_.erase(std::remove_if(activeSources_.begin(), activeSources_.end(), isRemoved),
                       activeSources_.end());
}

void WinMIDISetup::PlatformPollImpl() {
  Clocks const now = CurrentMIDITime();
  auto const hostClocks = static_cast<unsigned long long>(TimerCalibrator::fgInstance.Clocks());
  std::shared_ptr<Session> const session = GetSession();
  if (session != nullptr) {
    CalibrateTimeBase(now, hostClocks, session->GetSystem().timeGetTime());
  }
}

void WinMIDISetup::ProcessInput() {
  DrainPorts();
  DrainVirtualSources();
}

void WinMIDISetup::DrainPorts() {
  // The receiver may change the studio, so the list is walked over a copy.
  auto sources = CopyForDrain(activeSources_);
  for (auto const& source : sources) {
    WinMIDIPort* const port = WinMIDIPort::Of(*source);
    if (port == nullptr) {
      continue;
    }
    if (port->GetWhichAPI() == WinMIDIPort::kLegacy) {
      static_cast<WinLegacyMIDIInPort*>(port->GetActiveImpl())->DrainInput();
    } else if (port->GetWhichAPI() == WinMIDIPort::kDirectMusic) {
      static_cast<WinDMusMIDIInPort*>(port->GetActiveImpl())
          ->DrainInput(GetReceiver(), Source(source));
    }
  }
  GiveBackCopy(std::move(sources));
}

// The room of a copy is kept for the next one, so that a poll allocates nothing. A drain within a
// drain finds none and makes its own.
WinMIDISetup::Sources WinMIDISetup::CopyForDrain(Sources const& sources) {
  Sources copy = std::move(roomForCopy_);
  copy.assign(sources.begin(), sources.end());
  return copy;
}

void WinMIDISetup::GiveBackCopy(Sources copy) {
  copy.clear();
  roomForCopy_ = std::move(copy);
}

void WinMIDISetup::DrainVirtualSources() {
  if (!virtualSourcesMutex_.tryLock()) {
    return;  // they wait for the next poll, which must never wait for them
  }
  auto sources = CopyForDrain(virtualSources_);
  virtualSourcesMutex_.unlock();
  for (auto const& source : sources) {
    // One that a receiver has deleted meanwhile is silent: its own receiver may be gone as well.
    auto const* const peer = dynamic_cast<WinMIDIVirtSource const*>(source->Peer());
    if (peer != nullptr && peer->Exists()) {
      std::shared_ptr<PacketQueue> const queue = peer->Queue();
      queue->Drain(GetReceiver(), Source(source), true);
    }
  }
  GiveBackCopy(std::move(sources));
}

}  // namespace Impl
}  // namespace Ostinet
