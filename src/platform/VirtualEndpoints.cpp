// SPDX-License-Identifier: MIT

// Virtual pairs: what is sent to the destination is read from the source at the next poll.

#include <algorithm>

#include "model/DestinationImpl.h"
#include "model/PropertyKeys.h"
#include "platform/WinMIDISetup.h"
#include "platform/ports/WinMIDIVirtDest.h"

namespace Ostinet::Impl {

void WinMIDISetup::NameVirtualEnd(EndpointImpl& end, UString const& name, int wantedID,
                                  bool isPublic) {
  end.SetName(name);
  if (isPublic && wantedID != 0 && !UniqueIDInUse(wantedID)) {
    end.Peer()->SetInt(Keys::kUniqueID, wantedID);
  } else {
    MaybeAssignUniqueID(end);
  }
}

std::pair<RCPtrMT<EndpointImpl>, RCPtrMT<DestinationImpl>>
WinMIDISetup::PlatformCreateVirtualEndpoint(UString const& name, int uniqueID, SrcOrDest publicEnd,
                                            SrcOrDest) {
  bool const sourceIsPublic = publicEnd == kSourceEnd;
  bool const destinationIsPublic = publicEnd == kDestinationEnd;
  auto sourcePeer = std::make_unique<WinMIDIVirtSource>(*this);
  auto destinationPeer = std::make_unique<WinMIDIVirtDest>(*this, *sourcePeer);

  RCPtrMT<EndpointImpl> const source(new EndpointImpl(
      std::move(sourcePeer), *this, EndpointKind::Virtual(nullptr, !sourceIsPublic, false)));
  NameVirtualEnd(*source, name, uniqueID, sourceIsPublic);
  RCPtrMT<DestinationImpl> const destination(
      new DestinationImpl(std::move(destinationPeer), *this,
                          EndpointKind::Virtual(source.get(), !destinationIsPublic, false)));
  NameVirtualEnd(*destination, name, uniqueID, destinationIsPublic);

  (sourceIsPublic ? Lists().sources : Lists().privateSources).push_back(source);
  (destinationIsPublic ? Lists().destinations : Lists().privateDestinations).push_back(destination);
  MarkChanged();
  destination->RenewNewNames();
  MutexHolder const lock(virtualSourcesMutex_);
  virtualSources_.push_back(source);
  return {source, destination};
}

void WinMIDISetup::PlatformDeleteVirtualEndpoint(RCPtrMT<EndpointImpl>& source,
                                                 RCPtrMT<DestinationImpl>&) {
  MutexHolder const lock(virtualSourcesMutex_);
  virtualSources_.erase(std::remove(virtualSources_.begin(), virtualSources_.end(), source),
                        virtualSources_.end());
}

}  // namespace Ostinet::Impl
