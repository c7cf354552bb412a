// SPDX-License-Identifier: MIT
//
// One record, low bytes first:
//
//   offset  size  field
//        0     8  sample time, signed
//        8     2  0
//       10     2  count of bytes
//       12     2  kind
//       14   256  the bytes, the rest 0
#include "platform/PluginRecords.h"

#include <algorithm>
#include <cstdint>
#include <cstring>
#include <limits>
#include <memory>
#include <new>

namespace Ostinet {
namespace {

using Impl::kPluginRecordBytes;
using Impl::kPluginRecordData;

enum class RecordKind : std::uint16_t { kFirstPiece = 0, kLaterPiece = 1, kShortMessage = 2 };

// Engines map the records by pages.
constexpr std::size_t kPageBytes = 4096;

struct FreePages {
  void operator()(unsigned char* pages) const {
    ::operator delete (pages, std::align_val_t{kPageBytes});
  }
};

void PutLowFirst(unsigned char* at, std::uint64_t value, int count) {
  for (int i = 0; i < count; ++i) {
    at[i] = static_cast<unsigned char>(value >> (8 * i));
  }
}

// Truncated. A host that gives a position outside of 64 bits gets the last one there is.
std::int64_t SampleTime(TimeStamp const& stamp) {
  constexpr double kTwoTo63 = 9223372036854775808.0;
  double const samples = stamp.AsSampleCount();
  if (samples >= kTwoTo63) {
    return std::numeric_limits<std::int64_t>::max();
  }
  bool const fits = samples >= -kTwoTo63;  // false for what is no number
  return fits ? static_cast<std::int64_t>(samples) : std::numeric_limits<std::int64_t>::min();
}

// `count` is at most what a record holds; the record was all zeros.
void FillRecord(unsigned char* record, std::int64_t time, RecordKind kind,
                unsigned char const* bytes, std::size_t count) {
  PutLowFirst(record, static_cast<std::uint64_t>(time), 8);
  PutLowFirst(record + 10, count, 2);
  PutLowFirst(record + 12, static_cast<std::uint64_t>(kind), 2);
  std::memcpy(record + 14, bytes, count);
}

}  // namespace

void SendMIDIPacketToSYNAPDestination(DataPacket const& packet,
                                      ISynapMIDIDestination* destination) {
  if (destination == nullptr || packet.data == nullptr || packet.length == 0) {
    return;
  }
  unsigned char record[kPluginRecordBytes] = {};
  auto const count =
      static_cast<std::size_t>(std::min<unsigned long long>(packet.length, kPluginRecordData));
  FillRecord(record, SampleTime(packet.stamp), RecordKind::kShortMessage, packet.data, count);
  destination->Send(record, 1);
}

void SendSysexToSYNAPDestination(TimeStamp stamp, unsigned char* bytes, int length,
                                 ISynapMIDIDestination* destination) {
  if (length > 0) {
    Impl::SendLongMessage(stamp, bytes, static_cast<std::size_t>(length), destination);
  }
}

void Impl::SendLongMessage(TimeStamp stamp, unsigned char const* bytes, std::size_t length,
                           ISynapMIDIDestination* destination) {
  if (destination == nullptr || bytes == nullptr || length == 0) {
    return;
  }
  std::size_t const count = (length + kPluginRecordData - 1) / kPluginRecordData;
  std::unique_ptr<unsigned char, FreePages> const records(static_cast<unsigned char*>(
      ::operator new (count* kPluginRecordBytes, std::align_val_t{kPageBytes}, std::nothrow)));
  if (records == nullptr) {
    return;
  }
  std::memset(records.get(), 0, count * kPluginRecordBytes);
  std::int64_t const time = SampleTime(stamp);
  RecordKind kind = RecordKind::kFirstPiece;
  for (std::size_t i = 0; i < count; ++i) {
    std::size_t const start = i * kPluginRecordData;
    FillRecord(records.get() + i * kPluginRecordBytes, time, kind, bytes + start,
               std::min(length - start, kPluginRecordData));
    kind = RecordKind::kLaterPiece;
  }
  destination->Send(records.get(), static_cast<int>(count));
}

}  // namespace Ostinet
