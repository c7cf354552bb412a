// SPDX-License-Identifier: MIT
#include "NameLookup.h"

#include "Errors.h"
#include "NameMatch.h"
#include "ostinet/Setup.h"

namespace Ostinet::Tool {
namespace {

template <class Handle>
Handle FindByName(std::vector<Handle> const& handles, std::string const& name,
                  std::string const& kind) {
  std::vector<Candidate> candidates;
  for (Handle const& handle : handles) {
    candidates.push_back({handle.GetName().string(), 0});
  }
  return handles[MatchName(candidates, name, kind)];
}

std::vector<Patch> AllPatchesOf(DestinationNameSet const& nameSet, std::string const& bank) {
  if (!bank.empty()) {
    return PatchesOf(FindBank(nameSet, bank));
  }
  std::vector<Patch> patches;
  for (PatchBank const& each : BanksOf(nameSet)) {
    std::vector<Patch> const more = PatchesOf(each);
    patches.insert(patches.end(), more.begin(), more.end());
  }
  return patches;
}

std::vector<Patch> WithNumber(std::vector<Patch> const& patches, UString const& number) {
  std::vector<Patch> found;
  for (Patch const& patch : patches) {
    if (patch.GetNumber() == number) {
      found.push_back(patch);
    }
  }
  return found;
}

}  // namespace

Destination FindAnyDestination(Setup const& setup, std::string const& name) {
  std::vector<Candidate> candidates;
  for (int i = 0; i < setup.CountDestinations(); ++i) {
    Destination const destination = setup.GetDestination(i);
    candidates.push_back({destination.GetName().string(), destination.GetUniqueID()});
  }
  return setup.GetDestination(static_cast<int>(MatchName(candidates, name, "destination")));
}

short ChannelOf(int channel) {
  if (channel < 1 || channel > 16) {
    throw UsageError("a channel is a number from 1 to 16, not " + std::to_string(channel));
  }
  return static_cast<short>(channel - 1);
}

DestinationNameSet NameSetOf(Destination const& destination, short channel) {
  DestinationNameSet const nameSet = destination.GetCurrentNameSet(channel);
  if (nameSet.GetImplPtr() == nullptr) {
    throw Failure("\"" + destination.GetName().string() + "\" has no names on channel " +
                  std::to_string(channel + 1));
  }
  return nameSet;
}

std::vector<DestinationMode> ModesOf(Destination const& destination) {
  std::vector<DestinationMode> modes;
  for (int i = 0; i < destination.CountModes(); ++i) {
    modes.push_back(destination.GetMode(i));
  }
  return modes;
}

DestinationMode FindMode(Destination const& destination, std::string const& name) {
  return FindByName(ModesOf(destination), name, "mode");
}

std::vector<PatchBank> BanksOf(DestinationNameSet const& nameSet) {
  std::vector<PatchBank> banks;
  for (int i = 0; i < nameSet.CountBanks(); ++i) {
    banks.push_back(nameSet.GetBank(i));
  }
  return banks;
}

PatchBank FindBank(DestinationNameSet const& nameSet, std::string const& name) {
  return FindByName(BanksOf(nameSet), name, "bank");
}

std::vector<Patch> PatchesOf(PatchBank const& bank) {
  std::vector<Patch> patches;
  for (int i = 0; i < bank.CountPatches(); ++i) {
    patches.push_back(bank.GetPatch(i));
  }
  return patches;
}

Patch FindPatch(DestinationNameSet const& nameSet, std::string const& wanted,
                std::string const& bank) {
  std::vector<Patch> const patches = AllPatchesOf(nameSet, bank);
  std::vector<Patch> const numbered = WithNumber(patches, UString(wanted));
  if (numbered.size() == 1) {
    return numbered.front();
  }
  if (!numbered.empty()) {
    throw Failure("several banks have a patch " + wanted + ": name one with --bank");
  }
  return FindByName(patches, wanted, "patch");
}

Patch FindPatchToShow(Destination const& destination, short channel, std::string const& wanted,
                      std::string const& bank) {
  DestinationNameSet const nameSet = NameSetOf(destination, channel);
  if (!wanted.empty()) {
    return FindPatch(nameSet, wanted, bank);
  }
  Patch const playing = destination.GetCurrentPatch(channel);
  if (playing.GetImplPtr() != nullptr) {
    return playing;
  }
  std::vector<Patch> const patches = AllPatchesOf(nameSet, bank);
  if (patches.empty()) {
    throw Failure("\"" + destination.GetName().string() + "\" has no patches on channel " +
                  std::to_string(channel + 1));
  }
  return patches.front();
}

}  // namespace Ostinet::Tool
