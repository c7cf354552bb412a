// SPDX-License-Identifier: MIT
#include "datapath/SysexStorage.h"

#include <mutex>
#include <utility>

#include "ostinet/core/Error.h"

namespace Ostinet::Impl {
namespace {

struct MakerHolder {
  std::mutex mutex;
  std::shared_ptr<SysexStorageMaker> maker;  // guarded by mutex
};

// Never destroyed: a host's own statics may hold references until the process ends.
MakerHolder& Makers() {
  static MakerHolder& holder = *new MakerHolder;
  return holder;
}

std::shared_ptr<SysexStorageMaker> CurrentMaker() {
  std::lock_guard const lock(Makers().mutex);
  return Makers().maker;
}

}  // namespace

void SetSysexStorageMaker(std::shared_ptr<SysexStorageMaker> maker) {
  {
    std::lock_guard const lock(Makers().mutex);
    Makers().maker.swap(maker);
  }
  // The old maker, with the session that it may hold, ends here, outside the lock.
}

std::unique_ptr<SysexStorage> MakeSysexStorage(std::size_t bufferBytes) {
  std::shared_ptr<SysexStorageMaker> const maker = CurrentMaker();
  if (!maker) {
    throw VantorError("Ostinet", "SysexRef",
                      "A sysex message needs a MIDI session, and nobody is signed in.");
  }
  return maker->Make(bufferBytes);
}

}  // namespace Ostinet::Impl
