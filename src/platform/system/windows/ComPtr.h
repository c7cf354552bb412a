// SPDX-License-Identifier: MIT
#pragma once

#include <memory>

namespace Ostinet::Impl {

/// Lets one reference of a COM object go.
struct ComRelease {
  template <class Interface>
  void operator()(Interface* object) const {
    object->Release();
  }
};

/// Owns one reference of a COM object.
template <class Interface>
using ComPtr = std::unique_ptr<Interface, ComRelease>;

/// Takes over what `make(Interface**)` gives; null when that fails.
template <class Interface, class Make>
ComPtr<Interface> MakeCom(Make make) {
  Interface* object = nullptr;
  if (make(&object) < 0) return nullptr;
  return ComPtr<Interface>(object);
}

}  // namespace Ostinet::Impl
