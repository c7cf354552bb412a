// SPDX-License-Identifier: MIT
#include "platform/system/native/NativeOutput.h"

#include <utility>

#include "platform/system/native/MessageSplitter.h"

namespace Ostinet::Impl {

// Long enough for the note-offs of a reset, short enough for a host that quits.
constexpr unsigned kFinishMilliseconds = 500;

NativeOutput::NativeOutput(std::unique_ptr<OutputWire> wire, DeviceCallback callback)
    : lane_(std::make_unique<OutputLane>(std::move(wire))), callback_(callback) {}

void NativeOutput::ReportOpen(HMIDIOUT handle) { callback_.Call(handle, MOM_OPEN); }

void NativeOutput::Close(HMIDIOUT handle) {
  lane_->Finish(kFinishMilliseconds);
  callback_.Call(handle, MOM_CLOSE);
}

MMRESULT NativeOutput::Reset() {
  lane_->Silence();
  return MMSYSERR_NOERROR;
}

MMRESULT NativeOutput::ShortMessage(DWORD message) {
  unsigned char const bytes[3] = {static_cast<unsigned char>(message),
                                  static_cast<unsigned char>(message >> 8),
                                  static_cast<unsigned char>(message >> 16)};
  std::size_t const count = MessageLength(bytes[0]);
  // A word without a status is running status, which needs what a service does not keep.
  if (count == 0) return MMSYSERR_INVALPARAM;
  return lane_->Push(bytes, count) ? MMSYSERR_NOERROR : MIDIERR_NOTREADY;
}

MMRESULT NativeOutput::LongMessage(HMIDIOUT handle, MIDIHDR* header, UINT size) {
  if (header == nullptr || size < sizeof(MIDIHDR)) return MMSYSERR_INVALPARAM;
  if (header->lpData == nullptr) return MMSYSERR_INVALPARAM;
  if ((header->dwFlags & MHDR_PREPARED) == 0) return MIDIERR_UNPREPARED;
  auto const bytes = reinterpret_cast<unsigned char const*>(header->lpData);
  if (!lane_->Push(bytes, header->dwBufferLength)) return MIDIERR_NOTREADY;
  header->dwFlags |= MHDR_DONE;
  callback_.Call(handle, MOM_DONE, reinterpret_cast<DWORD_PTR>(header));
  return MMSYSERR_NOERROR;
}

}  // namespace Ostinet::Impl
