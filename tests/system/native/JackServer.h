// SPDX-License-Identifier: MIT
#pragma once

#include <sys/types.h>

#include <string>

namespace Ostinet::Testing {

/// A JACK server of its own, without sound, that this process's clients find by themselves while it
/// stands.
class JackServer {
 public:
  JackServer() = default;
  ~JackServer();
  JackServer(JackServer const&) = delete;
  JackServer& operator=(JackServer const&) = delete;

  /// Empty once clients can connect, else why they cannot.
  std::string Start();
  /// Lets it end in its own way.
  void Stop();
  /// Ends it in the middle of whatever it does.
  void Kill();

 private:
  void End(int signal);

  pid_t process_ = 0;
  std::string name_;
  bool wasKilled_ = false;
};

}  // namespace Ostinet::Testing
