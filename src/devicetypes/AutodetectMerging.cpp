// SPDX-License-Identifier: MIT
#include "devicetypes/AutodetectMerging.h"

#include <algorithm>

namespace Ostinet::Impl {

namespace {

constexpr std::size_t kMostResponses = 10;
using Responses = std::vector<RCPtrMT<AutodetectResponseImpl>>;

// Two bytes of a reply, neither of them the device ID or one that may be anything.
bool DoDiffer(MatchEntry const& a, MatchEntry const& b) {
  bool const areBytes = a.kind == 0 && b.kind == 0 && a.value < kAnyByte && b.value < kAnyByte;
  return areBytes && a.value != b.value;
}

bool DoConflict(Responses const& some, Responses const& others) {
  return std::any_of(some.begin(), some.end(), [&](auto const& a) {
    return std::any_of(others.begin(), others.end(),
                       [&](auto const& b) { return ResponsesConflict(*a, *b); });
  });
}

bool CanTake(AutodetectRequestImpl const& request, AutodetectRequestImpl const& other) {
  return request.responses.size() + other.responses.size() <= kMostResponses &&
         !DoConflict(request.responses, other.responses);
}

void Append(AutodetectRequestImpl& request, AutodetectRequestImpl const& other) {
  request.messages.insert(request.messages.end(), other.messages.begin(), other.messages.end());
  request.responses.insert(request.responses.end(), other.responses.begin(), other.responses.end());
}

}  // namespace

// A reply may go on behind a table, so what counts is the length that both have.
bool ResponsesConflict(AutodetectResponseImpl const& a, AutodetectResponseImpl const& b) {
  if ((a.strict || b.strict) && a.table.size() != b.table.size()) {
    return false;
  }
  std::size_t const shorter = std::min(a.table.size(), b.table.size());
  for (std::size_t i = 0; i < shorter; ++i) {
    if (DoDiffer(a.table[i], b.table[i])) {
      return false;
    }
  }
  return true;
}

void MergeRequest(AutodetectRequests& requests, RCPtrMT<AutodetectRequestImpl> const& request) {
  for (std::size_t i = 1; i < requests.size(); ++i) {
    if (CanTake(*requests[i], *request)) {
      Append(*requests[i], *request);
      return;
    }
  }
  requests.push_back(request);
}

void ComputeDeviceIDRange(AutodetectRequestImpl& request, std::uint8_t idOfAll) {
  request.minDeviceID = idOfAll;
  request.maxDeviceID = 0;
  for (auto const& response : request.responses) {
    for (auto const& type : response->deviceTypes) {
      if (type->hasDeviceID) {
        request.minDeviceID = std::min(request.minDeviceID, type->minDeviceID);
        request.maxDeviceID = std::max(request.maxDeviceID, type->maxDeviceID);
      }
    }
    for (auto const& next : response->requests) {
      ComputeDeviceIDRange(*next, idOfAll);
    }
  }
  request.maxDeviceID = std::max(request.maxDeviceID, request.minDeviceID);
}

}  // namespace Ostinet::Impl
