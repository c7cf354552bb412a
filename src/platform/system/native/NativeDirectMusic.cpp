// SPDX-License-Identifier: MIT
#include "platform/system/native/NativeDirectMusic.h"

#include <algorithm>
#include <new>
#include <string>
#include <string_view>
#include <utility>

#include "platform/system/native/MemoryMusicBuffer.h"
#include "platform/system/native/SteadyReferenceClock.h"

namespace Ostinet::Impl {
namespace {

constexpr std::u16string_view kEmulatedSuffix = u" [Emulated]";
constexpr DWORD kLargestBuffer = 1U << 30;

// The same port has the same identifier in every run: it follows from direction and name (FNV-1a,
// once for each half).
GUID PortGuid(DWORD portClass, std::u16string const& name) {
  constexpr ULONGLONG kPrime = 0x100000001B3;
  ULONGLONG halves[2] = {0xCBF29CE484222325, 0x84222325CBF29CE4};
  for (ULONGLONG& half : halves) {
    half = (half ^ portClass) * kPrime;
    for (char16_t unit : name) half = (half ^ unit) * kPrime;
  }
  GUID guid{static_cast<DWORD>(halves[0]),
            static_cast<WORD>(halves[0] >> 32),
            static_cast<WORD>(halves[0] >> 48),
            {}};
  for (int i = 0; i < 8; ++i) guid.Data4[i] = static_cast<BYTE>(halves[1] >> (8 * i));
  return guid;
}

DMUS_PORTCAPS Describe(DWORD portClass, std::u16string const& name) {
  DMUS_PORTCAPS caps{};
  caps.dwSize = sizeof caps;
  caps.dwFlags = DMUS_PC_EXTERNAL | DMUS_PC_SHAREABLE;
  caps.guidPort = PortGuid(portClass, name);
  caps.dwClass = portClass;
  caps.dwType = DMUS_PORT_WINMM_DRIVER;
  caps.dwMaxChannelGroups = 1;
  std::u16string description = name.substr(0, DMUS_MAX_DESCRIPTION - 1 - kEmulatedSuffix.size());
  description += kEmulatedSuffix;
  std::copy(description.begin(), description.end(), caps.wszDescription);
  return caps;
}

}  // namespace

NativeDirectMusic::NativeDirectMusic(std::shared_ptr<PortTable> ports) : ports_(std::move(ports)) {}

HRESULT NativeDirectMusic::EnumPort(DWORD index, LPDMUS_PORTCAPS caps) {
  if (caps == nullptr) return E_POINTER;
  if (index == 0) ports_->Refresh();
  std::scoped_lock lock(mutex_);
  if (index == 0) {
    seen_.clear();
    for (TablePort const& port : ports_->Present(PortDirection::kOutput)) {
      seen_.push_back(Describe(DMUS_PC_OUTPUTCLASS, port.name));
    }
    for (TablePort const& port : ports_->Present(PortDirection::kInput)) {
      seen_.push_back(Describe(DMUS_PC_INPUTCLASS, port.name));
    }
  }
  if (index >= seen_.size()) return S_FALSE;
  *caps = seen_[index];
  return S_OK;
}

HRESULT NativeDirectMusic::CreateMusicBuffer(LPDMUS_BUFFERDESC description,
                                             LPDIRECTMUSICBUFFER* buffer, LPUNKNOWN outer) {
  if (description == nullptr || buffer == nullptr) return E_POINTER;
  *buffer = nullptr;
  if (outer != nullptr) return CLASS_E_NOAGGREGATION;
  if (description->dwSize < sizeof(DMUS_BUFFERDESC) || description->cbBuffer == 0 ||
      description->cbBuffer > kLargestBuffer) {
    return E_INVALIDARG;
  }
  try {
    *buffer = new MemoryMusicBuffer(description->cbBuffer, description->guidBufferFormat);
    return S_OK;
  } catch (std::bad_alloc const&) {
    return E_OUTOFMEMORY;
  }
}

HRESULT NativeDirectMusic::CreatePort(REFCLSID, LPDMUS_PORTPARAMS, LPDIRECTMUSICPORT* result,
                                      LPUNKNOWN) {
  if (result != nullptr) *result = nullptr;
  return E_FAIL;
}

HRESULT NativeDirectMusic::EnumMasterClock(DWORD, LPDMUS_CLOCKINFO) { return S_FALSE; }

HRESULT NativeDirectMusic::GetMasterClock(LPGUID guid, IReferenceClock** clock) {
  if (guid != nullptr) *guid = GUID{};
  if (clock != nullptr) *clock = new SteadyReferenceClock;
  return S_OK;
}

HRESULT NativeDirectMusic::SetMasterClock(REFGUID) { return E_NOTIMPL; }

HRESULT NativeDirectMusic::Activate(BOOL) { return S_OK; }

HRESULT NativeDirectMusic::GetDefaultPort(LPGUID) { return E_NOTIMPL; }

HRESULT NativeDirectMusic::SetDirectSound(LPDIRECTSOUND, HWND) { return S_OK; }

HRESULT NativeLoader::GetObject(LPDMUS_OBJECTDESC, REFIID, LPVOID* object) {
  if (object != nullptr) *object = nullptr;
  return DMUS_E_NOT_FOUND;
}

}  // namespace Ostinet::Impl
