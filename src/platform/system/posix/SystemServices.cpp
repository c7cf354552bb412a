// SPDX-License-Identifier: MIT
#include "core/SystemServices.h"

#include <dlfcn.h>
#include <fcntl.h>
#include <pthread.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <cstdio>
#include <cstdlib>
#include <new>
#include <string>

namespace Ostinet::SystemServices {

namespace {

// The kernel's limit for a thread's name, without the 0 at its end.
constexpr std::size_t kLongestThreadName = 15;

// Anything of this library tells where it was loaded from.
void AnchorForAddress() {}

int FlushFolder(std::filesystem::path const& folder) {
  int const handle = ::open(folder.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC);
  if (handle < 0) {
    return errno;
  }
  int const error = ::fsync(handle) == 0 ? 0 : errno;
  ::close(handle);
  return error;
}

}  // namespace

std::optional<UString> Environment(char const* name) {
  char const* const value = std::getenv(name);
  if (value == nullptr || *value == '\0') {
    return std::nullopt;
  }
  return UString(value);
}

void SetEnvironment(char const* name, UString const& value) {
  if (value.empty()) {
    ::unsetenv(name);
  } else {
    ::setenv(name, value.string().c_str(), 1);
  }
}

std::filesystem::path LibraryFolder() {
  Dl_info info{};
  if (::dladdr(reinterpret_cast<void*>(&AnchorForAddress), &info) == 0 ||
      info.dli_fname == nullptr) {
    return {};
  }
  std::error_code error;
  // A program's own entry may hold the name it was started by, so the system's link is better.
  std::filesystem::path const file = std::filesystem::canonical(info.dli_fname, error);
  if (!error) {
    return file.parent_path();
  }
  return std::filesystem::canonical("/proc/self/exe", error).parent_path();
}

std::filesystem::path UserDataFolder() {
  // A relative path in the variable is to be ignored, as the convention for it demands.
  char const* const data = std::getenv("XDG_DATA_HOME");
  if (data != nullptr && data[0] == '/') {
    return data;
  }
  char const* const home = std::getenv("HOME");
  if (home != nullptr && home[0] == '/') {
    return std::filesystem::path(home) / ".local" / "share";
  }
  return {};
}

std::filesystem::path MachineDataFolder() { return {}; }
std::filesystem::path DeviceFilesSubfolder() { return "ostinet/midi-devices"; }
std::filesystem::path ResourcesSubfolder() { return "share/ostinet/resources"; }

bool IsFolderLink(std::filesystem::path const& path) {
  std::error_code error;
  return std::filesystem::is_symlink(path, error) && std::filesystem::is_directory(path, error);
}

std::optional<long long> ModificationTime(std::filesystem::path const& path) {
  struct stat status {};
  if (::stat(path.c_str(), &status) != 0) {
    return std::nullopt;
  }
  return status.st_mtime;
}

void NameThisThread(UString const& name, int) {
  std::string const text = name.string().substr(0, kLongestThreadName);
  // Without a name the thread runs as well. Priorities other than the usual are for programs
  // with special rights, which this library does not ask for.
  static_cast<void>(::pthread_setname_np(::pthread_self(), text.c_str()));
}

ThreadSlot::ThreadSlot(void (*free)(void*)) {
  pthread_key_t key = 0;
  if (::pthread_key_create(&key, free) != 0) {
    throw std::bad_alloc();
  }
  key_ = key;
}

void* ThreadSlot::Get() const { return ::pthread_getspecific(static_cast<pthread_key_t>(key_)); }

void ThreadSlot::Set(void* pointer) {
  if (::pthread_setspecific(static_cast<pthread_key_t>(key_), pointer) != 0) {
    throw std::bad_alloc();
  }
}

OutputFile::~OutputFile() { Close(); }

int OutputFile::Create(std::filesystem::path const& path) {
  int const handle = ::open(path.c_str(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, 0666);
  if (handle < 0) {
    return errno;
  }
  handle_ = handle;
  return 0;
}

int OutputFile::Write(void const* bytes, std::size_t count) {
  auto const* next = static_cast<char const*>(bytes);
  while (count > 0) {
    ssize_t const written = ::write(static_cast<int>(handle_), next, count);
    if (written < 0) {
      if (errno == EINTR) {
        continue;
      }
      return errno;
    }
    next += written;
    count -= static_cast<std::size_t>(written);
  }
  return 0;
}

int OutputFile::Flush() { return ::fsync(static_cast<int>(handle_)) == 0 ? 0 : errno; }

int OutputFile::Close() {
  if (handle_ == kNone) {
    return 0;
  }
  int const result = ::close(static_cast<int>(handle_));
  handle_ = kNone;
  return result == 0 ? 0 : errno;
}

int AlreadyExistsError() { return EEXIST; }

int RenameOver(std::filesystem::path const& from, std::filesystem::path const& to) {
  // A file that was there keeps its permissions.
  struct stat status {};
  if (::stat(to.c_str(), &status) == 0) {
    static_cast<void>(::chmod(from.c_str(), status.st_mode & 07777));
  }
  if (::rename(from.c_str(), to.c_str()) != 0) {
    return errno;
  }
  // The new name is in place already; what a failing flush risks is the old content after a
  // power failure, which is whole too.
  static_cast<void>(FlushFolder(to.has_parent_path() ? to.parent_path() : "."));
  return 0;
}

unsigned long ProcessNumber() { return static_cast<unsigned long>(::getpid()); }

bool IsErrorOutputATerminal() { return ::isatty(STDERR_FILENO) == 1; }

}  // namespace Ostinet::SystemServices
