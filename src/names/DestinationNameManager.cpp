// SPDX-License-Identifier: MIT
#include "names/DestinationNameManager.h"

#include <utility>

#include "model/NameFileStore.h"
#include "model/PropertyKeys.h"
#include "names/NameDocumentWriter.h"
#include "names/NameLoading.h"
#include "ostinet/Setup.h"
#include "ostinet/core/Error.h"

namespace Ostinet::Impl {

namespace {

PropertyDict ReadDict(ImplImpl const& peer) {
  PropertyDict dict;
  peer.GetDict(Keys::kNameConfiguration, dict);
  return dict;
}

// Stores the text that the destination has under `key` as the one last seen. True if it is new.
bool Remember(DestinationImpl& destination, UString const& key, UString const& savedKey) {
  UString const present = destination.GetString(key);
  if (present == destination.GetString(savedKey)) {
    return false;
  }
  destination.Peer()->SetString(savedKey, present);
  return true;
}

/// A new document of the library's own. If it cannot be written, nothing is left of it.
template <class Write>
File WriteDocument(DestinationImpl const& destination, Write const& write) {
  constexpr int kNoSuchFolder = -43;
  NameFileStore* const store = destination.GetNameFileStore();
  if (store == nullptr) {
    FailOSErr(kNoSuchFolder);
  }
  File file;
  store->CreateFile(file, destination);
  try {
    write(file, WrittenFor(destination, destination.GetSetup().SignInName()));
  } catch (...) {
    file.Delete();
    throw;
  }
  store->AddUses(file, 0);  // known, for whoever refers to it next
  return file;
}

}  // namespace

DestinationNameManager::DestinationNameManager(DestinationImpl& destination)
    : DestinationTree(destination) {}

DestinationNameManager* DestinationNameManager::Of(Destination const& destination) {
  return static_cast<DestinationNameManager*>(DestinationTree::Of(destination));
}

bool DestinationNameManager::IsInStudio() const { return GetDestination().Exists(); }

bool DestinationNameManager::Renew() {
  // A port on which other things hang has no names: these have.
  if (!IsInStudio() || GetDestination().IsInterface().get_value_or(false)) {
    return false;
  }
  ImplImpl& peer = *GetDestination().Peer();
  NameConfiguration next = NameConfiguration::Read(peer);
  bool isModified = false;
  if (RememberDevice() && next.kind != NameConfiguration::kChosenMaster) {
    if (!FindMasterFor(next)) {
      next.SetDefault(GetDestination().GetInt(Keys::kSupportsGeneralMIDI, 0) != 0);
    }
    isModified = true;
  }
  if (next == configuration_) {
    return IsTreeLoaded() && ApplySelection(ReadDict(peer), Tree());
  }
  if (!isModified && !next.HasMaster()) {
    isModified = FindMasterFor(next);
  }
  if (next.masterFile != configuration_.masterFile ||
      next.StandardModeName() != configuration_.StandardModeName()) {
    EditedBanks().clear();  // of another document
  }
  Use(next);
  if (isModified) {
    configuration_.Store(peer);
  }
  DropTree(true);
  return true;
}

bool DestinationNameManager::RememberDevice() {
  DestinationImpl& destination = GetDestination();
  bool const isNewMaker = Remember(destination, Keys::kManufacturer, Keys::kSavedManufacturer);
  bool const isNewModel = Remember(destination, Keys::kModel, Keys::kSavedModel);
  return isNewMaker || isNewModel;
}

bool DestinationNameManager::FindMasterFor(NameConfiguration& configuration) const {
  UString const manufacturer = GetDestination().GetString(Keys::kManufacturer);
  UString const model = GetDestination().GetString(Keys::kModel);
  if (manufacturer.empty() || model.empty()) {
    return false;
  }
  Names const master = FindMasterNames(manufacturer, model);
  if (master.Exists()) {
    configuration.SetMaster(master.GetFile());
  }
  return master.Exists();
}

void DestinationNameManager::LoadTree(NameTree& fresh) {
  if (IsInStudio()) {
    fresh = LoadNames(GetDestination(), configuration_);
    ApplySelection(ReadDict(*GetDestination().Peer()), fresh);
  }
}

// Null while signed out. A destination that was made before the sign-in catches up on its uses.
NameFileStore* DestinationNameManager::Store() {
  NameFileStore* const store = GetDestination().GetNameFileStore();
  if (store != nullptr && !std::exchange(ownsUses_, true)) {
    for (FileSpecification const& file : configuration_.GetFiles()) {
      store->Retain(file);
    }
  }
  return store;
}

// The new files are claimed first: one that both refer to must not go in between.
void DestinationNameManager::Use(NameConfiguration const& next) {
  if (NameFileStore* const store = Store()) {
    for (FileSpecification const& file : next.GetFiles()) {
      store->Retain(file);
    }
    for (FileSpecification const& file : configuration_.GetFiles()) {
      store->Release(file, false);
    }
  }
  configuration_ = next;
}

void DestinationNameManager::UseOverride(UString const& bankName, FileSpecification const& file,
                                         UString const& patchList) {
  if (NameFileStore* const store = Store()) {
    store->Retain(file);
  }
  DropOverride(bankName);
  configuration_.SetOverride(bankName, file, patchList);
}

void DestinationNameManager::DropOverride(UString const& bankName) {
  auto const entry = configuration_.overrides.find(bankName);
  if (entry == configuration_.overrides.end()) {
    return;
  }
  if (NameFileStore* const store = Store()) {
    store->Release(entry->second.file, true);
  }
  configuration_.overrides.erase(entry);
}

void DestinationNameManager::WillRemove() {
  EditedBanks().clear();
  Use(NameConfiguration());
  DropTree(false);
}

// Overrides need a master document to stand beside.
void DestinationNameManager::UseMasterOfStandardMode() {
  UString const modeName = configuration_.StandardModeName();
  if (!modeName.empty()) {
    UseNewMaster(modeName);
  }
}

void DestinationNameManager::UseNewMaster(UString const& modeName) {
  File const file = WriteDocument(GetDestination(), [&](File const& to, WrittenFor const& owner) {
    WriteStandardModeMaster(to, owner, modeName);
  });
  NameConfiguration next;
  next.SetMaster(file);
  Use(next);
}

void DestinationNameManager::SaveEditedBanks() {
  if (EditedBanks().empty()) {
    return;
  }
  NameConfiguration const before = configuration_;
  try {
    UseMasterOfStandardMode();
    WriteEditedBanks();
  } catch (...) {
    Use(before);
    throw;
  }
  configuration_.Store(*GetDestination().Peer());
  EditedBanks().clear();
}

void DestinationNameManager::WriteEditedBanks() {
  std::vector<PatchBankImpl const*> banks;
  for (RCPtrMT<PatchBankImpl> const& bank : EditedBanks()) {
    banks.push_back(bank.get());
  }
  std::vector<WrittenBank> written;
  File const file = WriteDocument(GetDestination(), [&](File const& to, WrittenFor const& owner) {
    written = WriteBanks(to, owner, banks);
  });
  for (WrittenBank const& bank : written) {
    UseOverride(bank.bankName, file, bank.listName);
  }
}

void DestinationNameManager::TellNamesChanged() {
  constexpr unsigned short kAllChannels = 0xFFFF;
  if (SetupListener* const listener = GetDestination().GetSetup().GetListener()) {
    listener->DestinationNamesChanged(RCPtrMT<DestinationImpl>(&GetDestination()), kAllChannels);
  }
}

Names DestinationNameManager::GetNames() const {
  NameTree const& tree = GetTree();
  if (tree.modes.size() == 1 && tree.modes.front()->IsStandard()) {
    return FindStandardModeNames(tree.modes.front()->GetName());
  }
  if (configuration_.HasMaster()) {
    return Names(Names::kMasterNames, configuration_.masterFile);
  }
  UString const modeName = configuration_.StandardModeName();
  return modeName.empty() ? Names() : FindStandardModeNames(modeName);
}

void DestinationNameManager::SetNames(Names const& names) {
  if (!IsInStudio()) {
    return;
  }
  if (names.GetType() == Names::kMasterNames) {
    NameConfiguration next;
    next.SetMaster(names.GetFile());
    Use(next);
  } else {
    UseNewMaster(names.GetName());
  }
  configuration_.Store(*GetDestination().Peer());
  EditedBanks().clear();  // the host asked for other names: what is not saved goes
  DropTree(true);
  TellNamesChanged();
}

Names DestinationNameManager::GetOverrideNames(PatchBankImpl const& bank) const {
  auto const entry = configuration_.overrides.find(bank.GetBankName());
  if (entry == configuration_.overrides.end()) {
    return Names();
  }
  return Names(bank.IsTemporary() ? Names::kEditedOverrideNames : Names::kOverrideNames,
               entry->second.file, entry->second.patchList);
}

void DestinationNameManager::SetOverrideNames(PatchBankImpl& bank, Names const& names) {
  if (!IsInStudio()) {
    return;
  }
  RCPtrMT<PatchBankImpl> const keptAlive(&bank);
  EditedBanks().erase(keptAlive);
  SaveEditedBanks();
  if (names.Exists()) {
    UseMasterOfStandardMode();
    UseOverride(bank.GetBankName(), names.GetFile(), names.GetName());
    DropTree(true);
  } else {
    DropOverride(bank.GetBankName());
    bank.ClearPatches();
  }
  configuration_.Store(*GetDestination().Peer());
  TellNamesChanged();
}

}  // namespace Ostinet::Impl
