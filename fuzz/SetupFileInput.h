// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

#include "ostinet/Setup.h"

namespace Ostinet::Fuzz {

/// True if all that the lists of the studio hold exists, and both ends of each connection agree.
inline bool IsStudioWhole(Setup const& setup) {
  bool ok = true;
  for (int i = 0; i < setup.CountDestinations(); ++i) {
    Destination const one = setup.GetDestination(i);
    ok = ok && one.Exists() && one.IsDirect() != one.GetEntity().Exists();
    for (int c = 0; c < one.CountConnectedDestinations(); ++c) {
      ok = ok && one.GetConnectedDestination(c).GetDirectDestination() == one;
    }
  }
  for (int i = 0; i < setup.CountSources(); ++i) {
    Source const one = setup.GetSource(i);
    ok = ok && one.Exists() && one.IsDirect() != one.GetEntity().Exists();
    for (int c = 0; c < one.CountConnectedSources(); ++c) {
      ok = ok && one.GetConnectedSource(c).GetDirectSource() == one;
    }
  }
  for (int i = 0; i < setup.CountDevices(); ++i) {
    Device const device = setup.GetDevice(i);
    ok = ok && device.Exists() && !device.IsDirect();
    for (int e = 0; e < device.CountEntities(); ++e) {
      ok = ok && device.GetEntity(e).GetDevice() == device;
    }
  }
  return ok;
}

/// Has a host without ports load a setup file of these bytes and save it, twice. True if the studio
/// is whole each time, and the second save is the same as the first. `setup` is signed out.
inline bool TrySetupFile(Setup& setup, PrefsHandler& prefs, std::uint8_t const* bytes,
                         std::size_t count) {
  Folder folder;
  prefs.GetFolder(folder);
  File const file = folder.GetFile("Ostinet.xml");
  file.Replace(bytes, count);
  std::vector<unsigned char> saved[2];
  bool ok = true;
  for (auto& each : saved) {
    ok = ok && setup.SignIn("Fuzz", nullptr, &prefs) == Setup::kSignInOK;
    ok = ok && IsStudioWhole(setup);
    setup.SignOut(true);
    each = file.Read();
  }
  return ok && saved[0] == saved[1];
}

}  // namespace Ostinet::Fuzz
