// SPDX-License-Identifier: MIT
#pragma once

#include "model/Handles.h"
#include "names/DestModeImpl.h"
#include "ostinet/NamesCatalog.h"

namespace Ostinet::Impl {

// From handles to the objects behind them; null for a null handle.

inline DestModeImpl* ImplOf(DestinationMode const& handle) {
  return static_cast<DestModeImpl*>(ImplOf(static_cast<Object const&>(handle)));
}
inline DestNameSetImpl* ImplOf(DestinationNameSet const& handle) {
  return static_cast<DestNameSetImpl*>(ImplOf(static_cast<Object const&>(handle)));
}
inline PatchBankImpl* ImplOf(PatchBank const& handle) {
  return static_cast<PatchBankImpl*>(ImplOf(static_cast<Object const&>(handle)));
}
inline PatchImpl* ImplOf(Patch const& handle) {
  return static_cast<PatchImpl*>(ImplOf(static_cast<Object const&>(handle)));
}

}  // namespace Ostinet::Impl
