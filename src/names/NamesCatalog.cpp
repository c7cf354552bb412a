// SPDX-License-Identifier: MIT
#include "ostinet/NamesCatalog.h"

#include "names/NamesSearches.h"

namespace Ostinet {

namespace {

void Search(Impl::NamesCatalogImpl& catalog, Impl::NamesCatalogImpl::Func& look) {
  catalog.Search(look, Impl::NamesCatalogImpl::Faults::kThrow);
}

}  // namespace

NamesCatalog::NamesCatalog() : impl_(&Impl::NamesCatalogImpl::Instance()) {}

NamesCatalog& NamesCatalog::Instance() {
  static NamesCatalog& instance = *new NamesCatalog;
  return instance;
}

Names NamesCatalog::FindMaster(UString const& manufacturer, UString const& model) {
  Impl::FindMasterFunc look(manufacturer, model);
  Search(*impl_, look);
  return look.GetResult();
}

void NamesCatalog::FindMasters(UString const& manufacturer, UString const& model,
                               std::vector<Names>& out) {
  Impl::FindMastersFunc look(manufacturer, model, out);
  Search(*impl_, look);
}

void NamesCatalog::FindOverrides(UString const& manufacturer, UString const& model,
                                 std::vector<Names>& out) {
  Impl::FindOverridesFunc look(manufacturer, model, out);
  Search(*impl_, look);
}

Names NamesCatalog::FindStandardMode(UString const& name) {
  Impl::FindStdFunc look(name);
  Search(*impl_, look);
  return look.GetResult();
}

void NamesCatalog::FindStandardModes(std::vector<Names>& out) {
  Impl::FindStdsFunc look(out);
  Search(*impl_, look);
}

}  // namespace Ostinet
