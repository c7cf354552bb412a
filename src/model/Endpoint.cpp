// SPDX-License-Identifier: MIT
#include "ostinet/Endpoint.h"

#include "model/Handles.h"
#include "model/PropertyKeys.h"

namespace Ostinet {

namespace Keys = Impl::Keys;
namespace KeyPairs = Impl::KeyPairs;
using Impl::ImplOf;

namespace {

bool Supports(Endpoint const& handle, Impl::KeyPair const& keys, bool fallback) {
  Impl::EndpointImpl const* const impl = ImplOf(handle);
  return impl != nullptr && impl->GetInt(keys.For(impl->IsDestination()), fallback ? 1 : 0) != 0;
}

}  // namespace

Endpoint::Endpoint() = default;
Endpoint::Endpoint(RCPtrMT<Impl::EndpointImpl> const& impl) : DeviceObject(impl) {}

int Endpoint::GetUniqueID() const { return _get_impl_id(); }

Entity Endpoint::GetEntity() const {
  Impl::EndpointImpl const* const impl = ImplOf(*this);
  return impl != nullptr ? Entity(impl->GetEntity()) : Entity();
}

UString Endpoint::GetChannelName(short channel) const {
  Impl::EndpointImpl const* const impl = ImplOf(*this);
  if (impl == nullptr || channel < 0 || channel > 15) {
    return UString();
  }
  UString number;
  number.Stream() << channel + 1;
  return impl->GetString(Keys::kChannelNames[static_cast<std::size_t>(channel)], number);
}

unsigned short Endpoint::GetChannels() const {
  Impl::EndpointImpl const* const impl = ImplOf(*this);
  return impl != nullptr ? impl->GetChannels() : static_cast<unsigned short>(0);
}

UString Endpoint::GetEntityAndEndpointName() const {
  Impl::EndpointImpl const* const impl = ImplOf(*this);
  return impl != nullptr ? impl->GetEntityAndEndpointName() : UString();
}

SlotID Endpoint::GetSlotID() const {
  Impl::EndpointImpl const* const impl = ImplOf(*this);
  return impl != nullptr ? impl->GetSlotID() : SlotID();
}

bool Endpoint::HasConnections() const {
  Impl::EndpointImpl const* const impl = ImplOf(*this);
  return impl != nullptr && impl->HasConnections();
}

bool Endpoint::IsDeviceCommon() const {
  Impl::EndpointImpl const* const impl = ImplOf(*this);
  Impl::EntityImpl* const entity = impl != nullptr ? impl->GetEntity() : nullptr;
  Impl::DeviceImpl const* const device = entity != nullptr ? entity->GetDevice() : nullptr;
  return device != nullptr && device->GetSpecialEntity(Device::kDeviceCommonEntity) == entity;
}

boost::optional<bool> Endpoint::IsInterface() const {
  Impl::EndpointImpl const* const impl = ImplOf(*this);
  return impl != nullptr ? impl->IsInterface() : boost::optional<bool>();
}

bool Endpoint::IsInternalSoftware() const {
  Impl::EndpointImpl const* const impl = ImplOf(*this);
  return impl != nullptr && impl->IsInternalSoftware();
}

bool Endpoint::IsLoop() const {
  Impl::EndpointImpl const* const impl = ImplOf(*this);
  return impl != nullptr && impl->GetString(Keys::kDriver) == "com.apple.AppleMIDIIACDriver";
}

bool Endpoint::IsPrivate() const {
  Impl::EndpointImpl const* const impl = ImplOf(*this);
  return impl != nullptr && impl->IsPrivate();
}

bool Endpoint::IsSoftware() const {
  Impl::EndpointImpl const* const impl = ImplOf(*this);
  return impl != nullptr && impl->IsSoftware();
}

bool Endpoint::IsVirtual() const {
  Impl::EndpointImpl const* const impl = ImplOf(*this);
  return impl != nullptr && impl->IsVirtual();
}

bool Endpoint::SupportsBankSelect0() const {
  return Supports(*this, KeyPairs::kBankSelectMSB, false);
}
bool Endpoint::SupportsBankSelect32() const {
  return Supports(*this, KeyPairs::kBankSelectLSB, false);
}
bool Endpoint::SupportsClock() const { return Supports(*this, KeyPairs::kClock, false); }
bool Endpoint::SupportsMTC() const { return Supports(*this, KeyPairs::kMTC, false); }
bool Endpoint::SupportsNotes() const { return Supports(*this, KeyPairs::kNotes, true); }
bool Endpoint::SupportsProgramChange() const {
  return Supports(*this, KeyPairs::kProgramChanges, true);
}

bool CompMIDIEndpointNames(Endpoint const& a, Endpoint const& b) {
  return a.GetName().less(b.GetName(), UString::kIgnoreCase);
}

}  // namespace Ostinet
