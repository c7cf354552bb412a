// SPDX-License-Identifier: MIT
#include "platform/system/native/NativeInput.h"

#include <algorithm>
#include <chrono>
#include <cstring>
#include <utility>

namespace Ostinet::Impl {
namespace {

std::int64_t SteadyMicroseconds() {
  return std::chrono::duration_cast<std::chrono::microseconds>(
             std::chrono::steady_clock::now().time_since_epoch())
      .count();
}

}  // namespace

NativeInput::NativeInput(DeviceCallback callback) : callback_(callback) {}

NativeInput::~NativeInput() {
  wire_.reset();
  ending_ = true;
  arrived_.release();
  if (thread_.joinable()) thread_.join();
}

bool NativeInput::Open(HMIDIIN handle, Opener const& open) {
  handle_ = handle;
  wire_ = open(
      [this](unsigned char const* bytes, std::size_t count) { TakeFromService(bytes, count); });
  if (!wire_) return false;
  thread_ = std::thread([this] { Run(); });
  callback_.Call(handle_, MIM_OPEN);
  return true;
}

MMRESULT NativeInput::Close() {
  if (std::this_thread::get_id() == thread_.get_id()) return MIDIERR_STILLPLAYING;
  {
    std::scoped_lock lock(mutex_);
    if (!buffers_.empty()) return MIDIERR_STILLPLAYING;
  }
  wire_.reset();
  ending_ = true;
  arrived_.release();
  thread_.join();
  callback_.Call(handle_, MIM_CLOSE);
  return MMSYSERR_NOERROR;
}

MMRESULT NativeInput::Start() {
  startedAt_ = SteadyMicroseconds();
  return MMSYSERR_NOERROR;
}

MMRESULT NativeInput::Stop() {
  startedAt_ = -1;
  std::scoped_lock delivering(delivering_);
  return MMSYSERR_NOERROR;
}

MMRESULT NativeInput::Reset() {
  Stop();
  std::deque<MIDIHDR*> returned;
  {
    std::scoped_lock lock(mutex_);
    returned.swap(buffers_);
  }
  for (MIDIHDR* header : returned) GiveBack(header, 0, 0);
  return MMSYSERR_NOERROR;
}

MMRESULT NativeInput::AddBuffer(MIDIHDR* header, UINT size) {
  if (header == nullptr || size < sizeof(MIDIHDR)) return MMSYSERR_INVALPARAM;
  if ((header->dwFlags & MHDR_PREPARED) == 0) return MIDIERR_UNPREPARED;
  std::scoped_lock lock(mutex_);
  if ((header->dwFlags & MHDR_INQUEUE) != 0) return MIDIERR_STILLPLAYING;
  header->dwBytesRecorded = 0;
  header->dwFlags = (header->dwFlags & ~MHDR_DONE) | MHDR_INQUEUE;
  buffers_.push_back(header);
  return MMSYSERR_NOERROR;
}

void NativeInput::TakeFromService(unsigned char const* bytes, std::size_t count) {
  std::int64_t const startedAt = startedAt_;
  if (startedAt < 0 || count == 0) return;
  auto const time = static_cast<std::uint32_t>((SteadyMicroseconds() - startedAt) / 1000);
  if (ring_.Push(time, bytes, count)) arrived_.release();
}

void NativeInput::Run() {
  std::vector<unsigned char> bytes;
  for (;;) {
    arrived_.acquire();
    if (ending_) return;
    std::scoped_lock delivering(delivering_);
    std::uint32_t time = 0;
    if (ring_.Pop(time, bytes) && startedAt_ >= 0) Deliver(time, bytes);
  }
}

void NativeInput::Deliver(std::uint32_t time, std::vector<unsigned char> const& bytes) {
  bool const isShort = bytes.size() <= 3 && bytes[0] >= 0x80 && bytes[0] != 0xF0;
  if (!isShort) {
    DeliverLong(time, bytes);
    return;
  }
  DWORD word = 0;
  for (std::size_t i = 0; i < bytes.size(); ++i) word |= static_cast<DWORD>(bytes[i]) << (8 * i);
  callback_.Call(handle_, MIM_DATA, word, time);
}

// What finds no buffer is lost, as it is with a driver.
void NativeInput::DeliverLong(std::uint32_t time, std::vector<unsigned char> const& bytes) {
  for (std::size_t at = 0; at < bytes.size();) {
    MIDIHDR* const header = TakeBuffer();
    if (header == nullptr) return;
    std::size_t const count = std::min<std::size_t>(bytes.size() - at, header->dwBufferLength);
    if (count > 0) std::memcpy(header->lpData, bytes.data() + at, count);
    at += count;
    GiveBack(header, static_cast<DWORD>(count), time);
  }
}

MIDIHDR* NativeInput::TakeBuffer() {
  std::scoped_lock lock(mutex_);
  if (buffers_.empty()) return nullptr;
  MIDIHDR* const header = buffers_.front();
  buffers_.pop_front();
  return header;
}

void NativeInput::GiveBack(MIDIHDR* header, DWORD recorded, std::uint32_t time) {
  header->dwBytesRecorded = recorded;
  header->dwFlags = (header->dwFlags & ~MHDR_INQUEUE) | MHDR_DONE;
  callback_.Call(handle_, MIM_LONGDATA, reinterpret_cast<DWORD_PTR>(header), time);
}

}  // namespace Ostinet::Impl
