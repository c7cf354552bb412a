// SPDX-License-Identifier: MIT
#include "NameLookup.h"

#include "Errors.h"
#include "NameMatch.h"
#include "ostinet/Setup.h"

namespace Ostinet::Tool {
namespace {

/// `where` tells handles of one name apart.
template <class Handle, class Where>
Handle FindByName(std::vector<Handle> const& handles, std::string const& name,
                  std::string const& kind, Where const& where) {
  std::vector<Candidate> candidates;
  for (Handle const& handle : handles) {
    candidates.push_back({handle.GetName().string(), 0, where(handle)});
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

std::string WithoutLeadingZeros(std::string const& number) {
  std::size_t const first = number.find_first_not_of('0');
  return first != std::string::npos ? number.substr(first) : number.substr(number.size() - 1);
}

// Those of exactly this number, else those whose number differs in leading zeros alone.
std::vector<Patch> WithNumber(std::vector<Patch> const& patches, std::string const& wanted) {
  std::vector<Patch> exact;
  std::vector<Patch> alike;
  for (Patch const& patch : patches) {
    std::string const number = patch.GetNumber().string();
    if (number.empty() || wanted.empty()) {
      continue;
    }
    if (number == wanted) {
      exact.push_back(patch);
    } else if (WithoutLeadingZeros(number) == WithoutLeadingZeros(wanted)) {
      alike.push_back(patch);
    }
  }
  return exact.empty() ? alike : exact;
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

void FailIfNothingIsKept(Destination const& destination) {
  std::string const name = "\"" + destination.GetName().string() + "\"";
  if (destination.IsSoftware()) {
    throw Failure("what is chosen for " + name +
                  " cannot be kept: it is made by software, which no studio's file holds");
  }
  if (destination.IsInterface().get_value_or(false)) {
    throw Failure(name + " has no names of its own: the instruments that hang on it have");
  }
}

DestinationNameSet NameSetOf(Destination const& destination, short channel) {
  DestinationNameSet const nameSet = destination.GetCurrentNameSet(channel);
  if (nameSet.GetImplPtr() == nullptr) {
    bool const needsMode =
        destination.CountModes() > 0 && destination.GetCurrentMode().GetImplPtr() == nullptr;
    throw Failure("\"" + destination.GetName().string() + "\" has no names on channel " +
                  std::to_string(channel + 1) +
                  (needsMode ? " before a mode is chosen with ostinet mode" : ""));
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
  return FindByName(ModesOf(destination), name, "mode",
                    [](DestinationMode const&) { return std::string(); });
}

std::vector<PatchBank> BanksOf(DestinationNameSet const& nameSet) {
  std::vector<PatchBank> banks;
  for (int i = 0; i < nameSet.CountBanks(); ++i) {
    banks.push_back(nameSet.GetBank(i));
  }
  return banks;
}

std::string BankNumbersText(PatchBank const& bank) {
  constexpr unsigned char kNone = 255;
  auto const half = [](unsigned char number) {
    return number != kNone ? std::to_string(number) : std::string("-");
  };
  bool const hasNone =
      bank.GetController0Number() == kNone && bank.GetController32Number() == kNone;
  return hasNone ? std::string()
                 : half(bank.GetController0Number()) + "/" + half(bank.GetController32Number());
}

PatchBank FindBank(DestinationNameSet const& nameSet, std::string const& name) {
  std::vector<PatchBank> const banks = BanksOf(nameSet);
  std::vector<PatchBank> numbered;
  for (PatchBank const& bank : banks) {
    if (!name.empty() && BankNumbersText(bank) == name) {
      numbered.push_back(bank);
    }
  }
  return numbered.size() == 1 ? numbered.front() : FindByName(banks, name, "bank", BankNumbersText);
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
  std::vector<Patch> const numbered = WithNumber(patches, wanted);
  if (numbered.size() == 1) {
    return numbered.front();
  }
  if (!numbered.empty()) {
    throw Failure(bank.empty() ? "several banks have a patch " + wanted + ": name one with --bank"
                               : "the bank has several patches " + wanted + ": name one of them");
  }
  return FindByName(patches, wanted, "patch",
                    [](Patch const& patch) { return patch.GetBank().GetName().string(); });
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
