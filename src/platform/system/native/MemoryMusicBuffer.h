// SPDX-License-Identifier: MIT
#pragma once

#include <vector>

#include "platform/system/native/ComObject.h"

namespace Ostinet::Impl {

/// A DirectMusic buffer, which is memory and two marks. Events lie one after another:
///
///   offset  size  content
///   0       4     bytes of the event, n
///   4       4     channel group
///   8       8     time, relative to the buffer's start time, which is that of the first event
///   16      4     1 for a short message, 0 for sysex
///   20      n     the bytes
///
/// and each takes (n + 27) & ~7 bytes, where a short message counts as 4.
///
/// Threads  One at a time.
class MemoryMusicBuffer final : public ComObject<IDirectMusicBuffer, IID_IDirectMusicBuffer> {
 public:
  MemoryMusicBuffer(DWORD size, GUID const& format);

  HRESULT Flush() override;
  HRESULT TotalTime(LPREFERENCE_TIME time) override;
  HRESULT PackStructured(REFERENCE_TIME time, DWORD group, DWORD message) override;
  HRESULT PackUnstructured(REFERENCE_TIME time, DWORD group, DWORD size, LPBYTE data) override;
  HRESULT ResetReadPtr() override;
  HRESULT GetNextEvent(LPREFERENCE_TIME time, LPDWORD group, LPDWORD length, LPBYTE* data) override;
  HRESULT GetRawBufferPtr(LPBYTE* data) override;
  HRESULT GetStartTime(LPREFERENCE_TIME time) override;
  HRESULT GetUsedBytes(LPDWORD bytes) override;
  HRESULT GetMaxBytes(LPDWORD bytes) override;
  HRESULT GetBufferFormat(LPGUID format) override;
  HRESULT SetStartTime(REFERENCE_TIME time) override;
  HRESULT SetUsedBytes(DWORD bytes) override;

 private:
  HRESULT Append(REFERENCE_TIME time, DWORD group, DWORD flags, void const* data, DWORD size,
                 DWORD room);

  GUID const format_;
  std::vector<BYTE> bytes_;
  DWORD used_ = 0;
  DWORD read_ = 0;
  REFERENCE_TIME start_ = 0;
  REFERENCE_TIME total_ = 0;
};

}  // namespace Ostinet::Impl
