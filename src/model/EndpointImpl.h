// SPDX-License-Identifier: MIT
#pragma once

#include <boost/optional.hpp>

#include "model/DeviceObjectImpl.h"

namespace Ostinet {
class Setup;
}

namespace Ostinet::Impl {

/// What kind of endpoint is made; fixed for its life.
struct EndpointKind {
  EntityImpl* entity = nullptr;
  EndpointImpl* matchingVirtual = nullptr;
  bool isDirect = false;
  bool isSoftware = false;
  bool isInternalSoftware = false;
  bool isVirtual = false;
  bool isPrivate = false;

  /// An end of a user's device, or of a direct one: direct as the entity is.
  static EndpointKind InEntity(EntityImpl& entity);
  /// Made by software, not a port.
  static EndpointKind Software(bool isPrivate, bool isInternal);
  /// One end of a virtual pair: the first is made with a null `matching`, the second with the
  /// first, which is then linked back.
  static EndpointKind Virtual(EndpointImpl* matching, bool isPrivate, bool isInternal);
  /// A port without an entity.
  static EndpointKind Bare(bool isDirect, bool isPrivate);
};

/// Where MIDI leaves (a source) or enters (a destination) the studio.
class EndpointImpl : public DeviceObjectImpl {
 public:
  EndpointImpl(std::unique_ptr<ImplImpl> peer, Setup& setup, EndpointKind const& kind);
  ~EndpointImpl() override;

  UString GetName() const override { return NameToShow(); }
  /// The same without a copy. It stays until the names of the studio change.
  UString const& NameToShow() const;
  void Deactivate(bool fromParent) override;
  void SetName(UString const& name) override;
  bool IsOnline() const override;
  bool HandlePropertyChanges(PropertyKeys const& keys) override;
  void WriteXML(XMLLib::Writer& writer) const override;
  virtual MatchObjectID GetObjectID() const;

  bool IsDestination() const { return isDestination_; }
  bool IsSoftware() const { return kind_.isSoftware; }
  bool IsInternalSoftware() const { return kind_.isInternalSoftware; }
  bool IsVirtual() const { return kind_.isVirtual; }
  bool IsPrivate() const { return kind_.isPrivate; }
  /// Null for bare and virtual endpoints, and once the endpoint left its entity.
  EntityImpl* GetEntity() const { return kind_.entity; }
  EndpointImpl* GetMatchingVirtual() const { return kind_.matchingVirtual; }
  EndpointImpl* GetDirectEndpoint() const { return directEndpoint_; }
  std::vector<EndpointImpl*> const& GetConnected() const { return connected_; }
  Setup& GetSetup() const { return setup_; }

  Receiver* GetDirectReceiver() const { return directReceiver_; }
  void SetDirectReceiver(Receiver* receiver) { directReceiver_ = receiver; }

  UString GetEntityAndEndpointName() const;
  unsigned short GetChannels() const;
  bool HasConnections() const;
  boost::optional<bool> IsInterface() const;
  void ClearCachedNames();
  /// For an entity that goes without Deactivate, at the end of the process.
  void LeaveEntity() { kind_.entity = nullptr; }

  /// On a direct endpoint: ties `endpoint` to it or unties it, and writes both properties. One
  /// that hangs on another port leaves that one's list first; the property there stays.
  void AddConnected(EndpointImpl* endpoint);
  /// Null, or an endpoint that hangs elsewhere, changes no link here.
  void RemoveConnected(EndpointImpl* endpoint);
  /// Replaces the connected endpoints; writes no property.
  void SetConnections(std::vector<EndpointImpl*> const& endpoints);

 protected:
  EndpointImpl(std::unique_ptr<ImplImpl> peer, Setup& setup, EndpointKind const& kind,
               bool isDestination);

 private:
  /// Where the endpoint stands among the endpoints of its direction in its entity.
  struct Place {
    int index = -1;  // -1: in no entity
    bool hasSiblings = false;
  };
  Place FindPlace() const;
  UString BuildName() const;
  UString BuildEntityAndEndpointName() const;
  bool WorkOutStandalone() const;
  void WriteConnections();
  void Disconnect();
  void Unpair();

  Setup& setup_;
  EndpointKind kind_;                   // links cleared by Deactivate
  Receiver* directReceiver_ = nullptr;  // the host's
  bool isStandalone_ = false;
  bool const isDestination_;
  mutable boost::optional<UString> name_;
  mutable boost::optional<UString> entityAndEndpointName_;
  EndpointImpl* directEndpoint_ = nullptr;  // cleared by Deactivate of either side
  std::vector<EndpointImpl*> connected_;    // likewise
};

}  // namespace Ostinet::Impl
