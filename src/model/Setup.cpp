// SPDX-License-Identifier: MIT
//
// Setup: the session, and what it holds.
#include "ostinet/Setup.h"

#include <utility>

#include "model/NamesHooks.h"
#include "model/SetupState.h"

namespace Ostinet {

using Impl::HandleAt;

SetupListener::~SetupListener() = default;

OstinetCallbackAPI* OstinetCallbackAPI::gInstance = nullptr;
OstinetCallbackAPI::~OstinetCallbackAPI() = default;

Impl::WinMIDIDevicesListener::~WinMIDIDevicesListener() = default;

Setup::Setup() : state_(std::make_unique<State>()) {}
Setup::~Setup() = default;

Setup::SignInResult Setup::SignIn(UString const& name, Receiver* receiver, PrefsHandler* prefs) {
  if (IsSignedIn()) {
    return kSignInAlreadySignedIn;
  }
  state_->signInName = name;
  state_->receiver = receiver;
  state_->prefs = prefs;
  state_->nameFileStore = std::make_unique<Impl::NameFileStore>(prefs);
  int const result = PlatformSignIn(name);
  if (result != kSignInOK) {
    return static_cast<SignInResult>(result);
  }
  state_->nameFileStore->Load();
  LoadNamesCatalog();
  PlatformLoadSetup();
  UpdateConnections();
  if (state_->listener != nullptr) {
    state_->listener->SetupChanged();
  }
  return kSignInOK;
}

void Setup::LoadNamesCatalog() {
  Impl::NamesHooks const* const hooks = Impl::GetNamesHooks();
  if (state_->prefs != nullptr && hooks != nullptr) {
    hooks->LoadCatalog(*state_->prefs);
    state_->isCatalogLoaded = true;
  }
}

// Only what was loaded: the host's handler outlives the session, but maybe no second sign-out.
void Setup::SaveNamesCatalog() {
  if (std::exchange(state_->isCatalogLoaded, false)) {
    Impl::GetNamesHooks()->SaveCatalog(*state_->prefs);
  }
}

namespace {

// An object that another one took along is deactivated a second time, harmlessly.
template <class List>
void DeactivateAll(List& list) {
  List const leaving = std::exchange(list, List());
  for (auto const& object : leaving) {
    object->Deactivate(false);
  }
}

}  // namespace

void Setup::SignOut(bool save) {
  TrySavingEditedBanks();
  if (std::unique_ptr<Impl::NameFileStore> const store = std::move(state_->nameFileStore)) {
    store->DeleteWaiting();
    store->Save();
  }
  SaveNamesCatalog();
  if (save) {
    SaveDevices();
  }
  Impl::Studio& studio = state_->studio;
  DeactivateAll(studio.devices);
  DeactivateAll(studio.entities);
  DeactivateAll(studio.privateSources);
  DeactivateAll(studio.privateDestinations);
  DeactivateAll(studio.sources);
  DeactivateAll(studio.destinations);
  PlatformSignOut();
  state_->receiver = nullptr;
}

UString const& Setup::SignInName() const { return state_->signInName; }
Receiver* Setup::GetReceiver() const { return state_->receiver; }
PrefsHandler* Setup::GetPrefsHandler() const { return state_->prefs; }
SetupListener* Setup::GetListener() const { return state_->listener; }
void Setup::SetListener(SetupListener* listener) { state_->listener = listener; }
Properties const& Setup::GetProperties() const { return state_->properties; }

Impl::Studio& Setup::GetStudio() { return state_->studio; }
Impl::Studio const& Setup::GetStudio() const { return state_->studio; }
Impl::NameFileStore* Setup::GetNameFileStore() const { return state_->nameFileStore.get(); }

int Setup::CountDevices() const { return static_cast<int>(GetStudio().devices.size()); }
Device Setup::GetDevice(int index) const { return HandleAt<Device>(GetStudio().devices, index); }

int Setup::CountEntities() const { return static_cast<int>(GetStudio().entities.size()); }
Entity Setup::GetEntity(int index) const { return HandleAt<Entity>(GetStudio().entities, index); }

int Setup::CountSources() const { return static_cast<int>(GetStudio().sources.size()); }
Source Setup::GetSource(int index) const { return HandleAt<Source>(GetStudio().sources, index); }

int Setup::CountDestinations() const { return static_cast<int>(GetStudio().destinations.size()); }
Destination Setup::GetDestination(int index) const {
  return HandleAt<Destination>(GetStudio().destinations, index);
}

int Setup::CountPrivateSources() const {
  return static_cast<int>(GetStudio().privateSources.size());
}
Source Setup::GetPrivateSource(int index) const {
  return HandleAt<Source>(GetStudio().privateSources, index);
}

int Setup::CountPrivateDestinations() const {
  return static_cast<int>(GetStudio().privateDestinations.size());
}
Destination Setup::GetPrivateDestination(int index) const {
  return HandleAt<Destination>(GetStudio().privateDestinations, index);
}

void Setup::SaveDevices() {}
void Setup::PlatformPollImpl() {}

}  // namespace Ostinet
