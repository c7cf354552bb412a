// SPDX-License-Identifier: MIT
#pragma once

#include <string>
#include <vector>

#include "ostinet/NamesCatalog.h"

namespace Ostinet::Tool {

// Names as lines for people and as JSON for scripts. docs/tool.md lists the keys: more may come,
// but none goes.

/// What `names list` prints.
struct CatalogView {
  std::vector<Names> documents;  ///< masters, overriding lists and standard modes
};

std::vector<std::string> NamesLines(Destination const& destination);
std::string NamesJSON(Destination const& destination);

std::vector<std::string> CatalogLines(CatalogView const& view);
std::string CatalogJSON(CatalogView const& view);

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
