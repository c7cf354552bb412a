// SPDX-License-Identifier: MIT
#pragma once

#include "platform/system/WindowsTypes.h"

namespace Ostinet::Impl::Simulated {

/// Whether a caller's header of a long message can be looked into.
inline bool IsHeader(MIDIHDR const* header, UINT size) {
  return header != nullptr && header->lpData != nullptr && size >= sizeof(MIDIHDR);
}

}  // namespace Ostinet::Impl::Simulated
