// SPDX-License-Identifier: MIT
#include "names/NamesSearches.h"

#include <algorithm>

namespace Ostinet::Impl {

bool FindMasterFunc::operator()(NameDocumentDigest const& digest) {
  bool const matches = std::any_of(
      digest.masters.begin(), digest.masters.end(),
      [this](NameDocumentDigest::Master const& m) { return m.Matches(manufacturer_, model_); });
  if (!matches || !digest.file.IsFile()) {
    return false;
  }
  bool const isByManufacturer = digest.author == manufacturer_;
  if (isByManufacturer || !result_.Exists()) {
    result_ = Names(Names::kMasterNames, digest.file);
  }
  return isByManufacturer;
}

bool FindMastersFunc::operator()(NameDocumentDigest const& digest) {
  for (NameDocumentDigest::Master const& master : digest.masters) {
    if (master.Matches(manufacturer_, model_) && digest.file.IsFile()) {
      out_.emplace_back(Names::kMasterNames, digest.file);
    }
  }
  return false;
}

bool FindOverridesFunc::operator()(NameDocumentDigest const& digest) {
  auto const extender = std::find_if(
      digest.extenders.begin(), digest.extenders.end(),
      [this](NameDocumentDigest::Extender const& e) { return e.Matches(manufacturer_, model_); });
  if (extender != digest.extenders.end() && digest.file.IsFile()) {
    for (UString const& list : extender->patchLists) {
      out_.emplace_back(Names::kOverrideNames, digest.file, list);
    }
  }
  return false;
}

bool FindStdFunc::operator()(NameDocumentDigest const& digest) {
  auto const& modes = digest.standardModes;
  if (std::find(modes.begin(), modes.end(), name_) == modes.end() || !digest.file.IsFile()) {
    return false;
  }
  result_ = Names(Names::kStandardModeNames, digest.file, name_);
  return true;
}

bool FindStdsFunc::operator()(NameDocumentDigest const& digest) {
  if (!digest.standardModes.empty() && digest.file.IsFile()) {
    for (UString const& name : digest.standardModes) {
      if (seen_.insert(name).second) {
        out_.emplace_back(Names::kStandardModeNames, digest.file, name);
      }
    }
  }
  return false;
}

namespace {

template <class Look>
Names SearchFor(Look look) {
  NamesCatalogImpl::Instance().Search(look, NamesCatalogImpl::Faults::kSkip);
  return look.GetResult();
}

}  // namespace

Names FindMasterNames(UString const& manufacturer, UString const& model) {
  return SearchFor(FindMasterFunc(manufacturer, model));
}

Names FindStandardModeNames(UString const& name) { return SearchFor(FindStdFunc(name)); }

}  // namespace Ostinet::Impl
