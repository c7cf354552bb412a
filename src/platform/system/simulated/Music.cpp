// SPDX-License-Identifier: MIT
#include "platform/system/simulated/Music.h"

#include <algorithm>
#include <string>

#include "platform/system/simulated/Instruments.h"
#include "platform/system/simulated/MusicBuffer.h"
#include "platform/system/simulated/MusicPort.h"
#include "platform/system/simulated/WideText.h"

namespace Ostinet::Impl::Simulated {

namespace {

// The smallest buffer takes one short message, the largest is far beyond what a host asks for.
constexpr DWORD kSmallestBuffer = 24;
constexpr DWORD kLargestBuffer = 1 << 24;

}  // namespace

HRESULT Music::EnumPort(DWORD index, LPDMUS_PORTCAPS caps) {
  HRESULT result = S_OK;
  if (Fails(Op::kEnumPort, result)) return result;
  if (caps == nullptr) return E_POINTER;
  if (caps->dwSize != sizeof *caps) return Log(Op::kEnumPort, E_INVALIDARG, {index});
  auto const port = GetStudio().MusicPortAt(index);
  if (port == nullptr) return Log(Op::kEnumPort, S_FALSE, {index});
  std::string const* name = nullptr;
  {
    std::lock_guard lock(GetStudio().Mutex());
    FillPortCaps(*port, *caps);
    name = port->name;
  }
  return Log(Op::kEnumPort, S_OK, {index}, name);
}

HRESULT Music::CreateMusicBuffer(LPDMUS_BUFFERDESC description, LPDIRECTMUSICBUFFER* buffer,
                                 LPUNKNOWN outer) {
  HRESULT result = S_OK;
  if (Fails(Op::kCreateMusicBuffer, result)) return result;
  if (description == nullptr || buffer == nullptr) return E_POINTER;
  *buffer = nullptr;
  DWORD const size = description->cbBuffer;
  if (outer != nullptr) {
    result = CLASS_E_NOAGGREGATION;
  } else if (description->dwSize != sizeof *description || size < kSmallestBuffer ||
             size > kLargestBuffer) {
    result = E_INVALIDARG;
  } else {
    *buffer = new MusicBuffer(SharedStudio(), size);
  }
  return Log(Op::kCreateMusicBuffer, result, {size});
}

HRESULT Music::CreatePort(REFCLSID guid, LPDMUS_PORTPARAMS params, LPDIRECTMUSICPORT* port,
                          LPUNKNOWN outer) {
  HRESULT result = S_OK;
  if (Fails(Op::kCreatePort, result)) return result;
  if (params == nullptr || port == nullptr) return E_POINTER;
  *port = nullptr;
  if (outer != nullptr) return Log(Op::kCreatePort, CLASS_E_NOAGGREGATION);
  auto const found = GetStudio().MusicPortWith(PortIDOf(guid));
  if (found == nullptr) return Log(Op::kCreatePort, REGDB_E_CLASSNOTREG);
  *port = new MusicPort(SharedStudio(), found);
  std::string const* name = nullptr;
  {
    std::lock_guard lock(GetStudio().Mutex());
    name = found->name;
  }
  return Log(Op::kCreatePort, S_OK, {params->dwSize, params->dwValidParams}, name);
}

HRESULT Music::GetMasterClock(LPGUID guid, IReferenceClock** clock) {
  HRESULT result = S_OK;
  if (Fails(Op::kGetMasterClock, result)) return result;
  if (guid != nullptr) *guid = {};
  if (clock != nullptr) *clock = new StudioClock(SharedStudio(), 0);
  return Log(Op::kGetMasterClock, S_OK);
}

HRESULT Music::SetDirectSound(LPDIRECTSOUND, HWND) {
  HRESULT result = S_OK;
  if (Fails(Op::kSetDirectSound, result)) return result;
  return Log(Op::kSetDirectSound, S_OK);
}

HRESULT Loader::GetObject(LPDMUS_OBJECTDESC description, REFIID iid, LPVOID* object) {
  HRESULT result = S_OK;
  if (Fails(Op::kGetObject, result)) return result;
  if (description == nullptr || object == nullptr) return E_POINTER;
  *object = nullptr;
  constexpr DWORD kNeeded = DMUS_OBJ_OBJECT | DMUS_OBJ_CLASS;
  if (description->dwSize != sizeof *description ||
      (description->dwValidData & kNeeded) != kNeeded) {
    result = E_INVALIDARG;
  } else if (description->guidClass != CLSID_DirectMusicCollection ||
             description->guidObject != GUID_DefaultGMCollection) {
    result = DMUS_E_NOT_FOUND;
  } else {
    auto* const collection = new Collection(SharedStudio());
    result = collection->QueryInterface(iid, object);
    collection->Release();
  }
  return Log(Op::kGetObject, result, {description->dwSize, description->dwValidData});
}

HRESULT Collection::GetInstrument(DWORD patch, IDirectMusicInstrument** instrument) {
  HRESULT result = S_OK;
  if (Fails(Op::kGetInstrument, result)) return result;
  if (instrument == nullptr) return E_POINTER;
  *instrument = nullptr;
  bool known = false;
  {
    std::lock_guard lock(GetStudio().Mutex());
    auto const& patches = GetStudio().collection;
    known = std::find(patches.begin(), patches.end(), patch) != patches.end();
  }
  if (known) *instrument = new CollectionInstrument(SharedStudio(), patch);
  return Log(Op::kGetInstrument, known ? S_OK : S_FALSE, {patch});
}

HRESULT Collection::EnumInstrument(DWORD index, DWORD* patch, LPWSTR name, DWORD nameLength) {
  HRESULT result = S_OK;
  if (Fails(Op::kEnumInstrument, result)) return result;
  if (patch == nullptr) return E_POINTER;
  {
    std::lock_guard lock(GetStudio().Mutex());
    auto const& patches = GetStudio().collection;
    bool const endless = GetStudio().endlessInstruments && !patches.empty();
    if (index >= patches.size() && !endless) {
      result = S_FALSE;
    } else {
      *patch = patches[index % patches.size()];
    }
  }
  if (result == S_OK && name != nullptr && nameLength > 0) {
    CopyWide(Widen("Instrument " + std::to_string(*patch)), name, nameLength);
  }
  return Log(Op::kEnumInstrument, result, {index});
}

}  // namespace Ostinet::Impl::Simulated
