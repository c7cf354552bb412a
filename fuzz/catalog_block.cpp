// SPDX-License-Identifier: MIT
//
// Arbitrary bytes as the saved block of the names catalog.
#include <cstdlib>

#include "SavedBlockInput.h"

extern "C" int LLVMFuzzerTestOneInput(std::uint8_t const* bytes, std::size_t count) {
  if (!Ostinet::Fuzz::TryCatalogBlock(bytes, count)) {
    std::abort();
  }
  return 0;
}
