// SPDX-License-Identifier: MIT
//
// EndpointImpl: what hangs on which port.
//
// A link has two ends that always agree: an endpoint stands in the list of exactly the port that
// its own link names. Both ends also store the connection as unique IDs, from which the links are
// rebuilt; a stored number without an endpoint waits for one that comes later.
#include <algorithm>
#include <unordered_set>
#include <utility>

#include "model/EndpointImpl.h"
#include "model/PropertyKeys.h"

namespace Ostinet::Impl {

namespace {

void Erase(std::vector<EndpointImpl*>& list, EndpointImpl const* endpoint) {
  auto const place = std::find(list.begin(), list.end(), endpoint);
  if (place != list.end()) {
    list.erase(place);
  }
}

}  // namespace

void EndpointImpl::Disconnect() {
  if (EndpointImpl* const port = std::exchange(directEndpoint_, nullptr)) {
    Erase(port->connected_, this);
  }
  for (EndpointImpl* const endpoint : std::exchange(connected_, {})) {
    endpoint->directEndpoint_ = nullptr;
  }
}

void EndpointImpl::AddConnected(EndpointImpl* endpoint) {
  if (std::find(connected_.begin(), connected_.end(), endpoint) != connected_.end()) {
    return;
  }
  if (endpoint->directEndpoint_ != nullptr) {
    Erase(endpoint->directEndpoint_->connected_, endpoint);
  }
  connected_.push_back(endpoint);
  endpoint->directEndpoint_ = this;
  WriteConnections();
}

void EndpointImpl::RemoveConnected(EndpointImpl* endpoint) {
  Erase(connected_, endpoint);
  if (endpoint != nullptr) {
    if (endpoint->directEndpoint_ == this) {
      endpoint->directEndpoint_ = nullptr;
    }
    if (!endpoint->Peer()->IsFake()) {
      endpoint->Peer()->RemoveProperty(Keys::kConnUniqueID);
    }
  }
  WriteConnections();
}

void EndpointImpl::WriteConnections() {
  EndpointImpl* port = this;
  while (!port->IsDirect() && port->directEndpoint_ != nullptr) {
    port = port->directEndpoint_;
  }
  std::vector<int> const portID(1, port->GetInt(Keys::kUniqueID, 0));
  std::vector<int> ids;
  std::vector<EndpointImpl*> const connected = port->connected_;
  for (EndpointImpl* const endpoint : connected) {
    if (!endpoint->Peer()->IsFake()) {
      endpoint->Peer()->SetIntList(Keys::kConnUniqueID, portID);
    }
    ids.push_back(endpoint->GetInt(Keys::kUniqueID, 0));
  }
  port->Peer()->SetIntList(Keys::kConnUniqueID, ids);
}

void EndpointImpl::SetConnections(std::vector<EndpointImpl*> const& endpoints) {
  if (endpoints == connected_) {
    return;  // as nearly always
  }
  std::unordered_set<EndpointImpl*> const before(connected_.begin(), connected_.end());
  std::unordered_set<EndpointImpl*> const now(endpoints.begin(), endpoints.end());
  for (EndpointImpl* const removed : connected_) {
    if (now.count(removed) == 0 && removed->directEndpoint_ == this) {
      removed->directEndpoint_ = nullptr;
    }
  }
  connected_ = endpoints;
  for (EndpointImpl* const added : endpoints) {
    if (before.count(added) == 0) {
      if (added->directEndpoint_ != nullptr && added->directEndpoint_ != this) {
        Erase(added->directEndpoint_->connected_, added);
      }
      added->directEndpoint_ = this;
    }
  }
}

}  // namespace Ostinet::Impl
