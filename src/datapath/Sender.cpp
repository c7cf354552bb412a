// SPDX-License-Identifier: MIT
#include "ostinet/Endpoint.h"

namespace Ostinet::Impl {

Sender::~Sender() = default;

}  // namespace Ostinet::Impl
