// SPDX-License-Identifier: MIT
#include "platform/system/native/RtMidiSupport.h"

#include <unistd.h>

namespace Ostinet::Impl {

std::string NextWireClientName() {
  static std::atomic<unsigned> last{0};
  return kWireClientPrefix + std::to_string(getpid()) + "-" + std::to_string(++last);
}

}  // namespace Ostinet::Impl
