// SPDX-License-Identifier: MIT
#include "Output.h"

#include <cerrno>
#include <csignal>
#include <cstdio>
#include <cstring>

#include "Errors.h"

namespace Ostinet::Tool {

void PrintLine(std::string const& line) {
  std::string const text = line + "\n";
  errno = 0;
  bool const written = std::fwrite(text.data(), 1, text.size(), stdout) == text.size();
  if (written && std::fflush(stdout) == 0) {
    return;
  }
  // A closed pipe is EPIPE, or EINVAL where the system knows no other name for it.
  if (errno == EPIPE || errno == EINVAL) {
    throw OutputClosed();
  }
  throw Failure(std::string("the output cannot be written: ") + std::strerror(errno));
}

void PrintOne(bool asJSON, std::string const& json, std::vector<std::string> const& lines) {
  for (std::string const& line : asJSON ? std::vector<std::string>{json} : lines) {
    PrintLine(line);
  }
}

void Notify(std::string const& sentence) {
  std::fprintf(stderr, "ostinet: %s\n", sentence.c_str());
  std::fflush(stderr);
}

void KeepRunningOnClosedPipes() {
#ifdef SIGPIPE
  std::signal(SIGPIPE, SIG_IGN);
#endif
}

}  // namespace Ostinet::Tool
