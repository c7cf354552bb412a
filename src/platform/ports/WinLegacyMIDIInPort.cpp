// SPDX-License-Identifier: MIT

#include "platform/ports/WinLegacyMIDIInPort.h"

#include "model/PropertyKeys.h"
#include "platform/ports/LegacyAPI.h"
#include "platform/system/WideText.h"

namespace Ostinet::Impl {

WinLegacyMIDIInPort::WinLegacyMIDIInPort(WinMIDISetup& setup, std::shared_ptr<Session> session)
    : WinMIDIImplImpl(setup, nullptr),
      session_(std::move(session)),
      device_(std::make_shared<LegacyInDevice>(session_)) {}

WinLegacyMIDIInPort::~WinLegacyMIDIInPort() { device_->Close(); }

void WinLegacyMIDIInPort::Open(UINT device, MIDIINCAPSW caps) {
  session_->GetSystem().midiInGetDevCapsW(device, &caps, sizeof caps);
  SetString(Keys::kName, TextOf(caps.szPname));
  SetInt(Keys::kWhichAPI, kLegacyAPI);
  device_->Open(device);
}

void WinLegacyMIDIInPort::Deactivate() {
  device_->Close();
  WinMIDIImplImpl::Deactivate();
}

void WinLegacyMIDIInPort::SetTarget(Source const& source, Receiver* receiver) {
  device_->SetTarget(source, receiver);
}

void WinLegacyMIDIInPort::DrainInput() {
  std::shared_ptr<LegacyInDevice> const device = device_;
  device->Drain();
}

}  // namespace Ostinet::Impl
