// SPDX-License-Identifier: MIT
#pragma once

#include <memory>

#include "model/Handles.h"
#include "model/NameFileStore.h"
#include "model/Studio.h"
#include "ostinet/Setup.h"

namespace Ostinet {

/// What Setup holds.
struct Setup::State {
  UString signInName;
  Receiver* receiver = nullptr;       // the host's; null while signed out
  SetupListener* listener = nullptr;  // the host's
  PrefsHandler* prefs = nullptr;      // the host's
  int changesPollCount = 0;           // rounds since edited banks were last saved
  Impl::Studio studio;
  Properties properties;
  bool isDeferred = false;
  std::unique_ptr<Impl::NameFileStore> nameFileStore;
  bool isCatalogLoaded = false;  // in this signed-in period
};

}  // namespace Ostinet
