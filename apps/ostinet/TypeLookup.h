// SPDX-License-Identifier: MIT
#pragma once

#include <string>
#include <vector>

#include "TypesText.h"
#include "ostinet/DeviceTypeCatalog.h"

namespace Ostinet::Tool {

/// The makers of the catalog with the count of their models, by name.
MakerCounts MakersOf(DeviceTypeCatalog const& catalog);

// Each is named as anything that a user names; they throw Failure.
std::string FindMaker(MakerCounts const& makers, std::string const& wanted);
DeviceTypeInfo FindModel(std::vector<DeviceTypeInfo> const& types, std::string const& wanted);
DeviceTypeInfo FindDeviceType(std::string const& maker, std::string const& model);

}  // namespace Ostinet::Tool
