// SPDX-License-Identifier: MIT
//
// Arbitrary bytes as a name document. Start it on tests/corpus/name_documents.
#include <cstdlib>

#include "NameDocumentInput.h"

extern "C" int LLVMFuzzerTestOneInput(std::uint8_t const* bytes, std::size_t count) {
  if (!Ostinet::Fuzz::TryNameDocument(bytes, count)) {
    std::abort();
  }
  return 0;
}
