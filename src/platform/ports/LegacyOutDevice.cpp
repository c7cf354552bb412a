// SPDX-License-Identifier: MIT

#include "platform/ports/LegacyOutDevice.h"

#include <algorithm>
#include <chrono>
#include <cstring>
#include <limits>
#include <system_error>
#include <vector>

#include "ostinet/core/Error.h"

namespace Ostinet::Impl {

namespace {

constexpr unsigned long long kWordBytes = 4;

/// Counts a sender in for the length of one message.
class CountedIn {
 public:
  explicit CountedIn(std::atomic<int>& count) : count_(count) { ++count_; }
  ~CountedIn() {
    --count_;
    count_.notify_all();
  }
  CountedIn(CountedIn const&) = delete;
  CountedIn& operator=(CountedIn const&) = delete;

 private:
  std::atomic<int>& count_;
};

/// The longest wait, of 14,000 years: added to any time of the clock it stays within 64 bits.
constexpr long long kForEver = std::numeric_limits<long long>::max() / 2;

/// How much later than now the stamp is, in clocks; 0 when it has come or cannot be told.
long long ClocksUntil(TimeStamp const& stamp) {
  unsigned long long const due = stamp.AsMIDITime().Value();
  if (due == 0) {
    return 0;
  }
  try {
    auto const late = static_cast<long long>(CurrentMIDITime().Value() - due);
    return late < 0 ? -std::max(late, -kForEver) : 0;
  } catch (VantorError const&) {
    return 0;  // a clock that fails must not hold output back
  }
}

/// A device that did not reset stays open in the system, which may still call back: what it calls
/// back with lives as long as the process.
void KeepForever(std::shared_ptr<LegacyOutDevice> device) {
  static std::mutex mutex;
  static auto* const kept = new std::vector<std::shared_ptr<LegacyOutDevice>>;
  std::lock_guard<std::mutex> const lock(mutex);
  kept->push_back(std::move(device));
}

/// How long a device may take to give a long message back: twice what a cable needs at 3,125
/// bytes a second, and a second more.
std::chrono::milliseconds PatienceFor(DWORD length) {
  return std::chrono::milliseconds(1000 + 2ull * length * 1000 / 3125);
}

}  // namespace

std::shared_ptr<LegacyOutDevice> LegacyOutDevice::Make(std::shared_ptr<Session> session) {
  std::shared_ptr<LegacyOutDevice> device(new LegacyOutDevice(std::move(session)));
  try {
    device->thread_ = std::thread([raw = device.get()] { raw->Run(); });
  } catch (std::system_error const& error) {
    FailOSErr(error.code().value());
    throw;
  }
  return device;
}

LegacyOutDevice::LegacyOutDevice(std::shared_ptr<Session> session)
    : session_(std::move(session)), waits_(session_->GetWaits()) {
  itemsSemaphore_ = waits_.CreateSemaphoreW(0, kMostWaiting);
  if (itemsSemaphore_ == nullptr) {
    FailWinError(static_cast<int>(waits_.GetLastError()));
    FailMemFullError();
  }
  quitSemaphore_ = waits_.CreateSemaphoreW(0, 1);
  if (quitSemaphore_ == nullptr) {
    int const error = static_cast<int>(waits_.GetLastError());
    waits_.CloseHandle(itemsSemaphore_);
    FailWinError(error);
    FailMemFullError();
  }
}

LegacyOutDevice::~LegacyOutDevice() {
  waits_.CloseHandle(quitSemaphore_);
  waits_.CloseHandle(itemsSemaphore_);
}

void LegacyOutDevice::Open(UINT device) {
  HMIDIOUT handle = nullptr;
  auto const callback = reinterpret_cast<DWORD_PTR>(&LegacyOutDevice::OnMessage);
  if (session_->GetSystem().midiOutOpen(&handle, device, callback,
                                        reinterpret_cast<DWORD_PTR>(this),
                                        CALLBACK_FUNCTION) == MMSYSERR_NOERROR) {
    handle_ = handle;
  }
}

void LegacyOutDevice::StopThread() {
  constexpr int kTries = 16;
  for (int tries = 0; tries < kTries; ++tries) {
    if (waits_.ReleaseSemaphore(quitSemaphore_, 1)) {
      thread_.join();
      return;
    }
  }
  // A thread that cannot be woken must not hang the host. It sends nothing any more.
  thread_.detach();
  KeepForever(shared_from_this());
}

void LegacyOutDevice::Close() {
  if (isClosing_.exchange(true)) {
    return;
  }
  StopThread();
  for (int sending = sending_; sending != 0; sending = sending_) {
    sending_.wait(sending);
  }
  HMIDIOUT const handle = handle_;
  if (handle == nullptr) {
    return;
  }
  System& system = session_->GetSystem();
  if (system.midiOutReset(handle) != MMSYSERR_NOERROR ||
      system.midiOutClose(handle) != MMSYSERR_NOERROR) {
    KeepForever(shared_from_this());
  }
}

void CALLBACK LegacyOutDevice::OnMessage(HMIDIOUT, UINT message, DWORD_PTR instance, DWORD_PTR,
                                         DWORD_PTR) {
  if (message == MOM_CLOSE) {
    reinterpret_cast<LegacyOutDevice*>(instance)->handle_ = nullptr;
  }
}

void LegacyOutDevice::SendPacket(DataPacket const& packet) {
  if (ClocksUntil(packet.stamp) > 0) {
    Enqueue(packet);
  } else {
    SendNow(packet.data, packet.length);
  }
}

void LegacyOutDevice::Enqueue(DataPacket const& packet) {
  MutexHolder const lock(queueMutex_);
  try {
    queue_.PushBack(packet);
    if (!waits_.ReleaseSemaphore(itemsSemaphore_, 1)) {
      queue_.PopBack();  // full: the newest is lost
    }
  } catch (std::bad_alloc const&) {
    // No room for a copy: the packet is lost, as any that cannot go out.
  }
}

void LegacyOutDevice::SendNow(unsigned char const* data, unsigned long long length) {
  CountedIn const counted(sending_);
  HMIDIOUT const handle = handle_;
  if (isClosing_ || handle == nullptr || length == 0) {
    return;
  }
  if (length <= kWordBytes) {
    DWORD message = 0;
    for (unsigned i = 0; i < length; ++i) {
      message |= static_cast<DWORD>(data[i]) << (8 * i);
    }
    session_->GetSystem().midiOutShortMsg(handle, message);
  } else if (length <= std::numeric_limits<DWORD>::max()) {
    SendLong(handle, data, static_cast<DWORD>(length));
  }
}

void LegacyOutDevice::SendLong(HMIDIOUT handle, unsigned char const* data, DWORD length) {
  System& system = session_->GetSystem();
  MIDIHDR header{};
  header.lpData = reinterpret_cast<LPSTR>(const_cast<unsigned char*>(data));
  header.dwBufferLength = length;
  if (system.midiOutPrepareHeader(handle, &header, sizeof header) != MMSYSERR_NOERROR) {
    return;
  }
  system.midiOutLongMsg(handle, &header, sizeof header);
  // A driver that plays in the background holds on to the header. It has to let go before the
  // header leaves this frame; a reset makes it when patience ends.
  auto const deadline = std::chrono::steady_clock::now() + PatienceFor(length);
  while (system.midiOutUnprepareHeader(handle, &header, sizeof header) == MIDIERR_STILLPLAYING) {
    if (std::chrono::steady_clock::now() >= deadline) {
      system.midiOutReset(handle);
      system.midiOutUnprepareHeader(handle, &header, sizeof header);
      return;
    }
    std::this_thread::sleep_for(std::chrono::milliseconds(1));
  }
}

void LegacyOutDevice::Run() {
  HANDLE const timer = waits_.CreateWaitableTimerW();
  PacketRing::Packet packet;
  while (WaitForItem()) {
    if (!WaitForTime(timer)) {
      break;
    }
    SendNext(packet);
  }
  if (timer != nullptr) {
    waits_.CloseHandle(timer);
  }
}

bool LegacyOutDevice::WaitForItem() {
  HANDLE const objects[] = {quitSemaphore_, itemsSemaphore_};
  return waits_.WaitForMultipleObjects(2, objects, INFINITE) == WAIT_OBJECT_0 + 1;
}

bool LegacyOutDevice::WaitForTime(HANDLE timer) {
  long long const clocks = ClocksUntil(FrontStamp());
  if (clocks == 0) {
    return true;
  }
  // A negative due time counts from now, in the unit of our clocks.
  if (timer != nullptr && waits_.SetWaitableTimer(timer, -clocks)) {
    HANDLE const objects[] = {quitSemaphore_, timer};
    return waits_.WaitForMultipleObjects(2, objects, INFINITE) == WAIT_OBJECT_0 + 1;
  }
  // No timer to be had: the same wait in milliseconds.
  constexpr long long kClocksAMillisecond = 10000;
  constexpr long long kLongestWait = 0x7FFFFFFF;
  long long const wait = (clocks + kClocksAMillisecond - 1) / kClocksAMillisecond;
  return waits_.WaitForSingleObject(
             quitSemaphore_, static_cast<DWORD>(std::min(wait, kLongestWait))) == WAIT_TIMEOUT;
}

void LegacyOutDevice::SendNext(PacketRing::Packet& packet) {
  if (TakeFront(packet)) {
    SendNow(packet.bytes.data(), packet.bytes.size());
  }
}

TimeStamp LegacyOutDevice::FrontStamp() {
  MutexHolder const lock(queueMutex_);
  return queue_.IsEmpty() ? kNoTimeStamp : queue_.Front().stamp;
}

bool LegacyOutDevice::TakeFront(PacketRing::Packet& packet) {
  MutexHolder const lock(queueMutex_);
  if (queue_.IsEmpty()) {
    return false;
  }
  queue_.PopFront(packet);
  return true;
}

}  // namespace Ostinet::Impl
