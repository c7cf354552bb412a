// SPDX-License-Identifier: MIT
#include "system/native/JackServer.h"

#include <fcntl.h>
#include <jack/jack.h>
#include <signal.h>
#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

#include <chrono>
#include <cstdlib>
#include <filesystem>
#include <thread>
#include <vector>

extern char** environ;

namespace Ostinet::Testing {
namespace {

// The directory where JACK keeps what its processes share.
constexpr char kSharedFolder[] = "/dev/shm";
constexpr auto kStartTime = std::chrono::seconds(10);

bool ServerAnswers() {
  jack_client_t* const client = jack_client_open("probe", JackNoStartServer, nullptr);
  if (client == nullptr) return false;
  jack_client_close(client);
  return true;
}

// A killed server leaves its semaphores behind.
void RemoveRemains(std::string const& server) {
  std::error_code error;
  std::vector<std::filesystem::path> remains;
  for (auto const& entry : std::filesystem::directory_iterator(kSharedFolder, error)) {
    if (entry.path().filename().string().find(server) != std::string::npos) {
      remains.push_back(entry.path());
    }
  }
  for (auto const& path : remains) std::filesystem::remove_all(path, error);
}

pid_t SpawnServer(std::string const& name) {
  std::string text[] = {"jackd", "-S", "--no-realtime", "-n", name, "-d",
                        "dummy", "-r", "48000",         "-p", "256"};
  std::vector<char*> arguments;
  for (std::string& argument : text) arguments.push_back(argument.data());
  arguments.push_back(nullptr);
  posix_spawn_file_actions_t files;
  posix_spawn_file_actions_init(&files);
  for (int output : {1, 2}) {
    posix_spawn_file_actions_addopen(&files, output, "/dev/null", O_WRONLY, 0);
  }
  pid_t process = 0;
  int const error = posix_spawnp(&process, "jackd", &files, nullptr, arguments.data(), environ);
  posix_spawn_file_actions_destroy(&files);
  return error == 0 ? process : 0;
}

}  // namespace

std::string JackServer::Start() {
  static int count = 0;
  if (name_.empty()) {
    name_ = "ostinet-test-" + std::to_string(getpid()) + "-" + std::to_string(++count);
  }
  setenv("JACK_DEFAULT_SERVER", name_.c_str(), 1);
  setenv("JACK_NO_START_SERVER", "1", 1);
  setenv("JACK_NO_AUDIO_RESERVATION", "1", 1);
  jack_set_error_function([](char const*) {});
  jack_set_info_function([](char const*) {});
  process_ = SpawnServer(name_);
  if (process_ == 0) return "jackd is not installed";
  auto const deadline = std::chrono::steady_clock::now() + kStartTime;
  while (!ServerAnswers()) {
    if (waitpid(process_, nullptr, WNOHANG) != 0) {
      process_ = 0;
      return "jackd ended at its start";
    }
    if (std::chrono::steady_clock::now() > deadline) return "jackd does not answer";
    std::this_thread::sleep_for(std::chrono::milliseconds(10));
  }
  return {};
}

void JackServer::Stop() { End(SIGTERM); }

// JACK knows at most eight servers a machine, and forgets a killed one only when a server of the
// same name starts and ends in order.
void JackServer::Kill() {
  End(SIGKILL);
  wasKilled_ = true;
}

void JackServer::End(int signal) {
  if (process_ == 0) return;
  kill(process_, signal);
  waitpid(process_, nullptr, 0);
  process_ = 0;
}

JackServer::~JackServer() {
  if (wasKilled_ && process_ == 0) Start();
  Stop();
  if (!name_.empty()) RemoveRemains(name_);
}

}  // namespace Ostinet::Testing
