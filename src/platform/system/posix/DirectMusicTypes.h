// SPDX-License-Identifier: MIT
#pragma once

// DirectMusic's structures and interfaces for machines without the system's own headers. Each
// interface keeps the published order of its operations; those that nobody here calls keep their
// slot, with plain pointers where a parameter's type is of no use to us.

#include "platform/system/posix/WinMMTypes.h"

using REFERENCE_TIME = LONGLONG;
using LPREFERENCE_TIME = REFERENCE_TIME*;

// Results.
inline constexpr HRESULT S_OK = 0;
inline constexpr HRESULT S_FALSE = 1;
inline constexpr HRESULT E_NOTIMPL = static_cast<HRESULT>(0x80004001);
inline constexpr HRESULT E_NOINTERFACE = static_cast<HRESULT>(0x80004002);
inline constexpr HRESULT E_POINTER = static_cast<HRESULT>(0x80004003);
inline constexpr HRESULT E_FAIL = static_cast<HRESULT>(0x80004005);
inline constexpr HRESULT E_OUTOFMEMORY = static_cast<HRESULT>(0x8007000E);
inline constexpr HRESULT E_INVALIDARG = static_cast<HRESULT>(0x80070057);
inline constexpr HRESULT CLASS_E_NOAGGREGATION = static_cast<HRESULT>(0x80040110);
inline constexpr HRESULT REGDB_E_CLASSNOTREG = static_cast<HRESULT>(0x80040154);
inline constexpr HRESULT DMUS_E_DEVICE_IN_USE = static_cast<HRESULT>(0x88781103);
inline constexpr HRESULT DMUS_E_NOT_DOWNLOADED_TO_PORT = static_cast<HRESULT>(0x88781120);
inline constexpr HRESULT DMUS_E_BUFFER_EMPTY = static_cast<HRESULT>(0x88781135);
inline constexpr HRESULT DMUS_E_BUFFER_FULL = static_cast<HRESULT>(0x88781136);
inline constexpr HRESULT DMUS_E_PORT_NOT_CAPTURE = static_cast<HRESULT>(0x88781137);
inline constexpr HRESULT DMUS_E_PORT_NOT_RENDER = static_cast<HRESULT>(0x88781138);
inline constexpr HRESULT DMUS_E_INVALID_EVENT = static_cast<HRESULT>(0x8878113F);
inline constexpr HRESULT DMUS_E_NOT_FOUND = static_cast<HRESULT>(0x88781161);
inline constexpr HRESULT DMUS_E_NO_MASTER_CLOCK = static_cast<HRESULT>(0x88781170);

constexpr bool SUCCEEDED(HRESULT result) { return result >= 0; }
constexpr bool FAILED(HRESULT result) { return result < 0; }

// Ports.
inline constexpr DWORD DMUS_PC_INPUTCLASS = 0;
inline constexpr DWORD DMUS_PC_OUTPUTCLASS = 1;
inline constexpr DWORD DMUS_PC_DLS = 0x1;
inline constexpr DWORD DMUS_PC_EXTERNAL = 0x2;
inline constexpr DWORD DMUS_PC_SOFTWARESYNTH = 0x4;
inline constexpr DWORD DMUS_PC_GMINHARDWARE = 0x10;
inline constexpr DWORD DMUS_PC_SHAREABLE = 0x100;
inline constexpr DWORD DMUS_PORT_WINMM_DRIVER = 0;
inline constexpr DWORD DMUS_PORT_USER_MODE_SYNTH = 1;
inline constexpr DWORD DMUS_PORT_KERNEL_MODE = 2;
inline constexpr DWORD DMUS_PORTPARAMS_CHANNELGROUPS = 0x02;
inline constexpr DWORD DMUS_PORTPARAMS_SHARE = 0x40;
inline constexpr int DMUS_MAX_DESCRIPTION = 128;

struct DMUS_PORTCAPS {
  DWORD dwSize;
  DWORD dwFlags;
  GUID guidPort;
  DWORD dwClass;
  DWORD dwType;
  DWORD dwMemorySize;
  DWORD dwMaxChannelGroups;
  DWORD dwMaxVoices;
  DWORD dwMaxAudioChannels;
  DWORD dwEffectFlags;
  WCHAR wszDescription[DMUS_MAX_DESCRIPTION];
};
using LPDMUS_PORTCAPS = DMUS_PORTCAPS*;

struct DMUS_PORTPARAMS8 {
  DWORD dwSize;
  DWORD dwValidParams;
  DWORD dwVoices;
  DWORD dwChannelGroups;
  DWORD dwAudioChannels;
  DWORD dwSampleRate;
  DWORD dwEffectFlags;
  BOOL fShare;
  DWORD dwFeatures;
};
using DMUS_PORTPARAMS = DMUS_PORTPARAMS8;
using LPDMUS_PORTPARAMS = DMUS_PORTPARAMS*;

