// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <filesystem>
#include <functional>

#include "core/SystemServices.h"
#include "ostinet/core/Noncopyable.h"

namespace Ostinet::Impl {

/// Writes a file beside the one that it is to replace, and renames it over that one at the end,
/// so that a crash or a full disk at any moment leaves the old content or the new one, whole.
///
/// Ownership    Removes what it has written unless Commit has succeeded.
/// Threads      One object on one thread at a time.
/// Errors       A VantorError of the domain "OS".
class AtomicFile : private Noncopyable<AtomicFile> {
 public:
  /// What is asked of the system, for those who make it fail.
  enum class Step { kCreate, kWrite, kFlush, kClose, kReplace };
  /// Gives the error number with which a step is to fail, or 0 to let it happen.
  using FaultHook = std::function<int(Step)>;

  /// Opens the temporary file. A link is followed: the file that it leads to is replaced.
  explicit AtomicFile(std::filesystem::path const& target);
  ~AtomicFile();

  void Write(void const* bytes, std::size_t count);
  /// Puts the file in the target's place.
  void Commit();

  /// Makes steps fail from now on, in the whole process; empty ends that. For tests, while no
  /// other thread writes files.
  static void SetFaultHook(FaultHook hook);

 private:
  std::filesystem::path target_;
  std::filesystem::path temporary_;
  SystemServices::OutputFile file_;
  bool created_ = false;
};

/// Replaces the whole content of a file.
void ReplaceFileContent(std::filesystem::path const& target, void const* bytes, std::size_t count);

}  // namespace Ostinet::Impl
