// SPDX-License-Identifier: MIT
#include "names/NamesInstallation.h"

#include "model/NamesHooks.h"
#include "names/DestinationNameManager.h"

namespace Ostinet::Impl {

namespace {

class Hooks : public NamesHooks {
 public:
  std::unique_ptr<DestinationNames> MakeNames(DestinationImpl& destination) const override {
    return std::make_unique<DestinationNameManager>(destination);
  }
  void LoadCatalog(PrefsHandler& prefs) const override {
    NamesCatalogImpl::Instance().LoadState(prefs);
  }
  void SaveCatalog(PrefsHandler& prefs) const override {
    NamesCatalogImpl::Instance().SaveState(prefs);
  }
};

}  // namespace

void InstallNames() {
  static Hooks const hooks;
  InstallNamesHooks(&hooks);
}

}  // namespace Ostinet::Impl
