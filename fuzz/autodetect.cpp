// SPDX-License-Identifier: MIT
//
// Arbitrary bytes as an autodetect file. Start it on tests/corpus/autodetect.
#include <cstdlib>

#include "AutodetectInput.h"

extern "C" int LLVMFuzzerTestOneInput(std::uint8_t const* bytes, std::size_t count) {
  if (!Ostinet::Fuzz::TryAutodetectFile(bytes, count)) {
    std::abort();
  }
  return 0;
}
