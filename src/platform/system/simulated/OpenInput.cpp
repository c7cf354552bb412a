// SPDX-License-Identifier: MIT
#include "platform/system/simulated/OpenInput.h"

#include <algorithm>
#include <utility>

namespace Ostinet::Impl::Simulated {

OpenInput::OpenInput(Studio& studio, PortPtr port, HMIDIIN handle, Callback* callback,
                     DWORD_PTR instance)
    : studio_(studio),
      port_(std::move(port)),
      handle_(handle),
      callback_(callback),
      instance_(instance) {}

OpenInput::~OpenInput() {
  if (!thread_.joinable()) return;
  {
    std::lock_guard lock(studio_.Mutex());
    quit_ = true;
    work_.notify_all();
  }
  thread_.join();
}

void OpenInput::Open(std::unique_lock<std::mutex>& lock) {
  port_->sinks.push_back(this);
  thread_ = std::thread([this] { Run(); });
  startTime_ = studio_.Clock().Now();
  Tell(MIM_OPEN, 0);
  WaitUntilTold(lock);
}

void OpenInput::Close(std::unique_lock<std::mutex>& lock) {
  auto& sinks = port_->sinks;
  sinks.erase(std::remove(sinks.begin(), sinks.end(), this), sinks.end());
  port_->opened = false;
  Tell(MIM_CLOSE, 0);
  quit_ = true;
  work_.notify_all();
  lock.unlock();
  thread_.join();
  lock.lock();
}

void OpenInput::Start() {
  started_ = true;
  startTime_ = studio_.Clock().Now();
}

void OpenInput::Stop(std::unique_lock<std::mutex>& lock) {
  started_ = false;
  // A buffer that holds something is given back as it is; empty ones stay for the next start.
  if (!buffers_.empty() && buffers_.front()->dwBytesRecorded != 0) GiveBack(MIM_LONGDATA);
  WaitUntilTold(lock);
}

void OpenInput::Reset(std::unique_lock<std::mutex>& lock) {
  started_ = false;
  parser_ = StreamParser();
  while (!buffers_.empty()) {
    buffers_.front()->dwBytesRecorded = 0;
    GiveBack(MIM_LONGDATA);
  }
  WaitUntilTold(lock);
}

void OpenInput::AddBuffer(MIDIHDR* header) {
  header->dwBytesRecorded = 0;
  header->dwFlags = (header->dwFlags & ~MHDR_DONE) | MHDR_INQUEUE;
  buffers_.push_back(header);
}

void OpenInput::Take(std::uint8_t const* bytes, std::size_t size) {
  if (started_) parser_.Parse(bytes, size, *this);
}

void OpenInput::Short(std::uint8_t const (&bytes)[3], int) {
  Tell(MIM_DATA, static_cast<DWORD_PTR>(bytes[0] | bytes[1] << 8 | bytes[2] << 16));
}

void OpenInput::Stray(std::uint8_t byte) { Tell(MIM_ERROR, byte); }

void OpenInput::SysexByte(std::uint8_t byte) {
  if (buffers_.empty()) return;  // nowhere to put it: lost
  MIDIHDR& header = *buffers_.front();
  if (header.dwBytesRecorded < header.dwBufferLength) {
    header.lpData[header.dwBytesRecorded] = static_cast<char>(byte);
    header.dwBytesRecorded += 1;
  }
  if (header.dwBytesRecorded >= header.dwBufferLength) GiveBack(MIM_LONGDATA);
}

void OpenInput::SysexEnd(bool whole) {
  if (buffers_.empty() || buffers_.front()->dwBytesRecorded == 0) return;
  GiveBack(whole ? MIM_LONGDATA : MIM_LONGERROR);
}

void OpenInput::GiveBack(UINT message) {
  MIDIHDR* const header = buffers_.front();
  buffers_.pop_front();
  header->dwFlags = (header->dwFlags & ~MHDR_INQUEUE) | MHDR_DONE;
  Tell(message, reinterpret_cast<DWORD_PTR>(header));
}

void OpenInput::Tell(UINT message, DWORD_PTR param1) {
  std::int64_t const elapsed = studio_.Clock().Now() - startTime_;
  pending_.push_back({message, param1, static_cast<DWORD_PTR>(elapsed / 10000)});
  work_.notify_all();
}

void OpenInput::WaitUntilTold(std::unique_lock<std::mutex>& lock) {
  if (IsOwnThread()) return;
  studio_.callbacksIdle.wait(lock, [this] { return IsIdle(); });
}

void OpenInput::Run() {
  std::vector<Message> messages;  // changes places with pending_, so that both keep their room
  std::unique_lock lock(studio_.Mutex());
  for (;;) {
    work_.wait(lock, [this] { return quit_ || !pending_.empty(); });
    if (pending_.empty()) return;
    calling_ = true;
    while (!pending_.empty()) {
      messages.swap(pending_);
      lock.unlock();
      for (Message const& each : messages) {
        if (callback_ != nullptr) {
          callback_(handle_, each.message, instance_, each.param1, each.param2);
        }
      }
      messages.clear();
      lock.lock();
    }
    calling_ = false;
    studio_.callbacksIdle.notify_all();
  }
}

}  // namespace Ostinet::Impl::Simulated
