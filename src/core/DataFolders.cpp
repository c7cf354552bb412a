// SPDX-License-Identifier: MIT
#include <algorithm>
#include <filesystem>

#include "core/Paths.h"
#include "core/SystemServices.h"
#include "ostinet/core/Error.h"
#include "ostinet/core/Files.h"

// Where data lies, the first that applies:
//   1. what an environment variable says
//   2. in the source tree, if the library runs from the tree that it was built in
//   3. the system's place for it: a folder of this user or of the machine, or one that stands in
//      a fixed relation to the library
//   4. where the build was told to install

namespace Ostinet {

namespace fs = std::filesystem;

namespace {

constexpr char kSystemFolderVariable[] = "OSTINET_SYSTEM_FOLDER";
constexpr char kUserFolderVariable[] = "OSTINET_USER_FOLDER";
constexpr char kResourcesVariable[] = "OSTINET_RESOURCES";

// How many folders above the library's own may hold "share": lib/, or lib/<machine>/.
constexpr int kLevelsUp = 3;

bool Exists(fs::path const& path) {
  std::error_code error;
  return fs::is_directory(path, error);
}

// True if `path` is `folder` or below it. The names of drives are not compared: a program for
// another system may run from a tree that was built here.
bool IsWithin(fs::path const& path, fs::path const& folder) {
  fs::path const inner = path.relative_path();
  fs::path const outer = folder.relative_path();
  return std::mismatch(outer.begin(), outer.end(), inner.begin(), inner.end()).first == outer.end();
}

fs::path InSourceTree(char const* folder) {
  bool const runsFromBuildTree = IsWithin(SystemServices::LibraryFolder(), OSTINET_BUILD_FOLDER);
  return runsFromBuildTree ? fs::path(OSTINET_SOURCE_DATA) / folder : fs::path();
}

// The folder that stands in a given relation to the library, or to a folder somewhat above it.
fs::path BesideLibrary(fs::path const& relative) {
  fs::path above = SystemServices::LibraryFolder();
  for (int level = 0; level <= kLevelsUp && !above.empty(); ++level) {
    fs::path const candidate = relative.empty() ? above : above / relative;
    if (Exists(candidate)) {
      return candidate;
    }
    above = above.parent_path();
  }
  return {};
}

fs::path SystemFolder() {
  if (auto const folder = SystemServices::Environment(kSystemFolderVariable)) {
    return Impl::ToPath(*folder);
  }
  if (fs::path const folder = InSourceTree("midi-devices"); !folder.empty()) {
    return folder;
  }
  fs::path const subfolder = SystemServices::DeviceFilesSubfolder();
  if (fs::path const folder = SystemServices::MachineDataFolder(); !folder.empty()) {
    return folder / subfolder;
  }
  fs::path const folder = BesideLibrary(fs::path("share") / subfolder);
  return folder.empty() ? fs::path(OSTINET_INSTALLED_DATA) / "midi-devices" : folder;
}

fs::path UserFolder() {
  if (auto const folder = SystemServices::Environment(kUserFolderVariable)) {
    return Impl::ToPath(*folder);
  }
  fs::path const folder = SystemServices::UserDataFolder();
  return folder.empty() ? folder : folder / SystemServices::DeviceFilesSubfolder();
}

fs::path ResourcesFolder() {
  if (auto const folder = SystemServices::Environment(kResourcesVariable)) {
    return Impl::ToPath(*folder);
  }
  if (fs::path const folder = InSourceTree("resources"); !folder.empty()) {
    return folder;
  }
  fs::path const folder = BesideLibrary(SystemServices::ResourcesSubfolder());
  return folder.empty() ? fs::path(OSTINET_INSTALLED_DATA) / "resources" : folder;
}

}  // namespace

Folder Folder::Find(FindType type, CreateMode mode) {
  fs::path path;
  if (type == kSystemDeviceFiles) {
    path = SystemFolder();
  } else if (type == kUserDeviceFiles) {
    path = UserFolder();
  }
  if (!path.empty() && mode == kCreate) {
    std::error_code error;
    fs::create_directories(path, error);
    FailOSErr(error.value());
  }
  return Exists(path) ? Folder(Impl::SpecificationOf(path)) : Folder();
}

ResourceAccess& ResourceAccess::Instance() {
  static ResourceAccess instance;
  return instance;
}

File ResourceAccess::GetFile(UString const& name, UString const& type) const {
  return Folder(Impl::SpecificationOf(ResourcesFolder())).GetFile(name + "." + type);
}

}  // namespace Ostinet
