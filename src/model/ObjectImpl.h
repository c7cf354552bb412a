// SPDX-License-Identifier: MIT
#pragma once

#include "ostinet/Common.h"

namespace Ostinet::Impl {

/// What every handle points at.
class ObjectImpl : public RCObjectMT<ObjectImpl> {
 public:
  ~ObjectImpl() override = default;
  virtual UString GetName() const = 0;
};

}  // namespace Ostinet::Impl
