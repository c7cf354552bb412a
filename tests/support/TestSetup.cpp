// SPDX-License-Identifier: MIT
#include "support/TestSetup.h"

#include <utility>

#include "model/PropertyKeys.h"

namespace Ostinet {

Setup& Setup::Instance() { return Testing::TestSetup::Get(); }

}  // namespace Ostinet

namespace Ostinet::Testing {

using Impl::EndpointKind;
using Impl::ImplOf;

int TestPeer::sAlive = 0;

namespace {

class RecordingSender : public Impl::Sender {
 public:
  RecordingSender(std::shared_ptr<SentLog> log, bool canSend)
      : log_(std::move(log)), canSend_(canSend) {
    ++log_->sendersAlive;
  }
  ~RecordingSender() override { --log_->sendersAlive; }
  void Send(DataPacket const& packet) override {
    log_->packets.push_back({std::vector<unsigned char>(packet.data, packet.data + packet.length),
                             packet.stamp.AsMIDITime().Value()});
  }
  void Flush() override { ++log_->flushes; }
  bool CanSend() const override { return canSend_; }

 private:
  std::shared_ptr<SentLog> const log_;
  bool const canSend_;
};

}  // namespace

std::unique_ptr<Impl::Sender> TestPeer::MakeSender(Impl::DeviceObjectImpl* object) {
  sent->sendersMadeFor.push_back(object);
  return makesSenders ? std::make_unique<RecordingSender>(sent, canSend) : nullptr;
}

TestSetup& TestSetup::Get() {
  static TestSetup instance;
  return instance;
}

void TestSetup::Reset() {
  SetListener(nullptr);
  signInResult = 0;
  onLoad = nullptr;
  onSaveDevices = nullptr;
  SignOut(false);
  changed = false;
  calls.clear();
  pending.clear();
}

Device TestSetup::MakeDevice(UString const& name, bool isDirect) {
  RCPtrMT<Impl::DeviceImpl> device(
      new Impl::DeviceImpl(std::make_unique<TestPeer>(*this), isDirect));
  GetStudio().devices.push_back(device);
  device->SetName(name);
  MaybeAssignUniqueID(*device);
  return device;
}

Entity TestSetup::MakeEntity(Device const& device, UString const& name, int sources,
                             int destinations) {
  RCPtrMT<Impl::EntityImpl> impl(
      new Impl::EntityImpl(std::make_unique<TestPeer>(*this, &PeerOf(device)), ImplOf(device)));
  GetStudio().entities.push_back(impl);
  ImplOf(device)->AddEntity(impl);
  impl->SetName(name);
  MaybeAssignUniqueID(*impl);
  Entity const entity(impl);
  for (int i = 0; i < sources; ++i) {
    MakeSourceIn(entity);
  }
  for (int i = 0; i < destinations; ++i) {
    MakeDestinationIn(entity);
  }
  return entity;
}

Source TestSetup::MakeSourceIn(Entity const& entity) {
  RCPtrMT<Impl::EndpointImpl> source(
      new Impl::EndpointImpl(std::make_unique<TestPeer>(*this, &PeerOf(entity)), *this,
                             EndpointKind::InEntity(*ImplOf(entity))));
  ImplOf(entity)->AddSource(source);
  GetStudio().sources.push_back(source);
  MaybeAssignUniqueID(*source);
  return source;
}

Destination TestSetup::MakeDestinationIn(Entity const& entity) {
  RCPtrMT<Impl::DestinationImpl> destination(
      new Impl::DestinationImpl(std::make_unique<TestPeer>(*this, &PeerOf(entity)), *this,
                                EndpointKind::InEntity(*ImplOf(entity))));
  ImplOf(entity)->AddDestination(destination);
  GetStudio().destinations.push_back(destination);
  MaybeAssignUniqueID(*destination);
  return destination;
}

Source TestSetup::MakeSource(UString const& name, EndpointKind const& kind) {
  RCPtrMT<Impl::EndpointImpl> source(
      new Impl::EndpointImpl(std::make_unique<TestPeer>(*this), *this, kind));
  (kind.isPrivate ? GetStudio().privateSources : GetStudio().sources).push_back(source);
  source->SetName(name);
  MaybeAssignUniqueID(*source);
  return source;
}

Destination TestSetup::MakeDestination(UString const& name, EndpointKind const& kind) {
  RCPtrMT<Impl::DestinationImpl> destination(
      new Impl::DestinationImpl(std::make_unique<TestPeer>(*this), *this, kind));
  (kind.isPrivate ? GetStudio().privateDestinations : GetStudio().destinations)
      .push_back(destination);
  destination->SetName(name);
  MaybeAssignUniqueID(*destination);
  return destination;
}

Destination TestSetup::MakeInstrument(UString const& name) {
  Entity const entity = MakeEntity(MakeDevice(name), "Port 1", 0, 0);
  Destination const destination = MakeDestinationIn(entity);
  PeerOf(destination).RemoveProperty("uniqueID");
  static int sNextID = 500000;
  PeerOf(destination).SetInt("uniqueID", ++sNextID);  // one of its own, where parts inherit
  return destination;
}

Source TestSetup::MakeSourceInstrument(UString const& name) {
  Entity const entity = MakeEntity(MakeDevice(name), "Port 1", 0, 0);
  Source const source = MakeSourceIn(entity);
  static int sNextID = 600000;
  PeerOf(source).SetInt("uniqueID", ++sNextID);
  return source;
}

TestPeer& TestSetup::PeerOf(DeviceObject const& object) {
  return static_cast<TestPeer&>(*ImplOf(object)->Peer());
}

void TestSetup::SetInt(DeviceObject const& object, char const* key, int value) {
  ImplOf(object)->Peer()->SetInt(key, value);
}

std::vector<int> TestSetup::GetIntList(DeviceObject const& object, char const* key) {
  std::vector<int> list;
  ImplOf(object)->Peer()->GetIntList(key, list);
  return list;
}

void TestSetup::PropChanged(Impl::DeviceObjectImpl* object, UString const& key) {
  pending[RCPtrMT<Impl::DeviceObjectImpl>(object)].insert(key);
}

int TestSetup::PlatformSignIn(UString const&) {
  calls.push_back("SignIn");
  isSignedIn_ = signInResult == 0;
  return signInResult;
}

void TestSetup::SaveDevices() {
  calls.push_back("SaveDevices");
  if (onSaveDevices) {
    onSaveDevices();
  }
}

void TestSetup::PlatformSignOut() {
  calls.push_back("SignOut");
  isSignedIn_ = false;
  pending.clear();
}

void TestSetup::PlatformLoadSetup() {
  calls.push_back("LoadSetup");
  if (onLoad) {
    onLoad();
  }
}

bool TestSetup::PlatformPollSetupChanges(bool& connectionsChanged) {
  calls.push_back("PollSetupChanges");
  bool notify = std::exchange(changed, false);
  auto const changes = std::exchange(pending, {});
  for (auto const& [object, keys] : changes) {
    notify |= object->Exists();
    connectionsChanged |= object->HandlePropertyChanges(keys);
  }
  return notify;
}

RCPtrMT<Impl::DeviceImpl> TestSetup::PlatformCreateDevice(XMLLib::Parser&) {
  calls.push_back("CreateDevice(Parser)");
  return ImplOf(MakeDevice("Imported"));
}

RCPtrMT<Impl::DeviceImpl> TestSetup::PlatformCreateDevice(Impl::DeviceTypeInfoImpl*,
                                                          UString const& name) {
  calls.push_back("CreateDevice");
  Device const device = MakeDevice(name);
  MakeEntity(device, "Port 1", 1, 1);
  return ImplOf(device);
}

void TestSetup::PlatformWillDeleteDevice(RCPtrMT<Impl::DeviceImpl>&) {
  calls.push_back("WillDeleteDevice");
}

RCPtrMT<Impl::EntityImpl> TestSetup::PlatformCreateEntity(RCPtrMT<Impl::DeviceImpl>& device,
                                                          UString const& name, int sources,
                                                          int destinations) {
  calls.push_back("CreateEntity");
  return ImplOf(MakeEntity(Device(device), name, sources, destinations));
}

void TestSetup::PlatformWillDeleteEntity(RCPtrMT<Impl::EntityImpl>&) {
  calls.push_back("WillDeleteEntity");
}

void TestSetup::PlatformSetEntitySources(RCPtrMT<Impl::EntityImpl>& entity, int count) {
  calls.push_back("SetEntitySources " + std::to_string(count));
  while (static_cast<int>(entity->GetSources().size()) < count) {
    MakeSourceIn(Entity(entity));
  }
  while (static_cast<int>(entity->GetSources().size()) > count) {
    RemoveSource(entity->GetSources().back());
  }
}

void TestSetup::PlatformSetEntityDestinations(RCPtrMT<Impl::EntityImpl>& entity, int count) {
  calls.push_back("SetEntityDestinations " + std::to_string(count));
  while (static_cast<int>(entity->GetDestinations().size()) < count) {
    MakeDestinationIn(Entity(entity));
  }
  while (static_cast<int>(entity->GetDestinations().size()) > count) {
    RemoveDestination(entity->GetDestinations().back());
  }
}

void TestSetup::PlatformWillDeleteBareEndpoint(RCPtrMT<Impl::EndpointImpl>&) {
  calls.push_back("WillDeleteBareEndpoint");
}

std::pair<RCPtrMT<Impl::EndpointImpl>, RCPtrMT<Impl::DestinationImpl>>
TestSetup::PlatformCreateVirtualEndpoint(UString const& name, int uniqueID, SrcOrDest source,
                                         SrcOrDest destination) {
  calls.push_back("CreateVirtualEndpoint " + name.string() + " " + std::to_string(uniqueID) + " " +
                  std::to_string(source) + " " + std::to_string(destination));
  Source const first =
      MakeSource(name, EndpointKind::Virtual(nullptr, source != kSourceEnd, false));
  Destination const second = MakeDestination(
      name, EndpointKind::Virtual(ImplOf(first), destination != kDestinationEnd, false));
  PeerOf(second).isFake = true;
  return {ImplOf(first), ImplOf(second)};
}

void TestSetup::PlatformDeleteVirtualEndpoint(RCPtrMT<Impl::EndpointImpl>& source,
                                              RCPtrMT<Impl::DestinationImpl>& destination) {
  calls.push_back(std::string("DeleteVirtualEndpoint") + (source ? " source" : "") +
                  (destination ? " destination" : ""));
}

}  // namespace Ostinet::Testing
