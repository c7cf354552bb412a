// SPDX-License-Identifier: MIT
#include "model/StandaloneDevices.h"

#include <utility>

#include "model/XMLNames.h"
#include "ostinet/core/Error.h"
#include "ostinet/core/SortedVector.h"

namespace Ostinet::Impl {

namespace {

using Table = sorted_vector_set<std::pair<UString, UString>>;

void ReadDevices(XMLLib::Parser& parser, Table& table) {
  XMLLib::Name const manufacturerName("Mfr");
  XMLLib::Name const modelName("Model");
  for (; parser.DownToChildNounexp(XMLNames::kDevice); parser.UpToParent()) {
    UString manufacturer;
    UString model;
    if (parser.ReadReqAttribute(manufacturerName, manufacturer) &&
        parser.ReadReqAttribute(modelName, model)) {
      table.insert(std::make_pair(manufacturer, model));
    }
  }
}

// A missing or broken list costs nothing but the devices that were not read.
Table ReadTable() {
  Table table;
  try {
    XMLLib::Parser parser(ResourceAccess::Instance().GetFile("StandaloneDevices", "xml"));
    if (parser.DownToReqChildNounexp("StandaloneDevices")) {
      ReadDevices(parser, table);
    }
  } catch (VantorError const&) {
  }
  return table;
}

}  // namespace

bool IsStandaloneDevice(UString const& manufacturer, UString const& model) {
  static Table const table = ReadTable();
  return table.count(std::make_pair(manufacturer, model)) != 0;
}

}  // namespace Ostinet::Impl
