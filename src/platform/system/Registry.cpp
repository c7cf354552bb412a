// SPDX-License-Identifier: MIT
//
// Which system the library runs on. The choice lives until the process ends and is never taken
// apart: ports and threads that outlast static objects may still be using it.

#include "platform/system/Registry.h"

#include <mutex>
#include <string>
#include <utility>

#include "ostinet/core/Environment.h"
#include "ostinet/core/Error.h"
#include "platform/system/MachineSystem.h"
#include "platform/system/System.h"
#include "platform/system/simulated/SimulatedSystem.h"
#include "platform/system/simulated/StudioFile.h"

namespace Ostinet::Impl {

namespace {

struct Choice {
  std::mutex mutex;
  std::shared_ptr<System> installed;
  std::shared_ptr<System> automatic;
};

Choice& TheChoice() {
  static Choice* const choice = new Choice;
  return *choice;
}

// A file that was asked for and does not load is an error: other ports in its place would be a
// surprise.
std::shared_ptr<System> LoadStudio(std::string const& path) {
  auto system = std::make_shared<Simulated::SimulatedSystem>();
  try {
    Simulated::ReadStudioFile(path, system->GetStudio());
  } catch (StudioFileError const& error) {
    throw VantorError("Ostinet", "Studio", 0, error.what());
  }
  return system;
}

}  // namespace

std::shared_ptr<System> ChooseSystem(char const* studioFile) {
  if (studioFile != nullptr && *studioFile != 0) return LoadStudio(studioFile);
  if (auto machine = MakeMachineSystem()) return machine;
  return std::make_shared<Simulated::SimulatedSystem>();
}

std::shared_ptr<System> CurrentSystem() {
  Choice& choice = TheChoice();
  std::lock_guard lock(choice.mutex);
  if (choice.installed != nullptr) return choice.installed;
  if (choice.automatic == nullptr) {
    choice.automatic = ChooseSystem(EnvironmentText("OSTINET_STUDIO").string().c_str());
  }
  return choice.automatic;
}

void InstallSystem(std::shared_ptr<System> system) {
  Choice& choice = TheChoice();
  {
    std::lock_guard lock(choice.mutex);
    choice.installed.swap(system);
  }
  // What was installed before ends here, outside of the lock.
}

void UninstallSystem(System const* system) {
  Choice& choice = TheChoice();
  std::shared_ptr<System> removed;  // before the lock, so that it ends after it
  std::lock_guard lock(choice.mutex);
  if (choice.installed.get() == system) choice.installed.swap(removed);
}

}  // namespace Ostinet::Impl
