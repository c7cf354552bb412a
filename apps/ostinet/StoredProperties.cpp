// SPDX-License-Identifier: MIT
//
// The export writes files, so all objects go into one document, in the order of the walk, and are
// read back in that order.

#include "StoredProperties.h"

#include <filesystem>
#include <random>
#include <vector>

#include "ostinet/Setup.h"
#include "ostinet/core/XML.h"

namespace Ostinet::Tool {
namespace {

using XMLLib::Name;
using XMLLib::Parser;
using XMLLib::Writer;

// A file that goes with this object.
class TemporaryFile {
 public:
  TemporaryFile() {
    std::string const name = "ostinet-diag-" + std::to_string(std::random_device()()) + ".xml";
    path_ = std::filesystem::temp_directory_path() / name;
  }
  ~TemporaryFile() {
    std::error_code ignored;
    std::filesystem::remove(path_, ignored);
  }
  TemporaryFile(TemporaryFile const&) = delete;
  TemporaryFile& operator=(TemporaryFile const&) = delete;

  File Get() const { return File(FileSpecification(UString(path_.u16string()))); }

 private:
  std::filesystem::path path_;
};

// Writes the studio and notes whose turn it was.
class Exporter {
 public:
  explicit Exporter(File const& file) : writer_(file) { writer_.StartElement("Studio"); }

  void AddStudio(Setup const& setup) {
    for (int i = 0; i < setup.CountDevices(); ++i) {
      AddDevice(setup.GetDevice(i));
    }
    AddLoose(setup.CountSources(), [&](int i) { return setup.GetSource(i); });
    AddLoose(setup.CountPrivateSources(), [&](int i) { return setup.GetPrivateSource(i); });
    AddLoose(setup.CountDestinations(), [&](int i) { return setup.GetDestination(i); });
    AddLoose(setup.CountPrivateDestinations(),
             [&](int i) { return setup.GetPrivateDestination(i); });
  }

  std::vector<unsigned long long> Close() {
    writer_.Close();
    return std::move(keys_);
  }

 private:
  void AddDevice(Device const& device) {
    keys_.push_back(device.GetKey());
    for (int i = 0; i < device.CountEntities(); ++i) {
      Entity const entity = device.GetEntity(i);
      keys_.push_back(entity.GetKey());
      for (int k = 0; k < entity.CountSources(); ++k) {
        keys_.push_back(entity.GetSource(k).GetKey());
      }
      for (int k = 0; k < entity.CountDestinations(); ++k) {
        keys_.push_back(entity.GetDestination(k).GetKey());
      }
    }
    Export(device);
  }

  template <class Get>
  void AddLoose(int count, Get const& get) {
    for (int i = 0; i < count; ++i) {
      auto const endpoint = get(i);
      if (endpoint.GetEntity().GetImplPtr() == nullptr) {
        keys_.push_back(endpoint.GetKey());
        Export(endpoint);
      }
    }
  }

  void Export(DeviceObject const& object) {
    writer_.StartElement("Object");
    object.ExportToXML(writer_);
    writer_.EndElement();
  }

  Writer writer_;
  std::vector<unsigned long long> keys_;
};

Json ReadValue(Parser& parser);

Json ReadKeys(Parser& parser) {
  Json values = Json::object();
  for (; parser.DownToChild(); parser.UpToParent()) {
    UString key;
    parser.ReadAttribute("key", key);
    values[key.string()] = ReadValue(parser);
  }
  return values;
}

Json ReadPath(Parser& parser) {
  UString base;
  if (!parser.DownToChild("Path")) {
    return "";
  }
  parser.ReadAttribute("type", base);
  std::string const path = parser.ReadText().string();
  parser.UpToParent();
  return base == "Absolute" ? path : base.string() + ":" + path;
}

// Stands on the element of one value, as setup files have it.
Json ReadValue(Parser& parser) {
  Name const element = parser.CurrentElement();
  if (element == "Int" || element == "IntItem") {
    return vantor::UStringToNum(parser.ReadText(), vantor::kDecimal);
  }
  if (element == "File") {
    return ReadPath(parser);
  }
  if (element == "Dict") {
    return ReadKeys(parser);
  }
  if (element == "IntList" || element == "StringList") {
    Json items = Json::array();
    for (; parser.DownToChild(); parser.UpToParent()) {
      items.push_back(ReadValue(parser));
    }
    return items;
  }
  return parser.ReadText().string();
}

// Stands on an object; `next` is the key of the one whose turn it is.
void ReadObject(Parser& parser, std::vector<unsigned long long>::const_iterator& next,
                StoredProperties& properties) {
  unsigned long long const key = *next++;
  for (; parser.DownToChild(); parser.UpToParent()) {
    Name const element = parser.CurrentElement();
    if (element == "Properties") {
      properties[key] = ReadKeys(parser);
    } else if (element == "Entity" || element == "Source" || element == "Destination") {
      ReadObject(parser, next, properties);
    }
  }
}

}  // namespace

StoredProperties ReadStoredProperties(Setup const& setup) {
  TemporaryFile const file;
  Exporter exporter(file.Get());
  exporter.AddStudio(setup);
  std::vector<unsigned long long> const keys = exporter.Close();
  StoredProperties properties;
  Parser parser(file.Get());
  auto next = keys.begin();
  for (parser.DownToChild("Studio"); parser.DownToChild("Object"); parser.UpToParent()) {
    ReadObject(parser, next, properties);
  }
  return properties;
}

}  // namespace Ostinet::Tool
