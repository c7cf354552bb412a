// SPDX-License-Identifier: MIT
#pragma once

#include "datapath/ChannelPatchState.h"
#include "model/EndpointImpl.h"

namespace Ostinet::Impl {

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

 private:
  RCPtrMT<ChannelPatchState> channelState_;
};

}  // namespace Ostinet::Impl
