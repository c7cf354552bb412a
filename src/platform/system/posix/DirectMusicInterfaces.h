// SPDX-License-Identifier: MIT
#pragma once

// The COM interfaces of DirectMusic, operations in their published order. None has a virtual
// destructor: Release ends an object.

#include "platform/system/posix/DirectMusicTypes.h"

struct IDirectMusicObject;
struct IDirectSound;
struct IDirectSoundBuffer;
struct DMUS_CLOCKINFO8;
struct DMUS_SYNTHSTATS;
struct WAVEFORMATEX;
struct OVERLAPPED;
using DMUS_CLOCKINFO = DMUS_CLOCKINFO8;
using LPDMUS_CLOCKINFO = DMUS_CLOCKINFO*;
using LPDMUS_SYNTHSTATS = DMUS_SYNTHSTATS*;
using LPDIRECTSOUND = IDirectSound*;
using LPDIRECTSOUNDBUFFER = IDirectSoundBuffer*;
using LPWAVEFORMATEX = WAVEFORMATEX*;
using LPOVERLAPPED = OVERLAPPED*;

struct IUnknown {
  virtual HRESULT QueryInterface(REFIID iid, void** object) = 0;
  virtual ULONG AddRef() = 0;
  virtual ULONG Release() = 0;
};
using LPUNKNOWN = IUnknown*;

struct IReferenceClock : IUnknown {
  /// Units of 100 ns.
  virtual HRESULT GetTime(REFERENCE_TIME* time) = 0;
  virtual HRESULT AdviseTime(REFERENCE_TIME base, REFERENCE_TIME stream, HANDLE event,
                             DWORD* cookie) = 0;
  virtual HRESULT AdvisePeriodic(REFERENCE_TIME start, REFERENCE_TIME period, HANDLE semaphore,
                                 DWORD* cookie) = 0;
  virtual HRESULT Unadvise(DWORD cookie) = 0;
};

struct IDirectMusicBuffer : IUnknown {
  virtual HRESULT Flush() = 0;
  virtual HRESULT TotalTime(LPREFERENCE_TIME time) = 0;
  virtual HRESULT PackStructured(REFERENCE_TIME time, DWORD group, DWORD message) = 0;
  virtual HRESULT PackUnstructured(REFERENCE_TIME time, DWORD group, DWORD size, LPBYTE data) = 0;
  virtual HRESULT ResetReadPtr() = 0;
  virtual HRESULT GetNextEvent(LPREFERENCE_TIME time, LPDWORD group, LPDWORD length,
                               LPBYTE* data) = 0;
  virtual HRESULT GetRawBufferPtr(LPBYTE* data) = 0;
  virtual HRESULT GetStartTime(LPREFERENCE_TIME time) = 0;
  virtual HRESULT GetUsedBytes(LPDWORD bytes) = 0;
  virtual HRESULT GetMaxBytes(LPDWORD bytes) = 0;
  virtual HRESULT GetBufferFormat(LPGUID format) = 0;
  virtual HRESULT SetStartTime(REFERENCE_TIME time) = 0;
  virtual HRESULT SetUsedBytes(DWORD bytes) = 0;
};
using LPDIRECTMUSICBUFFER = IDirectMusicBuffer*;

struct IDirectMusicInstrument : IUnknown {
  virtual HRESULT GetPatch(DWORD* patch) = 0;
  virtual HRESULT SetPatch(DWORD patch) = 0;
};

struct IDirectMusicDownloadedInstrument : IUnknown {};

struct IDirectMusicCollection : IUnknown {
  virtual HRESULT GetInstrument(DWORD patch, IDirectMusicInstrument** instrument) = 0;
  virtual HRESULT EnumInstrument(DWORD index, DWORD* patch, LPWSTR name, DWORD nameLength) = 0;
};

