// SPDX-License-Identifier: MIT
#include "VirtualEndpoints.h"

#include <algorithm>
#include <utility>

#include "Errors.h"
#include "JsonText.h"
#include "Lookup.h"
#include "ReferenceText.h"

// The file:
//
//   {"virtual": [{"name": "Loop", "public": "source", "reference": "0000..."}]}
//
// "public" is the end that shows, source or destination. "name" is for readers: the reference holds
// it too.

namespace Ostinet::Tool {
namespace {

char const* WordOf(Setup::SrcOrDest end) {
  return end == Setup::kSourceEnd ? "source" : "destination";
}

Setup::SrcOrDest EndOf(std::string const& word) {
  if (word != "source" && word != "destination") {
    throw Failure("\"public\" is source or destination, not \"" + word + "\"");
  }
  return word == "source" ? Setup::kSourceEnd : Setup::kDestinationEnd;
}

VirtualEndpoints::Kept KeptOf(Json const& entry) {
  return {EndOf(entry.at("public").get<std::string>()),
          ParseReference(entry.at("reference").get<std::string>())};
}

Endpoint Shown(std::pair<Source, Destination> const& pair, Setup::SrcOrDest publicEnd) {
  return publicEnd == Setup::kSourceEnd ? Endpoint(pair.first) : Endpoint(pair.second);
}

}  // namespace

void VirtualEndpoints::Load(File const& file) {
  if (!file.IsFile()) {
    return;
  }
  try {
    Json const content = Json::parse(file.Read());
    for (Json const& entry : content.at("virtual")) {
      loaded_.push_back(KeptOf(entry));
    }
  } catch (std::exception const& error) {
    throw Failure("the virtual endpoints in \"" + file.GetFullPath().string() +
                  "\" cannot be read: " + error.what());
  }
}

void VirtualEndpoints::Make(Setup& setup) {
  for (Kept const& kept : std::exchange(loaded_, {})) {
    Endpoint const shown =
        Shown(setup.CreateVirtualEndpoint(kept.reference, kept.publicEnd, kept.publicEnd),
              kept.publicEnd);
    if (shown.Exists()) {
      pairs_.push_back({kept, shown});
    }
  }
}

void VirtualEndpoints::Save(File const& file) const {
  if (!isEdited_) {
    return;
  }
  Json list = Json::array();
  for (Pair const& pair : pairs_) {
    list.push_back({{"name", pair.kept.reference.GetObjectName().string()},
                    {"public", WordOf(pair.kept.publicEnd)},
                    {"reference", ReferenceText(pair.kept.reference)}});
  }
  Json const content = {{"virtual", list}};
  std::string const text = JsonText(content) + "\n";
  try {
    file.Replace(text.data(), text.size());
  } catch (std::exception const& error) {
    throw Failure("the virtual endpoints could not be kept in \"" + file.GetFullPath().string() +
                  "\": " + error.what());
  }
}

Endpoint VirtualEndpoints::Add(Setup& setup, UString const& name, Setup::SrcOrDest publicEnd) {
  Endpoint const shown = Shown(setup.CreateVirtualEndpoint(name, publicEnd, publicEnd), publicEnd);
  pairs_.push_back({{publicEnd, shown.GetMatchData()}, shown});
  isEdited_ = true;
  return shown;
}

Endpoint VirtualEndpoints::Find(std::string const& name) const {
  std::vector<Endpoint> shown;
  for (Pair const& pair : pairs_) {
    shown.push_back(pair.shown);
  }
  return Tool::Find(shown, name, "virtual endpoint");
}

void VirtualEndpoints::Remove(Setup& setup, Endpoint const& shown) {
  setup.DeleteVirtualEndpoint(shown);
  pairs_.erase(std::remove_if(pairs_.begin(), pairs_.end(),
                              [&](Pair const& pair) { return pair.shown == shown; }),
               pairs_.end());
  isEdited_ = true;
}

}  // namespace Ostinet::Tool
