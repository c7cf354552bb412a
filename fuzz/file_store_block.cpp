// SPDX-License-Identifier: MIT
//
// Arbitrary bytes as the saved block of written name documents.
#include <cstdlib>

#include "SavedBlockInput.h"

extern "C" int LLVMFuzzerTestOneInput(std::uint8_t const* bytes, std::size_t count) {
  if (!Ostinet::Fuzz::TryFileStoreBlock(bytes, count)) {
    std::abort();
  }
  return 0;
}