struct IDirectMusicPort : IUnknown {
  virtual HRESULT PlayBuffer(LPDIRECTMUSICBUFFER buffer) = 0;
  virtual HRESULT SetReadNotificationHandle(HANDLE event) = 0;
  virtual HRESULT Read(LPDIRECTMUSICBUFFER buffer) = 0;
  virtual HRESULT DownloadInstrument(IDirectMusicInstrument* instrument,
                                     IDirectMusicDownloadedInstrument** downloaded,
                                     DMUS_NOTERANGE* ranges, DWORD rangeCount) = 0;
  virtual HRESULT UnloadInstrument(IDirectMusicDownloadedInstrument* downloaded) = 0;
  virtual HRESULT GetLatencyClock(IReferenceClock** clock) = 0;
  virtual HRESULT GetRunningStats(LPDMUS_SYNTHSTATS stats) = 0;
  virtual HRESULT Compact() = 0;
  virtual HRESULT GetCaps(LPDMUS_PORTCAPS caps) = 0;
  virtual HRESULT DeviceIoControl(DWORD code, LPVOID in, DWORD inSize, LPVOID out, DWORD outSize,
                                  LPDWORD returned, LPOVERLAPPED overlapped) = 0;
  virtual HRESULT SetNumChannelGroups(DWORD groups) = 0;
  virtual HRESULT GetNumChannelGroups(LPDWORD groups) = 0;
  virtual HRESULT Activate(BOOL active) = 0;
  virtual HRESULT SetChannelPriority(DWORD group, DWORD channel, DWORD priority) = 0;
  virtual HRESULT GetChannelPriority(DWORD group, DWORD channel, LPDWORD priority) = 0;
  virtual HRESULT SetDirectSound(LPDIRECTSOUND sound, LPDIRECTSOUNDBUFFER buffer) = 0;
  virtual HRESULT GetFormat(LPWAVEFORMATEX format, LPDWORD formatSize, LPDWORD bufferSize) = 0;
};
using LPDIRECTMUSICPORT = IDirectMusicPort*;

struct IDirectMusic : IUnknown {
  virtual HRESULT EnumPort(DWORD index, LPDMUS_PORTCAPS caps) = 0;
  virtual HRESULT CreateMusicBuffer(LPDMUS_BUFFERDESC description, LPDIRECTMUSICBUFFER* buffer,
                                    LPUNKNOWN outer) = 0;
  virtual HRESULT CreatePort(REFCLSID port, LPDMUS_PORTPARAMS params, LPDIRECTMUSICPORT* result,
                             LPUNKNOWN outer) = 0;
  virtual HRESULT EnumMasterClock(DWORD index, LPDMUS_CLOCKINFO info) = 0;
  virtual HRESULT GetMasterClock(LPGUID guid, IReferenceClock** clock) = 0;
  virtual HRESULT SetMasterClock(REFGUID guid) = 0;
  virtual HRESULT Activate(BOOL enable) = 0;
  virtual HRESULT GetDefaultPort(LPGUID guid) = 0;
  virtual HRESULT SetDirectSound(LPDIRECTSOUND sound, HWND window) = 0;
};

struct IDirectMusicLoader : IUnknown {
  virtual HRESULT GetObject(LPDMUS_OBJECTDESC description, REFIID iid, LPVOID* object) = 0;
  virtual HRESULT SetObject(LPDMUS_OBJECTDESC description) = 0;
  virtual HRESULT SetSearchDirectory(REFGUID type, WCHAR* path, BOOL clear) = 0;
  virtual HRESULT ScanDirectory(REFGUID type, WCHAR* extension, WCHAR* cache) = 0;
  virtual HRESULT CacheObject(IDirectMusicObject* object) = 0;
  virtual HRESULT ReleaseObject(IDirectMusicObject* object) = 0;
  virtual HRESULT ClearCache(REFGUID type) = 0;
  virtual HRESULT EnableCache(REFGUID type, BOOL enable) = 0;
  virtual HRESULT EnumObject(REFGUID type, DWORD index, LPDMUS_OBJECTDESC description) = 0;
};
