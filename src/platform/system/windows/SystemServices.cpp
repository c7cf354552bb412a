// SPDX-License-Identifier: MIT
#include "core/SystemServices.h"

#include <windows.h>

#include <algorithm>
#include <new>
#include <string>
#include <vector>

namespace Ostinet::SystemServices {

namespace {

constexpr DWORD kLongestPath = 32768;

// Anything of this library tells where it was loaded from.
void AnchorForAddress() {}

std::wstring WideEnvironment(std::wstring const& name) {
  std::vector<wchar_t> text(kLongestPath);
  DWORD const length = ::GetEnvironmentVariableW(name.c_str(), text.data(), kLongestPath);
  return length < kLongestPath ? std::wstring(text.data(), length) : std::wstring();
}

std::wstring Widened(std::string const& name) { return {name.begin(), name.end()}; }

int LastError() { return static_cast<int>(::GetLastError()); }

HANDLE HandleOf(std::intptr_t handle) { return reinterpret_cast<HANDLE>(handle); }

}  // namespace

std::optional<UString> Environment(char const* name) {
  std::wstring const value = WideEnvironment(Widened(name));
  if (value.empty()) {
    return std::nullopt;
  }
  return UString(value.c_str());
}

void SetEnvironment(char const* name, UString const& value) {
  std::wstring const text(value.begin(), value.end());
  ::SetEnvironmentVariableW(Widened(name).c_str(), text.empty() ? nullptr : text.c_str());
}

std::filesystem::path LibraryFolder() {
  HMODULE module = nullptr;
  constexpr DWORD kFlags =
      GET_MODULE_HANDLE_EX_FLAG_FROM_ADDRESS | GET_MODULE_HANDLE_EX_FLAG_UNCHANGED_REFCOUNT;
  auto const address = reinterpret_cast<LPCWSTR>(&AnchorForAddress);
  if (::GetModuleHandleExW(kFlags, address, &module) == 0) {
    return {};
  }
  std::vector<wchar_t> text(kLongestPath);
  DWORD const length = ::GetModuleFileNameW(module, text.data(), kLongestPath);
  return std::filesystem::path(std::wstring(text.data(), length)).parent_path();
}

std::filesystem::path UserDataFolder() { return WideEnvironment(L"APPDATA"); }
std::filesystem::path MachineDataFolder() { return WideEnvironment(L"ProgramData"); }
std::filesystem::path DeviceFilesSubfolder() { return L"Ostinet\\MIDI Devices"; }
std::filesystem::path ResourcesSubfolder() { return {}; }

bool IsFolderLink(std::filesystem::path const& path) {
  DWORD const attributes = ::GetFileAttributesW(path.c_str());
  constexpr DWORD kFolderLink = FILE_ATTRIBUTE_DIRECTORY | FILE_ATTRIBUTE_REPARSE_POINT;
  return attributes != INVALID_FILE_ATTRIBUTES && (attributes & kFolderLink) == kFolderLink;
}

std::optional<long long> ModificationTime(std::filesystem::path const& path) {
  WIN32_FILE_ATTRIBUTE_DATA data{};
  if (::GetFileAttributesExW(path.c_str(), GetFileExInfoStandard, &data) == 0) {
    return std::nullopt;
  }
  // The system counts in 100 ns since 1601.
  constexpr long long kSecondsTo1970 = 11644473600;
  ULARGE_INTEGER time{};
  time.LowPart = data.ftLastWriteTime.dwLowDateTime;
  time.HighPart = data.ftLastWriteTime.dwHighDateTime;
  return static_cast<long long>(time.QuadPart / 10'000'000) - kSecondsTo1970;
}

void NameThisThread(UString const& name, int priority) {
  // The call for names came with a later edition of the system, so it is looked up.
  using SetDescription = HRESULT(WINAPI*)(HANDLE, PCWSTR);
  HMODULE const kernel = ::GetModuleHandleW(L"kernel32.dll");
  auto const function = reinterpret_cast<SetDescription>(
      reinterpret_cast<void*>(::GetProcAddress(kernel, "SetThreadDescription")));
  if (function != nullptr) {
    std::wstring const text(name.begin(), name.end());
    static_cast<void>(function(::GetCurrentThread(), text.c_str()));
  }
  if (priority > 0) {
    ::SetThreadPriority(::GetCurrentThread(), THREAD_PRIORITY_ABOVE_NORMAL);
  }
}

ThreadSlot::ThreadSlot(void (*free)(void*))
    : key_(::FlsAlloc(reinterpret_cast<PFLS_CALLBACK_FUNCTION>(free))) {
  if (key_ == FLS_OUT_OF_INDEXES) {
    throw std::bad_alloc();
  }
}

void* ThreadSlot::Get() const { return ::FlsGetValue(key_); }

void ThreadSlot::Set(void* pointer) {
  if (::FlsSetValue(key_, pointer) == 0) {
    throw std::bad_alloc();
  }
}

OutputFile::~OutputFile() { Close(); }

int OutputFile::Create(std::filesystem::path const& path) {
  HANDLE const handle = ::CreateFileW(path.c_str(), GENERIC_WRITE, FILE_SHARE_READ, nullptr,
                                      CREATE_NEW, FILE_ATTRIBUTE_NORMAL, nullptr);
  if (handle == INVALID_HANDLE_VALUE) {
    return LastError();
  }
  handle_ = reinterpret_cast<std::intptr_t>(handle);
  return 0;
}

int OutputFile::Write(void const* bytes, std::size_t count) {
  constexpr std::size_t kAtOnce = std::size_t{1} << 30;
  auto const* next = static_cast<char const*>(bytes);
  while (count > 0) {
    DWORD written = 0;
    auto const part = static_cast<DWORD>(std::min(count, kAtOnce));
    if (::WriteFile(HandleOf(handle_), next, part, &written, nullptr) == 0) {
      return LastError();
    }
    next += written;
    count -= written;
  }
  return 0;
}

int OutputFile::Flush() { return ::FlushFileBuffers(HandleOf(handle_)) != 0 ? 0 : LastError(); }

int OutputFile::Close() {
  if (handle_ == kNone) {
    return 0;
  }
  BOOL const closed = ::CloseHandle(HandleOf(handle_));
  handle_ = kNone;
  return closed != 0 ? 0 : LastError();
}

int AlreadyExistsError() { return ERROR_FILE_EXISTS; }

int RenameOver(std::filesystem::path const& from, std::filesystem::path const& to) {
  constexpr DWORD kFlags = MOVEFILE_REPLACE_EXISTING | MOVEFILE_WRITE_THROUGH;
  return ::MoveFileExW(from.c_str(), to.c_str(), kFlags) != 0 ? 0 : LastError();
}

unsigned long ProcessNumber() { return ::GetCurrentProcessId(); }

bool IsErrorOutputATerminal() {
  DWORD mode = 0;
  return ::GetConsoleMode(::GetStdHandle(STD_ERROR_HANDLE), &mode) != 0;
}

}  // namespace Ostinet::SystemServices
