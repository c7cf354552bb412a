// SPDX-License-Identifier: MIT
#pragma once

#include "platform/system/WindowsTypes.h"

namespace Ostinet::Impl {

/// Keeps the process's multithreaded COM apartment alive, so that every thread that has initialized
/// no apartment of its own can make and use COM objects: the library's job thread as well as a
/// host's. Threads that the host has put in another apartment stay there.
class ComApartment {
 public:
  ComApartment();
  ~ComApartment();
  ComApartment(ComApartment const&) = delete;
  ComApartment& operator=(ComApartment const&) = delete;

 private:
  void* cookie_ = nullptr;  // null when the system refused; objects then need the host's apartment
};

}  // namespace Ostinet::Impl
