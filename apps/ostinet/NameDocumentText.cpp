// SPDX-License-Identifier: MIT
#include "NameDocumentText.h"

#include "StudioText.h"

namespace Ostinet::Tool {
namespace {

constexpr unsigned char kNoNumber = 255;

std::string BankNumbers(PatchBank const& bank) {
  std::string text;
  if (bank.GetController0Number() != kNoNumber) {
    text += "  MSB " + std::to_string(bank.GetController0Number());
  }
  if (bank.GetController32Number() != kNoNumber) {
    text += "  LSB " + std::to_string(bank.GetController32Number());
  }
  return text;
}

std::string ModeLine(DestinationMode const& mode) {
  std::string text = "  " + mode.GetName().string();
  for (int channel = 0; channel < kChannels; ++channel) {
    DestinationNameSet const nameSet = mode.GetNameSet(static_cast<short>(channel));
    if (nameSet.GetImplPtr() == nullptr) {
      continue;
    }
    unsigned short mask = 0;
    for (int index = 0; index < nameSet.CountModes(); ++index) {
      auto const [user, channels] = nameSet.GetMode(index);
      mask = user == mode ? channels : mask;
    }
    bool const isFirstOfSet = (mask & ((1U << channel) - 1)) == 0;
    if (isFirstOfSet) {
      text += "  [" + ChannelsText(mask) + ": " + nameSet.GetName().string() + "]";
    }
  }
  return text;
}

void AddNameSet(DestinationNameSet const& nameSet, std::vector<std::string>& lines) {
  lines.push_back("  " + nameSet.GetName().string() + "  (channels " +
                  ChannelsText(nameSet.GetChannels()) + ")");
  for (int i = 0; i < nameSet.CountBanks(); ++i) {
    PatchBank const bank = nameSet.GetBank(i);
    lines.push_back("    " + bank.GetName().string() + BankNumbers(bank));
    for (int k = 0; k < bank.CountPatches(); ++k) {
      lines.push_back("      " + bank.GetPatch(k).GetNumberAndName().string());
    }
  }
}

}  // namespace

std::vector<std::string> NameDocumentLines(NameDocument const& document) {
  std::vector<std::string> lines{"Modes"};
  for (int i = 0; i < document.CountModes(); ++i) {
    lines.push_back(ModeLine(document.GetMode(i)));
  }
  for (int i = 0; i < document.CountSupportedStandardModes(); ++i) {
    lines.push_back("  " + document.GetSupportedStandardMode(i).string() + "  (standard)");
  }
  lines.emplace_back("Name sets");
  for (int i = 0; i < document.CountNameSets(); ++i) {
    AddNameSet(document.GetNameSet(i), lines);
  }
  return lines;
}

std::vector<std::string> NameCheckLines(CheckedNameDocument const& file) {
  std::vector<std::string> lines;
  for (NameDocumentFinding const& finding : file.check.findings) {
    std::string const place = finding.line > 0 ? ":" + std::to_string(finding.line) : "";
    lines.push_back(file.path + place + ": " + finding.text.string());
  }
  lines.push_back(file.path + (!file.check.isWellFormed ? ": cannot be read"
                               : file.check.isStandard  ? ": as the standard wants it"
                                                        : ": not as the standard wants it"));
  return lines;
}

}  // namespace Ostinet::Tool
