// SPDX-License-Identifier: MIT
#pragma once

#include <string>
#include <vector>

#include "ostinet/NamesCatalog.h"

namespace Ostinet {
class Setup;
}

namespace Ostinet::Tool {

// From what users type to modes, banks and patches. Each throws Failure where nothing fits, or more
// than one thing does.

/// The destination of that name, online or not.
Destination FindAnyDestination(Setup const& setup, std::string const& name);

/// A channel as people count, 1 to 16, as the library does. Throws UsageError for any other.
short ChannelOf(int channel);

/// Throws Failure where nothing that is chosen for the destination would be there the next time.
void FailIfNothingIsKept(Destination const& destination);

/// The names of a channel; throws Failure where it has none.
DestinationNameSet NameSetOf(Destination const& destination, short channel);

std::vector<DestinationMode> ModesOf(Destination const& destination);
DestinationMode FindMode(Destination const& destination, std::string const& name);

std::vector<PatchBank> BanksOf(DestinationNameSet const& nameSet);
/// "87/64", or "87/-" and "-/64" with half of it; empty for a bank without numbers.
std::string BankNumbersText(PatchBank const& bank);
/// By its numbers, as that text, or by its name.
PatchBank FindBank(DestinationNameSet const& nameSet, std::string const& name);

std::vector<Patch> PatchesOf(PatchBank const& bank);
/// By number or name, in all banks or, unless `bank` is empty, in the one that it means.
Patch FindPatch(DestinationNameSet const& nameSet, std::string const& wanted,
                std::string const& bank);

/// The patch that is asked for, else the one that plays, else the first there is.
Patch FindPatchToShow(Destination const& destination, short channel, std::string const& wanted,
                      std::string const& bank);

}  // namespace Ostinet::Tool
