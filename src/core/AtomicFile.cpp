// SPDX-License-Identifier: MIT
#include "core/AtomicFile.h"

#include <atomic>
#include <utility>

#include "core/Paths.h"
#include "ostinet/core/Error.h"

namespace Ostinet::Impl {

namespace {

using Step = AtomicFile::Step;

AtomicFile::FaultHook& Hook() {
  static AtomicFile::FaultHook hook;
  return hook;
}

// Does one step of the system unless it is told to fail; gives its error number.
template <class Call>
int Try(Step step, Call call) {
  if (Hook()) {
    if (int const error = Hook()(step)) {
      return error;
    }
  }
  return call();
}

std::filesystem::path LinkTarget(std::filesystem::path const& path) {
  std::error_code error;
  if (!std::filesystem::is_symlink(path, error)) {
    return path;
  }
  std::filesystem::path const target = std::filesystem::canonical(path, error);
  return error ? path : target;
}

// A name that no file of this process or another has had from this function.
std::filesystem::path TemporaryName(std::filesystem::path const& target) {
  static std::atomic<unsigned long> sCount{0};
  UString name = "." + FromPath(target.filename());
  name.Stream() << "." << SystemServices::ProcessNumber() << "-" << ++sCount << ".tmp";
  return target.parent_path() / ToPath(name);
}

}  // namespace

AtomicFile::AtomicFile(std::filesystem::path const& target) : target_(LinkTarget(target)) {
  int error = SystemServices::AlreadyExistsError();
  // One left by a crash of a process of this number is passed over.
  for (int attempt = 0; attempt < 100 && error == SystemServices::AlreadyExistsError(); ++attempt) {
    temporary_ = TemporaryName(target_);
    error = Try(Step::kCreate, [this] { return file_.Create(temporary_); });
  }
  FailOSErr(error);
  created_ = true;
}

AtomicFile::~AtomicFile() {
  if (created_) {
    file_.Close();
    std::error_code ignored;
    std::filesystem::remove(temporary_, ignored);
  }
}

void AtomicFile::Write(void const* bytes, std::size_t count) {
  FailOSErr(Try(Step::kWrite, [&] { return file_.Write(bytes, count); }));
}

void AtomicFile::Commit() {
  FailOSErr(Try(Step::kFlush, [this] { return file_.Flush(); }));
  FailOSErr(Try(Step::kClose, [this] { return file_.Close(); }));
  FailOSErr(
      Try(Step::kReplace, [this] { return SystemServices::RenameOver(temporary_, target_); }));
  created_ = false;
}

void AtomicFile::SetFaultHook(FaultHook hook) { Hook() = std::move(hook); }

void ReplaceFileContent(std::filesystem::path const& target, void const* bytes, std::size_t count) {
  AtomicFile file(target);
  file.Write(bytes, count);
  file.Commit();
}

}  // namespace Ostinet::Impl
