// SPDX-License-Identifier: MIT
#include "platform/system/native/NativeSystem.h"

#include <algorithm>
#include <cstring>
#include <utility>

#include "platform/system/native/NativeDirectMusic.h"
#include "platform/system/native/SteadyReferenceClock.h"

namespace Ostinet::Impl {
namespace {

constexpr WORD kUnmappedID = 0xFFFF;  // manufacturer and product of no list
constexpr MMVERSION kDriverVersion = 0x0100;

template <class Caps>
Caps DescribePort(std::u16string const& name) {
  Caps caps{};
  caps.wMid = kUnmappedID;
  caps.wPid = kUnmappedID;
  caps.vDriverVersion = kDriverVersion;
  std::copy(name.begin(), name.end(), caps.szPname);
  return caps;
}

// A caller with an older, shorter structure gets as much as it asks for.
template <class Caps>
MMRESULT GiveCaps(Caps const& caps, Caps* target, UINT size) {
  if (target == nullptr) return MMSYSERR_INVALPARAM;
  std::memcpy(target, &caps, std::min<std::size_t>(size, sizeof caps));
  return MMSYSERR_NOERROR;
}

MMRESULT Prepare(MIDIHDR* header, UINT size) {
  if (header == nullptr || size < sizeof(MIDIHDR)) return MMSYSERR_INVALPARAM;
  header->dwFlags |= MHDR_PREPARED;
  return MMSYSERR_NOERROR;
}

MMRESULT Unprepare(MIDIHDR* header, UINT size) {
  if (header == nullptr || size < sizeof(MIDIHDR)) return MMSYSERR_INVALPARAM;
  if ((header->dwFlags & MHDR_INQUEUE) != 0) return MIDIERR_STILLPLAYING;
  header->dwFlags &= ~MHDR_PREPARED;
  return MMSYSERR_NOERROR;
}

}  // namespace

NativeSystem::NativeSystem(std::vector<std::shared_ptr<MidiService>> services,
                           std::unique_ptr<Waits> waits)
    : services_(std::move(services)),
      waits_(std::move(waits)),
      ports_(std::make_shared<PortTable>(services_)),
      watch_([ports = ports_, seen = ports_->Refresh()]() mutable {
        unsigned const before = std::exchange(seen, ports->Refresh());
        return before != seen;
      }) {
  for (auto const& service : services_) {
    service->SetChangeHint([this] { watch_.Hint(); });
  }
}

NativeSystem::~NativeSystem() {
  for (auto const& service : services_) service->SetChangeHint(nullptr);
}

UINT NativeSystem::midiInGetNumDevs() {
  ports_->Refresh();
  return ports_->Count();
}

MMRESULT NativeSystem::midiInGetDevCapsW(UINT_PTR device, MIDIINCAPSW* caps, UINT size) {
  auto const port = ports_->Find(PortDirection::kInput, device);
  if (!port) return MMSYSERR_BADDEVICEID;
  return GiveCaps(DescribePort<MIDIINCAPSW>(port->name), caps, size);
}

MMRESULT NativeSystem::midiInOpen(HMIDIIN* handle, UINT device, DWORD_PTR callback,
                                  DWORD_PTR instance, DWORD flags) {
  if (handle == nullptr) return MMSYSERR_INVALPARAM;
  auto const port = ports_->Find(PortDirection::kInput, device);
  if (!port) return MMSYSERR_BADDEVICEID;
  auto const input = std::make_shared<NativeInput>(DeviceCallback(callback, instance, flags));
  HMIDIIN const made = inputs_.Add(input);
  bool const open = input->Open(made, [&port](InputSink sink) {
    return port->service->OpenInput(port->id, std::move(sink));
  });
  if (!open) {
    inputs_.Remove(made);
    return MMSYSERR_NODRIVER;
  }
  *handle = made;
  return MMSYSERR_NOERROR;
}

MMRESULT NativeSystem::midiInClose(HMIDIIN handle) {
  auto const input = inputs_.Find(handle);
  if (!input) return MMSYSERR_INVALHANDLE;
  MMRESULT const result = input->Close();
  if (result == MMSYSERR_NOERROR) inputs_.Remove(handle);
  return result;
}

MMRESULT NativeSystem::midiInStart(HMIDIIN handle) {
  auto const input = inputs_.Find(handle);
  return input ? input->Start() : MMSYSERR_INVALHANDLE;
}

MMRESULT NativeSystem::midiInStop(HMIDIIN handle) {
  auto const input = inputs_.Find(handle);
  return input ? input->Stop() : MMSYSERR_INVALHANDLE;
}

MMRESULT NativeSystem::midiInReset(HMIDIIN handle) {
  auto const input = inputs_.Find(handle);
  return input ? input->Reset() : MMSYSERR_INVALHANDLE;
}

MMRESULT NativeSystem::midiInPrepareHeader(HMIDIIN handle, MIDIHDR* header, UINT size) {
  return inputs_.Find(handle) ? Prepare(header, size) : MMSYSERR_INVALHANDLE;
}

MMRESULT NativeSystem::midiInUnprepareHeader(HMIDIIN handle, MIDIHDR* header, UINT size) {
  return inputs_.Find(handle) ? Unprepare(header, size) : MMSYSERR_INVALHANDLE;
}

MMRESULT NativeSystem::midiInAddBuffer(HMIDIIN handle, MIDIHDR* header, UINT size) {
  auto const input = inputs_.Find(handle);
  return input ? input->AddBuffer(header, size) : MMSYSERR_INVALHANDLE;
}

UINT NativeSystem::midiOutGetNumDevs() {
  ports_->Refresh();
  return ports_->Count();
}

MMRESULT NativeSystem::midiOutGetDevCapsW(UINT_PTR device, MIDIOUTCAPSW* caps, UINT size) {
  auto const port = ports_->Find(PortDirection::kOutput, device);
  if (!port) return MMSYSERR_BADDEVICEID;
  auto described = DescribePort<MIDIOUTCAPSW>(port->name);
  described.wTechnology = MOD_MIDIPORT;
  described.wChannelMask = 0xFFFF;
  return GiveCaps(described, caps, size);
}

MMRESULT NativeSystem::midiOutOpen(HMIDIOUT* handle, UINT device, DWORD_PTR callback,
                                   DWORD_PTR instance, DWORD flags) {
  if (handle == nullptr) return MMSYSERR_INVALPARAM;
  auto const port = ports_->Find(PortDirection::kOutput, device);
  if (!port) return MMSYSERR_BADDEVICEID;
  auto wire = port->service->OpenOutput(port->id);
  if (!wire) return MMSYSERR_NODRIVER;
  auto const output =
      std::make_shared<NativeOutput>(std::move(wire), DeviceCallback(callback, instance, flags));
  *handle = outputs_.Add(output);
  output->ReportOpen(*handle);
  return MMSYSERR_NOERROR;
}

MMRESULT NativeSystem::midiOutClose(HMIDIOUT handle) {
  auto const output = outputs_.Remove(handle);
  if (!output) return MMSYSERR_INVALHANDLE;
  output->Close(handle);
  return MMSYSERR_NOERROR;
}

MMRESULT NativeSystem::midiOutReset(HMIDIOUT handle) {
  auto const output = outputs_.Find(handle);
  return output ? output->Reset() : MMSYSERR_INVALHANDLE;
}

MMRESULT NativeSystem::midiOutShortMsg(HMIDIOUT handle, DWORD message) {
  auto const output = outputs_.Find(handle);
  return output ? output->ShortMessage(message) : MMSYSERR_INVALHANDLE;
}

MMRESULT NativeSystem::midiOutPrepareHeader(HMIDIOUT handle, MIDIHDR* header, UINT size) {
  return outputs_.Find(handle) ? Prepare(header, size) : MMSYSERR_INVALHANDLE;
}

MMRESULT NativeSystem::midiOutUnprepareHeader(HMIDIOUT handle, MIDIHDR* header, UINT size) {
  return outputs_.Find(handle) ? Unprepare(header, size) : MMSYSERR_INVALHANDLE;
}

MMRESULT NativeSystem::midiOutLongMsg(HMIDIOUT handle, MIDIHDR* header, UINT size) {
  auto const output = outputs_.Find(handle);
  return output ? output->LongMessage(handle, header, size) : MMSYSERR_INVALHANDLE;
}

DWORD NativeSystem::timeGetTime() { return static_cast<DWORD>(SteadyClocks() / 10000); }

HRESULT NativeSystem::CreateDirectMusic(IDirectMusic** result) {
  if (result == nullptr) return E_POINTER;
  *result = new NativeDirectMusic(ports_);
  return S_OK;
}

HRESULT NativeSystem::CreateDirectMusicLoader(IDirectMusicLoader** result) {
  if (result == nullptr) return E_POINTER;
  *result = new NativeLoader;
  return S_OK;
}

std::shared_ptr<void> NativeSystem::WatchDeviceChanges(std::function<void()> changed) {
  return watch_.Add(std::move(changed));
}

}  // namespace Ostinet::Impl
