// SPDX-License-Identifier: MIT
#include <algorithm>
#include <filesystem>

#include "core/Paths.h"
#include "core/SystemServices.h"
#include "ostinet/core/Files.h"

namespace Ostinet {

FolderIterator::FolderIterator(Folder const& folder, IteratorOptions options) {
  std::error_code error;
  std::filesystem::directory_iterator entry(Impl::ToPath(folder), error);
  for (; !error && entry != std::filesystem::directory_iterator(); entry.increment(error)) {
    std::error_code ignored;
    bool const isFolder = entry->is_directory(ignored);
    bool const wanted = isFolder
                            ? options != kFilesOnly && !SystemServices::IsFolderLink(entry->path())
                            : options != kFoldersOnly && entry->is_regular_file(ignored);
    if (wanted) {
      entries_.push_back({Impl::SpecificationOf(entry->path()), isFolder});
    }
  }
  // The system gives entries in an order of its own, and the first of two files of one model wins.
  std::sort(entries_.begin(), entries_.end(),
            [](Entry const& a, Entry const& b) { return a.specification < b.specification; });
}

}  // namespace Ostinet
