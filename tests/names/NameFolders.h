// SPDX-License-Identifier: MIT
#pragma once

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <chrono>
#include <filesystem>
#include <string>
#include <vector>

#include "core/Paths.h"
#include "core/SystemServices.h"
#include "core/Time.h"
#include "names/NamesCatalogImpl.h"
#include "ostinet/NamesCatalog.h"
#include "support/Printers.h"
#include "support/Recorders.h"
#include "support/TemporaryFolder.h"

namespace Ostinet {

inline void PrintTo(Names const& names, std::ostream* out) {
  *out << "type " << names.GetType() << " of ";
  PrintTo(names.GetFile(), out);
  *out << ' ';
  PrintTo(names.GetName(), out);
}

}  // namespace Ostinet

namespace Ostinet::Testing {

/// A whole name document.
inline std::string NameDocument(std::string const& content, std::string const& author = "") {
  return "<?xml version=\"1.0\"?><MIDINameDocument><Author>" + author + "</Author>" + content +
         "</MIDINameDocument>";
}

inline std::string DeviceText(std::string const& manufacturer, std::string const& model) {
  return "<Manufacturer>" + manufacturer + "</Manufacturer><Model>" + model + "</Model>";
}

/// The names of one model.
inline std::string Master(std::string const& manufacturer, std::string const& model,
                          std::string const& content = "") {
  return "<MasterDeviceNames>" + DeviceText(manufacturer, model) + content + "</MasterDeviceNames>";
}

/// Patch lists for the banks of one model.
inline std::string Extender(std::string const& manufacturer, std::string const& model,
                            std::string const& content = "") {
  return "<ExtendingDeviceNames>" + DeviceText(manufacturer, model) + content +
         "</ExtendingDeviceNames>";
}

inline std::string StandardMode(std::string const& name, std::string const& content = "") {
  return "<StandardDeviceMode Name=\"" + name + "\">" + content + "</StandardDeviceMode>";
}

/// The two folders of name documents, empty; a clock that only the test moves; and a catalog that
/// knows nothing.
class NameFolders {
 public:
  NameFolders() {
    SystemServices::SetEnvironment("OSTINET_USER_FOLDER", Impl::FromPath(folder.Path() / "user"));
    SystemServices::SetEnvironment("OSTINET_SYSTEM_FOLDER",
                                   Impl::FromPath(folder.Path() / "system"));
    sClock = 0;
    TimerCalibrator::fgInstance.SetCounter([] { return sClock; });
    ForgetCatalog();
  }
  ~NameFolders() {
    TimerCalibrator::fgInstance.SetCounter(nullptr);
    SystemServices::SetEnvironment("OSTINET_USER_FOLDER", UString());
    SystemServices::SetEnvironment("OSTINET_SYSTEM_FOLDER", UString());
  }
  NameFolders(NameFolders const&) = delete;
  NameFolders& operator=(NameFolders const&) = delete;

  static void ForgetCatalog() {
    MemoryPrefs none;
    Impl::NamesCatalogImpl::Instance().LoadState(none);
  }
  static void PassSeconds(double seconds) {
    sClock += static_cast<unsigned long long>(seconds * 1e7);
  }

  /// `path` starts with "user/" or "system/".
  File Write(std::string const& path, std::string const& content) const {
    return folder.Write(path, content);
  }
  std::filesystem::path PathOf(std::string const& path) const { return folder.Path() / path; }
  /// The file becomes so much younger.
  void Touch(std::string const& path, std::chrono::seconds by = std::chrono::hours(1)) const {
    std::filesystem::last_write_time(PathOf(path),
                                     std::filesystem::last_write_time(PathOf(path)) + by);
  }
  void Remove(std::string const& path) const { std::filesystem::remove(PathOf(path)); }

  TemporaryFolder folder;

 private:
  inline static unsigned long long sClock = 0;  // in clocks of 100 ns
};

}  // namespace Ostinet::Testing
