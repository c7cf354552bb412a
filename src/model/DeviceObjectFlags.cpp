// SPDX-License-Identifier: MIT
//
// DeviceObject: what a thing is, understands and sends. A flag is stored as 0 or 1; a null handle
// has none, whatever the default.
#include "model/Handles.h"
#include "model/PropertyKeys.h"

namespace Ostinet {

namespace Keys = Impl::Keys;
using Impl::ImplOf;

namespace {

bool GetFlag(DeviceObject const& handle, UString const& key, bool fallback) {
  Impl::DeviceObjectImpl const* const impl = ImplOf(handle);
  return impl != nullptr && impl->GetInt(key, fallback ? 1 : 0) != 0;
}

void SetFlag(DeviceObject const& handle, UString const& key, bool value) {
  if (Impl::DeviceObjectImpl* const impl = ImplOf(handle)) {
    impl->Peer()->SetInt(key, value ? 1 : 0);
  }
}

}  // namespace

bool DeviceObject::IsADrumMachine() const { return GetFlag(*this, Keys::kIsDrumMachine, false); }
void DeviceObject::SetIsADrumMachine(bool value) const {
  SetFlag(*this, Keys::kIsDrumMachine, value);
}

bool DeviceObject::IsAMixer() const { return GetFlag(*this, Keys::kIsMixer, false); }
void DeviceObject::SetIsAMixer(bool value) const { SetFlag(*this, Keys::kIsMixer, value); }

bool DeviceObject::IsASampler() const { return GetFlag(*this, Keys::kIsSampler, false); }
void DeviceObject::SetIsASampler(bool value) const { SetFlag(*this, Keys::kIsSampler, value); }

bool DeviceObject::IsAnEffectsUnit() const { return GetFlag(*this, Keys::kIsEffectUnit, false); }
void DeviceObject::SetIsAnEffectsUnit(bool value) const {
  SetFlag(*this, Keys::kIsEffectUnit, value);
}

bool DeviceObject::ReceivesBankSelect0() const {
  return GetFlag(*this, Keys::kReceivesBankSelectMSB, false);
}
void DeviceObject::SetReceivesBankSelect0(bool value) const {
  SetFlag(*this, Keys::kReceivesBankSelectMSB, value);
}

bool DeviceObject::ReceivesBankSelect32() const {
  return GetFlag(*this, Keys::kReceivesBankSelectLSB, false);
}
void DeviceObject::SetReceivesBankSelect32(bool value) const {
  SetFlag(*this, Keys::kReceivesBankSelectLSB, value);
}

bool DeviceObject::ReceivesClock() const { return GetFlag(*this, Keys::kReceivesClock, false); }
void DeviceObject::SetReceivesClock(bool value) const {
  SetFlag(*this, Keys::kReceivesClock, value);
}

bool DeviceObject::ReceivesMTC() const { return GetFlag(*this, Keys::kReceivesMTC, false); }
void DeviceObject::SetReceivesMTC(bool value) const { SetFlag(*this, Keys::kReceivesMTC, value); }

bool DeviceObject::ReceivesNotes() const { return GetFlag(*this, Keys::kReceivesNotes, true); }
void DeviceObject::SetReceivesNotes(bool value) const {
  SetFlag(*this, Keys::kReceivesNotes, value);
}

bool DeviceObject::ReceivesProgramChange() const {
  return GetFlag(*this, Keys::kReceivesProgramChanges, true);
}
void DeviceObject::SetReceivesProgramChange(bool value) const {
  SetFlag(*this, Keys::kReceivesProgramChanges, value);
}

bool DeviceObject::TransmitsBankSelect0() const {
  return GetFlag(*this, Keys::kTransmitsBankSelectMSB, false);
}
void DeviceObject::SetTransmitsBankSelect0(bool value) const {
  SetFlag(*this, Keys::kTransmitsBankSelectMSB, value);
}

bool DeviceObject::TransmitsBankSelect32() const {
  return GetFlag(*this, Keys::kTransmitsBankSelectLSB, false);
}
void DeviceObject::SetTransmitsBankSelect32(bool value) const {
  SetFlag(*this, Keys::kTransmitsBankSelectLSB, value);
}

bool DeviceObject::TransmitsClock() const { return GetFlag(*this, Keys::kTransmitsClock, false); }
void DeviceObject::SetTransmitsClock(bool value) const {
  SetFlag(*this, Keys::kTransmitsClock, value);
}

bool DeviceObject::TransmitsMTC() const { return GetFlag(*this, Keys::kTransmitsMTC, false); }
void DeviceObject::SetTransmitsMTC(bool value) const { SetFlag(*this, Keys::kTransmitsMTC, value); }

bool DeviceObject::TransmitsNotes() const { return GetFlag(*this, Keys::kTransmitsNotes, true); }
void DeviceObject::SetTransmitsNotes(bool value) const {
  SetFlag(*this, Keys::kTransmitsNotes, value);
}

bool DeviceObject::TransmitsProgramChange() const {
  return GetFlag(*this, Keys::kTransmitsProgramChanges, true);
}
void DeviceObject::SetTransmitsProgramChange(bool value) const {
  SetFlag(*this, Keys::kTransmitsProgramChanges, value);
}

bool DeviceObject::SupportsGeneralMIDI() const {
  return GetFlag(*this, Keys::kSupportsGeneralMIDI, false);
}
void DeviceObject::SetSupportsGeneralMIDI(bool value) const {
  SetFlag(*this, Keys::kSupportsGeneralMIDI, value);
}

bool DeviceObject::SupportsMMC() const { return GetFlag(*this, Keys::kSupportsMMC, false); }
void DeviceObject::SetSupportsMMC(bool value) const { SetFlag(*this, Keys::kSupportsMMC, value); }

bool Device::IsOpenInMIDIMonitor() const {
  return GetFlag(*this, Keys::kIsOpenInMIDIMonitor, false);
}

void Device::OpenInMIDIMonitor(bool open) const {
  SetFlag(*this, Keys::kIsOpenInMIDIMonitor, open);
}

}  // namespace Ostinet
