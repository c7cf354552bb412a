// SPDX-License-Identifier: MIT

#include "platform/SetupFileReader.h"

#include "model/DestinationImpl.h"
#include "model/DeviceImpl.h"
#include "model/EntityImpl.h"
#include "model/PropertyXML.h"
#include "model/XMLNames.h"
#include "platform/SetupFile.h"
#include "platform/WinMIDIPort.h"
#include "platform/WinMIDISetup.h"

namespace Ostinet::Impl {

void SetupFileReader::ReadStudio() {
  if (!parser_.DownToReqChildNounexp(kSetupFileRoot)) {
    return;
  }
  while (parser_.DownToChild()) {
    XMLLib::Name const name = parser_.CurrentElement();
    if (name == XMLNames::kDevice) {
      ReadDevice();
    } else if (name == XMLNames::kSource || name == XMLNames::kDestination) {
      ReadBarePort(name == XMLNames::kSource);
    }
    parser_.UpToParent();
  }
  parser_.UpToParent();
}

RCPtrMT<DeviceImpl> SetupFileReader::ReadDevice() {
  bool isDirect = true;
  if (!parser_.ReadReqAttribute(XMLNames::kDirect, XMLLib::kBoolAttribute, isDirect) || isDirect) {
    return {};
  }
  auto peer = std::make_unique<WinMIDIImplImpl>(setup_, nullptr);
  ReadProperties(*peer);
  RCPtrMT<DeviceImpl> const device(new DeviceImpl(std::move(peer), false));
  setup_.Lists().devices.push_back(device);
  setup_.MarkChanged();
  while (parser_.DownToChildNounexp(XMLNames::kEntity)) {
    ReadEntity(*device);
    parser_.UpToParent();
  }
  setup_.AssignUniqueID(*device);
  return device;
}

void SetupFileReader::ReadEntity(DeviceImpl& device) {
  bool isDirect = false;
  if (!parser_.ReadReqAttribute(XMLNames::kDirect, XMLLib::kBoolAttribute, isDirect) ||
      isDirect != device.IsDirect()) {
    return;
  }
  auto peer =
      std::make_unique<WinMIDIImplImpl>(setup_, dynamic_cast<WinMIDIImplImpl*>(device.Peer()));
  ReadProperties(*peer);
  RCPtrMT<EntityImpl> const entity(new EntityImpl(std::move(peer), &device));
  device.AddEntity(entity);
  setup_.Lists().entities.push_back(entity);
  setup_.MarkChanged();
  while (parser_.DownToChild()) {
    ReadEntityChild(*entity);
    parser_.UpToParent();
  }
  setup_.AssignUniqueID(*entity);
}

void SetupFileReader::ReadEntityChild(EntityImpl& entity) {
  XMLLib::Name const name = parser_.CurrentElement();
  if (name == XMLNames::kSource || name == XMLNames::kDestination) {
    ReadEndpoint(entity, name == XMLNames::kSource);
  }
}

bool SetupFileReader::ReadEndpointAttributes(bool& isDirect) const {
  bool isSoftware = true;
  return parser_.ReadReqAttribute(XMLNames::kDirect, XMLLib::kBoolAttribute, isDirect) &&
         parser_.ReadReqAttribute(XMLNames::kSoftware, XMLLib::kBoolAttribute, isSoftware) &&
         !isSoftware;
}

void SetupFileReader::ReadBarePort(bool isSource) {
  bool isDirect = false;
  if (!ReadEndpointAttributes(isDirect) || !isDirect) {
    return;
  }
  auto peer = std::make_unique<WinMIDIPort>(setup_);
  ReadProperties(*peer);
  EndpointKind const kind = EndpointKind::Bare(true, false);
  if (isSource) {
    AddSource(new EndpointImpl(std::move(peer), setup_, kind));
  } else {
    AddDestination(new DestinationImpl(std::move(peer), setup_, kind));
  }
}

void SetupFileReader::ReadEndpoint(EntityImpl& entity, bool isSource) {
  bool isDirect = false;
  if (!ReadEndpointAttributes(isDirect) || isDirect != entity.IsDirect()) {
    return;
  }
  auto peer =
      std::make_unique<WinMIDIImplImpl>(setup_, dynamic_cast<WinMIDIImplImpl*>(entity.Peer()));
  ImplImpl& endpointPeer = *peer;
  ReadProperties(*peer);
  EndpointKind const kind = EndpointKind::InEntity(entity);
  if (isSource) {
    RCPtrMT<EndpointImpl> const source(new EndpointImpl(std::move(peer), setup_, kind));
    entity.AddSource(source);
    AddSource(source);
  } else {
    RCPtrMT<DestinationImpl> const destination(new DestinationImpl(std::move(peer), setup_, kind));
    entity.AddDestination(destination);
    AddDestination(destination);
  }
  // A saved studio gets its connections back by their stored IDs.
  if (purpose_ == kImport && !isDirect) {
    ReadConnection(endpointPeer, isSource);
  }
}

void SetupFileReader::AddSource(RCPtrMT<EndpointImpl> const& source) {
  setup_.Lists().sources.push_back(source);
  setup_.MarkChanged();
  setup_.AssignUniqueID(*source);
}

void SetupFileReader::AddDestination(RCPtrMT<DestinationImpl> const& destination) {
  setup_.Lists().destinations.push_back(destination);
  setup_.MarkChanged();
  setup_.AssignUniqueID(*destination);
  destination->RenewNewNames();
}

void SetupFileReader::ReadConnection(ImplImpl& peer, bool isSource) {
  if (parser_.DownToChildNounexp(XMLNames::kConnection)) {
    setup_.ImportConnection(parser_, peer, isSource);
    parser_.UpToParent();
  }
}

void SetupFileReader::ReadProperties(ImplImpl& peer) {
  if (parser_.DownToReqChildNounexp(XMLNames::kProperties)) {
    Impl::ReadProperties(parser_, peer, purpose_ == kImport);
    parser_.UpToParent();
  }
}

}  // namespace Ostinet::Impl
