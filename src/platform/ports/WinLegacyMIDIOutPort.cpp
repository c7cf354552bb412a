// SPDX-License-Identifier: MIT

#include "platform/ports/WinLegacyMIDIOutPort.h"

#include "datapath/SysexImpl.h"
#include "model/PropertyKeys.h"
#include "platform/ports/LegacyAPI.h"
#include "platform/system/WideText.h"

namespace Ostinet::Impl {

WinLegacyMIDIOutPort::WinLegacyMIDIOutPort(WinMIDISetup& setup, std::shared_ptr<Session> session)
    : WinMIDIImplImpl(setup, nullptr),
      session_(std::move(session)),
      device_(LegacyOutDevice::Make(session_)) {}

WinLegacyMIDIOutPort::~WinLegacyMIDIOutPort() { device_->Close(); }

void WinLegacyMIDIOutPort::Open(UINT device, MIDIOUTCAPSW caps) {
  session_->GetSystem().midiOutGetDevCapsW(device, &caps, sizeof caps);
  device_->Open(device);
  SetString(Keys::kName, TextOf(caps.szPname));
  SetInt(Keys::kWhichAPI, kLegacyAPI);
}

void WinLegacyMIDIOutPort::Deactivate() {
  device_->Close();
  WinMIDIImplImpl::Deactivate();
}

void WinLegacyMIDIOutPort::SendSysex(TimeStamp stamp, RCPtrMT<SysexImpl> const& sysex) {
  if (sysex && sysex->Size() > 0) {
    device_->SendPacket({sysex->begin(), sysex->Size(), stamp});
  }
}

}  // namespace Ostinet::Impl
