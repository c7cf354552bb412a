// SPDX-License-Identifier: MIT
#include "names/NameConfiguration.h"

#include "model/PropertyKeys.h"
#include "ostinet/core/Error.h"

namespace Ostinet::Impl {

namespace {

// Keys of the Dict "nameConfiguration". They are stored in users' setup files.
UString const kMaster("master");
UString const kBanks("banks");
UString const kFile("file");
UString const kPatchListKey("patchNameList");

FileModDate DateOf(FileSpecification const& file) {
  try {
    return File(file).GetModDate();
  } catch (VantorError const&) {
    return FileModDate();  // the document is gone, and may come back
  }
}

template <class Value>
Value const* Find(PropertyDict const& dict, UString const& key) {
  auto const place = dict.entries.find(key);
  return place != dict.entries.end() ? boost::get<Value>(&place->second) : nullptr;
}

FileSpecification FindFile(PropertyDict const& dict, UString const& key) {
  PropertyPath const* const path = Find<PropertyPath>(dict, key);
  return FileSpecification(path != nullptr ? path->path : UString());
}

FileSpecification SavedMaster(ImplImpl const& peer) {
  UString path;
  // Users' files hold it as a text or as a path.
  if (!peer.GetString(Keys::kSavedMasterNameFile, path)) {
    peer.GetFile(Keys::kSavedMasterNameFile, path);
  }
  return FileSpecification(path);
}

bool SupportsGeneralMIDI(ImplImpl const& peer) {
  int value = 0;
  return peer.GetInt(Keys::kSupportsGeneralMIDI, value) && value != 0;
}

}  // namespace

NameConfiguration NameConfiguration::Read(ImplImpl const& peer) {
  NameConfiguration result;
  PropertyDict dict;
  peer.GetDict(Keys::kNameConfiguration, dict);
  FileSpecification const master = FindFile(dict, kMaster);
  if (!master.IsValid()) {
    result.SetDefault(SupportsGeneralMIDI(peer));
    return result;
  }
  result.SetMaster(master);
  result.kind = SavedMaster(peer) == master ? kAutomaticMaster : kChosenMaster;
  if (PropertyDict const* const banks = Find<PropertyDict>(dict, kBanks)) {
    for (auto const& [bankName, value] : banks->entries) {
      PropertyDict const* const entry = boost::get<PropertyDict>(&value);
      FileSpecification const file =
          entry != nullptr ? FindFile(*entry, kFile) : FileSpecification();
      if (file.IsValid()) {
        UString const* const patchList = Find<UString>(*entry, kPatchListKey);
        result.SetOverride(bankName, file, patchList != nullptr ? *patchList : UString());
      }
    }
  }
  return result;
}

void NameConfiguration::Store(ImplImpl& peer) const {
  PropertyDict dict;
  peer.GetDict(Keys::kNameConfiguration, dict);
  dict.entries.erase(kMaster);
  dict.entries.erase(kBanks);
  if (masterFile.IsValid()) {
    dict.entries[kMaster] = PropertyPath{masterFile.GetFullPath()};
  }
  if (!overrides.empty()) {
    PropertyDict banks;
    for (auto const& [bankName, entry] : overrides) {
      PropertyDict bank;
      bank.entries[kFile] = PropertyPath{entry.file.GetFullPath()};
      bank.entries[kPatchListKey] = entry.patchList;
      banks.entries[bankName] = bank;
    }
    dict.entries[kBanks] = banks;
  }
  peer.SetDict(Keys::kNameConfiguration, dict);
  peer.SetString(Keys::kSavedMasterNameFile,
                 kind == kAutomaticMaster ? masterFile.GetFullPath() : UString());
}

UString NameConfiguration::StandardModeName() const {
  return kind == kDefaultNames ? "Default Names" : kind == kGeneralMIDI ? "General MIDI" : "";
}

void NameConfiguration::SetMaster(FileSpecification const& file) {
  kind = kAutomaticMaster;
  masterFile = file;
  masterDate = DateOf(file);
  overrides.clear();
}

void NameConfiguration::SetDefault(bool supportsGeneralMIDI) {
  *this = NameConfiguration();
  kind = supportsGeneralMIDI ? kGeneralMIDI : kDefaultNames;
}

void NameConfiguration::SetOverride(UString const& bankName, FileSpecification const& file,
                                    UString const& patchList) {
  overrides[bankName] = Override{file, DateOf(file), patchList};
}

std::vector<FileSpecification> NameConfiguration::GetFiles() const {
  std::vector<FileSpecification> files;
  if (masterFile.IsValid()) {
    files.push_back(masterFile);
  }
  for (auto const& [bankName, entry] : overrides) {
    files.push_back(entry.file);
  }
  return files;
}

}  // namespace Ostinet::Impl
