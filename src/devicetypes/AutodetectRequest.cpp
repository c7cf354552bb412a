// SPDX-License-Identifier: MIT
#include <algorithm>

#include "devicetypes/AutodetectImpl.h"

namespace Ostinet {

namespace Autodetect {

namespace {

constexpr int kHighestDeviceID = 127;  // what goes over the wire as one data byte
constexpr double kFirstWait = 1.0;     // seconds
constexpr double kFurtherWait = 0.2;   // seconds

using Message = std::vector<MatchEntry>;

// The highest device ID to send `message` with: no byte that holds one may exceed 127. A message
// that holds none goes out once. Below the lowest ID where no byte can hold one.
int HighestID(Message const& message, Impl::AutodetectRequestImpl const& request) {
  int highest = request.maxDeviceID;
  bool hasID = false;
  for (MatchEntry const& entry : message) {
    if (entry.kind != 0) {
      hasID = true;
      highest = std::min(highest, kHighestDeviceID - entry.value);
    }
  }
  return hasID ? highest : request.minDeviceID;
}

void AddPacket(Message const& message, int deviceID, TimeStamp const& stamp, DataBuffer& buffer) {
  std::vector<unsigned char> bytes;
  bytes.reserve(message.size());
  for (MatchEntry const& entry : message) {
    int const byte = entry.kind == 0 ? entry.value : entry.value + deviceID;
    bytes.push_back(static_cast<unsigned char>(byte));
  }
  buffer.Add(stamp, bytes.data(), bytes.size());
}

}  // namespace

Request::Request(RCPtrMT<Impl::AutodetectRequestImpl> const& impl) : impl_(impl) {}
Request::Request(Request const& other) = default;
Request& Request::operator=(Request const& other) = default;
Request::~Request() = default;

DataBuffer Request::GetMessageW(TimeStamp stamp) const {
  DataBuffer buffer;
  if (!impl_) {
    return buffer;
  }
  if (stamp == kNoTimeStamp) {
    stamp = CurrentMIDITime();
  }
  for (Message const& message : impl_->messages) {
    int const highest = HighestID(message, *impl_);
    for (int id = impl_->minDeviceID; id <= highest; ++id) {
      AddPacket(message, id, stamp, buffer);
    }
  }
  return buffer;
}

// A request without messages waits for 0.8 seconds: the sum is not cut off at the first second.
double Request::GetTimeout() const {
  if (!impl_) {
    return 0.0;
  }
  return (static_cast<double>(impl_->messages.size()) - 1.0) * kFurtherWait + kFirstWait;
}

int Request::CountResponses() const {
  return impl_ ? static_cast<int>(impl_->responses.size()) : 0;
}

Response Request::GetResponse(int index) const {
  bool const isThere = index >= 0 && index < CountResponses();
  return Response(isThere ? impl_->responses[static_cast<size_t>(index)] : nullptr);
}

}  // namespace Autodetect

}  // namespace Ostinet
