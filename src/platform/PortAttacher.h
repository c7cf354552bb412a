// SPDX-License-Identifier: MIT
#pragma once

#include <memory>
#include <unordered_map>

#include "model/EndpointImpl.h"
#include "platform/PortList.h"
#include "platform/Session.h"
#include "platform/WinMIDIPort.h"

namespace Ostinet::Impl {

/// Brings listed ports and direct endpoints together: opens a port and installs it in the
/// endpoint that stands for it, making that endpoint if there is none. Lives for one pass over a
/// list of ports, for which it indexes the endpoints by name once there is a port to attach.
class PortAttacher {
 public:
  PortAttacher(WinMIDISetup& setup, std::shared_ptr<Session> session);

  /// True if `endpoint`, which bears the name of `port`, stands for it: is of its kind.
  static bool IsPair(EndpointImpl const& endpoint, PortInfo const& port);

  /// Attaches the port to the first endpoint that stands for it. One that does not open is left
  /// out, and the others go on: a VantorError ends here, other exceptions travel on.
  void Attach(PortInfo const& port);

 private:
  using Index = std::unordered_map<UString, std::vector<RCPtrMT<EndpointImpl>>>;

  void IndexEndpoints();
  void AttachUnguarded(PortInfo const& port);
  RCPtrMT<EndpointImpl> Find(PortInfo const& port) const;
  void AddEndpoint(PortInfo const& port, std::unique_ptr<WinMIDIPort> peer);
  void OpenInto(WinMIDIPort& peer, PortInfo const& port) const;
  void StartInput(RCPtrMT<EndpointImpl> const& source) const;

  WinMIDISetup& setup_;
  std::shared_ptr<Session> const session_;
  Index sources_;
  Index destinations_;
  bool isIndexed_ = false;
};

}  // namespace Ostinet::Impl
