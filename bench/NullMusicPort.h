// SPDX-License-Identifier: MIT
#pragma once

#include "platform/ComPtr.h"
#include "platform/system/System.h"

namespace Ostinet::Bench {

/// A DirectMusic port that takes buffers and does nothing with them. Lives on the stack: it counts
/// no references.
class NullMusicPort final : public IDirectMusicPort {
 public:
  explicit NullMusicPort(Impl::ComPtr<IReferenceClock> clock) : clock_(std::move(clock)) {}

  HRESULT QueryInterface(REFIID, void**) override { return E_FAIL; }
  ULONG AddRef() override { return 1; }
  ULONG Release() override { return 1; }
  HRESULT PlayBuffer(LPDIRECTMUSICBUFFER) override { return S_OK; }
  HRESULT SetReadNotificationHandle(HANDLE) override { return S_OK; }
  HRESULT Read(LPDIRECTMUSICBUFFER) override { return E_FAIL; }
  HRESULT DownloadInstrument(IDirectMusicInstrument*, IDirectMusicDownloadedInstrument**,
                             DMUS_NOTERANGE*, DWORD) override {
    return E_FAIL;
  }
  HRESULT UnloadInstrument(IDirectMusicDownloadedInstrument*) override { return E_FAIL; }
  HRESULT GetLatencyClock(IReferenceClock** clock) override {
    clock_->AddRef();
    *clock = clock_.get();
    return S_OK;
  }
  HRESULT GetRunningStats(LPDMUS_SYNTHSTATS) override { return E_FAIL; }
  HRESULT Compact() override { return S_OK; }
  HRESULT GetCaps(LPDMUS_PORTCAPS) override { return E_FAIL; }
  HRESULT DeviceIoControl(DWORD, LPVOID, DWORD, LPVOID, DWORD, LPDWORD, LPOVERLAPPED) override {
    return E_FAIL;
  }
  HRESULT SetNumChannelGroups(DWORD) override { return S_OK; }
  HRESULT GetNumChannelGroups(LPDWORD) override { return E_FAIL; }
  HRESULT Activate(BOOL) override { return S_OK; }
  HRESULT SetChannelPriority(DWORD, DWORD, DWORD) override { return S_OK; }
  HRESULT GetChannelPriority(DWORD, DWORD, LPDWORD) override { return E_FAIL; }
  HRESULT SetDirectSound(LPDIRECTSOUND, LPDIRECTSOUNDBUFFER) override { return S_OK; }
  HRESULT GetFormat(LPWAVEFORMATEX, LPDWORD, LPDWORD) override { return E_FAIL; }

 private:
  Impl::ComPtr<IReferenceClock> const clock_;
};

}  // namespace Ostinet::Bench
