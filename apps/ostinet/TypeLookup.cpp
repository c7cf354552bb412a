// SPDX-License-Identifier: MIT
#include "TypeLookup.h"

#include <algorithm>

#include "NameMatch.h"

namespace Ostinet::Tool {

// In the order of the catalog, which is sorted but for the types at its end that no file describes.
MakerCounts MakersOf(DeviceTypeCatalog const& catalog) {
  sorted_vector_set<UString> names;
  catalog.CollectManufacturers(names);
  MakerCounts makers;
  for (UString const& name : names) {
    std::vector<DeviceTypeInfo> types;
    catalog.CollectModels(name, types);
    makers.emplace_back(name.string(), static_cast<int>(types.size()));
  }
  std::stable_sort(makers.begin(), makers.end(), [](auto const& a, auto const& b) {
    return UString(a.first).less(UString(b.first), UString::kForPeople);
  });
  return makers;
}

std::string FindMaker(MakerCounts const& makers, std::string const& wanted) {
  std::vector<Candidate> candidates;
  for (auto const& maker : makers) {
    candidates.push_back({maker.first, 0});
  }
  return candidates[MatchName(candidates, wanted, "maker")].name;
}

DeviceTypeInfo FindModel(std::vector<DeviceTypeInfo> const& types, std::string const& wanted) {
  std::vector<Candidate> candidates;
  for (DeviceTypeInfo const& type : types) {
    candidates.push_back({type.GetModelName().string(), 0});
  }
  return types[MatchName(candidates, wanted, "model")];
}

DeviceTypeInfo FindDeviceType(std::string const& maker, std::string const& model) {
  DeviceTypeCatalog const& catalog = DeviceTypeCatalog::Instance();
  std::vector<DeviceTypeInfo> types;
  catalog.CollectModels(UString(FindMaker(MakersOf(catalog), maker)), types);
  return FindModel(types, model);
}

}  // namespace Ostinet::Tool
