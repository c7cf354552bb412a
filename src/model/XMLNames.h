// SPDX-License-Identifier: MIT
#pragma once

#include "ostinet/core/XML.h"

namespace Ostinet::Impl {

// The elements and attributes of studio objects in setup files, for their writers and readers.
namespace XMLNames {
inline XMLLib::Name const kDevice("Device");
inline XMLLib::Name const kEntity("Entity");
inline XMLLib::Name const kSource("Source");
inline XMLLib::Name const kDestination("Destination");
inline XMLLib::Name const kProperties("Properties");
inline XMLLib::Name const kConnection("Connection");

inline XMLLib::Name const kDirect("direct");
inline XMLLib::Name const kSoftware("software");
inline XMLLib::Name const kFake("fake");
inline XMLLib::Name const kName("name");
inline XMLLib::Name const kManufacturer("manufacturer");
inline XMLLib::Name const kModel("model");
}  // namespace XMLNames

}  // namespace Ostinet::Impl
