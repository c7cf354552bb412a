// SPDX-License-Identifier: MIT
#include "ostinet/DeviceObject.h"

#include <algorithm>

#include "model/Handles.h"
#include "model/PropertyKeys.h"

namespace Ostinet {

namespace Keys = Impl::Keys;
using Impl::ImplOf;

namespace {

constexpr int kChannels = 16;
constexpr int kAllChannels = 0xFFFF;

UString GetText(DeviceObject const& handle, UString const& key) {
  Impl::DeviceObjectImpl const* const impl = ImplOf(handle);
  return impl != nullptr ? impl->GetString(key) : UString();
}

void SetText(DeviceObject const& handle, UString const& key, UString const& value) {
  if (Impl::DeviceObjectImpl* const impl = ImplOf(handle)) {
    impl->Peer()->SetString(key, value);
  }
}

int GetNumber(DeviceObject const& handle, UString const& key, int fallback) {
  Impl::DeviceObjectImpl const* const impl = ImplOf(handle);
  return impl != nullptr ? impl->GetInt(key, fallback) : 0;
}

void SetNumber(DeviceObject const& handle, UString const& key, int value) {
  if (Impl::DeviceObjectImpl* const impl = ImplOf(handle)) {
    impl->Peer()->SetInt(key, value);
  }
}

bool IsChannel(int channel) { return channel >= 0 && channel < kChannels; }

UString const& ChannelNameKey(int channel) {
  return Keys::kChannelNames[static_cast<std::size_t>(channel)];
}

}  // namespace

ModelInfo::ModelInfo() { std::fill(std::begin(bytes), std::end(bytes), 0xFF); }

bool ModelInfo::operator==(ModelInfo const& other) const {
  return std::equal(std::begin(bytes), std::end(bytes), std::begin(other.bytes));
}

DeviceObject::DeviceObject() = default;
DeviceObject::DeviceObject(RCPtrMT<Impl::DeviceObjectImpl> const& impl) : Object(impl) {}

bool DeviceObject::Exists() const {
  Impl::DeviceObjectImpl const* const impl = ImplOf(*this);
  return impl != nullptr && impl->Exists();
}

bool DeviceObject::IsDirect() const {
  Impl::DeviceObjectImpl const* const impl = ImplOf(*this);
  return impl != nullptr && impl->IsDirect();
}

bool DeviceObject::IsOnline() const {
  Impl::DeviceObjectImpl const* const impl = ImplOf(*this);
  return impl != nullptr && impl->IsOnline();
}

UString DeviceObject::GetRawName() const { return GetText(*this, Keys::kName); }

void DeviceObject::SetRawName(UString const& name) const {
  if (Impl::DeviceObjectImpl* const impl = ImplOf(*this)) {
    impl->SetName(name);
  }
}

UString DeviceObject::GetManufacturer() const { return GetText(*this, Keys::kManufacturer); }
void DeviceObject::SetManufacturer(UString const& manufacturer) const {
  SetText(*this, Keys::kManufacturer, manufacturer);
}

UString DeviceObject::GetModel() const { return GetText(*this, Keys::kModel); }
void DeviceObject::SetModel(UString const& model) const { SetText(*this, Keys::kModel, model); }

char DeviceObject::GetSysexDeviceID() const {
  Impl::DeviceObjectImpl const* const impl = ImplOf(*this);
  return impl != nullptr ? static_cast<char>(impl->GetSysexDeviceID()) : static_cast<char>(-1);
}

void DeviceObject::SetSysexDeviceID(char id) const {
  int const value = static_cast<unsigned char>(id);
  SetNumber(*this, Keys::kDeviceID, value < 128 ? value : -1);
}

int DeviceObject::GetAdvanceScheduleMicroseconds() const {
  return GetNumber(*this, Keys::kScheduleAheadMuSec, 0);
}
void DeviceObject::SetAdvanceScheduleMicroseconds(int microseconds) const {
  SetNumber(*this, Keys::kScheduleAheadMuSec, microseconds);
}

unsigned short DeviceObject::ReceiveChannels() const {
  return static_cast<unsigned short>(GetNumber(*this, Keys::kReceiveChannels, kAllChannels));
}
void DeviceObject::SetReceiveChannels(unsigned short mask) const {
  SetNumber(*this, Keys::kReceiveChannels, mask);
}

unsigned short DeviceObject::TransmitChannels() const {
  return static_cast<unsigned short>(GetNumber(*this, Keys::kTransmitChannels, kAllChannels));
}
void DeviceObject::SetTransmitChannels(unsigned short mask) const {
  SetNumber(*this, Keys::kTransmitChannels, mask);
}

UString DeviceObject::GetChannelName(int channel) const {
  return IsChannel(channel) ? GetText(*this, ChannelNameKey(channel)) : UString();
}
void DeviceObject::SetChannelName(int channel, UString const& name) const {
  if (IsChannel(channel)) {
    SetText(*this, ChannelNameKey(channel), name);
  }
}

ModelInfo DeviceObject::GetModelInfo() const {
  Impl::DeviceObjectImpl const* const impl = ImplOf(*this);
  return impl != nullptr ? impl->GetModelInfo() : ModelInfo();
}

Properties::Implementation DeviceObject::GetImplementation() const {
  Impl::DeviceObjectImpl const* const impl = ImplOf(*this);
  return impl != nullptr ? impl->Peer()->GetImplementation() : Properties::kNoImplementation;
}

void DeviceObject::ExportToXML(XMLLib::Writer& writer) const {
  if (Impl::DeviceObjectImpl const* const impl = ImplOf(*this)) {
    impl->WriteXML(writer);
  }
}

int DeviceObject::_get_impl_id() const { return GetNumber(*this, Keys::kUniqueID, 0); }

void* DeviceObject::_get_impl_obj_ref(Properties::Implementation implementation) const {
  Impl::DeviceObjectImpl const* const impl = ImplOf(*this);
  return impl != nullptr ? impl->Peer()->GetImplObjRef(implementation) : nullptr;
}

bool DeviceObject::matches_impl_obj_ref(void* ref) const {
  Impl::DeviceObjectImpl const* const impl = ImplOf(*this);
  return impl != nullptr && _get_impl_obj_ref(GetImplementation()) == ref;
}

}  // namespace Ostinet
