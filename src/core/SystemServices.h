// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <cstdint>
#include <filesystem>
#include <optional>

#include "ostinet/core/UString.h"

// The few services that each operating system offers in its own way and the core needs. One file
// for each system implements them.

namespace Ostinet::SystemServices {

/// The value of an environment variable; nothing if it is not set or empty.
std::optional<UString> Environment(char const* name);
/// Sets a variable of this process; an empty value removes it. While no other thread reads one.
void SetEnvironment(char const* name, UString const& value);

/// The folder that the library, or the program that it is linked into, was loaded from. Empty if
/// the system does not tell.
std::filesystem::path LibraryFolder();
/// Where this user's programs keep data, without a part for this library. Empty if unknown.
std::filesystem::path UserDataFolder();
/// The same for all users, where the system has one place for it, else empty.
std::filesystem::path MachineDataFolder();
/// What this library's folders are called below those two, in the manner of the system.
std::filesystem::path DeviceFilesSubfolder();
/// Where the resources lie, seen from the folder of the library.
std::filesystem::path ResourcesSubfolder();

/// Whether an entry leads to another place: a link to a folder, or a mount of one.
bool IsFolderLink(std::filesystem::path const& path);
/// When a file or folder was last written, in seconds since 1970. Nothing if there is none.
std::optional<long long> ModificationTime(std::filesystem::path const& path);

/// Names the calling thread for debuggers and lists of threads, and asks for its priority.
void NameThisThread(UString const& name, int priority);

/// One pointer for each thread. Where a thread ends with a pointer set, `free` is called with it,
/// on that thread. Never destroyed in practice: threads may end after any static object did.
class ThreadSlot {
 public:
  explicit ThreadSlot(void (*free)(void*));
  ThreadSlot(ThreadSlot const&) = delete;
  ThreadSlot& operator=(ThreadSlot const&) = delete;
  ~ThreadSlot() = delete;

  void* Get() const;
  void Set(void* pointer);

 private:
  unsigned long key_;
};

/// A file being written, through the system's own calls, so that each can be told to fail. Each
/// operation gives 0 or the system's error number.
class OutputFile {
 public:
  OutputFile() = default;
  OutputFile(OutputFile const&) = delete;
  OutputFile& operator=(OutputFile const&) = delete;
  ~OutputFile();

  /// Makes a file; one that is there already is an error.
  int Create(std::filesystem::path const& path);
  int Write(void const* bytes, std::size_t count);
  /// Waits until what was written is on the disk.
  int Flush();
  int Close();

 private:
  static constexpr std::intptr_t kNone = -1;
  std::intptr_t handle_ = kNone;
};

/// The error number that says that a file is there already.
int AlreadyExistsError();
/// Gives the file `from` the name `to`, in one step, in place of a file that bears it.
int RenameOver(std::filesystem::path const& from, std::filesystem::path const& to);
/// A number that no other running process has.
unsigned long ProcessNumber();
bool IsErrorOutputATerminal();

}  // namespace Ostinet::SystemServices