struct DMUS_BUFFERDESC {
  DWORD dwSize;
  DWORD dwFlags;
  GUID guidBufferFormat;
  DWORD cbBuffer;
};
using LPDMUS_BUFFERDESC = DMUS_BUFFERDESC*;

// What stands before each event's bytes in a raw buffer.
inline constexpr DWORD DMUS_EVENT_STRUCTURED = 1;
#pragma pack(push, 4)
struct DMUS_EVENTHEADER {
  DWORD cbEvent;
  DWORD dwChannelGroup;
  REFERENCE_TIME rtDelta;
  DWORD dwFlags;
};
#pragma pack(pop)

struct FILETIME {
  DWORD dwLowDateTime;
  DWORD dwHighDateTime;
};
struct DMUS_VERSION {
  DWORD dwVersionMS;
  DWORD dwVersionLS;
};
struct DMUS_NOTERANGE {
  DWORD dwLowNote;
  DWORD dwHighNote;
};

// Objects of the loader.
inline constexpr DWORD DMUS_OBJ_OBJECT = 1;
inline constexpr DWORD DMUS_OBJ_CLASS = 2;
inline constexpr int DMUS_MAX_NAME = 64;
inline constexpr int DMUS_MAX_CATEGORY = 64;
inline constexpr int DMUS_MAX_FILENAME = 260;
struct IStream;
struct DMUS_OBJECTDESC {
  DWORD dwSize;
  DWORD dwValidData;
  GUID guidObject;
  GUID guidClass;
  FILETIME ftDate;
  DMUS_VERSION vVersion;
  WCHAR wszName[DMUS_MAX_NAME];
  WCHAR wszCategory[DMUS_MAX_CATEGORY];
  WCHAR wszFileName[DMUS_MAX_FILENAME];
  LONGLONG llMemLength;
  LPBYTE pbMemData;
  IStream* pStream;
};
using LPDMUS_OBJECTDESC = DMUS_OBJECTDESC*;

inline constexpr GUID IID_IUnknown = {
    0x00000000, 0x0000, 0x0000, {0xC0, 0x00, 0x00, 0x00, 0x00, 0x00, 0x00, 0x46}};
inline constexpr GUID IID_IReferenceClock = {
    0x56A86897, 0x0AD4, 0x11CE, {0xB0, 0x3A, 0x00, 0x20, 0xAF, 0x0B, 0xA7, 0x70}};
inline constexpr GUID IID_IDirectMusic = {
    0x6536115A, 0x7B2D, 0x11D2, {0xBA, 0x18, 0x00, 0x00, 0xF8, 0x75, 0xAC, 0x12}};
inline constexpr GUID IID_IDirectMusicBuffer = {
    0xD2AC2878, 0xB39B, 0x11D1, {0x87, 0x04, 0x00, 0x60, 0x08, 0x93, 0xB1, 0xBD}};
inline constexpr GUID IID_IDirectMusicCollection = {
    0xD2AC287C, 0xB39B, 0x11D1, {0x87, 0x04, 0x00, 0x60, 0x08, 0x93, 0xB1, 0xBD}};
inline constexpr GUID IID_IDirectMusicInstrument = {
    0xD2AC287D, 0xB39B, 0x11D1, {0x87, 0x04, 0x00, 0x60, 0x08, 0x93, 0xB1, 0xBD}};
inline constexpr GUID IID_IDirectMusicDownloadedInstrument = {
    0xD2AC287E, 0xB39B, 0x11D1, {0x87, 0x04, 0x00, 0x60, 0x08, 0x93, 0xB1, 0xBD}};
inline constexpr GUID IID_IDirectMusicPort = {
    0x08F2D8C9, 0x37C2, 0x11D2, {0xB9, 0xF9, 0x00, 0x00, 0xF8, 0x75, 0xAC, 0x12}};
inline constexpr GUID IID_IDirectMusicLoader = {
    0x2FFAACA2, 0x5DCA, 0x11D2, {0xAF, 0xA6, 0x00, 0xAA, 0x00, 0x24, 0xD8, 0xB6}};
inline constexpr GUID CLSID_DirectMusicCollection = {
    0x480FF4B0, 0x28B2, 0x11D1, {0xBE, 0xF7, 0x00, 0xC0, 0x4F, 0xBF, 0x8F, 0xEF}};
inline constexpr GUID GUID_DefaultGMCollection = {
    0xF17E8673, 0xC3B4, 0x11D1, {0x87, 0x0B, 0x00, 0x60, 0x08, 0x93, 0xB1, 0xBD}};
