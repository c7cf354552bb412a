// SPDX-License-Identifier: MIT
#include "model/DestinationImpl.h"

#include <utility>

#include "model/NamesHooks.h"
#include "model/PropertyKeys.h"
#include "ostinet/Setup.h"

namespace Ostinet::Impl {

DestinationImpl::DestinationImpl(std::unique_ptr<ImplImpl> peer, Setup& setup,
                                 EndpointKind const& kind)
    : EndpointImpl(std::move(peer), setup, kind, true) {
  if (IsDirect()) {
    channelState_ = new ChannelPatchState;
  }
  if (NamesHooks const* const hooks = GetNamesHooks()) {
    names_ = hooks->MakeNames(*this);
  }
}

DestinationImpl::~DestinationImpl() = default;

bool DestinationImpl::HandlePropertyChanges(PropertyKeys const& keys) {
  bool const result = EndpointImpl::HandlePropertyChanges(keys);
  for (UString const* key : {&Keys::kManufacturer, &Keys::kModel, &Keys::kNameConfiguration,
                             &Keys::kSupportsGeneralMIDI}) {
    if (keys.count(*key) != 0) {
      RenewNames();
      break;
    }
  }
  return result;
}

void DestinationImpl::RenewNames() {
  constexpr unsigned short kAllChannels = 0xFFFF;
  if (names_ == nullptr || !names_->Renew()) {
    return;
  }
  if (SetupListener* const listener = GetSetup().GetListener()) {
    listener->DestinationNamesChanged(RCPtrMT<DestinationImpl>(this), kAllChannels);
  }
}

void DestinationImpl::RenewNewNames() {
  if (names_ != nullptr) {
    names_->Renew();
  }
}

NameFileStore* DestinationImpl::GetNameFileStore() const { return GetSetup().GetNameFileStore(); }

MatchObjectID DestinationImpl::GetObjectID() const { return Destination::kObjectID; }

unsigned short DestinationImpl::TakeChangedChannels() {
  return channelState_.get() != nullptr ? channelState_->TakeChangedChannels()
                                        : static_cast<unsigned short>(0);
}

DestinationImpl* AsDestination(EndpointImpl* endpoint) {
  return dynamic_cast<DestinationImpl*>(endpoint);
}

}  // namespace Ostinet::Impl
