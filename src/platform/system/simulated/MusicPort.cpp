// SPDX-License-Identifier: MIT
#include "platform/system/simulated/MusicPort.h"

#include <algorithm>
#include <utility>

#include "platform/system/simulated/Instruments.h"
#include "platform/system/simulated/WideText.h"

namespace Ostinet::Impl::Simulated {

namespace {

constexpr std::size_t kWinMMName = 31;

// Every port's GUID is this one, with the port's number in front.
constexpr GUID kPortGUID = {0, 0x5EED, 0x4A11, {0xA5, 0x1D, 0x0C, 0x71, 0x6E, 0x7B, 0x3D, 0x90}};

DWORD FlagsOf(SimulatedPort const& spec) {
  switch (spec.kind) {
    case SimulatedPort::Kind::kWinMMOut:
      return spec.technology == MOD_MIDIPORT ? DMUS_PC_EXTERNAL : 0;
    case SimulatedPort::Kind::kWinMMIn:
      return DMUS_PC_EXTERNAL;
    default:
      break;
  }
  DWORD flags = 0;
  if (spec.external) flags |= DMUS_PC_EXTERNAL;
  if (spec.dls) flags |= DMUS_PC_DLS | DMUS_PC_SOFTWARESYNTH;
  if (spec.gmInHardware) flags |= DMUS_PC_GMINHARDWARE;
  return flags;
}

DWORD TypeOf(Port const& port) {
  if (port.IsWinMM() || port.spec.emulated) return DMUS_PORT_WINMM_DRIVER;
  return port.spec.dls ? DMUS_PORT_USER_MODE_SYNTH : DMUS_PORT_KERNEL_MODE;
}

}  // namespace

void FillPortCaps(Port const& port, DMUS_PORTCAPS& caps) {
  caps = {};
  caps.dwSize = sizeof caps;
  caps.dwFlags = FlagsOf(port.spec);
  caps.guidPort = kPortGUID;
  caps.guidPort.Data1 = port.id;
  caps.dwClass = port.IsOutput() ? DMUS_PC_OUTPUTCLASS : DMUS_PC_INPUTCLASS;
  caps.dwType = TypeOf(port);
  caps.dwMaxChannelGroups = 1;
  std::u16string description = port.wideName;
  if (port.IsWinMM()) {
    // Shown by the name that WinMM has room for.
    WCHAR name[kWinMMName + 1];
    CopyWide(port.wideName, name, kWinMMName + 1);
    description.assign(name, std::find(name, name + kWinMMName, WCHAR()));
  }
  if (caps.dwType == DMUS_PORT_WINMM_DRIVER) description += u" [Emulated]";
  CopyWide(description, caps.wszDescription, DMUS_MAX_DESCRIPTION);
}

std::uint32_t PortIDOf(REFGUID guid) {
  GUID expected = kPortGUID;
  expected.Data1 = guid.Data1;
  return guid == expected ? static_cast<std::uint32_t>(guid.Data1) : 0;
}

MusicPort::MusicPort(std::shared_ptr<Studio> studio, PortPtr port)
    : ComObject(std::move(studio), ObjectCounts::kPort, IID_IDirectMusicPort),
      port_(std::move(port)) {}

MusicPort::~MusicPort() {
  if (latencyClock_ != nullptr) {
    latencyClock_->Release();
  }
  std::lock_guard lock(GetStudio().Mutex());
  DetachLocked();
}

void MusicPort::DetachLocked() {
  active_ = false;
  auto& sinks = port_->sinks;
  sinks.erase(std::remove(sinks.begin(), sinks.end(), static_cast<InputSink*>(this)), sinks.end());
  GetStudio().Unschedule(this);
}

HRESULT MusicPort::Activate(BOOL active) {
  HRESULT result = S_OK;
  if (Fails(Op::kActivate, result)) return result;
  std::string const* name = nullptr;
  {
    std::lock_guard lock(GetStudio().Mutex());
    name = port_->name;
    DetachLocked();
    active_ = active != FALSE;
    if (active_ && !port_->IsOutput()) port_->sinks.push_back(this);
  }
  return Log(Op::kActivate, S_OK, {active}, name);
}

HRESULT MusicPort::PlayBuffer(LPDIRECTMUSICBUFFER buffer) {
  HRESULT result = S_OK;
  if (Fails(Op::kPlayBuffer, result)) return result;
  auto* const own = dynamic_cast<MusicBuffer*>(buffer);
  if (own == nullptr) return E_INVALIDARG;
  std::string const* name = nullptr;
  {
    std::lock_guard lock(GetStudio().Mutex());
    name = port_->name;
    result = PlayLocked(*own);
  }
  return Log(Op::kPlayBuffer, result, {}, name);
}

HRESULT MusicPort::PlayLocked(MusicBuffer& buffer) {
  if (!port_->IsOutput()) return DMUS_E_PORT_NOT_RENDER;
  if (buffer.IsEmpty()) return DMUS_E_BUFFER_EMPTY;
  if (!active_) return E_FAIL;
  DWORD offset = 0;
  for (MusicBuffer::Event event; buffer.Next(offset, event);) {
    GetStudio().Schedule(port_, this, event.time, event.data, event.size);
  }
  return S_OK;
}

HRESULT MusicPort::SetReadNotificationHandle(HANDLE event) {
  HRESULT result = S_OK;
  if (Fails(Op::kSetReadNotificationHandle, result)) return result;
  std::string const* name = nullptr;
  {
    std::lock_guard lock(GetStudio().Mutex());
    name = port_->name;
    notification_ = event;
    if (event != nullptr && !arrivals_.empty()) GetStudio().GetWaits().SignalQuietly(event);
  }
  return Log(Op::kSetReadNotificationHandle, S_OK, {event != nullptr ? 1 : 0}, name);
}

HRESULT MusicPort::Read(LPDIRECTMUSICBUFFER buffer) {
  HRESULT result = S_OK;
  if (Fails(Op::kRead, result)) return result;
  auto* const own = dynamic_cast<MusicBuffer*>(buffer);
  if (own == nullptr) return E_INVALIDARG;
  std::string const* name = nullptr;
  {
    std::lock_guard lock(GetStudio().Mutex());
    name = port_->name;
    result = ReadLocked(*own);
  }
  return Log(Op::kRead, result, {}, name);
}

HRESULT MusicPort::ReadLocked(MusicBuffer& buffer) {
  if (port_->IsOutput()) return DMUS_E_PORT_NOT_CAPTURE;
  if (GetStudio().endlessRead) {
    std::uint8_t const activeSensing = 0xFE;
    std::int64_t const now = GetStudio().Clock().Now();
    return buffer.Append(now, 1, DMUS_EVENT_STRUCTURED, &activeSensing, 1);
  }
  bool any = false;
  while (!arrivals_.empty()) {
    Arrival& next = arrivals_.front();
    auto size = static_cast<DWORD>(next.bytes.size());
    bool const fits = MusicBuffer::Footprint(size) <= buffer.Room();
    // One that no buffer of this size takes comes in pieces.
    if (!fits && any) break;
    if (!fits) size = buffer.Room() < 24 ? 0 : ((buffer.Room() & ~DWORD{7}) - 20);
    if (size == 0) break;
    DWORD const flags = next.bytes[0] >= 0x80 && next.bytes[0] != 0xF0 ? DMUS_EVENT_STRUCTURED : 0;
    if (FAILED(buffer.Append(next.time, 1, flags, next.bytes.data(), size))) break;
    any = true;
    next.bytes.erase(next.bytes.begin(), next.bytes.begin() + static_cast<std::ptrdiff_t>(size));
    if (!next.bytes.empty()) break;
    arrivals_.pop_front();
  }
  return any ? S_OK : S_FALSE;
}

HRESULT MusicPort::DownloadInstrument(IDirectMusicInstrument* instrument,
                                      IDirectMusicDownloadedInstrument** downloaded,
                                      DMUS_NOTERANGE*, DWORD) {
  HRESULT result = S_OK;
  if (Fails(Op::kDownloadInstrument, result)) return result;
  if (instrument == nullptr || downloaded == nullptr) return E_POINTER;
  *downloaded = nullptr;
  std::string const* name = nullptr;
  {
    std::lock_guard lock(GetStudio().Mutex());
    name = port_->name;
    result = port_->spec.dls ? S_OK : E_NOTIMPL;
    if (result == S_OK) ++port_->downloaded;
  }
  DWORD patch = 0;
  instrument->GetPatch(&patch);
  if (result == S_OK) *downloaded = new DownloadedInstrument(SharedStudio(), port_);
  return Log(Op::kDownloadInstrument, result, {patch}, name);
}

HRESULT MusicPort::UnloadInstrument(IDirectMusicDownloadedInstrument* downloaded) {
  HRESULT result = S_OK;
  if (Fails(Op::kUnloadInstrument, result)) return result;
  auto* const own = dynamic_cast<DownloadedInstrument*>(downloaded);
  if (own == nullptr) return E_INVALIDARG;
  std::string const* name = nullptr;
  {
    std::lock_guard lock(GetStudio().Mutex());
    name = port_->name;
    bool const ours = own->IsLoadedOn(*port_);
    if (ours) own->UnloadLocked();
    result = ours ? S_OK : DMUS_E_NOT_DOWNLOADED_TO_PORT;
  }
  return Log(Op::kUnloadInstrument, result, {}, name);
}

HRESULT MusicPort::GetLatencyClock(IReferenceClock** clock) {
  HRESULT result = S_OK;
  if (Fails(Op::kGetLatencyClock, result)) return result;
  if (clock == nullptr) return E_POINTER;
  std::call_once(latencyClockMade_, [this] {
    latencyClock_ = new StudioClock(SharedStudio(), port_->spec.latencyMicroseconds * 10);
  });
  latencyClock_->AddRef();
  *clock = latencyClock_;
  return Log(Op::kGetLatencyClock, S_OK);
}

HRESULT MusicPort::GetCaps(LPDMUS_PORTCAPS caps) {
  if (caps == nullptr) return E_POINTER;
  std::lock_guard lock(GetStudio().Mutex());
  FillPortCaps(*port_, *caps);
  return S_OK;
}

HRESULT MusicPort::GetNumChannelGroups(LPDWORD groups) {
  if (groups == nullptr) return E_POINTER;
  *groups = 1;
  return S_OK;
}

void MusicPort::Take(std::uint8_t const* bytes, std::size_t size) {
  parser_.Parse(bytes, size, *this);
}

void MusicPort::Short(std::uint8_t const (&bytes)[3], int length) {
  Arrive({bytes, bytes + length});
}

void MusicPort::SysexByte(std::uint8_t byte) { sysex_.push_back(byte); }

void MusicPort::SysexEnd(bool whole) {
  auto message = std::exchange(sysex_, {});
  if (whole) Arrive(std::move(message));
}

void MusicPort::Arrive(std::vector<std::uint8_t> bytes) {
  arrivals_.push_back({GetStudio().Clock().Now(), std::move(bytes)});
  if (notification_ != nullptr) GetStudio().GetWaits().SignalQuietly(notification_);
}

}  // namespace Ostinet::Impl::Simulated
