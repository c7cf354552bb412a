// SPDX-License-Identifier: MIT
#pragma once

#include <atomic>
#include <memory>

#include "platform/Session.h"
#include "platform/WinMIDIImplImpl.h"

namespace Ostinet::Impl {

/// An open DirectMusic port, shared by its port object and by senders. A sender that outlives the
/// port object finds it closed and sends nothing.
struct DMusLine {
  DMusLine(std::shared_ptr<Session> s, ComPtr<IDirectMusicPort> p)
      : session(std::move(s)), port(std::move(p)) {}

  std::shared_ptr<Session> const session;
  ComPtr<IDirectMusicPort> const port;
  std::atomic<bool> isOpen{true};  // cleared on the polling thread, read by senders on any
};

/// A port of DirectMusic, of either direction.
class WinDMusMIDIPort : public WinMIDIImplImpl {
 public:
  WinDMusMIDIPort(WinMIDISetup& setup, std::shared_ptr<Session> session);
  ~WinDMusMIDIPort() override;

  /// Throws a VantorError when the system cannot make or start the port.
  virtual void Open(DMUS_PORTCAPS const& caps);
  void Deactivate() override;
  /// The system's port, for the platform's implementation only.
  void* GetImplObjRef(Properties::Implementation implementation) const override;

  /// Null while closed.
  std::shared_ptr<DMusLine> const& Line() const { return line_; }

 protected:
  std::shared_ptr<Session> const& GetSession() const { return session_; }
  /// Null while closed.
  IDirectMusicPort* Port() const { return line_ ? line_->port.get() : nullptr; }

 private:
  std::shared_ptr<Session> const session_;
  std::shared_ptr<DMusLine> line_;
};

}  // namespace Ostinet::Impl
