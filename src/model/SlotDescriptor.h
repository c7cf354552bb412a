// SPDX-License-Identifier: MIT
#pragma once

#include "model/ImplImpl.h"
#include "ostinet/MatchData.h"

namespace Ostinet::Impl {

/// The first six numbers of the slot descriptor that `peer` gives; zeros where there are fewer.
SlotID SlotIDOf(ImplImpl const& peer);

}  // namespace Ostinet::Impl
