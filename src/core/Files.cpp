// SPDX-License-Identifier: MIT
#include "ostinet/core/Files.h"

#include <algorithm>
#include <deque>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <limits>

#include "core/AtomicFile.h"
#include "core/Paths.h"
#include "core/SystemServices.h"
#include "ostinet/core/Error.h"

namespace Ostinet {

namespace fs = std::filesystem;

namespace {

// What the system says when a file or folder is not there.
int NoEntryError() { return static_cast<int>(std::errc::no_such_file_or_directory); }

// The path as the system writes it, without separators at its end, except of a root, which is
// nothing but its separator.
UString InSystemForm(UString const& fullPath) {
  fs::path path = Impl::ToPath(fullPath);
  if (!path.has_filename() && path.has_relative_path()) {
    path = path.parent_path();
  }
  return Impl::FromPath(path);
}

FileSpecification Inside(FileSpecification const& folder, UString const& name) {
  return Impl::SpecificationOf(Impl::ToPath(folder) / Impl::ToPath(name));
}

// A new, empty file; the system's error number if that fails.
int CreateEmpty(FileSpecification const& file) {
  SystemServices::OutputFile output;
  if (int const error = output.Create(Impl::ToPath(file))) {
    return error;
  }
  return output.Close();
}

void CreateFolders(FileSpecification const& folder) {
  std::error_code error;
  fs::create_directories(Impl::ToPath(folder), error);
  FailOSErr(error.value());
}

}  // namespace

FileSpecification::FileSpecification(UString const& fullPath) : path_(InSystemForm(fullPath)) {}

bool FileSpecification::IsFile() const {
  std::error_code error;
  return fs::is_regular_file(Impl::ToPath(path_), error);
}

bool FileSpecification::IsFolder() const {
  std::error_code error;
  return fs::is_directory(Impl::ToPath(path_), error);
}

UString FileSpecification::GetName() const {
  return Impl::FromPath(Impl::ToPath(path_).filename());
}

FileSystemObject::FileSystemObject(FileSpecification const& specification)
    : FileSpecification(specification) {}

Folder FileSystemObject::ParentFolder() const {
  return Folder(Impl::SpecificationOf(Impl::ToPath(*this).parent_path()));
}

FileModDate FileSystemObject::GetModDate() const {
  auto const seconds = SystemServices::ModificationTime(Impl::ToPath(*this));
  if (!seconds) {
    FailOSErr(NoEntryError());
  }
  constexpr long long kLast = std::numeric_limits<std::uint32_t>::max();
  return FileModDate(static_cast<std::uint32_t>(std::clamp(*seconds, 0LL, kLast)));
}

void FileSystemObject::Delete() const {
  std::error_code error;
  fs::remove_all(Impl::ToPath(*this), error);
  FailOSErr(error.value());
}

File::File(FileSpecification const& specification) : FileSystemObject(specification) {}

std::vector<unsigned char> File::Read() const {
  std::ifstream stream(Impl::ToPath(*this), std::ios::binary);
  if (!stream || IsFolder()) {
    FailOSErr(NoEntryError());
  }
  std::vector<unsigned char> const bytes{std::istreambuf_iterator<char>(stream),
                                         std::istreambuf_iterator<char>()};
  if (stream.bad()) {
    FailOSErr(static_cast<int>(std::errc::io_error));
  }
  return bytes;
}

void File::Replace(void const* bytes, std::size_t count) const {
  Impl::ReplaceFileContent(Impl::ToPath(*this), bytes, count);
}

Folder::Folder(FileSpecification const& specification) : FileSystemObject(specification) {}

Folder Folder::GetSubFolder(UString const& name) const { return Folder(Inside(*this, name)); }

Folder Folder::DemandSubFolder(UString const& name) const {
  Folder const folder = GetSubFolder(name);
  CreateFolders(folder);
  return folder;
}

File Folder::GetFile(UString const& name) const { return File(Inside(*this, name)); }

File Folder::DemandFileInFolder(UString const& name, FileTypeClass, FileTypeClass) const {
  File const file = GetFile(name);
  if (!file.IsFile()) {
    CreateFolders(*this);
    FailOSErr(CreateEmpty(file));
  }
  return file;
}

File Folder::CreateFileInFolder(UString const& name, FileTypeClass, FileTypeClass,
                                AdjustName adjust) const {
  UString const wanted = adjust == kAdjustName ? Impl::MakeFileName(name) : name;
  UString taken = wanted;
  for (int number = 2;; ++number) {
    File const file = GetFile(taken);
    int const error = CreateEmpty(file);
    if (error == 0) {
      return file;
    }
    if (adjust != kAdjustName || error != SystemServices::AlreadyExistsError()) {
      FailOSErr(error);
    }
    taken = Impl::NumberedFileName(wanted, number);
  }
}

bool Folder::SearchFolder(UString const& name, FileSpecification& found) const {
  FileSpecification similar;
  for (std::deque<Folder> folders{*this}; !folders.empty(); folders.pop_front()) {
    for (FolderIterator entry(folders.front()); !entry.AtEnd(); ++entry) {
      if (entry.IsFolder()) {
        folders.emplace_back(*entry);
        continue;
      }
      UString const entryName = entry->GetName();
      if (entryName == name) {
        found = *entry;
        return true;
      }
      if (!similar.IsValid() && entryName.equal(name, UString::kIgnoreCase)) {
        similar = *entry;
      }
    }
  }
  if (similar.IsValid()) {
    found = similar;
  }
  return similar.IsValid();
}

}  // namespace Ostinet
