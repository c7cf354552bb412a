// SPDX-License-Identifier: MIT
#include "names/PatchBankImpl.h"

#include "ostinet/NamesCatalog.h"

namespace Ostinet::Impl {

namespace {

bool IsPatch(PatchImpl const& patch, PatchNumbers const& wanted) {
  if (patch.Commands().PendingProgram() != wanted.program) {
    return false;
  }
  PatchNumbers const numbers = patch.GetNumbers();
  return numbers.msb == wanted.msb && numbers.lsb == wanted.lsb;
}

}  // namespace

PatchBankImpl::~PatchBankImpl() { ClearPatches(); }

void PatchBankImpl::AddPatch(RCPtrMT<PatchImpl> const& patch) {
  patches_.push_back(patch);
  patch->SetBank(this);
}

void PatchBankImpl::ClearPatches() {
  for (RCPtrMT<PatchImpl> const& patch : patches_) {
    patch->SetBank(nullptr);
  }
  patches_.clear();
}

PatchImpl* PatchBankImpl::FindPatch(PatchNumbers const& numbers) const {
  for (RCPtrMT<PatchImpl> const& patch : patches_) {
    if (IsPatch(*patch, numbers)) {
      return patch.get();
    }
  }
  return nullptr;
}

}  // namespace Ostinet::Impl
