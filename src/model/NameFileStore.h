// SPDX-License-Identifier: MIT
#pragma once

#include <map>
#include <set>
#include <vector>

#include "ostinet/core/Files.h"

namespace Ostinet {
class PrefsHandler;
}

namespace Ostinet::Impl {

class ObjectImpl;

/// Counts who uses each name document that the library itself wrote, and deletes one that nobody
/// needs any more. A document that was in use at sign-out waits at the next sign-in; if nobody
/// claims it there, it is deleted at the sign-out after.
///
/// Ownership    Setup's, from sign-in to sign-out.
/// Threads      The host's polling thread.
/// Errors       A block that cannot be read gives what was read of it; a file that cannot be
///              deleted stays.
class NameFileStore {
 public:
  /// `prefs` is the host's; null means that nothing is kept from one session to the next.
  explicit NameFileStore(PrefsHandler* prefs);

  /// Takes the files of the saved block that still exist into those that wait.
  void Load();
  /// Saves the files in use; nothing before a Load, which would lose what stands in the block.
  void Save() const;
  /// Deletes the files that wait.
  void DeleteWaiting();

  /// Makes a new, empty document in the folder "MIDINameDocuments" of the host's, named after a
  /// destination; a name that is taken gets a number. It counts only once it is used. Throws a
  /// VantorError where the host has no folder, or the disk refuses.
  void CreateFile(File& out, ObjectImpl const& object) const;
  /// `count` more uses of a file, known or not.
  void AddUses(FileSpecification const& file, int count);
  /// One more use of a file that is in use or waits; nothing for any other.
  void Retain(FileSpecification const& file);
  /// One use less. With the last one the file goes: at once if `deleteNow` was true at each
  /// release, else at sign-out.
  void Release(FileSpecification const& file, bool deleteNow);

 private:
  struct Use {
    int count = 0;
    bool mayDeleteNow = true;
  };

  PrefsHandler* const prefs_;
  bool isLoaded_ = false;
  std::map<FileSpecification, Use> inUse_;
  std::set<FileSpecification> waiting_;
};

}  // namespace Ostinet::Impl
