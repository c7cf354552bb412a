// SPDX-License-Identifier: MIT
#include "ostinet/Endpoint.h"

namespace Ostinet {

namespace {

using EndpointFilter = ObjectFilter<Endpoint>;
using EndpointPredicate = boost::function<bool(Endpoint const&)>;

// Whether the three-state answer may be taken for `wanted`; `ifUnknown` settles the third state.
EndpointPredicate InterfaceIs(bool wanted, bool ifUnknown) {
  return [=](Endpoint const& endpoint) {
    boost::optional<bool> const answer = endpoint.IsInterface();
    return answer ? *answer == wanted : ifUnknown;
  };
}

}  // namespace

EndpointFilter& DirectEndpoint() {
  static EndpointFilter filter{EndpointPredicate(&Endpoint::IsDirect)};
  return filter;
}

EndpointFilter& OnlineEndpoint() {
  static EndpointFilter filter{EndpointPredicate(&Endpoint::IsOnline)};
  return filter;
}

EndpointFilter& PublicEndpoint() {
  static EndpointFilter filter =
      EndpointPredicate([](Endpoint const& endpoint) { return !endpoint.IsPrivate(); });
  return filter;
}

EndpointFilter& SoftwareEndpoint() {
  static EndpointFilter filter{EndpointPredicate(&Endpoint::IsSoftware)};
  return filter;
}

EndpointFilter& DefinitelyInterfaceEndpoint() {
  static EndpointFilter filter(InterfaceIs(true, false));
  return filter;
}

EndpointFilter& DefinitelyNonInterfaceEndpoint() {
  static EndpointFilter filter(InterfaceIs(false, false));
  return filter;
}

EndpointFilter& CouldBeInterfaceEndpoint() {
  static EndpointFilter filter(InterfaceIs(true, true));
  return filter;
}

EndpointFilter& CouldBeNonInterfaceEndpoint() {
  static EndpointFilter filter(InterfaceIs(false, true));
  return filter;
}

EndpointFilter& EntitylessNonSoftwareEndpoint() {
  static EndpointFilter filter = EndpointPredicate([](Endpoint const& endpoint) {
    return endpoint.GetEntity() == Entity::kNoEntity && !endpoint.IsSoftware();
  });
  return filter;
}

ObjectFilter<Device>& DirectDevice() {
  static ObjectFilter<Device> filter{boost::function<bool(Device const&)>(&Device::IsDirect)};
  return filter;
}

}  // namespace Ostinet
