// SPDX-License-Identifier: MIT
#include <set>
#include <utility>

#include "names/NamesSearches.h"
#include "ostinet/NameDocument.h"

namespace Ostinet {

using Impl::NameDocumentDigest;
using Impl::NamesCatalogImpl;

namespace {

/// Looks at every document, whatever it is for.
class CollectOffersFunc : public NamesCatalogImpl::Func {
 public:
  explicit CollectOffersFunc(std::vector<NameDocumentOffer>& offers) : offers_(offers) {}

  bool operator()(NameDocumentDigest const& digest) override {
    if (digest.file.IsFile()) {
      AddMasters(digest);
      AddOverrides(digest);
      AddStandardModes(digest);
    }
    return false;
  }

 private:
  using Devices = std::set<std::pair<UString, UString>>;

  void AddMasters(NameDocumentDigest const& digest) {
    Devices seen;
    for (NameDocumentDigest::Master const& master : digest.masters) {
      for (UString const& model : master.models) {
        if (seen.emplace(master.manufacturer, model).second) {
          offers_.push_back({Names(Names::kMasterNames, digest.file), master.manufacturer, model});
        }
      }
    }
  }

  // Of several entries for one device the first counts, as in a search for that device.
  void AddOverrides(NameDocumentDigest const& digest) {
    Devices seen;
    for (NameDocumentDigest::Extender const& extender : digest.extenders) {
      for (UString const& model : extender.models) {
        if (!seen.emplace(extender.manufacturer, model).second) {
          continue;
        }
        for (UString const& list : extender.patchLists) {
          offers_.push_back(
              {Names(Names::kOverrideNames, digest.file, list), extender.manufacturer, model});
        }
      }
    }
  }

  void AddStandardModes(NameDocumentDigest const& digest) {
    for (UString const& mode : digest.standardModes) {
      if (modes_.insert(mode).second) {
        offers_.push_back(
            {Names(Names::kStandardModeNames, digest.file, mode), UString(), UString()});
      }
    }
  }

  std::vector<NameDocumentOffer>& offers_;
  std::set<UString> modes_;
};

}  // namespace

std::vector<NameDocumentOffer> ListNameDocuments(std::vector<FileSpecification>& unreadable) {
  NamesCatalogImpl& catalog = NamesCatalogImpl::Instance();
  std::vector<NameDocumentOffer> offers;
  CollectOffersFunc look(offers);
  catalog.Search(look, NamesCatalogImpl::Faults::kSkip);
  for (NameDocumentDigest const& digest : catalog.GetDocuments()) {
    if (!digest.isParsed) {
      unreadable.push_back(digest.file);
    }
  }
  return offers;
}

}  // namespace Ostinet
