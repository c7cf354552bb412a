// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <memory>

namespace Ostinet::Impl {

/// The bytes of one long message, behind the event header that the system's buffers start with.
class SysexStorage {
 public:
  virtual ~SysexStorage() = default;
  /// The first byte of the system's buffer: 20 bytes of header, then the message. The same for the
  /// storage's whole life.
  virtual unsigned char* RawBytes() const = 0;
  /// How much of the buffer is in use, header included. Does not fail.
  virtual void SetUsedBytes(std::size_t count) = 0;
};

/// Makes storage with room for `bufferBytes`, header included, or throws a VantorError.
class SysexStorageMaker {
 public:
  virtual ~SysexStorageMaker() = default;
  virtual std::unique_ptr<SysexStorage> Make(std::size_t bufferBytes) = 0;
};

/// The backend installs its maker at sign-in and takes it away, with null, at sign-out. Storage
/// made before stays valid. Threads: any.
void SetSysexStorageMaker(std::shared_ptr<SysexStorageMaker> maker);

/// Storage from the maker in use; throws a VantorError where there is none. Threads: any.
std::unique_ptr<SysexStorage> MakeSysexStorage(std::size_t bufferBytes);

}  // namespace Ostinet::Impl
