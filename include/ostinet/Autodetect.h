// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <vector>

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

/// One step of a request's or an answer's pattern. Kind 0 is a byte of the message; any other kind
/// is the place of the device ID, to which `value` is added on the wire. In an answer, kind 0 with
/// a value from 0xF8 on takes any byte: 0xF8 forgets it, 0xF9 to 0xFF keep it in the slots 0 to 6
/// of the identity (three bytes of manufacturer, two of family, two of member).
struct MatchEntry {
  unsigned char kind;
  unsigned char value;
};

/// The sysex questions and answers by which instruments are recognised.
///
/// A host sends a request's message to a port, and shows what comes back to the matcher of each of
/// the request's responses. A response that fits names the device types, or the requests to ask
/// next on the same port. The library only holds the questions; DetectionRun of the host kit runs
/// them.
///
/// Ownership    Counted handles that share the catalog's tables; Matcher is a value with a table of
///              its own.
/// Null handle  What an index out of range gives. It has no messages, types or requests.
/// Threads      [any thread] The tables never change.
/// Errors       GetMessageW throws as CurrentMIDITime does. Nothing else throws.
namespace Autodetect {

class Request;

/// Recognises one answer, in pieces of any size. It keeps no position, so that one matcher can
/// serve any number of ports at once.
class OSTINET_EXPORT Matcher {
 public:
  /// Matches `table`. If `strict`, an answer that goes on behind the table is none.
  Matcher(std::vector<MatchEntry> table, bool strict);
  Matcher(Matcher const& other);
  Matcher& operator=(Matcher const& other);
  ~Matcher();

  /// The position before the first byte: 0.
  size_t Start() const;
  /// The position that means that the whole answer fits: the length of the table. Of an empty
  /// table it is 0, which is failure as well.
  size_t Success() const;
  /// The position after `data`, from `position`: 0 if this is not the answer, Success() if it is.
  /// Look for 0 first. Bytes behind the end of the table are ignored unless the matcher is strict.
  ///
  /// Writes the device ID, 0 to 255, and the slots of `captured` that the table names, also where
  /// a later byte does not fit; what it does not write keeps its value, so begin each attempt with
  /// seven bytes of 0xFF. [realtime]
  size_t Match(Data const& data, size_t position, unsigned char& deviceID,
               Array<unsigned char, 7>& captured) const;

 private:
  std::vector<MatchEntry> table_;
  bool strict_;
};

/// What an answer looks like, and what it means.
class OSTINET_EXPORT Response {
 public:
  Response(RCPtrMT<Impl::AutodetectResponseImpl> const& impl);
  Response(Response const& other);
  Response& operator=(Response const& other);
  ~Response();

  int CountDeviceTypeInfos() const;
  DeviceTypeInfo GetDeviceTypeInfo(int index) const;
  /// The requests that tell the types of this answer apart, to be asked next.
  int CountRequests() const;
  Request GetRequest(int index) const;
  Matcher GetMatcher() const;
  /// The type that the answer means, by the bytes that the matcher captured into seven of 0xFF:
  /// the only type, where nothing was captured, else the first whose identity these bytes are. A
  /// null handle where there is none.
  DeviceTypeInfo GetMatchedDeviceTypeInfo(Array<unsigned char, 7> const& captured) const;

 private:
  RCPtrMT<Impl::AutodetectResponseImpl> impl_;
};

/// A question to ask of a port.
class OSTINET_EXPORT Request {
 public:
  Request(RCPtrMT<Impl::AutodetectRequestImpl> const& impl);
  Request(Request const& other);
  Request& operator=(Request const& other);
  ~Request();

  /// Everything to send: each message once for each device ID that its instruments may have. All
  /// packets bear one stamp, `stamp`, or the present moment for kNoTimeStamp; sending them no
  /// faster than a cable carries them is up to the way out.
  DataBuffer GetMessageW(TimeStamp stamp) const;
  /// How long to wait for the answers, in seconds: 1.0, and 0.2 more for each further message.
  double GetTimeout() const;
  int CountResponses() const;
  Response GetResponse(int index) const;

 private:
  RCPtrMT<Impl::AutodetectRequestImpl> impl_;
};

}  // namespace Autodetect

}  // namespace Ostinet
