// SPDX-License-Identifier: MIT

#include "platform/WinMIDIImplImpl.h"

#include <algorithm>

#include "platform/WinMIDISetup.h"
#include "platform/ports/WinSender.h"

namespace Ostinet::Impl {

WinMIDIImplImpl::WinMIDIImplImpl(WinMIDISetup& setup, WinMIDIImplImpl* parent)
    : setup_(setup), parent_(parent) {
  if (parent_ != nullptr) {
    parent_->children_.push_back(this);
  }
}

WinMIDIImplImpl::~WinMIDIImplImpl() {
  if (parent_ != nullptr) {
    auto& siblings = parent_->children_;
    siblings.erase(std::remove(siblings.begin(), siblings.end(), this), siblings.end());
  }
  for (WinMIDIImplImpl* const child : children_) {
    child->parent_ = nullptr;
  }
}

void WinMIDIImplImpl::Deactivate() {
  if (owner_ != nullptr) {
    setup_.MarkChanged();
    owner_ = nullptr;
  }
}

Properties::Implementation WinMIDIImplImpl::GetImplementation() const {
  return Properties::kPlatformImplementation;
}

std::unique_ptr<Sender> WinMIDIImplImpl::MakeSender(DeviceObjectImpl* object) {
  return MakeWinSender(object);
}

void WinMIDIImplImpl::PropChangedInternal(UString const& key) {
  if (owner_ != nullptr) {
    setup_.PropChanged(owner_, key);
  }
}

}  // namespace Ostinet::Impl
