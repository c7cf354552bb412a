// SPDX-License-Identifier: MIT
#include "names/DestNameSetImpl.h"

#include <algorithm>

#include "names/DestModeImpl.h"

namespace Ostinet::Impl {

namespace {

unsigned short Bit(int channel) { return static_cast<unsigned short>(1U << (channel & 15)); }

}  // namespace

DestNameSetImpl::~DestNameSetImpl() {
  for (RCPtrMT<PatchBankImpl> const& bank : banks_) {
    bank->SetNameSet(nullptr);
  }
}

void DestNameSetImpl::SetChannelAvailable(int channel, bool isAvailable) {
  unsigned const bit = Bit(channel);
  channels_ = static_cast<unsigned short>(isAvailable ? channels_ | bit : channels_ & ~bit);
}

void DestNameSetImpl::AddBank(RCPtrMT<PatchBankImpl> const& bank) {
  banks_.push_back(bank);
  bank->SetNameSet(this);
}

void DestNameSetImpl::Detach() {
  destination_ = nullptr;
  for (RCPtrMT<PatchBankImpl> const& bank : banks_) {
    for (RCPtrMT<PatchImpl> const& patch : bank->GetPatches()) {
      patch->DropChannelNameSets();
    }
  }
}

void DestNameSetImpl::AddUse(DestModeImpl* mode, int channel) {
  for (ModeUse& use : modes_) {
    if (use.first == mode) {
      use.second = static_cast<unsigned short>(use.second | Bit(channel));
      return;
    }
  }
  modes_.emplace_back(mode, Bit(channel));
}

void DestNameSetImpl::RemoveUse(DestModeImpl* mode, int channel) {
  for (ModeUse& use : modes_) {
    if (use.first == mode) {
      use.second = static_cast<unsigned short>(use.second & ~Bit(channel));
      if (use.second == 0) {
        RemoveMode(mode);
      }
      return;
    }
  }
}

void DestNameSetImpl::RemoveMode(DestModeImpl* mode) {
  auto const isMode = [mode](ModeUse const& use) { return use.first == mode; };
  modes_.erase(std::remove_if(modes_.begin(), modes_.end(), isMode), modes_.end());
}

}  // namespace Ostinet::Impl
