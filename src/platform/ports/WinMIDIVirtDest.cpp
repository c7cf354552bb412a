// SPDX-License-Identifier: MIT

#include "platform/ports/WinMIDIVirtDest.h"

#include "datapath/SysexImpl.h"

namespace Ostinet::Impl {

bool WinMIDIVirtDest::SetFile(UString const& key, UString const& path) {
  auto* const source = GetParentSSImplImpl();
  return source != nullptr ? source->SetFile(key, path) : WinMIDIImplImpl::SetFile(key, path);
}

bool WinMIDIVirtDest::SetDict(UString const& key, PropertyDict const& value) {
  auto* const source = GetParentSSImplImpl();
  return source != nullptr ? source->SetDict(key, value) : WinMIDIImplImpl::SetDict(key, value);
}

bool WinMIDIVirtDest::SetIntList(UString const& key, std::vector<int> const& value) {
  auto* const source = GetParentSSImplImpl();
  return source != nullptr ? source->SetIntList(key, value)
                           : WinMIDIImplImpl::SetIntList(key, value);
}

bool WinMIDIVirtDest::SetString(UString const& key, UString const& value) {
  auto* const source = GetParentSSImplImpl();
  return source != nullptr ? source->SetString(key, value) : WinMIDIImplImpl::SetString(key, value);
}

bool WinMIDIVirtDest::SetInt(UString const& key, int value) {
  auto* const source = GetParentSSImplImpl();
  return source != nullptr ? source->SetInt(key, value) : WinMIDIImplImpl::SetInt(key, value);
}

void WinMIDIVirtDest::RemoveProperty(UString const& key) {
  auto* const source = GetParentSSImplImpl();
  if (source != nullptr) {
    source->RemoveProperty(key);
  } else {
    WinMIDIImplImpl::RemoveProperty(key);
  }
}

void WinMIDIVirtDest::SendSysex(TimeStamp stamp, RCPtrMT<SysexImpl> const& sysex) {
  if (sysex && sysex->Size() > 0) {
    queue_->Enqueue(stamp, sysex);
  }
}

}  // namespace Ostinet::Impl
