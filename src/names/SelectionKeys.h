// SPDX-License-Identifier: MIT
#pragma once

#include "ostinet/core/UString.h"

namespace Ostinet::Impl {

/// The keys, in a destination's Dict "nameConfiguration", of what is selected. They are stored in
/// users' setup files, so they never change.
namespace SelectionKeys {

inline UString const kCurrentMode("currentDeviceMode");  // a text
/// 16 texts by channel, empty where there is none.
inline UString const kCurrentNameSets("currentChannelNameSets");

}  // namespace SelectionKeys

}  // namespace Ostinet::Impl
