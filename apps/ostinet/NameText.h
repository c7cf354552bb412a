// SPDX-License-Identifier: MIT
#pragma once

#include <string>
#include <vector>

#include "ostinet/NameDocument.h"

namespace Ostinet::Tool {

// Names as lines for people and as JSON for scripts. docs/tool.md lists the keys: more may come,
// but none goes.

std::vector<std::string> NamesLines(Destination const& destination);
std::string NamesJSON(Destination const& destination);

/// What `names list` prints.
std::vector<std::string> OffersLines(std::vector<NameDocumentOffer> const& offers);
std::string OffersJSON(std::vector<NameDocumentOffer> const& offers);

std::vector<std::string> ModesLines(Destination const& destination);
std::string ModesJSON(Destination const& destination);

std::vector<std::string> BanksLines(std::vector<PatchBank> const& banks);
std::string BanksJSON(std::vector<PatchBank> const& banks);

std::vector<std::string> PatchesLines(std::vector<PatchBank> const& banks);
std::string PatchesJSON(std::vector<PatchBank> const& banks);

std::vector<std::string> NotesLines(Patch const& patch);
std::string NotesJSON(Patch const& patch);

std::vector<std::string> ControlsLines(Patch const& patch);
std::string ControlsJSON(Patch const& patch);

/// One patch, with its bank.
std::string PatchJSON(Patch const& patch);
std::string NoteJSON(int pitch, std::string const& name);
/// "1 Piano (Preset)".
std::string PatchText(Patch const& patch);

}  // namespace Ostinet::Tool
