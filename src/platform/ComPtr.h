// SPDX-License-Identifier: MIT
#pragma once

#include <utility>

namespace Ostinet::Impl {

/// One counted reference to a COM object.
template <class T>
class ComPtr {
 public:
  ComPtr() = default;
  /// Shares `pointer`, adding a reference.
  explicit ComPtr(T* pointer) : pointer_(pointer) {
    if (pointer_ != nullptr) {
      pointer_->AddRef();
    }
  }
  ComPtr(ComPtr const& other) : ComPtr(other.pointer_) {}
  ComPtr(ComPtr&& other) noexcept : pointer_(std::exchange(other.pointer_, nullptr)) {}
  ComPtr& operator=(ComPtr other) noexcept {
    std::swap(pointer_, other.pointer_);
    return *this;
  }
  ~ComPtr() { Reset(); }

  void Reset() {
    if (T* const old = std::exchange(pointer_, nullptr)) {
      old->Release();
    }
  }
  /// Where a call puts a new reference that this pointer then owns.
  T** Receive() {
    Reset();
    return &pointer_;
  }
  T* get() const { return pointer_; }
  T* operator->() const { return pointer_; }
  explicit operator bool() const { return pointer_ != nullptr; }

 private:
  T* pointer_ = nullptr;
};

}  // namespace Ostinet::Impl
