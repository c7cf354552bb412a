// SPDX-License-Identifier: MIT
#pragma once

#include <gtest/gtest.h>

#include <mutex>
#include <string>
#include <vector>

#include "ostinet/SimulatedMIDI.h"
#include "platform/system/simulated/SimulatedSystem.h"

namespace Ostinet::Impl::Simulated {

using Bytes = std::vector<unsigned char>;
using PortKind = SimulatedPort::Kind;

inline SimulatedPort PortOf(std::string const& name, PortKind kind) {
  SimulatedPort port;
  port.name = name;
  port.kind = kind;
  return port;
}

/// A result as the field writes it.
inline unsigned Code(HRESULT result) { return static_cast<unsigned>(result); }

inline std::string Narrow(WCHAR const* text) {
  std::string result;
  for (; *text != 0; ++text) result += static_cast<char>(*text);
  return result;
}

inline std::vector<Bytes> BytesOf(std::vector<SimulatedMessage> const& messages) {
  std::vector<Bytes> result;
  for (auto const& each : messages) result.push_back(each.bytes);
  return result;
}

/// A studio whose clock is moved by hand, from 1000 on.
class SimulatedTest : public testing::Test {
 protected:
  SimulatedTest() { studio_.MoveClockByHand(1000); }

  System& Sys() const { return *studio_.GetSystem(); }

  SimulatedMIDI studio_;
};

/// A reference to a COM object that a test owns.
template <class T>
class Held {
 public:
  Held() = default;
  Held(Held const&) = delete;
  Held& operator=(Held const&) = delete;
  ~Held() { Reset(); }

  T** Out() { return &object_; }
  T* Get() const { return object_; }
  T* operator->() const { return object_; }
  void Reset() {
    if (object_ != nullptr) object_->Release();
    object_ = nullptr;
  }

 private:
  T* object_ = nullptr;
};

/// An open WinMM input with what its callback was told.
class InputLog {
 public:
  struct Told {
    UINT message;
    DWORD_PTR param1;
    DWORD_PTR milliseconds;
    bool operator==(Told const& other) const {
      return message == other.message && param1 == other.param1 &&
             milliseconds == other.milliseconds;
    }
  };

  MMRESULT Open(System& system, UINT device) {
    return system.midiInOpen(&handle, device, reinterpret_cast<DWORD_PTR>(&Callback),
                             reinterpret_cast<DWORD_PTR>(this), CALLBACK_FUNCTION);
  }

  std::vector<Told> Take() {
    std::lock_guard lock(mutex_);
    return std::exchange(told_, {});
  }

  HMIDIIN handle = nullptr;

 private:
  static void CALLBACK Callback(HMIDIIN, UINT message, DWORD_PTR instance, DWORD_PTR param1,
                                DWORD_PTR param2) {
    auto* const self = reinterpret_cast<InputLog*>(instance);
    std::lock_guard lock(self->mutex_);
    self->told_.push_back({message, param1, param2});
  }

  std::mutex mutex_;
  std::vector<Told> told_;
};

/// A header with its buffer.
struct Header {
  explicit Header(std::size_t size) : bytes(size) {
    header.lpData = bytes.data();
    header.dwBufferLength = static_cast<DWORD>(size);
  }
  explicit Header(Bytes const& from) : Header(from.size()) {
    for (std::size_t i = 0; i < from.size(); ++i) bytes[i] = static_cast<char>(from[i]);
  }
  Bytes Recorded() const {
    return {bytes.begin(), bytes.begin() + static_cast<std::ptrdiff_t>(header.dwBytesRecorded)};
  }
  DWORD_PTR Address() const { return reinterpret_cast<DWORD_PTR>(&header); }

  std::vector<char> bytes;
  MIDIHDR header{};
};

constexpr UINT kHeaderSize = sizeof(MIDIHDR);

}  // namespace Ostinet::Impl::Simulated
