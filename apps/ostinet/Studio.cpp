// SPDX-License-Identifier: MIT
#include "Studio.h"

#include <cstdlib>
#include <exception>

#include "Errors.h"
#include "ostinet/MachineMIDI.h"
#include "ostinet/SimulatedMIDI.h"
#include "ostinet/core/Error.h"

namespace Ostinet::Tool {

void ChooseStudio(std::string const& studioFile) {
  try {
    if (studioFile.empty()) {
      SimulatedMIDI::InUse();  // Has the library choose now, where a bad file can be told.
    } else {
      SimulatedMIDI::FromFile(studioFile).Install();
    }
  } catch (VantorError const& error) {
    throw Failure(error.Text());
  } catch (std::exception const& error) {
    throw Failure(error.what());
  }
}

// The machine without MIDI runs on an empty simulated studio too, so its being simulated does not
// tell whether anybody asked for it.
std::string StudioFileAskedFor(std::string const& studioFile) {
  char const* const variable = std::getenv("OSTINET_STUDIO");
  return studioFile.empty() && variable != nullptr ? variable : studioFile;
}

std::string WhyNoMIDI(std::string const& studioFile) {
  bool const isStudio = !StudioFileAskedFor(studioFile).empty();
  std::string const why = isStudio ? std::string() : WhyNoMachineMIDI();
  return why.empty()
             ? why
             : why + " To run on a simulated studio, describe one in a file: --studio FILE.json";
}

}  // namespace Ostinet::Tool
