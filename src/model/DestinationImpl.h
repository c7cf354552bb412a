// SPDX-License-Identifier: MIT
#pragma once

#include "datapath/ChannelPatchState.h"
#include "model/EndpointImpl.h"

namespace Ostinet::Impl {

class NameFileStore;

/// What a destination's patches are called: the side of a destination that knows documents. The
/// destination tells it what happens; it does the rest.
class DestinationNames {
 public:
  virtual ~DestinationNames() = default;
  /// Looks anew at what the names follow from; true if they changed.
  virtual bool Renew() = 0;
  /// Writes what the user edited.
  virtual void SaveEditedBanks() = 0;
  /// The destination is about to leave the studio.
  virtual void WillRemove() = 0;
};

/// A destination: an endpoint that is sent to.
class DestinationImpl : public EndpointImpl {
 public:
  DestinationImpl(std::unique_ptr<ImplImpl> peer, Setup& setup, EndpointKind const& kind);
  ~DestinationImpl() override;

  bool HandlePropertyChanges(PropertyKeys const& keys) override;
  MatchObjectID GetObjectID() const override;

  /// What was sent on each channel; null unless the destination is direct.
  RCPtrMT<ChannelPatchState> const& GetChannelState() const { return channelState_; }
  /// The channels on which a patch change was sent since the last call; bit n is channel n.
  unsigned short TakeChangedChannels();

  /// Null for a destination without names.
  DestinationNames* GetNames() const { return names_.get(); }
  void SetNames(std::unique_ptr<DestinationNames> names) { names_ = std::move(names); }
  /// Renews the names, and tells the listener if they changed.
  void RenewNames();
  /// The same for a destination that the host does not know yet: it will hear of it as a whole.
  void RenewNewNames();
  /// The written name documents in use; null while signed out.
  NameFileStore* GetNameFileStore() const;

 private:
  RCPtrMT<ChannelPatchState> channelState_;
  std::unique_ptr<DestinationNames> names_;
};

/// The endpoint as a destination; null for a source, and for null.
DestinationImpl* AsDestination(EndpointImpl* endpoint);

}  // namespace Ostinet::Impl
