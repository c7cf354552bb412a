// SPDX-License-Identifier: MIT
#pragma once

// A DirectMusic buffer: a row of events in memory.
//
//   offset  bytes  of one event
//        0      4  number n of data bytes
//        4      4  channel group
//        8      8  time, relative to the buffer's start time, units of 100 ns
//       16      4  1 for a packed short message, 0 for raw bytes
//       20      n  data, then nothing up to a multiple of 8
//
// A host may fill the memory itself and say how much of it is used.

#include <vector>

#include "platform/system/simulated/ComObject.h"

namespace Ostinet::Impl::Simulated {

class MusicBuffer final : public ComObject<IDirectMusicBuffer> {
 public:
  struct Event {
    REFERENCE_TIME time = 0;  // absolute
    DWORD group = 0;
    DWORD size = 0;
    std::uint8_t* data = nullptr;
  };

  MusicBuffer(std::shared_ptr<Studio> studio, DWORD size);

  /// Memory that an event with `size` data bytes takes.
  static constexpr DWORD Footprint(DWORD size) { return (size + 27) & ~DWORD{7}; }
  /// The same as packing, outside of the book. Fails when there is no room.
  HRESULT Append(REFERENCE_TIME time, DWORD group, DWORD flags, std::uint8_t const* data,
                 DWORD size);
  /// The event at `offset`, which moves past it. False at the end or where no whole event is.
  bool Next(DWORD& offset, Event& event);
  bool IsEmpty() const { return used_ == 0; }
  DWORD Room() const { return static_cast<DWORD>(bytes_.size()) - used_; }

  HRESULT STDMETHODCALLTYPE Flush() override;
  HRESULT STDMETHODCALLTYPE TotalTime(LPREFERENCE_TIME time) override;
  HRESULT STDMETHODCALLTYPE PackStructured(REFERENCE_TIME time, DWORD group,
                                           DWORD message) override;
  HRESULT STDMETHODCALLTYPE PackUnstructured(REFERENCE_TIME time, DWORD group, DWORD size,
                                             LPBYTE data) override;
  HRESULT STDMETHODCALLTYPE ResetReadPtr() override;
  HRESULT STDMETHODCALLTYPE GetNextEvent(LPREFERENCE_TIME time, LPDWORD group, LPDWORD length,
                                         LPBYTE* data) override;
  HRESULT STDMETHODCALLTYPE GetRawBufferPtr(LPBYTE* data) override;
  HRESULT STDMETHODCALLTYPE GetStartTime(LPREFERENCE_TIME time) override;
  HRESULT STDMETHODCALLTYPE GetUsedBytes(LPDWORD bytes) override;
  HRESULT STDMETHODCALLTYPE GetMaxBytes(LPDWORD bytes) override;
  HRESULT STDMETHODCALLTYPE GetBufferFormat(LPGUID format) override;
  HRESULT STDMETHODCALLTYPE SetStartTime(REFERENCE_TIME time) override;
  HRESULT STDMETHODCALLTYPE SetUsedBytes(DWORD bytes) override;

 private:
  std::vector<std::uint8_t> bytes_;
  DWORD used_ = 0;
  DWORD read_ = 0;
  REFERENCE_TIME start_ = 0;
};

}  // namespace Ostinet::Impl::Simulated
