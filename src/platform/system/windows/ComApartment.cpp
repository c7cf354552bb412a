// SPDX-License-Identifier: MIT
#include "platform/system/windows/ComApartment.h"

#include <combaseapi.h>

namespace Ostinet::Impl {

ComApartment::ComApartment() {
  CO_MTA_USAGE_COOKIE cookie = nullptr;
  if (SUCCEEDED(::CoIncrementMTAUsage(&cookie))) cookie_ = cookie;
}

ComApartment::~ComApartment() {
  if (cookie_ != nullptr) ::CoDecrementMTAUsage(static_cast<CO_MTA_USAGE_COOKIE>(cookie_));
}

}  // namespace Ostinet::Impl
