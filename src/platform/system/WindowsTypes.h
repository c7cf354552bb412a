// SPDX-License-Identifier: MIT
#pragma once

// The types that the seam speaks in. On Windows they are the system's own; elsewhere they are
// declared here in the layout that the system publishes for 64 bits, so that the code above the
// seam is the same on every machine. The sizes below hold in both builds.

#ifdef _WIN32

#ifndef WIN32_LEAN_AND_MEAN
#define WIN32_LEAN_AND_MEAN
#endif
#ifndef NOMINMAX
#define NOMINMAX
#endif
#include <windows.h>
// The loader's GetObject keeps its name: windows.h has a macro of that name.
#undef GetObject
#include <dmusicc.h>
#include <dmusici.h>
#include <mmsystem.h>
#include <objbase.h>

// Macros that collide with names of ours.
#undef CopyFile
#undef CreateEvent
#undef CreateFile
#undef CreateSemaphore
#undef CreateWaitableTimer
#undef DELETE
#undef DeleteFile
#undef ERROR
#undef GetCurrentTime
#undef GetMessage
#undef GetObject
#undef IGNORE
#undef IN
#undef MoveFile
#undef OPTIONAL
#undef OUT
#undef SendMessage
#undef Yield
#undef interface
#undef small

#else

#include "platform/system/posix/DirectMusicInterfaces.h"
#include "platform/system/posix/WinMMTypes.h"

#endif

static_assert(sizeof(void*) == 8, "The seam's layouts are those for 64 bits");
static_assert(sizeof(WCHAR) == 2);
static_assert(sizeof(DWORD) == 4);
static_assert(sizeof(LONG) == 4);
static_assert(sizeof(GUID) == 16);
static_assert(sizeof(MIDIHDR) == 112);
static_assert(sizeof(MIDIINCAPSW) == 76);
static_assert(sizeof(MIDIOUTCAPSW) == 84);
static_assert(sizeof(DMUS_PORTCAPS) == 308);
static_assert(sizeof(DMUS_BUFFERDESC) == 28);
static_assert(sizeof(DMUS_PORTPARAMS8) == 36);
static_assert(sizeof(DMUS_OBJECTDESC) == 856);
static_assert(sizeof(DMUS_EVENTHEADER) == 20);
