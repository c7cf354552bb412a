// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

#include "ostinet/Export.h"
#include "ostinet/core/UString.h"

namespace Ostinet {

class Folder;

/// Names a file or folder, which may exist or not, by its full path.
///
/// Ownership    A value.
/// Null handle  Default-constructed: IsValid is false, the texts are empty.
/// Threads      [any thread], one object on one thread at a time.
/// Errors       The questions throw nothing: what cannot be looked at does not exist.
class OSTINET_EXPORT FileSpecification {
 public:
  FileSpecification() = default;
  /// A separator at the end is dropped.
  explicit FileSpecification(UString const& fullPath);

  /// True if there is a path at all.
  bool IsValid() const { return !path_.empty(); }
  /// True for a regular file, or a link to one.
  bool IsFile() const;
  bool IsFolder() const;
  /// The last part of the path.
  UString GetName() const;
  UString GetFullPath() const { return path_; }

  friend bool operator==(FileSpecification const& a, FileSpecification const& b) {
    return a.path_ == b.path_;
  }
  friend bool operator!=(FileSpecification const& a, FileSpecification const& b) {
    return !(a == b);
  }
  friend bool operator<(FileSpecification const& a, FileSpecification const& b) {
    return a.path_ < b.path_;
  }

 private:
  UString path_;
};

/// When a file was last written, in seconds since 1970 in universal time.
class FileModDate {
 public:
  /// The date of no file.
  FileModDate() = default;
  explicit FileModDate(std::uint32_t value) : value_(value) {}
  std::uint32_t AsInt32() const { return value_; }

  friend bool operator==(FileModDate a, FileModDate b) { return a.value_ == b.value_; }
  friend bool operator!=(FileModDate a, FileModDate b) { return a.value_ != b.value_; }
  friend bool operator<(FileModDate a, FileModDate b) { return a.value_ < b.value_; }

 private:
  std::uint32_t value_ = 0;
};

/// Four characters that once told a file's type or creator, or 0 for none. Kept for hosts that
/// pass them; no file system in use stores them.
class FileTypeClass {
 public:
  FileTypeClass(std::uint32_t code = 0) : code_(code) {}
  std::uint32_t Code() const { return code_; }

 private:
  std::uint32_t code_;
};

/// What files and folders have in common.
///
/// Errors       A failure of the system throws a VantorError of the domain "OS".
class OSTINET_EXPORT FileSystemObject : public FileSpecification {
 public:
  Folder ParentFolder() const;
  /// Throws if it does not exist.
  FileModDate GetModDate() const;
  /// Removes a file, or a folder with all that is in it. What does not exist counts as removed.
  void Delete() const;

 protected:
  FileSystemObject() = default;
  explicit FileSystemObject(FileSpecification const& specification);
};

/// A file. Making one does not touch the disk; IsFile tells whether it is there.
class OSTINET_EXPORT File : public FileSystemObject {
 public:
  File() = default;
  explicit File(FileSpecification const& specification);

  /// The whole content.
  std::vector<unsigned char> Read() const;
  /// Replaces the whole content: the new one is written beside the file and renamed over it, so
  /// a failure at any moment leaves the old content or the new one, never a part.
  void Replace(void const* bytes, std::size_t count) const;
};

/// A folder. Making one does not touch the disk; IsFolder tells whether it is there.
class OSTINET_EXPORT Folder : public FileSystemObject {
 public:
  enum FindType : int {
    kSystemDeviceFiles = 11,  ///< device files and name documents for every user of the machine
    kUserDeviceFiles = 12,    ///< the same for this user
  };
  enum CreateMode : int { kDoNotCreate = 0, kCreate = 1 };
  enum AdjustName : int {
    kKeepName = 0,    ///< a taken name is an error
    kAdjustName = 1,  ///< "name.ext" becomes "name 2.ext" where it is taken
  };

  Folder() = default;
  explicit Folder(FileSpecification const& specification);

  /// A well-known folder. An invalid one if it does not exist and is not to be created, and for
  /// a type that is not listed.
  static Folder Find(FindType type, CreateMode mode);

  /// The subfolder of this name, whether it exists or not.
  Folder GetSubFolder(UString const& name) const;
  /// The same, created with the folders above it where missing.
  Folder DemandSubFolder(UString const& name) const;
  /// The file of this name, whether it exists or not.
  File GetFile(UString const& name) const;
  /// The same, created empty where missing, with the folders above it.
  File DemandFileInFolder(UString const& name, FileTypeClass type = 0,
                          FileTypeClass creator = 0) const;
  /// Makes a new, empty file. With kAdjustName, also characters that no file name may hold
  /// (separators, control characters) become "_".
  File CreateFileInFolder(UString const& name, FileTypeClass type, FileTypeClass creator,
                          AdjustName adjust) const;
  /// Looks for a file of this name in the folder, then in those below it, level by level; one
  /// that differs in case only is taken if no other is found. Sets `found` when true.
  bool SearchFolder(UString const& name, FileSpecification& found) const;
};

/// Walks the entries of a folder: its regular files and its folders, in the order of their
/// names' code units. Links to folders, devices and pipes are passed over. The entries are those
/// at construction; a folder that cannot be read has none.
///
/// Ownership    A value.
/// Threads      One object on one thread at a time.
class OSTINET_EXPORT FolderIterator {
 public:
  enum IteratorOptions : int { kFilesAndFolders = 0, kFilesOnly = 1, kFoldersOnly = 2 };

  explicit FolderIterator(Folder const& folder, IteratorOptions options = kFilesAndFolders);

  bool AtEnd() const { return index_ >= entries_.size(); }
  /// The present entry; not to be called at the end.
  FileSpecification const& operator*() const { return entries_[index_].specification; }
  FileSpecification const* operator->() const { return &entries_[index_].specification; }
  bool IsFolder() const { return entries_[index_].isFolder; }
  FolderIterator& operator++() {
    ++index_;
    return *this;
  }

 private:
  struct Entry {
    FileSpecification specification;
    bool isFolder = false;
  };
  std::vector<Entry> entries_;
  std::size_t index_ = 0;
};

/// The data files that are installed with the library.
///
/// Ownership    One object, which lives as long as the process.
/// Threads      [any thread]
class OSTINET_EXPORT ResourceAccess {
 public:
  static ResourceAccess& Instance();
  /// The file `name`.`type`, whether it exists or not.
  File GetFile(UString const& name, UString const& type) const;
};

}  // namespace Ostinet
