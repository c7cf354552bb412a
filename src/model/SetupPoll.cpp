// SPDX-License-Identifier: MIT
//
// Setup: what happens at the host's regular calls. Its callbacks may create and delete objects,
// so every list is walked over a copy.
#include <array>
#include <exception>
#include <vector>

#include "model/SetupState.h"
#include "ostinet/core/Error.h"

namespace Ostinet {

namespace {

using Destinations = std::vector<RCPtrMT<Impl::DestinationImpl>>;

Destinations ConnectedDestinations(Impl::DestinationImpl const& port) {
  Destinations destinations;
  for (Impl::EndpointImpl* const endpoint : port.GetConnected()) {
    destinations.push_back(Impl::AsDestination(endpoint));
  }
  return destinations;
}

void TellPatchChanged(Setup const& setup, Impl::DestinationImpl* destination,
                      unsigned short channels) {
  SetupListener* const listener = setup.GetListener();
  if (listener != nullptr && destination != nullptr) {
    listener->CurrentPatchChanged(RCPtrMT<Impl::DestinationImpl>(destination), channels);
  }
}

}  // namespace

void Setup::Poll() {
  Destinations const destinations = GetStudio().destinations;
  for (RCPtrMT<Impl::DestinationImpl> const& destination : destinations) {
    // Taken also when nobody listens: a listener that comes later hears of later changes only.
    unsigned short const channels = destination->TakeChangedChannels();
    if (channels == 0 || !destination->Exists()) {
      continue;
    }
    if (destination->HasConnections()) {
      for (auto const& connected : ConnectedDestinations(*destination)) {
        TellPatchChanged(*this, connected.get(), channels);
      }
    }
    TellPatchChanged(*this, destination.get(), channels);
  }
  for (RCPtrMT<Impl::DestinationImpl> const& destination : GetStudio().privateDestinations) {
    destination->TakeChangedChannels();
  }
  PlatformPollImpl();
}

void Setup::PollSetupChanges() {
  if (state_->isDeferred) {
    return;
  }
  bool connectionsChanged = false;
  if (PlatformPollSetupChanges(connectionsChanged)) {
    if (connectionsChanged) {
      UpdateConnections();
    }
    if (state_->listener != nullptr) {
      state_->listener->SetupChanged();
    }
  }
  constexpr int kRoundsPerSave = 30;  // once a minute at PollSetupChangesInterval
  if (++state_->changesPollCount >= kRoundsPerSave) {
    state_->changesPollCount = 0;
    TrySavingEditedBanks();
  }
}

double Setup::PollInterval() const { return 1.0; }
double Setup::PollSetupChangesInterval() const { return 2.0; }

void Setup::Suspend() {}
void Setup::Resume() {}

void Setup::SaveEditedDestBanks() {
  std::exception_ptr firstFailure;
  for (Destinations const* list : {&GetStudio().destinations, &GetStudio().privateDestinations}) {
    Destinations const destinations = *list;
    for (RCPtrMT<Impl::DestinationImpl> const& destination : destinations) {
      if (Impl::DestinationNames* const names = destination->GetNames()) {
        try {
          names->SaveEditedBanks();
        } catch (VantorError const&) {
          firstFailure = firstFailure ? firstFailure : std::current_exception();
        }
      }
    }
  }
  if (firstFailure) {
    std::rethrow_exception(firstFailure);
  }
}

// What a round or a sign-out cannot save must not keep it from its other work.
void Setup::TrySavingEditedBanks() {
  try {
    SaveEditedDestBanks();
  } catch (VantorError const&) {
  }
}

void Setup::Panic() {
  constexpr unsigned char kControlChange = 0xB0;
  constexpr unsigned char kAllSoundOff = 120;
  constexpr unsigned char kSustain = 64;
  std::array<std::array<unsigned char, 3>, 32> messages{};
  for (std::size_t i = 0; i < messages.size(); ++i) {
    auto const status = static_cast<unsigned char>(kControlChange + i / 2);
    messages[i] = {status, i % 2 == 0 ? kAllSoundOff : kSustain, 0};
  }
  PlatformPanic();
  Destinations const destinations = GetStudio().destinations;
  for (RCPtrMT<Impl::DestinationImpl> const& impl : destinations) {
    Destination const destination(impl);
    if (!destination.IsDirect() || !destination.IsOnline()) {
      continue;
    }
    std::unique_ptr<Impl::Sender> const sender = destination.MakeSender();
    if (sender != nullptr && sender->CanSend()) {
      for (auto const& message : messages) {
        sender->Send(DataPacket{message.data(), message.size(), kNoTimeStamp});
      }
      sender->Flush();
    }
  }
}

WithSetupChangesCompleteAndDeferred::WithSetupChangesCompleteAndDeferred() {
  Setup& setup = Setup::Instance();
  setup.PollSetupChanges();
  setup.state_->isDeferred = true;
}

WithSetupChangesCompleteAndDeferred::~WithSetupChangesCompleteAndDeferred() {
  Setup::Instance().state_->isDeferred = false;
}

}  // namespace Ostinet
