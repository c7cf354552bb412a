// SPDX-License-Identifier: MIT
#include "platform/system/native/WireBudget.h"

#include <algorithm>

namespace Ostinet::Impl {

WireBudget::Duration WireBudget::Spend(std::size_t count, Time now) {
  std::chrono::duration<double> const rested = now - last_;
  if (rested.count() > 0) {
    debt_ = std::max(0.0, debt_ - rested.count() * kCableRate);
    last_ = now;
  }
  bool const isShort = count <= 3;
  debt_ += static_cast<double>(count) / (isShort ? kShortDiscount : 1.0);
  double const excess = std::max(0.0, debt_ - kBurst);
  return std::chrono::duration_cast<Duration>(std::chrono::duration<double>(excess / kCableRate));
}

}  // namespace Ostinet::Impl
