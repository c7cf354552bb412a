// SPDX-License-Identifier: MIT
#include "Findings.h"

#include <algorithm>
#include <iterator>

namespace Ostinet {

namespace {

using Finding = DetectionRun::Finding;
using Types = std::vector<DeviceTypeInfo>;

constexpr unsigned char kNotCaptured = 0xFF;

bool Holds(Types const& types, DeviceTypeInfo const& type) {
  return std::find(types.begin(), types.end(), type) != types.end();
}

// Those of `types` that `others` hold too.
Types Common(Types const& types, Types const& others) {
  Types common;
  std::copy_if(types.begin(), types.end(), std::back_inserter(common),
               [&](DeviceTypeInfo const& type) { return Holds(others, type); });
  return common;
}

bool HasSameIdentity(DeviceTypeInfo const& a, DeviceTypeInfo const& b) {
  return a.GetFacts().inquiryResponse == b.GetFacts().inquiryResponse;
}

bool IsRealID(int id) {
  return id != DetectionRun::kNoDeviceID && id != DetectionRun::kAllDeviceIDs;
}

bool CanBeOneID(int a, int b) { return a == b || !IsRealID(a) || !IsRealID(b); }

// The maker's bytes of a maker's own reply, and those of an identity, begin alike.
bool IsOfMaker(DetectionRun::Bytes const& reply, DetectionRun::Bytes const& identity) {
  std::size_t const size = !identity.empty() && identity[0] == 0 ? 3 : 1;
  return identity.size() >= size && reply.size() > size &&
         std::equal(identity.begin(), identity.begin() + static_cast<std::ptrdiff_t>(size),
                    reply.begin() + 1);
}

// An identity of no type, and a type that answered a request of its maker's own.
bool IsIdentityOf(Finding const& unknown, Finding const& typed) {
  return unknown.types.empty() && typed.identity.empty() &&
         IsOfMaker(typed.reply, unknown.identity);
}

bool IsSameInstrument(Finding const& known, Finding const& found) {
  if (!(known.source == found.source) || !CanBeOneID(known.deviceID, found.deviceID)) {
    return false;
  }
  if (known.types.empty() && found.types.empty()) {
    return known.identity == found.identity;
  }
  return !Common(known.types, found.types).empty() || IsIdentityOf(known, found) ||
         IsIdentityOf(found, known);
}

bool IsRefined(Finding const& known, Meaning const& meaning) {
  return !meaning.finding.types.empty() && known.source == meaning.finding.source &&
         CanBeOneID(known.deviceID, meaning.finding.deviceID) &&
         !Common(known.types, meaning.refines).empty();
}

void Combine(Finding& known, Finding const& found) {
  if (known.types.empty()) {
    known.types = found.types;
  } else if (!found.types.empty()) {
    known.types = Common(known.types, found.types);
  }
  if (!IsRealID(known.deviceID) && found.deviceID != DetectionRun::kNoDeviceID) {
    known.deviceID = found.deviceID;
  }
  if (known.identity.empty()) {
    known.identity = found.identity;
  }
}

}  // namespace

bool HasIdentity(Hit const& hit) { return hit.captured[0] != kNotCaptured; }

// Several types may have one identity, of which the library means the first.
Types TypesOf(Autodetect::Response const& response, Hit const& hit) {
  DeviceTypeInfo const matched = response.GetMatchedDeviceTypeInfo(hit.captured);
  if (!matched.Exists() && HasIdentity(hit)) {
    return {};
  }
  Types types;
  if (matched.Exists()) {
    types.push_back(matched);
  }
  for (int i = 0; i < response.CountDeviceTypeInfos(); ++i) {
    DeviceTypeInfo const type = response.GetDeviceTypeInfo(i);
    if (!Holds(types, type) && (!HasIdentity(hit) || HasSameIdentity(type, matched))) {
      types.push_back(type);
    }
  }
  return types;
}

DetectionRun::Bytes IdentityOf(std::vector<Hit> const& hits) {
  for (Hit const& hit : hits) {
    bool const isLong = hit.captured[1] != kNotCaptured;
    if (HasIdentity(hit) && isLong == (hit.captured[0] == 0)) {
      auto const* const bytes = hit.captured.elements;
      DetectionRun::Bytes identity(bytes, bytes + (isLong ? 3 : 1));
      identity.insert(identity.end(), bytes + 3, bytes + 7);
      return identity;
    }
  }
  return {};
}

void AddMeaning(std::vector<Finding>& findings, Meaning const& meaning) {
  for (Finding& known : findings) {
    if (IsRefined(known, meaning)) {
      known.types = meaning.finding.types;
      Combine(known, meaning.finding);
      return;
    }
    if (IsSameInstrument(known, meaning.finding)) {
      Combine(known, meaning.finding);
      return;
    }
  }
  findings.push_back(meaning.finding);
}

}  // namespace Ostinet
