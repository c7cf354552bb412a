// SPDX-License-Identifier: MIT
#pragma once

#include <memory>

namespace Ostinet {
class PrefsHandler;
}

namespace Ostinet::Impl {

class DestinationImpl;
class DestinationNames;

/// What the model asks of the names, which stand above it.
///
/// Threads  The host's polling thread.
class NamesHooks {
 public:
  /// The names side of a destination under construction: it is only remembered, not asked.
  virtual std::unique_ptr<DestinationNames> MakeNames(DestinationImpl& destination) const = 0;
  /// The catalog's part of sign-in and sign-out.
  virtual void LoadCatalog(PrefsHandler& prefs) const = 0;
  virtual void SaveCatalog(PrefsHandler& prefs) const = 0;

 protected:
  ~NamesHooks() = default;
};

/// Gives every destination that is made from now on its names. `hooks` lives as long as the
/// process; without any, destinations have no names.
void InstallNamesHooks(NamesHooks const* hooks);
NamesHooks const* GetNamesHooks();

}  // namespace Ostinet::Impl
