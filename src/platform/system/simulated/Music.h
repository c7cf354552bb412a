// SPDX-License-Identifier: MIT
#pragma once

#include "platform/system/simulated/ComObject.h"

namespace Ostinet::Impl::Simulated {

/// The DirectMusic session of a simulated studio.
class Music final : public ComObject<IDirectMusic> {
 public:
  explicit Music(std::shared_ptr<Studio> studio)
      : ComObject(std::move(studio), ObjectCounts::kMusic, IID_IDirectMusic) {}

  HRESULT STDMETHODCALLTYPE EnumPort(DWORD index, LPDMUS_PORTCAPS caps) override;
  HRESULT STDMETHODCALLTYPE CreateMusicBuffer(LPDMUS_BUFFERDESC description,
                                              LPDIRECTMUSICBUFFER* buffer,
                                              LPUNKNOWN outer) override;
  HRESULT STDMETHODCALLTYPE CreatePort(REFCLSID port, LPDMUS_PORTPARAMS params,
                                       LPDIRECTMUSICPORT* result, LPUNKNOWN outer) override;
  HRESULT STDMETHODCALLTYPE EnumMasterClock(DWORD, LPDMUS_CLOCKINFO) override { return S_FALSE; }
  HRESULT STDMETHODCALLTYPE GetMasterClock(LPGUID guid, IReferenceClock** clock) override;
  HRESULT STDMETHODCALLTYPE SetMasterClock(REFGUID) override { return E_NOTIMPL; }
  HRESULT STDMETHODCALLTYPE Activate(BOOL) override { return S_OK; }
  HRESULT STDMETHODCALLTYPE GetDefaultPort(LPGUID) override { return E_NOTIMPL; }
  HRESULT STDMETHODCALLTYPE SetDirectSound(LPDIRECTSOUND sound, HWND window) override;
};

/// The loader, which knows the default collection and nothing else.
class Loader final : public ComObject<IDirectMusicLoader> {
 public:
  explicit Loader(std::shared_ptr<Studio> studio)
      : ComObject(std::move(studio), ObjectCounts::kLoader, IID_IDirectMusicLoader) {}

  HRESULT STDMETHODCALLTYPE GetObject(LPDMUS_OBJECTDESC description, REFIID iid,
                                      LPVOID* object) override;
  HRESULT STDMETHODCALLTYPE SetObject(LPDMUS_OBJECTDESC) override { return E_NOTIMPL; }
  HRESULT STDMETHODCALLTYPE SetSearchDirectory(REFGUID, WCHAR*, BOOL) override { return E_NOTIMPL; }
  HRESULT STDMETHODCALLTYPE ScanDirectory(REFGUID, WCHAR*, WCHAR*) override { return E_NOTIMPL; }
  HRESULT STDMETHODCALLTYPE CacheObject(IDirectMusicObject*) override { return E_NOTIMPL; }
  HRESULT STDMETHODCALLTYPE ReleaseObject(IDirectMusicObject*) override { return E_NOTIMPL; }
  HRESULT STDMETHODCALLTYPE ClearCache(REFGUID) override { return E_NOTIMPL; }
  HRESULT STDMETHODCALLTYPE EnableCache(REFGUID, BOOL) override { return E_NOTIMPL; }
  HRESULT STDMETHODCALLTYPE EnumObject(REFGUID, DWORD, LPDMUS_OBJECTDESC) override {
    return E_NOTIMPL;
  }
};

/// The default collection: one instrument for each patch that the studio lists.
class Collection final : public ComObject<IDirectMusicCollection> {
 public:
  explicit Collection(std::shared_ptr<Studio> studio)
      : ComObject(std::move(studio), ObjectCounts::kCollection, IID_IDirectMusicCollection) {}

  HRESULT STDMETHODCALLTYPE GetInstrument(DWORD patch,
                                          IDirectMusicInstrument** instrument) override;
  HRESULT STDMETHODCALLTYPE EnumInstrument(DWORD index, DWORD* patch, LPWSTR name,
                                           DWORD nameLength) override;
};

}  // namespace Ostinet::Impl::Simulated
