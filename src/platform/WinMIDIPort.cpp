// SPDX-License-Identifier: MIT

#include "platform/WinMIDIPort.h"

#include "model/EndpointImpl.h"
#include "model/PropertyKeys.h"
#include "platform/WinMIDISetup.h"

namespace Ostinet::Impl {

void WinMIDIPort::Dummy::Deactivate() {
  owner_ = nullptr;
  isDeactivated_ = true;
}

Properties::Implementation WinMIDIPort::Dummy::GetImplementation() const {
  return Properties::kPlatformImplementation;
}

void WinMIDIPort::Dummy::PropChangedInternal(UString const& key) {
  if (owner_ != nullptr) {
    setup_.PropChanged(owner_, key);
  }
}

WinMIDIPort::WinMIDIPort(WinMIDISetup& setup) : dummy_(setup) {}

WinMIDIPort::~WinMIDIPort() = default;

WinMIDIPort* WinMIDIPort::Of(EndpointImpl const& endpoint) {
  return dynamic_cast<WinMIDIPort*>(endpoint.Peer());
}

void WinMIDIPort::Attach(WhichAPI api, std::unique_ptr<WinMIDIImplImpl> port) {
  Detach();
  port->AdoptMissingProperties(dummy_);
  whichAPI_ = api;
  active_ = std::move(port);
  if (dummy_.Owner() != nullptr) {
    active_->Activate(dummy_.Owner());
  }
}

void WinMIDIPort::Detach() {
  if (active_ == nullptr) {
    return;
  }
  active_->Deactivate();
  for (UString const* const key : {&Keys::kName, &Keys::kUniqueID, &Keys::kConnUniqueID}) {
    dummy_.CopyProperty(*active_, *key);
  }
  whichAPI_ = kOffline;
  active_.reset();
}

SelfStorageImplImpl& WinMIDIPort::Current() {
  return active_ != nullptr ? static_cast<SelfStorageImplImpl&>(*active_) : dummy_;
}

SelfStorageImplImpl const& WinMIDIPort::Current() const {
  return const_cast<WinMIDIPort*>(this)->Current();
}

void WinMIDIPort::Activate(DeviceObjectImpl* owner) {
  dummy_.Activate(owner);  // so that the owner outlasts a swap of the port
  if (active_ != nullptr) {
    active_->Activate(owner);
  }
}

void WinMIDIPort::Deactivate() {
  if (active_ != nullptr) {
    active_->Deactivate();
  }
  dummy_.Deactivate();
}

bool WinMIDIPort::Exists() const { return Current().Exists(); }
bool WinMIDIPort::ReallyExists() const { return Current().ReallyExists(); }
bool WinMIDIPort::IsFake() const { return Current().IsFake(); }
bool WinMIDIPort::IsPregen() const { return Current().IsPregen(); }
SynapMidiPort* WinMIDIPort::GetSynapMIDIPort() const { return Current().GetSynapMIDIPort(); }
void* WinMIDIPort::GetImplObjRef(Properties::Implementation implementation) const {
  return Current().GetImplObjRef(implementation);
}

bool WinMIDIPort::GetFile(UString const& key, UString& path) const {
  return Current().GetFile(key, path);
}
bool WinMIDIPort::GetDict(UString const& key, PropertyDict& out) const {
  return Current().GetDict(key, out);
}
bool WinMIDIPort::GetIntList(UString const& key, std::vector<int>& out) const {
  return Current().GetIntList(key, out);
}
bool WinMIDIPort::GetString(UString const& key, UString& out) const {
  return Current().GetString(key, out);
}
bool WinMIDIPort::GetInt(UString const& key, int& out) const { return Current().GetInt(key, out); }

bool WinMIDIPort::SetFile(UString const& key, UString const& path) {
  return Current().SetFile(key, path);
}
bool WinMIDIPort::SetDict(UString const& key, PropertyDict const& value) {
  return Current().SetDict(key, value);
}
bool WinMIDIPort::SetIntList(UString const& key, std::vector<int> const& value) {
  return Current().SetIntList(key, value);
}
bool WinMIDIPort::SetString(UString const& key, UString const& value) {
  return Current().SetString(key, value);
}
bool WinMIDIPort::SetInt(UString const& key, int value) { return Current().SetInt(key, value); }

Properties::Implementation WinMIDIPort::GetImplementation() const {
  return Current().GetImplementation();
}
void WinMIDIPort::RemoveProperty(UString const& key) { Current().RemoveProperty(key); }
void WinMIDIPort::TouchProperty(UString const& key) { Current().TouchProperty(key); }
void WinMIDIPort::WriteProperties(XMLLib::Writer& writer) const {
  Current().WriteProperties(writer);
}
std::unique_ptr<Sender> WinMIDIPort::MakeSender(DeviceObjectImpl* object) {
  return Current().MakeSender(object);
}
void WinMIDIPort::SendSysex(TimeStamp stamp, RCPtrMT<SysexImpl> const& sysex) {
  Current().SendSysex(stamp, sysex);
}
void WinMIDIPort::FlushOutput() { Current().FlushOutput(); }

}  // namespace Ostinet::Impl
