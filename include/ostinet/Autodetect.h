// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>

#include "ostinet/Common.h"
#include "ostinet/DeviceTypeCatalog.h"
#include "ostinet/TimeStamp.h"

namespace Ostinet {

/// `N` values of one type. Unchecked.
template <class T, unsigned N>
struct Array {
  T elements[N];

  T& operator[](size_t i) { return elements[i]; }
  T const& operator[](size_t i) const { return elements[i]; }
};

/// Bytes that stand elsewhere and outlive this.
struct OSTINET_EXPORT Data {
  unsigned char const* bytes;
  size_t count;

  Data(unsigned char const* begin, size_t size);
  Data(DataPacket const& packet);
};

/// One step of a request's or an answer's pattern.
struct MatchEntry {
  unsigned char kind;
  unsigned char value;
};

/// The sysex questions and answers by which instruments are recognised. A host sends a request,
/// and shows what comes back to the matcher of each of its responses; a response that fits names
/// the device types, or the requests to ask next.
///
/// Ownership    Each class is a value that shares the catalog's tables, which live to the end of
///              the process.
/// Threads      The host's polling thread.
namespace Autodetect {

class Request;

/// Recognises one answer, byte by byte.
class OSTINET_EXPORT Matcher {
 public:
  Matcher(Matcher const& other);
  Matcher& operator=(Matcher const& other);
  /// The position before the first byte.
  size_t Start() const;
  /// The position that means that the whole answer fits.
  size_t Success() const;
  /// The position after `data`, from `position`; fills in what the answer tells of the device.
  size_t Match(Data const& data, size_t position, unsigned char& deviceID,
               Array<unsigned char, 7>& captured) const;
};

/// What an answer means.
class OSTINET_EXPORT Response {
 public:
  Response(Response const& other);
  Response& operator=(Response const& other);
  int CountDeviceTypeInfos() const;
  DeviceTypeInfo GetDeviceTypeInfo(int index) const;
  int CountRequests() const;
  Request GetRequest(int index) const;
  Matcher GetMatcher() const;
  DeviceTypeInfo GetMatchedDeviceTypeInfo(Array<unsigned char, 7> const& captured) const;
};

/// A question to ask of a port.
class OSTINET_EXPORT Request {
 public:
  Request(Request const& other);
  Request& operator=(Request const& other);
  DataBuffer GetMessageW(TimeStamp stamp) const;
  /// How long to wait for the answers, in seconds.
  double GetTimeout() const;
  int CountResponses() const;
  Response GetResponse(int index) const;
};

}  // namespace Autodetect

}  // namespace Ostinet
