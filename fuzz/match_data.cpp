// SPDX-License-Identifier: MIT
//
// Arbitrary bytes as a reference. Start it on tests/corpus/match_data.
#include <cstdlib>

#include "MatchDataInput.h"

extern "C" int LLVMFuzzerTestOneInput(std::uint8_t const* bytes, std::size_t count) {
  if (!Ostinet::Fuzz::TryMatchData(bytes, count)) {
    std::abort();
  }
  return 0;
}
