// SPDX-License-Identifier: MIT
#pragma once

#include <string>

#include "ostinet/Export.h"

namespace Ostinet {

/// Why this machine offers no MIDI ports of its own, as one English sentence in UTF-8 for people;
/// empty where it can offer some, also when none is plugged in at present. The library itself
/// prints nothing: a host shows this text once if it wants its user to know. Looks anew at each
/// call, which takes up to a fifth of a second where a JACK server runs. [any thread]
OSTINET_EXPORT std::string WhyNoMachineMIDI();

}  // namespace Ostinet
