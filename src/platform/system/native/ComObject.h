// SPDX-License-Identifier: MIT
#pragma once

#include <atomic>

#include "platform/system/WindowsTypes.h"

namespace Ostinet::Impl {

/// A counted object behind one published interface. Born with one reference; the last Release ends
/// it. Derive a final class.
template <class Interface, GUID const& kInterfaceID>
class ComObject : public Interface {
 public:
  ComObject(ComObject const&) = delete;
  ComObject& operator=(ComObject const&) = delete;

  HRESULT QueryInterface(REFIID iid, void** object) override {
    if (object == nullptr) return E_POINTER;
    if (iid != IID_IUnknown && iid != kInterfaceID) {
      *object = nullptr;
      return E_NOINTERFACE;
    }
    AddRef();
    *object = static_cast<Interface*>(this);
    return S_OK;
  }

  ULONG AddRef() override { return references_.fetch_add(1, std::memory_order_relaxed) + 1; }

  // The last one to let go has to see what all others did to the object.
  ULONG Release() override {
    ULONG const left = references_.fetch_sub(1, std::memory_order_acq_rel) - 1;
    if (left == 0) delete this;
    return left;
  }

 protected:
  ComObject() = default;
  virtual ~ComObject() = default;

 private:
  std::atomic<ULONG> references_{1};
};

}  // namespace Ostinet::Impl
