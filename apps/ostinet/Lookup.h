// SPDX-License-Identifier: MIT
#pragma once

#include <string>
#include <vector>

#include "NameMatch.h"
#include "ostinet/DeviceObject.h"
#include "ostinet/Endpoint.h"

namespace Ostinet {
class Setup;
}

namespace Ostinet::Tool {

/// The lists of a studio as they stand.
std::vector<Device> DevicesOf(Setup const& setup);
std::vector<Entity> EntitiesOf(Device const& device);
std::vector<Source> SourcesOf(Setup const& setup);
std::vector<Destination> DestinationsOf(Setup const& setup);

template <class List>
std::vector<Candidate> CandidatesOf(List const& objects) {
  std::vector<Candidate> candidates;
  for (auto const& object : objects) {
    candidates.push_back({object.GetName().string(), object._get_impl_id()});
  }
  return candidates;
}

/// The one that `name` means, as MatchName tells; throws Failure.
template <class Handle>
Handle Find(std::vector<Handle> const& objects, std::string const& name, std::string const& kind) {
  return objects[MatchName(CandidatesOf(objects), name, kind)];
}

/// A null handle where none fits; throws Failure where more than one does.
template <class Handle>
Handle TryFind(std::vector<Handle> const& objects, std::string const& name,
               std::string const& kind) {
  auto const place = FindName(CandidatesOf(objects), name, kind);
  return place ? objects[*place] : Handle();
}

Device FindDevice(Setup const& setup, std::string const& name);

/// A new name for something of a user's; throws UsageError for one without letters.
UString NewName(std::string const& name, std::string const& kind);

}  // namespace Ostinet::Tool
