// SPDX-License-Identifier: MIT
#pragma once

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "core/Paths.h"
#include "core/SystemServices.h"
#include "devicetypes/DevTypeFileReader.h"
#include "devicetypes/DeviceTypeCatalogImpl.h"
#include "support/Printers.h"
#include "support/TemporaryFolder.h"

namespace Ostinet::Testing {

/// A whole device type file.
inline std::string TypesFile(std::string const& content, std::string const& author = "") {
  return "<?xml version=\"1.0\"?><MIDIDeviceTypes>" + content +
         (author.empty() ? "" : "<Author>" + author + "</Author>") + "</MIDIDeviceTypes>";
}

/// A type of maker and model, with what stands in it.
inline std::string TypeElement(std::string const& manufacturer, std::string const& model,
                               std::string const& content = "",
                               std::string const& attributes = "") {
  return "<MIDIDeviceType Manufacturer=\"" + manufacturer + "\" Model=\"" + model + "\" " +
         attributes + ">" + content + "</MIDIDeviceType>";
}

/// The folders of device files, of the resources, and whatever else a test writes, all empty.
class TypeFolders : public ::testing::Test {
 protected:
  TypeFolders() {
    SystemServices::SetEnvironment("OSTINET_USER_FOLDER", PathOf("user"));
    SystemServices::SetEnvironment("OSTINET_SYSTEM_FOLDER", PathOf("system"));
    SystemServices::SetEnvironment("OSTINET_RESOURCES", PathOf("resources"));
  }
  ~TypeFolders() override {
    for (char const* name : {"OSTINET_USER_FOLDER", "OSTINET_SYSTEM_FOLDER", "OSTINET_RESOURCES"}) {
      SystemServices::SetEnvironment(name, UString());
    }
  }

  UString PathOf(char const* name) const { return Impl::FromPath(folder_.Path() / name); }
  File Write(std::string const& name, std::string const& content) const {
    return folder_.Write(name, content);
  }

  /// The types of a file with this content.
  std::vector<RCPtrMT<Impl::DeviceTypeInfoImpl>> ReadTypes(std::string const& content) const {
    Impl::DevTypeFileReader reader(Write("elsewhere/One.middev", TypesFile(content)));
    reader.Read();
    return reader.Types();
  }
  /// The one type "Acme" "Synth" with this content.
  RCPtrMT<Impl::DeviceTypeInfoImpl> ReadType(std::string const& content,
                                             std::string const& attributes = "") const {
    auto const types = ReadTypes(TypeElement("Acme", "Synth", content, attributes));
    EXPECT_EQ(types.size(), 1U);
    return types.at(0);
  }

  /// "Acme Synth", one for each type of a catalog read now.
  std::vector<std::string> CatalogNames() const {
    Impl::DeviceTypeCatalogImpl const catalog;
    std::vector<std::string> names;
    for (auto const& type : catalog.GetTypes()) {
      names.push_back(type->manufacturer.string() + " " + type->model.string());
    }
    return names;
  }

 private:
  TemporaryFolder const folder_;
};

}  // namespace Ostinet::Testing
