// SPDX-License-Identifier: MIT

#include "platform/ports/WinDMusMIDIPort.h"

#include "model/PropertyKeys.h"
#include "ostinet/core/Error.h"
#include "platform/PortList.h"

namespace Ostinet::Impl {

namespace {

// What "which API" says of a DirectMusic port.
constexpr int kNativePort = 0;
constexpr int kEmulatedPort = 1;

ComPtr<IDirectMusicPort> CreatePort(IDirectMusic& directMusic, DMUS_PORTCAPS const& caps) {
  DMUS_PORTPARAMS8 params{};
  params.dwSize = sizeof params;
  params.dwValidParams = DMUS_PORTPARAMS_CHANNELGROUPS | DMUS_PORTPARAMS_SHARE;
  params.dwChannelGroups = 1;
  params.fShare = TRUE;
  ComPtr<IDirectMusicPort> port;
  FailCOMError(directMusic.CreatePort(caps.guidPort, &params, port.Receive(), nullptr));
  FailCOMError(port->Activate(TRUE));
  return port;
}

}  // namespace

WinDMusMIDIPort::WinDMusMIDIPort(WinMIDISetup& setup, std::shared_ptr<Session> session)
    : WinMIDIImplImpl(setup, nullptr), session_(std::move(session)) {}

WinDMusMIDIPort::~WinDMusMIDIPort() {
  if (line_) {
    line_->isOpen = false;
  }
}

void WinDMusMIDIPort::Open(DMUS_PORTCAPS const& caps) {
  DMusPortName const port = NameOfPort(caps);
  SetString(Keys::kName, port.name);
  if ((caps.dwFlags & (DMUS_PC_DLS | DMUS_PC_GMINHARDWARE)) != 0) {
    SetInt(Keys::kSupportsGeneralMIDI, 1);
  }
  SetInt(Keys::kWhichAPI, port.isEmulated ? kEmulatedPort : kNativePort);
  line_ = std::make_shared<DMusLine>(session_, CreatePort(*session_->DirectMusic().get(), caps));
}

void WinDMusMIDIPort::Deactivate() {
  if (line_) {
    line_->isOpen = false;
    line_->port->Activate(FALSE);
    line_.reset();
  }
  WinMIDIImplImpl::Deactivate();
}

void* WinDMusMIDIPort::GetImplObjRef(Properties::Implementation implementation) const {
  return implementation == Properties::kPlatformImplementation ? Port() : nullptr;
}

}  // namespace Ostinet::Impl
