// SPDX-License-Identifier: MIT
#pragma once

#include "platform/system/WindowsTypes.h"

namespace Ostinet::Impl {

/// The function that an open device reports to.
class DeviceCallback {
 public:
  DeviceCallback(DWORD_PTR function, DWORD_PTR instance, DWORD flags)
      : function_((flags & CALLBACK_TYPEMASK) == CALLBACK_FUNCTION
                      ? reinterpret_cast<DRVCALLBACK*>(function)
                      : nullptr),
        instance_(instance) {}

  template <class Handle>
  void Call(Handle handle, UINT message, DWORD_PTR param1 = 0, DWORD_PTR param2 = 0) const {
    if (function_ != nullptr) {
      function_(reinterpret_cast<HDRVR>(handle), message, instance_, param1, param2);
    }
  }

 private:
  DRVCALLBACK* function_;
  DWORD_PTR instance_;
};

}  // namespace Ostinet::Impl
