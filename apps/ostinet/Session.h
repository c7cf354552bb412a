// SPDX-License-Identifier: MIT
#pragma once

#include <functional>
#include <memory>
#include <optional>
#include <string>

#include "VirtualEndpoints.h"
#include "ostinet/Setup.h"
#include "ostinet/hostkit/FolderPrefs.h"
#include "ostinet/hostkit/HostCallbacks.h"
#include "ostinet/hostkit/PollLoop.h"

namespace Ostinet::Tool {

/// What may stand before or behind any command.
struct GlobalOptions {
  bool json = false;
  std::string studio;    ///< a studio file; empty: the one of OSTINET_STUDIO, else the machine
  std::string settings;  ///< a folder; empty: the user's own
};

/// The studio, signed in for as long as this lives, with the user's virtual endpoints in it. Its
/// end saves nothing: a command that only looks or plays must not write over what another program
/// has edited meanwhile. A command that edits calls Save.
///
/// Threads      The main thread, which runs the loop.
/// Errors       Failure, with one sentence for people.
class Session : private Noncopyable<Session> {
 public:
  /// `receiver` and `listener` may be null and outlive this.
  Session(GlobalOptions const& options, Receiver* receiver, SetupListener* listener);
  ~Session();

  Setup& GetSetup() const { return Setup::Instance(); }

  /// The user's virtual endpoints, to be edited.
  VirtualEndpoints& GetVirtualEndpoints() { return virtualEndpoints_; }

  /// What the first failure to read or write the settings said; empty while all went well.
  std::string SettingsFault() const;

  /// Signs out and keeps what was edited: the last thing that a command does. Throws Failure where
  /// it could not be kept; the files are then as they were.
  void Save();

  /// Runs the studio until `goOn` returns false or Ctrl-C is pressed. `goOn` is asked every few
  /// milliseconds; what it throws ends the run and travels on.
  void Run(std::function<bool()> const& goOn);

  /// Runs the studio for that long, or until Ctrl-C is pressed.
  void RunFor(PollLoop::Duration duration);

 private:
  void SignIn(Receiver* receiver, SetupListener* listener);
  File FileInSettings(char const* name) const;
  void FailIfSettingsFailed() const;
  void LookForDamage();

  std::unique_ptr<FolderPrefs> prefs_;
  PollLoop loop_;
  HostCallbacks callbacks_;
  VirtualEndpoints virtualEndpoints_;
  std::string damage_;  // a sentence, where the studio's file cannot be read to its end
};

/// The folder of the settings: the one that was named, else the user's own. An invalid folder where
/// the user has none.
Folder SettingsFolder(GlobalOptions const& options);

/// When a command that listens ends by itself.
struct Limits {
  std::optional<double> seconds;
  std::optional<long long> count;

  bool AreReached(PollLoop::Clock::time_point start, long long printed) const;
};

}  // namespace Ostinet::Tool
