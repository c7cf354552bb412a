// SPDX-License-Identifier: MIT
#pragma once

#include <string>
#include <vector>

#include "ostinet/Setup.h"
#include "ostinet/core/Files.h"

namespace Ostinet {

/// A PrefsHandler that keeps each block as a file of its own in one folder, "block-<id>.bin",
/// beside the setup file that the library writes there. A block is written whole or not at all:
/// a crash or a full disk leaves the old one.
///
/// Ownership    The host's; it outlives the signed-in period that it was given to.
/// Threads      The host's polling thread.
/// Errors       Save and Load throw nothing, since a sign-out must come to its end: LastError
///              tells the first failure. EnsureFolder throws a VantorError.
class FolderPrefs : public PrefsHandler {
 public:
  /// The folder is made when it is first needed.
  explicit FolderPrefs(Folder const& folder);
  virtual ~FolderPrefs() = default;

  /// Makes the folder with those above it where it is missing, and makes sure that files can be
  /// written in it. Throws if not; a host calls it first to tell its user in time.
  void EnsureFolder() const;

  void Save(int id, std::vector<unsigned char> const& bytes) override;
  /// An empty block where none was saved.
  void Load(int id, std::vector<unsigned char>& bytes) override;
  void GetFolder(Folder& out) override;

  /// What the first failed Save or Load said, in UTF-8; empty as long as all went well.
  std::string const& LastError() const { return lastError_; }

  /// Where the settings of a program belong for the present user: `$XDG_CONFIG_HOME`, `%APPDATA%`
  /// or `$HOME/.config`, the first that is set, with a folder of the program's name in it (in
  /// lower case except below `%APPDATA%`). An invalid folder if none is set.
  static Folder UserFolder(std::string const& program);

 private:
  File BlockFile(int id) const;
  void Keep(std::string const& error);

  Folder folder_;
  std::string lastError_;
};

}  // namespace Ostinet
