// SPDX-License-Identifier: MIT
#pragma once

#include <deque>
#include <mutex>
#include <vector>

#include "platform/system/simulated/ComObject.h"
#include "platform/system/simulated/MusicBuffer.h"
#include "platform/system/simulated/StreamParser.h"

namespace Ostinet::Impl::Simulated {

/// The capabilities that DirectMusic gives for a port: a WinMM one shows as emulated. With the
/// studio's mutex held.
void FillPortCaps(Port const& port, DMUS_PORTCAPS& caps);
/// The number within a port's GUID; 0 when it is no port of a simulated studio.
std::uint32_t PortIDOf(REFGUID guid);

/// An open DirectMusic port. An output plays each event at its time by the master clock; an input
/// keeps what arrives until it is read.
///
/// Threads  Any.
class MusicPort final : public ComObject<IDirectMusicPort>,
                        private InputSink,
                        private StreamParser::Sink {
 public:
  MusicPort(std::shared_ptr<Studio> studio, PortPtr port);

  HRESULT STDMETHODCALLTYPE PlayBuffer(LPDIRECTMUSICBUFFER buffer) override;
  HRESULT STDMETHODCALLTYPE SetReadNotificationHandle(HANDLE event) override;
  HRESULT STDMETHODCALLTYPE Read(LPDIRECTMUSICBUFFER buffer) override;
  HRESULT STDMETHODCALLTYPE DownloadInstrument(IDirectMusicInstrument* instrument,
                                               IDirectMusicDownloadedInstrument** downloaded,
                                               DMUS_NOTERANGE* ranges, DWORD rangeCount) override;
  HRESULT STDMETHODCALLTYPE UnloadInstrument(IDirectMusicDownloadedInstrument* downloaded) override;
  HRESULT STDMETHODCALLTYPE GetLatencyClock(IReferenceClock** clock) override;
  HRESULT STDMETHODCALLTYPE GetRunningStats(LPDMUS_SYNTHSTATS) override { return E_NOTIMPL; }
  HRESULT STDMETHODCALLTYPE Compact() override { return S_OK; }
  HRESULT STDMETHODCALLTYPE GetCaps(LPDMUS_PORTCAPS caps) override;
  HRESULT STDMETHODCALLTYPE DeviceIoControl(DWORD, LPVOID, DWORD, LPVOID, DWORD, LPDWORD,
                                            LPOVERLAPPED) override {
    return E_NOTIMPL;
  }
  HRESULT STDMETHODCALLTYPE SetNumChannelGroups(DWORD) override { return S_OK; }
  HRESULT STDMETHODCALLTYPE GetNumChannelGroups(LPDWORD groups) override;
  HRESULT STDMETHODCALLTYPE Activate(BOOL active) override;
  HRESULT STDMETHODCALLTYPE SetChannelPriority(DWORD, DWORD, DWORD) override { return S_OK; }
  HRESULT STDMETHODCALLTYPE GetChannelPriority(DWORD, DWORD, LPDWORD) override { return E_NOTIMPL; }
  HRESULT STDMETHODCALLTYPE SetDirectSound(LPDIRECTSOUND, LPDIRECTSOUNDBUFFER) override {
    return S_OK;
  }
  HRESULT STDMETHODCALLTYPE GetFormat(LPWAVEFORMATEX, LPDWORD, LPDWORD) override {
    return E_NOTIMPL;
  }

 private:
  struct Arrival {
    std::int64_t time;
    std::vector<std::uint8_t> bytes;
  };

  ~MusicPort() override;

  void Take(std::uint8_t const* bytes, std::size_t size) override;
  void Short(std::uint8_t const (&bytes)[3], int length) override;
  void SysexByte(std::uint8_t byte) override;
  void SysexEnd(bool whole) override;
  void Stray(std::uint8_t) override {}

  HRESULT PlayLocked(MusicBuffer& buffer);
  HRESULT ReadLocked(MusicBuffer& buffer);
  void DetachLocked();
  void Arrive(std::vector<std::uint8_t> bytes);

  PortPtr const port_;
  std::once_flag latencyClockMade_;
  StudioClock* latencyClock_ = nullptr;  // one for all who ask
  // Guarded by the studio's mutex.
  bool active_ = false;
  HANDLE notification_ = nullptr;
  StreamParser parser_;
  std::vector<std::uint8_t> sysex_;
  std::deque<Arrival> arrivals_;
};

}  // namespace Ostinet::Impl::Simulated
