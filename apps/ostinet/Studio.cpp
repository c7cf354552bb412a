// SPDX-License-Identifier: MIT
#include "Studio.h"

#include <exception>

#include "Errors.h"
#include "ostinet/MachineMIDI.h"
#include "ostinet/SimulatedMIDI.h"

namespace Ostinet::Tool {

void ChooseStudio(std::string const& studioFile) {
  try {
    if (studioFile.empty()) {
      SimulatedMIDI::InUse();  // Has the library choose now, where a bad file can be told.
    } else {
      SimulatedMIDI::FromFile(studioFile).Install();
    }
  } catch (std::exception const& error) {
    throw Failure(error.what());
  }
}

std::string WhyNoMIDI() {
  std::string const why = WhyNoMachineMIDI();
  if (why.empty() || !SimulatedMIDI::InUse().IsNull()) {
    return {};
  }
  return why + " To run on a simulated studio, give a description of one: --studio FILE.json";
}

}  // namespace Ostinet::Tool
