// SPDX-License-Identifier: MIT
#include "platform/system/simulated/LongHeader.h"
#include "platform/system/simulated/OpenOutput.h"
#include "platform/system/simulated/SimulatedSystem.h"
#include "platform/system/simulated/WideText.h"

namespace Ostinet::Impl::Simulated {

namespace {

constexpr MMRESULT kNoError = MMSYSERR_NOERROR;
// The device was there and is gone.
constexpr MMRESULT kNoDevice = 68;

using Lock = std::unique_lock<std::mutex>;

// One call on an open device: counted, made to fail, checked, carried out, written down.
template <class Action>
MMRESULT OnOpenOutput(Studio& studio, Op op, HMIDIOUT handle, CallBook::Arguments arguments,
                      Action const& action) {
  long long failure = 0;
  if (studio.Book().Fails(op, failure)) return static_cast<MMRESULT>(failure);
  MMRESULT result = MMSYSERR_INVALHANDLE;
  std::string const* name = nullptr;
  {
    Lock lock(studio.Mutex());
    auto const found = studio.openOutputs.find(reinterpret_cast<std::uintptr_t>(handle));
    if (found != studio.openOutputs.end()) {
      auto const output = found->second;
      name = output->port->name;
      result = action(*output, lock);
    }
  }
  studio.Book().Log(op, result, arguments, name);
  return result;
}

void Finish(MIDIHDR& header) { header.dwFlags = (header.dwFlags & ~MHDR_INQUEUE) | MHDR_DONE; }

// The bytes of a packed message: as many as its status asks for, the running status filled in.
// A sysex that is short enough to be packed ends with its F7.
std::size_t Unpack(DWORD message, std::uint8_t& runningStatus, std::uint8_t (&bytes)[4]) {
  for (unsigned i = 0; i < 4; ++i) bytes[i] = static_cast<std::uint8_t>(message >> (8 * i));
  if (bytes[0] < 0x80) {
    if (runningStatus == 0) return 0;
    bytes[2] = bytes[1];
    bytes[1] = bytes[0];
    bytes[0] = runningStatus;
  }
  std::uint8_t const status = bytes[0];
  if (status < 0xF0) {
    runningStatus = status;
    return (status & 0xE0) == 0xC0 ? 2 : 3;
  }
  if (status < 0xF8) runningStatus = 0;
  switch (status) {
    case 0xF0:
      for (std::size_t i = 1; i < 4; ++i) {
        if (bytes[i] == 0xF7) return i + 1;
      }
      return 4;
    case 0xF1:
    case 0xF3:
      return 2;
    case 0xF2:
      return 3;
    default:
      return 1;
  }
}

}  // namespace

UINT SimulatedSystem::midiOutGetNumDevs() {
  long long failure = 0;
  if (studio_->Book().Fails(Op::kMidiOutGetNumDevs, failure)) return static_cast<UINT>(failure);
  UINT const count = studio_->CountDevices(true);
  studio_->Book().Log(Op::kMidiOutGetNumDevs, count);
  return count;
}

MMRESULT SimulatedSystem::midiOutGetDevCapsW(UINT_PTR device, MIDIOUTCAPSW* caps, UINT size) {
  long long failure = 0;
  if (studio_->Book().Fails(Op::kMidiOutGetDevCaps, failure)) {
    return static_cast<MMRESULT>(failure);
  }
  MMRESULT result = MMSYSERR_BADDEVICEID;
  auto const port = studio_->Device(true, device);
  if (port != nullptr && (caps == nullptr || size < sizeof *caps)) {
    result = MMSYSERR_INVALPARAM;
  } else if (port != nullptr) {
    std::lock_guard lock(studio_->Mutex());
    *caps = {};
    caps->vDriverVersion = 0x100;
    CopyWide(port->wideName, caps->szPname, MAXPNAMELEN);
    caps->wTechnology = static_cast<WORD>(port->spec.technology);
    caps->wChannelMask = 0xFFFF;
    result = kNoError;
  }
  studio_->Book().Log(Op::kMidiOutGetDevCaps, result, {static_cast<long long>(device)});
  return result;
}

MMRESULT SimulatedSystem::midiOutOpen(HMIDIOUT* handle, UINT device, DWORD_PTR callback,
                                      DWORD_PTR instance, DWORD flags) {
  long long failure = 0;
  if (studio_->Book().Fails(Op::kMidiOutOpen, failure)) return static_cast<MMRESULT>(failure);
  auto const port = studio_->Device(true, device);
  DWORD const kind = flags & CALLBACK_TYPEMASK;
  MMRESULT result = kNoError;
  if (port == nullptr) {
    result = MMSYSERR_BADDEVICEID;
  } else if (handle == nullptr) {
    result = MMSYSERR_INVALPARAM;
  } else if (kind != CALLBACK_FUNCTION && kind != CALLBACK_NULL) {
    result = MMSYSERR_NOTSUPPORTED;
  }
  std::string const* name = nullptr;
  std::shared_ptr<OpenOutput> output;
  if (result == kNoError) {
    std::lock_guard lock(studio_->Mutex());
    name = port->name;
    if (port->opened) {
      result = MMSYSERR_ALLOCATED;
    } else {
      port->opened = true;
      auto const number = studio_->NextHandle();
      output = std::make_shared<OpenOutput>();
      output->port = port;
      output->handle = *handle = reinterpret_cast<HMIDIOUT>(number);
      if (kind == CALLBACK_FUNCTION) {
        output->callback = reinterpret_cast<OpenOutput::Callback*>(callback);
      }
      output->instance = instance;
      studio_->openOutputs[number] = output;
    }
  }
  if (output != nullptr) output->Tell(MOM_OPEN, 0);
  studio_->Book().Log(Op::kMidiOutOpen, result, {device}, name);
  return result;
}

MMRESULT SimulatedSystem::midiOutClose(HMIDIOUT handle) {
  return OnOpenOutput(*studio_, Op::kMidiOutClose, handle, {}, [&](OpenOutput& output, Lock& lock) {
    if (!output.playing.empty()) return MMRESULT{MIDIERR_STILLPLAYING};
    studio_->openOutputs.erase(reinterpret_cast<std::uintptr_t>(handle));
    output.port->opened = false;
    lock.unlock();
    output.Tell(MOM_CLOSE, 0);
    return kNoError;
  });
}

MMRESULT SimulatedSystem::midiOutReset(HMIDIOUT handle) {
  return OnOpenOutput(*studio_, Op::kMidiOutReset, handle, {}, [](OpenOutput& output, Lock& lock) {
    auto const playing = std::exchange(output.playing, {});
    for (auto const& [header, tries] : playing) Finish(*header);
    lock.unlock();
    for (auto const& [header, tries] : playing) {
      output.Tell(MOM_DONE, reinterpret_cast<DWORD_PTR>(header));
    }
    return kNoError;
  });
}

MMRESULT SimulatedSystem::midiOutShortMsg(HMIDIOUT handle, DWORD message) {
  return OnOpenOutput(*studio_, Op::kMidiOutShortMsg, handle, {message},
                      [&](OpenOutput& output, Lock&) {
                        if (!output.port->present) return kNoDevice;
                        std::uint8_t bytes[4];
                        std::size_t const size = Unpack(message, output.runningStatus, bytes);
                        if (size == 0) return MMRESULT{MMSYSERR_INVALPARAM};
                        std::int64_t const now = studio_->Clock().Now();
                        studio_->Emit(*output.port, bytes, size, {now, now, now});
                        return kNoError;
                      });
}

MMRESULT SimulatedSystem::midiOutPrepareHeader(HMIDIOUT handle, MIDIHDR* header, UINT size) {
  return OnOpenOutput(*studio_, Op::kMidiOutPrepareHeader, handle, {size}, [&](OpenOutput&, Lock&) {
    if (!IsHeader(header, size)) return MMRESULT{MMSYSERR_INVALPARAM};
    header->dwFlags |= MHDR_PREPARED;
    return kNoError;
  });
}

MMRESULT SimulatedSystem::midiOutUnprepareHeader(HMIDIOUT handle, MIDIHDR* header, UINT size) {
  return OnOpenOutput(*studio_, Op::kMidiOutUnprepareHeader, handle, {size},
                      [&](OpenOutput& output, Lock& lock) {
                        if (!IsHeader(header, size)) return MMRESULT{MMSYSERR_INVALPARAM};
                        auto const found = output.playing.find(header);
                        if (found != output.playing.end() && found->second-- > 0) {
                          return MMRESULT{MIDIERR_STILLPLAYING};
                        }
                        bool const finishes = found != output.playing.end();
                        if (finishes) {
                          output.playing.erase(found);
                          Finish(*header);
                        }
                        header->dwFlags &= ~MHDR_PREPARED;
                        lock.unlock();
                        if (finishes) output.Tell(MOM_DONE, reinterpret_cast<DWORD_PTR>(header));
                        return kNoError;
                      });
}

MMRESULT SimulatedSystem::midiOutLongMsg(HMIDIOUT handle, MIDIHDR* header, UINT size) {
  return OnOpenOutput(
      *studio_, Op::kMidiOutLongMsg, handle, {size, header != nullptr ? header->dwBufferLength : 0},
      [&](OpenOutput& output, Lock& lock) {
        if (!IsHeader(header, size)) return MMRESULT{MMSYSERR_INVALPARAM};
        if ((header->dwFlags & MHDR_PREPARED) == 0) return MMRESULT{MIDIERR_UNPREPARED};
        if (output.playing.count(header) != 0) return MMRESULT{MIDIERR_STILLPLAYING};
        if (!output.port->present) return kNoDevice;
        std::int64_t const now = studio_->Clock().Now();
        output.runningStatus = 0;
        studio_->Emit(*output.port, reinterpret_cast<std::uint8_t const*>(header->lpData),
                      header->dwBufferLength, {now, now, now});
        if (studio_->longMessageTries > 0) {
          header->dwFlags = (header->dwFlags & ~MHDR_DONE) | MHDR_INQUEUE;
          output.playing[header] = studio_->longMessageTries;
          return kNoError;
        }
        Finish(*header);
        lock.unlock();
        output.Tell(MOM_DONE, reinterpret_cast<DWORD_PTR>(header));
        return kNoError;
      });
}

}  // namespace Ostinet::Impl::Simulated
