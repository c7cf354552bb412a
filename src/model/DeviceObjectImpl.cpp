// SPDX-License-Identifier: MIT
#include "model/DeviceObjectImpl.h"

#include <algorithm>
#include <utility>

#include "model/PropertyKeys.h"
#include "model/SlotDescriptor.h"
#include "model/XMLNames.h"

namespace Ostinet::Impl {

namespace {

struct TypedModel {
  int deviceType;
  unsigned char identity[7];  // maker, family, member
};

// The interfaces whose type numbers stand in users' files, with what they answer to an inquiry.
constexpr TypedModel kTypedModels[] = {
    {3, {0x00, 0x00, 0x33, 0x00, 0x07, 0x10, 0x00}},
    {5, {0x00, 0x00, 0x33, 0x00, 0x07, 0x11, 0x00}},
    {6, {0x00, 0x00, 0x33, 0x00, 0x07, 0x12, 0x00}},
    {7, {0x00, 0x00, 0x33, 0x01, 0x00, 0x01, 0x00}},
};

}  // namespace

DeviceObjectImpl::DeviceObjectImpl(std::unique_ptr<ImplImpl> peer, bool isDirect)
    : peer_(std::move(peer)), isDirect_(isDirect) {}

DeviceObjectImpl::~DeviceObjectImpl() = default;

UString DeviceObjectImpl::GetName() const { return GetString(Keys::kName); }

void DeviceObjectImpl::Deactivate(bool) { peer_->Deactivate(); }

void DeviceObjectImpl::SetName(UString const& name) { peer_->SetString(Keys::kName, name); }

bool DeviceObjectImpl::IsOnline() const { return Exists() && GetInt(Keys::kOffline, 0) == 0; }

bool DeviceObjectImpl::HandlePropertyChanges(PropertyKeys const&) { return false; }

int DeviceObjectImpl::GetInt(UString const& key, int fallback) const {
  int value = fallback;
  return peer_->GetInt(key, value) ? value : fallback;
}

UString DeviceObjectImpl::GetString(UString const& key, UString const& fallback) const {
  UString value;
  return peer_->GetString(key, value) ? value : fallback;
}

signed char DeviceObjectImpl::GetSysexDeviceID() const {
  int const id = GetInt(Keys::kDeviceID, -1);
  return id >= 0 && id <= 127 ? static_cast<signed char>(id) : static_cast<signed char>(-1);
}

ModelInfo DeviceObjectImpl::GetModelInfo() const {
  ModelInfo info;
  int const type = GetInt(Keys::kDeviceType, 0);
  for (TypedModel const& model : kTypedModels) {
    if (model.deviceType == type) {
      std::copy(std::begin(model.identity), std::end(model.identity), info.bytes);
    }
  }
  return info;
}

SlotID DeviceObjectImpl::GetSlotID() const { return SlotIDOf(*peer_); }

SlotID SlotIDOf(ImplImpl const& peer) {
  SlotID slot;
  std::vector<int> words;
  constexpr std::size_t kWords = 6;
  if (peer.GetIntList(Keys::kSlotDescriptor, words) && words.size() >= kWords) {
    for (std::size_t i = 0; i < kWords; ++i) {
      slot.words[i] = static_cast<unsigned int>(words[i]);
    }
  }
  return slot;
}

void DeviceObjectImpl::WriteProperties(XMLLib::Writer& writer) const {
  writer.StartElement(XMLNames::kProperties);
  peer_->WriteProperties(writer);
  writer.EndElement();
}

}  // namespace Ostinet::Impl
