// SPDX-License-Identifier: MIT
#pragma once

#include <vector>

#include "ReplyReader.h"
#include "ostinet/hostkit/DetectionRun.h"

namespace Ostinet {

/// What one reply says.
struct Meaning {
  DetectionRun::Finding finding;
  /// Of an answer to a request that follows on another one: the types that it tells apart.
  std::vector<DeviceTypeInfo> refines;
};

/// The types that an answer can mean, the likeliest first; none if it is an identity of no type.
std::vector<DeviceTypeInfo> TypesOf(Autodetect::Response const& response, Hit const& hit);

/// Whether the hit holds the identity of an instrument.
bool HasIdentity(Hit const& hit);

/// The bytes of maker, family and member of the hit among these that read the maker in the right
/// size, or nothing. Makers of three bytes begin with 00.
DetectionRun::Bytes IdentityOf(std::vector<Hit> const& hits);

/// Adds what a reply says to what is known of a port. An instrument that answers several times is
/// one finding, whose types are those that all its answers allow.
void AddMeaning(std::vector<DetectionRun::Finding>& findings, Meaning const& meaning);

}  // namespace Ostinet
