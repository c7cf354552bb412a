// SPDX-License-Identifier: MIT
#include "ostinet/SystemPorts.h"

#include <memory>

#include "platform/system/System.h"
#include "platform/system/WideText.h"

namespace Ostinet {

namespace {

using Impl::System;
using Impl::TextOf;

// A driver that lists ports without end must not hang the list.
constexpr unsigned kMostSystemPorts = 65536;

SystemPort PortOfWinMM(SystemPort::Kind kind, unsigned index, MMRESULT result) {
  SystemPort port;
  port.kind = kind;
  port.index = index;
  port.error = result;
  return port;
}

void ListWinMMOutputs(System& system, std::vector<SystemPort>& ports) {
  UINT const count = system.midiOutGetNumDevs();
  for (UINT device = 0; device < count; ++device) {
    MIDIOUTCAPSW caps{};
    MMRESULT const result = system.midiOutGetDevCapsW(device, &caps, sizeof caps);
    ports.push_back(PortOfWinMM(SystemPort::kWinMMOut, device, result));
    if (result == MMSYSERR_NOERROR) {
      ports.back().name = TextOf(caps.szPname);
      ports.back().technology = caps.wTechnology;
    }
  }
}

void ListWinMMInputs(System& system, std::vector<SystemPort>& ports) {
  UINT const count = system.midiInGetNumDevs();
  for (UINT device = 0; device < count; ++device) {
    MIDIINCAPSW caps{};
    MMRESULT const result = system.midiInGetDevCapsW(device, &caps, sizeof caps);
    ports.push_back(PortOfWinMM(SystemPort::kWinMMIn, device, result));
    if (result == MMSYSERR_NOERROR) {
      ports.back().name = TextOf(caps.szPname);
    }
  }
}

struct ReleaseDirectMusic {
  void operator()(IDirectMusic* directMusic) const { directMusic->Release(); }
};

void ListDirectMusicPorts(System& system, std::vector<SystemPort>& ports) {
  IDirectMusic* made = nullptr;
  if (system.CreateDirectMusic(&made) != S_OK || made == nullptr) {
    return;
  }
  std::unique_ptr<IDirectMusic, ReleaseDirectMusic> const directMusic(made);
  for (unsigned index = 0; index < kMostSystemPorts; ++index) {
    DMUS_PORTCAPS caps{};
    caps.dwSize = sizeof caps;
    if (directMusic->EnumPort(index, &caps) != S_OK) {
      break;
    }
    SystemPort port;
    port.kind = caps.dwClass == DMUS_PC_INPUTCLASS ? SystemPort::kDirectMusicIn
                                                   : SystemPort::kDirectMusicOut;
    port.index = index;
    port.name = TextOf(caps.wszDescription);
    port.flags = caps.dwFlags;
    ports.push_back(port);
  }
}

}  // namespace

std::vector<SystemPort> ListSystemPorts() {
  std::shared_ptr<System> const system = Impl::CurrentSystem();
  std::vector<SystemPort> ports;
  ListWinMMOutputs(*system, ports);
  ListWinMMInputs(*system, ports);
  ListDirectMusicPorts(*system, ports);
  return ports;
}

}  // namespace Ostinet
