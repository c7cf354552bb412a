// SPDX-License-Identifier: MIT
#include "platform/system/simulated/LongHeader.h"
#include "platform/system/simulated/OpenInput.h"
#include "platform/system/simulated/SimulatedSystem.h"
#include "platform/system/simulated/WideText.h"

namespace Ostinet::Impl::Simulated {

namespace {

// One call on an open device: counted, made to fail, checked, carried out, written down.
template <class Action>
MMRESULT OnOpenInput(Studio& studio, Op op, HMIDIIN handle, CallBook::Arguments arguments,
                     Action const& action) {
  long long failure = 0;
  if (studio.Book().Fails(op, failure)) return static_cast<MMRESULT>(failure);
  MMRESULT result = MMSYSERR_INVALHANDLE;
  std::string const* name = nullptr;
  {
    std::unique_lock lock(studio.Mutex());
    auto const found = studio.openInputs.find(reinterpret_cast<std::uintptr_t>(handle));
    if (found != studio.openInputs.end()) {
      // Held for the call: another thread may close the device meanwhile.
      auto const input = found->second;
      name = input->GetPort().name;
      result = action(*input, lock);
    }
  }
  studio.Book().Log(op, result, arguments, name);
  return result;
}

}  // namespace

UINT SimulatedSystem::midiInGetNumDevs() {
  long long failure = 0;
  if (studio_->Book().Fails(Op::kMidiInGetNumDevs, failure)) return static_cast<UINT>(failure);
  UINT const count = studio_->CountDevices(false);
  studio_->Book().Log(Op::kMidiInGetNumDevs, count);
  return count;
}

MMRESULT SimulatedSystem::midiInGetDevCapsW(UINT_PTR device, MIDIINCAPSW* caps, UINT size) {
  long long failure = 0;
  if (studio_->Book().Fails(Op::kMidiInGetDevCaps, failure)) return static_cast<MMRESULT>(failure);
  MMRESULT result = MMSYSERR_BADDEVICEID;
  auto const port = studio_->Device(false, device);
  if (port != nullptr && (caps == nullptr || size < sizeof *caps)) {
    result = MMSYSERR_INVALPARAM;
  } else if (port != nullptr) {
    std::lock_guard lock(studio_->Mutex());
    *caps = {};
    caps->vDriverVersion = 0x100;
    CopyWide(port->wideName, caps->szPname, MAXPNAMELEN);
    result = MMSYSERR_NOERROR;
  }
  studio_->Book().Log(Op::kMidiInGetDevCaps, result, {static_cast<long long>(device)});
  return result;
}

MMRESULT SimulatedSystem::midiInOpen(HMIDIIN* handle, UINT device, DWORD_PTR callback,
                                     DWORD_PTR instance, DWORD flags) {
  long long failure = 0;
  if (studio_->Book().Fails(Op::kMidiInOpen, failure)) return static_cast<MMRESULT>(failure);
  MMRESULT result = MMSYSERR_NOERROR;
  std::string const* name = nullptr;
  auto const port = studio_->Device(false, device);
  DWORD const kind = flags & CALLBACK_TYPEMASK;
  if (port == nullptr) {
    result = MMSYSERR_BADDEVICEID;
  } else if (handle == nullptr) {
    result = MMSYSERR_INVALPARAM;
  } else if (kind != CALLBACK_FUNCTION && kind != CALLBACK_NULL) {
    result = MMSYSERR_NOTSUPPORTED;
  } else {
    std::unique_lock lock(studio_->Mutex());
    name = port->name;
    if (port->opened) {
      result = MMSYSERR_ALLOCATED;
    } else {
      port->opened = true;
      auto const number = studio_->NextHandle();
      *handle = reinterpret_cast<HMIDIIN>(number);
      auto* const function =
          kind == CALLBACK_FUNCTION ? reinterpret_cast<OpenInput::Callback*>(callback) : nullptr;
      auto const input = std::make_shared<OpenInput>(*studio_, port, *handle, function, instance);
      studio_->openInputs[number] = input;
      input->Open(lock);
    }
  }
  studio_->Book().Log(Op::kMidiInOpen, result, {device}, name);
  return result;
}

MMRESULT SimulatedSystem::midiInClose(HMIDIIN handle) {
  return OnOpenInput(*studio_, Op::kMidiInClose, handle, {}, [&](OpenInput& input, auto& lock) {
    if (input.HasBuffers() || input.IsOwnThread()) return MMRESULT{MIDIERR_STILLPLAYING};
    studio_->openInputs.erase(reinterpret_cast<std::uintptr_t>(handle));
    input.Close(lock);
    return MMRESULT{MMSYSERR_NOERROR};
  });
}

MMRESULT SimulatedSystem::midiInStart(HMIDIIN handle) {
  return OnOpenInput(*studio_, Op::kMidiInStart, handle, {}, [](OpenInput& input, auto&) {
    input.Start();
    return MMRESULT{MMSYSERR_NOERROR};
  });
}

MMRESULT SimulatedSystem::midiInStop(HMIDIIN handle) {
  return OnOpenInput(*studio_, Op::kMidiInStop, handle, {}, [](OpenInput& input, auto& lock) {
    input.Stop(lock);
    return MMRESULT{MMSYSERR_NOERROR};
  });
}

MMRESULT SimulatedSystem::midiInReset(HMIDIIN handle) {
  return OnOpenInput(*studio_, Op::kMidiInReset, handle, {}, [](OpenInput& input, auto& lock) {
    input.Reset(lock);
    return MMRESULT{MMSYSERR_NOERROR};
  });
}

MMRESULT SimulatedSystem::midiInPrepareHeader(HMIDIIN handle, MIDIHDR* header, UINT size) {
  return OnOpenInput(*studio_, Op::kMidiInPrepareHeader, handle, {size}, [&](OpenInput&, auto&) {
    if (!IsHeader(header, size)) return MMRESULT{MMSYSERR_INVALPARAM};
    header->dwFlags |= MHDR_PREPARED;
    return MMRESULT{MMSYSERR_NOERROR};
  });
}

MMRESULT SimulatedSystem::midiInUnprepareHeader(HMIDIIN handle, MIDIHDR* header, UINT size) {
  long long failure = 0;
  if (studio_->Book().Fails(Op::kMidiInUnprepareHeader, failure)) {
    return static_cast<MMRESULT>(failure);
  }
  // Headers are the host's memory: one may be unprepared after its device was closed.
  MMRESULT result = MMSYSERR_NOERROR;
  if (!IsHeader(header, size)) {
    result = MMSYSERR_INVALPARAM;
  } else {
    std::lock_guard lock(studio_->Mutex());
    if ((header->dwFlags & MHDR_INQUEUE) != 0) {
      result = MIDIERR_STILLPLAYING;
    } else {
      header->dwFlags &= ~MHDR_PREPARED;
      bool const open = studio_->openInputs.count(reinterpret_cast<std::uintptr_t>(handle)) != 0;
      result = open ? MMSYSERR_NOERROR : MMSYSERR_INVALHANDLE;
    }
  }
  studio_->Book().Log(Op::kMidiInUnprepareHeader, result, {size});
  return result;
}

MMRESULT SimulatedSystem::midiInAddBuffer(HMIDIIN handle, MIDIHDR* header, UINT size) {
  return OnOpenInput(*studio_, Op::kMidiInAddBuffer, handle, {size}, [&](OpenInput& input, auto&) {
    if (!IsHeader(header, size)) return MMRESULT{MMSYSERR_INVALPARAM};
    if ((header->dwFlags & MHDR_PREPARED) == 0) return MMRESULT{MIDIERR_UNPREPARED};
    if ((header->dwFlags & MHDR_INQUEUE) != 0) return MMRESULT{MIDIERR_STILLPLAYING};
    input.AddBuffer(header);
    return MMRESULT{MMSYSERR_NOERROR};
  });
}

}  // namespace Ostinet::Impl::Simulated
