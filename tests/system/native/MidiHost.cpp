// SPDX-License-Identifier: MIT
#include "system/native/MidiHost.h"

#include <chrono>

namespace Ostinet::Testing {

constexpr auto kHostPatience = std::chrono::seconds(30);

InputHost::InputHost(Impl::System& system, UINT device, int buffers) : system_(system) {
  opened_ = system_.midiInOpen(&handle_, device, reinterpret_cast<DWORD_PTR>(&OnMessage),
                               reinterpret_cast<DWORD_PTR>(this), CALLBACK_FUNCTION);
  if (opened_ != MMSYSERR_NOERROR) return;
  for (int i = 0; i < buffers; ++i) {
    Buffer& buffer = buffers_.emplace_back();
    buffer.header.lpData = buffer.bytes;
    buffer.header.dwBufferLength = sizeof buffer.bytes;
    system_.midiInPrepareHeader(handle_, &buffer.header, sizeof buffer.header);
    system_.midiInAddBuffer(handle_, &buffer.header, sizeof buffer.header);
  }
  system_.midiInStart(handle_);
}

MMRESULT InputHost::Close() {
  if (handle_ == nullptr) return MMSYSERR_INVALHANDLE;
  system_.midiInStop(handle_);
  system_.midiInReset(handle_);
  MMRESULT const result = system_.midiInClose(handle_);
  handle_ = nullptr;
  return result;
}

void CALLBACK InputHost::OnMessage(HDRVR, UINT message, DWORD_PTR self, DWORD_PTR param1,
                                   DWORD_PTR param2) {
  reinterpret_cast<InputHost*>(self)->Take(message, param1, param2);
}

void InputHost::Take(UINT message, DWORD_PTR param1, DWORD_PTR param2) {
  Piece piece;
  piece.time = static_cast<DWORD>(param2);
  if (message == MIM_LONGDATA) {
    auto* const header = reinterpret_cast<MIDIHDR*>(param1);
    if (header->dwBytesRecorded == 0) return;
    piece.isLong = true;
    piece.bytes.assign(header->lpData, header->lpData + header->dwBytesRecorded);
    system_.midiInAddBuffer(handle_, header, sizeof *header);
  } else if (message == MIM_DATA) {
    for (int shift : {0, 8, 16}) piece.bytes.push_back(static_cast<unsigned char>(param1 >> shift));
  }
  std::scoped_lock lock(mutex_);
  if (piece.bytes.empty()) {
    events_.push_back(message);
  } else {
    pieces_.push_back(std::move(piece));
  }
  arrived_.notify_all();
}

std::vector<InputHost::Piece> InputHost::WaitForPieces(std::size_t count) {
  std::unique_lock lock(mutex_);
  arrived_.wait_for(lock, kHostPatience, [&] { return pieces_.size() >= count; });
  return pieces_;
}

std::vector<UINT> InputHost::Events() {
  std::scoped_lock lock(mutex_);
  return events_;
}

std::vector<std::u16string> OutputNames(Impl::System& system) {
  std::vector<std::u16string> names;
  UINT const count = system.midiOutGetNumDevs();
  for (UINT i = 0; i < count; ++i) {
    MIDIOUTCAPSW caps{};
    bool const there = system.midiOutGetDevCapsW(i, &caps, sizeof caps) == MMSYSERR_NOERROR;
    names.emplace_back(there ? caps.szPname : u"");
  }
  return names;
}

std::vector<std::u16string> InputNames(Impl::System& system) {
  std::vector<std::u16string> names;
  UINT const count = system.midiInGetNumDevs();
  for (UINT i = 0; i < count; ++i) {
    MIDIINCAPSW caps{};
    bool const there = system.midiInGetDevCapsW(i, &caps, sizeof caps) == MMSYSERR_NOERROR;
    names.emplace_back(there ? caps.szPname : u"");
  }
  return names;
}

namespace {

int IndexOf(std::vector<std::u16string> const& names, std::u16string const& name) {
  for (std::size_t i = 0; i < names.size(); ++i) {
    if (names[i] == name) return static_cast<int>(i);
  }
  return -1;
}

}  // namespace

int FindOutput(Impl::System& system, std::u16string const& name) {
  return IndexOf(OutputNames(system), name);
}

int FindInput(Impl::System& system, std::u16string const& name) {
  return IndexOf(InputNames(system), name);
}

MMRESULT SendLong(Impl::System& system, HMIDIOUT output, std::vector<unsigned char> bytes) {
  MIDIHDR header{};
  header.lpData = reinterpret_cast<LPSTR>(bytes.data());
  header.dwBufferLength = static_cast<DWORD>(bytes.size());
  system.midiOutPrepareHeader(output, &header, sizeof header);
  MMRESULT const result = system.midiOutLongMsg(output, &header, sizeof header);
  system.midiOutUnprepareHeader(output, &header, sizeof header);
  return result;
}

}  // namespace Ostinet::Testing
