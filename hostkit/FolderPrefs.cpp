// SPDX-License-Identifier: MIT
#include "ostinet/hostkit/FolderPrefs.h"

#include <algorithm>
#include <exception>

#include "ostinet/core/Environment.h"

namespace Ostinet {
namespace {

struct UserPlace {
  char const* variable;
  char const* below;  // what comes between the variable's folder and the program's
  bool lowerCase;
};

// In this order: what a user sets on purpose comes first.
constexpr UserPlace kUserPlaces[] = {
    {"XDG_CONFIG_HOME", "", true},
    {"APPDATA", "", false},
    {"HOME", "/.config", true},
};

std::string LowerCase(std::string text) {
  std::transform(text.begin(), text.end(), text.begin(), [](char c) {
    return c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c;
  });
  return text;
}

// Makes the folder with those above it.
void MakeFolder(Folder const& folder) {
  if (!folder.IsFolder()) {
    folder.ParentFolder().DemandSubFolder(folder.GetName());
  }
}

}  // namespace

FolderPrefs::FolderPrefs(Folder const& folder) : folder_(folder) {}

void FolderPrefs::EnsureFolder() const {
  MakeFolder(folder_);
  File const probe = folder_.CreateFileInFolder("write-test", 0, 0, Folder::kAdjustName);
  probe.Delete();
}

void FolderPrefs::Save(int id, std::vector<unsigned char> const& bytes) {
  try {
    MakeFolder(folder_);
    BlockFile(id).Replace(bytes.data(), bytes.size());
  } catch (std::exception const& error) {
    Keep(error.what());
  }
}

void FolderPrefs::Load(int id, std::vector<unsigned char>& bytes) {
  bytes.clear();
  try {
    File const file = BlockFile(id);
    if (file.IsFile()) {
      bytes = file.Read();
    }
  } catch (std::exception const& error) {
    Keep(error.what());
  }
}

void FolderPrefs::GetFolder(Folder& out) { out = folder_; }

File FolderPrefs::BlockFile(int id) const {
  return folder_.GetFile(UString("block-" + std::to_string(id) + ".bin"));
}

void FolderPrefs::Keep(std::string const& error) {
  if (lastError_.empty()) {
    lastError_ = error;
  }
}

Folder FolderPrefs::UserFolder(std::string const& program) {
  for (UserPlace const& place : kUserPlaces) {
    UString const value = EnvironmentText(place.variable);
    if (!value.empty()) {
      Folder const above{FileSpecification(value + place.below)};
      return above.GetSubFolder(UString(place.lowerCase ? LowerCase(program) : program));
    }
  }
  return Folder();
}

}  // namespace Ostinet
