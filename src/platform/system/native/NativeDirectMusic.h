// SPDX-License-Identifier: MIT
#pragma once

#include <memory>
#include <mutex>
#include <vector>

#include "platform/system/native/ComObject.h"
#include "platform/system/native/PortTable.h"

namespace Ostinet::Impl {

/// A DirectMusic session over the machine's ports. It lists each as an emulated port, to which the
/// WinMM device of that name belongs, and it makes buffers and the clock. The ports are opened
/// through their WinMM devices only: CreatePort fails.
///
/// Threads  Any.
class NativeDirectMusic final : public ComObject<IDirectMusic, IID_IDirectMusic> {
 public:
  explicit NativeDirectMusic(std::shared_ptr<PortTable> ports);

  /// Index 0 looks at the machine anew; the following ones go on with what was seen then.
  HRESULT EnumPort(DWORD index, LPDMUS_PORTCAPS caps) override;
  HRESULT CreateMusicBuffer(LPDMUS_BUFFERDESC description, LPDIRECTMUSICBUFFER* buffer,
                            LPUNKNOWN outer) override;
  HRESULT CreatePort(REFCLSID port, LPDMUS_PORTPARAMS params, LPDIRECTMUSICPORT* result,
                     LPUNKNOWN outer) override;
  HRESULT EnumMasterClock(DWORD index, LPDMUS_CLOCKINFO info) override;
  HRESULT GetMasterClock(LPGUID guid, IReferenceClock** clock) override;
  HRESULT SetMasterClock(REFGUID guid) override;
  HRESULT Activate(BOOL enable) override;
  HRESULT GetDefaultPort(LPGUID guid) override;
  HRESULT SetDirectSound(LPDIRECTSOUND sound, HWND window) override;

 private:
  std::shared_ptr<PortTable> const ports_;
  std::mutex mutex_;
  std::vector<DMUS_PORTCAPS> seen_;  // guarded by mutex_
};

/// A loader that finds nothing: the machine's ports take no instruments.
class NativeLoader final : public ComObject<IDirectMusicLoader, IID_IDirectMusicLoader> {
 public:
  HRESULT GetObject(LPDMUS_OBJECTDESC description, REFIID iid, LPVOID* object) override;
  HRESULT SetObject(LPDMUS_OBJECTDESC) override { return E_NOTIMPL; }
  HRESULT SetSearchDirectory(REFGUID, WCHAR*, BOOL) override { return E_NOTIMPL; }
  HRESULT ScanDirectory(REFGUID, WCHAR*, WCHAR*) override { return E_NOTIMPL; }
  HRESULT CacheObject(IDirectMusicObject*) override { return E_NOTIMPL; }
  HRESULT ReleaseObject(IDirectMusicObject*) override { return E_NOTIMPL; }
  HRESULT ClearCache(REFGUID) override { return S_OK; }
  HRESULT EnableCache(REFGUID, BOOL) override { return S_OK; }
  HRESULT EnumObject(REFGUID, DWORD, LPDMUS_OBJECTDESC) override { return S_FALSE; }
};

}  // namespace Ostinet::Impl
