// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <memory>
#include <vector>

#include "datapath/SysexStorage.h"
#include "ostinet/SysexRef.h"
#include "ostinet/core/Error.h"

namespace Ostinet::Testing {

/// What the storage of a session did.
struct StorageRecord {
  std::vector<std::size_t> made;  ///< sizes asked for, in order
  std::size_t alive = 0;
  std::size_t usedBytes = 0;  ///< as last set on any of them
  int failAt = 0;             ///< the n-th request from now on fails
};

/// Storage in plain memory, filled with 0xEE.
class MemorySysexStorage : public Impl::SysexStorage {
 public:
  MemorySysexStorage(std::size_t size, std::shared_ptr<StorageRecord> record)
      : bytes_(size, 0xEE), record_(std::move(record)) {
    ++record_->alive;
  }
  ~MemorySysexStorage() override { --record_->alive; }
  unsigned char* RawBytes() const override { return bytes_.data(); }
  void SetUsedBytes(std::size_t count) override { record_->usedBytes = count; }

 private:
  mutable std::vector<unsigned char> bytes_;
  std::shared_ptr<StorageRecord> record_;
};

class MemorySysexStorageMaker : public Impl::SysexStorageMaker {
 public:
  explicit MemorySysexStorageMaker(std::shared_ptr<StorageRecord> record)
      : record_(std::move(record)) {}
  std::unique_ptr<Impl::SysexStorage> Make(std::size_t bufferBytes) override {
    if (record_->failAt > 0 && --record_->failAt == 0) {
      FailCOMError(static_cast<int>(0x8007000Eu));
    }
    record_->made.push_back(bufferBytes);
    return std::make_unique<MemorySysexStorage>(bufferBytes, record_);
  }

 private:
  std::shared_ptr<StorageRecord> record_;
};

/// A session for sysex while it lives.
class SysexSession {
 public:
  SysexSession() { SignIn(); }
  ~SysexSession() { SignOut(); }
  SysexSession(SysexSession const&) = delete;
  SysexSession& operator=(SysexSession const&) = delete;

  void SignIn() { Impl::SetSysexStorageMaker(std::make_shared<MemorySysexStorageMaker>(record_)); }
  void SignOut() { Impl::SetSysexStorageMaker(nullptr); }
  StorageRecord& Record() { return *record_; }

 private:
  std::shared_ptr<StorageRecord> record_ = std::make_shared<StorageRecord>();
};

using Bytes = std::vector<unsigned char>;
inline Bytes BytesOf(SysexRefBase const& ref) { return Bytes(ref.begin(), ref.end()); }

}  // namespace Ostinet::Testing
