// SPDX-License-Identifier: MIT
#include "ostinet/Common.h"

#include "model/Handles.h"

namespace Ostinet {

template class RCPtrMT<Impl::ObjectImpl>;
template class RCPtrMT<Impl::DeviceObjectImpl>;
template class RCPtrMT<Impl::DeviceImpl>;
template class RCPtrMT<Impl::EntityImpl>;
template class RCPtrMT<Impl::EndpointImpl>;
template class RCPtrMT<Impl::DestinationImpl>;

Properties::~Properties() = default;

Properties::Implementation Properties::GetImplementation() const { return kPlatformImplementation; }

UString Properties::GetImplementationName() const { return "WinMIDI"; }

unsigned int Properties::GetImplementationVersion() const { return 0; }

bool Properties::ConfigUtilityExists() const { return false; }

UString Properties::GetConfigUtilityName() const { return "No MIDI Utility"; }

Properties::RunConfigResult Properties::RunConfigUtility() const { return kNoConfigUtility; }

}  // namespace Ostinet
