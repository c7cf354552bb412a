// SPDX-License-Identifier: MIT
#include "model/NamesHooks.h"

namespace Ostinet::Impl {

namespace {

NamesHooks const* gHooks = nullptr;

}  // namespace

void InstallNamesHooks(NamesHooks const* hooks) { gHooks = hooks; }
NamesHooks const* GetNamesHooks() { return gHooks; }

}  // namespace Ostinet::Impl
