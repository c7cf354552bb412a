// SPDX-License-Identifier: MIT
#pragma once

#include <memory>

#include "core/SystemServices.h"

namespace Ostinet {

/// A `T` for each thread, made at its first use and deleted when its thread ends. In place of
/// `thread_local` for types with a destructor: MinGW frees the storage of those before it destroys
/// them.
///
/// Threads      [any thread] Each sees its own.
template <class T>
class PerThread {
 public:
  PerThread() : slot_(*new SystemServices::ThreadSlot(&Free)) {}

  T& operator*() {
    if (void* const known = slot_.Get()) {
      return *static_cast<T*>(known);
    }
    auto fresh = std::make_unique<T>();
    slot_.Set(fresh.get());
    return *fresh.release();
  }

 private:
  static void Free(void* pointer) { delete static_cast<T*>(pointer); }

  SystemServices::ThreadSlot& slot_;  // stays to the end of the process
};

}  // namespace Ostinet
