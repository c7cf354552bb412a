// SPDX-License-Identifier: MIT
#include "names/NameLoading.h"

#include <algorithm>
#include <utility>

#include "model/DestinationImpl.h"
#include "names/NameDocumentReader.h"
#include "names/NamesSearches.h"
#include "names/SelectionKeys.h"

namespace Ostinet::Impl {

namespace {

/// One load of a destination's names, out of several documents.
class Load {
 public:
  explicit Load(DestinationImpl& destination) : owner_(destination) {}

  void AddMaster(FileSpecification const& file) {
    NameDocumentReader reader(owner_);
    reader.LoadMaster(file);
    std::vector<UString> const modes = reader.standardModeNames;
    Take(std::move(reader));
    for (UString const& mode : modes) {
      AddStandardMode(mode);
    }
  }

  void AddStandardMode(UString const& name) {
    Names const document = FindStandardModeNames(name);
    if (document.Exists()) {
      NameDocumentReader reader(owner_);
      reader.LoadStandardMode(document.GetFile(), name);
      Take(std::move(reader));
    }
  }

  // Each document is read once for all banks that it overrides.
  void AddOverrides(NameConfiguration const& configuration) {
    using Request = std::pair<FileSpecification, std::vector<NameDocumentReader::BankRequest>>;
    std::vector<Request> requests;
    for (RCPtrMT<DestNameSetImpl> const& nameSet : tree_.nameSets) {
      for (RCPtrMT<PatchBankImpl> const& bank : nameSet->GetBanks()) {
        auto const entry = configuration.overrides.find(bank->GetBankName());
        if (entry == configuration.overrides.end()) {
          continue;
        }
        NameConfiguration::Override const& wanted = entry->second;
        auto place = std::find_if(requests.begin(), requests.end(), [&](Request const& request) {
          return request.first == wanted.file;
        });
        if (place == requests.end()) {
          requests.emplace_back(wanted.file, std::vector<NameDocumentReader::BankRequest>());
          place = std::prev(requests.end());
        }
        place->second.emplace_back(bank, wanted.patchList);
      }
    }
    for (auto const& [file, banks] : requests) {
      NameDocumentReader reader(owner_);
      reader.LoadExtending(file, banks);
      uses_.Merge(reader.uses);
    }
  }

  NameTree Finish() {
    AssignLists(tree_, uses_);
    return std::move(tree_);
  }

 private:
  void Take(NameDocumentReader&& reader) {
    tree_.Append(std::move(reader.tree));
    uses_.Merge(reader.uses);
  }

  NameDocumentOwner const owner_;
  NameTree tree_;
  NameListUses uses_;
};

template <class Value>
Value const* Find(PropertyDict const& dict, UString const& key) {
  auto const place = dict.entries.find(key);
  return place != dict.entries.end() ? boost::get<Value>(&place->second) : nullptr;
}

// Null if there is none of that name; case and white space do not tell names apart.
template <class T>
RCPtrMT<T> FindNamed(std::vector<RCPtrMT<T>> const& list, UString const& name) {
  auto const place = std::find_if(list.begin(), list.end(), [&](RCPtrMT<T> const& object) {
    return object->GetName().equal(name, UString::kCatalogKey);
  });
  return place != list.end() ? *place : RCPtrMT<T>();
}

template <class T>
bool Set(RCPtrMT<T>& slot, RCPtrMT<T> const& value) {
  bool const changes = slot != value;
  slot = value;
  return changes;
}

template <class T>
bool SetIfFound(RCPtrMT<T>& slot, RCPtrMT<T> const& found) {
  return found.get() != nullptr && Set(slot, found);
}

bool ApplyMode(PropertyDict const& dict, NameTree& tree) {
  if (UString const* const name = Find<UString>(dict, SelectionKeys::kCurrentMode)) {
    return SetIfFound(tree.currentMode, FindNamed(tree.modes, *name));
  }
  return !tree.modes.empty() && Set(tree.currentMode, tree.modes.front());
}

bool ApplyNameSets(PropertyDict const& dict, NameTree& tree) {
  using Names = std::vector<UString>;
  bool changed = false;
  if (Names const* const names = Find<Names>(dict, SelectionKeys::kCurrentNameSets)) {
    std::size_t const count = std::min(names->size(), tree.currentNameSets.size());
    for (std::size_t channel = 0; channel < count; ++channel) {
      changed |=
          SetIfFound(tree.currentNameSets[channel], FindNamed(tree.nameSets, (*names)[channel]));
    }
  } else if (!tree.modes.empty()) {
    // Those of the first mode, even where another one is current: what a host sees after a mode
    // was stored without name sets has always been this.
    for (std::size_t channel = 0; channel < tree.currentNameSets.size(); ++channel) {
      changed |= Set(tree.currentNameSets[channel], tree.modes.front()->GetNameSets()[channel]);
    }
  }
  return changed;
}

}  // namespace

NameTree LoadNames(DestinationImpl& destination, NameConfiguration const& configuration) {
  Load load(destination);
  if (configuration.HasMaster()) {
    load.AddMaster(configuration.masterFile);
    load.AddOverrides(configuration);
  } else if (configuration.kind != NameConfiguration::kNoConfiguration) {
    load.AddStandardMode(configuration.StandardModeName());
  }
  return load.Finish();
}

bool ApplySelection(PropertyDict const& dict, NameTree& tree) {
  bool const modeChanged = ApplyMode(dict, tree);
  bool const nameSetsChanged = ApplyNameSets(dict, tree);
  return modeChanged || nameSetsChanged;
}

}  // namespace Ostinet::Impl
