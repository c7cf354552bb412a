// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>

#include "ostinet/Common.h"
#include "ostinet/DeviceTypeCatalog.h"
#include "ostinet/TimeStamp.h"

namespace Ostinet {
template <class T, unsigned N>
struct Array {
  T elements[N];
  T& operator[](size_t i);
  T const& operator[](size_t i) const;
};
struct Data {
  unsigned char const* bytes;
  size_t count;
  Data(unsigned char const*, size_t);
  Data(DataPacket const&);
};
struct MatchEntry {
  unsigned char kind;
  unsigned char value;
};
namespace Autodetect {
class Request;
class Matcher {
 public:
  Matcher(Matcher const&);
  Matcher& operator=(Matcher const&);
  size_t Start() const;
  size_t Success() const;
  size_t Match(Data const& data, size_t position, unsigned char& deviceID,
               Array<unsigned char, 7>& captured) const;
};
class Response {
 public:
  Response(Response const&);
  Response& operator=(Response const&);
  int CountDeviceTypeInfos() const;
  DeviceTypeInfo GetDeviceTypeInfo(int) const;
  int CountRequests() const;
  Request GetRequest(int) const;
  Matcher GetMatcher() const;
  DeviceTypeInfo GetMatchedDeviceTypeInfo(Array<unsigned char, 7> const& captured) const;
};
class Request {
 public:
  Request(Request const&);
  Request& operator=(Request const&);
  DataBuffer GetMessageW(TimeStamp) const;
  double GetTimeout() const;
  int CountResponses() const;
  Response GetResponse(int) const;
};
}  // namespace Autodetect
}  // namespace Ostinet
