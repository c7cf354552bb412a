// SPDX-License-Identifier: MIT
#include "ReferenceIndex.h"

#include <algorithm>

namespace Ostinet {

namespace {

using Visitor = std::function<void(std::size_t)>;

template <class Map, class Key>
void VisitAll(Map const& map, Key const& key, Visitor const& visit) {
  auto const place = map.find(key);
  if (place != map.end()) {
    std::for_each(place->second.begin(), place->second.end(), visit);
  }
}

}  // namespace

bool ReferenceResolver::Index::SlotLess::operator()(SlotID const& a, SlotID const& b) const {
  return std::lexicographical_compare(std::begin(a.words), std::end(a.words), std::begin(b.words),
                                      std::end(b.words));
}

ReferenceResolver::Index::Index(std::vector<Source> const& sources) : sources_(sources) {
  for (Source const& source : sources) {
    Add(source, source.GetDirectSource());
  }
}

ReferenceResolver::Index::Index(std::vector<Destination> const& destinations)
    : destinations_(destinations) {
  for (Destination const& destination : destinations) {
    Add(destination, destination.GetDirectDestination());
  }
}

void ReferenceResolver::Index::Add(Endpoint const& endpoint, Endpoint const& port) {
  std::size_t const place = endpoints_.size();
  endpoints_.push_back(endpoint);
  byUniqueID_[endpoint.GetUniqueID()].push_back(place);
  byFullName_[endpoint.GetName()].push_back(place);
  byRawName_[endpoint.GetRawName()].push_back(place);
  Maker& maker = byMaker_[endpoint.GetManufacturer()];
  maker.all.push_back(place);
  maker.byModel[endpoint.GetModel()].push_back(place);
  if (!endpoint.IsDirect()) {
    byPort_[port.GetUniqueID()].push_back(place);
  }
  if (endpoint.IsInternalSoftware()) {
    bySlot_[endpoint.GetSlotID()].push_back(place);
  }
}

ReferenceResolver::Candidate ReferenceResolver::Index::CandidateAt(std::size_t place) const {
  Candidate candidate;
  candidate.endpoint = endpoints_[place];
  if (!sources_.empty()) {
    candidate.source = sources_[place];
  } else {
    candidate.destination = destinations_[place];
  }
  return candidate;
}

bool ReferenceResolver::Index::Covers(MatchLevel const& level) {
  return level.minRank > 0 && level.matchType != ObjectMatch::kGeneralMIDIMatch;
}

void ReferenceResolver::Index::Find(MatchLevel const& level, MatchContents const& contents,
                                    Visitor const& visit) const {
  switch (level.matchType) {
    case ObjectMatch::kUniqueIDMatch:
      if (contents.uniqueID != 0) {
        VisitAll(byUniqueID_, contents.uniqueID, visit);
      }
      if (contents.slot.value_or(SlotID()) != SlotID()) {
        VisitAll(bySlot_, *contents.slot, visit);
      }
      break;
    case ObjectMatch::kNameMatch:
      VisitAll(contents.nameIsFull ? byFullName_ : byRawName_, contents.name, visit);
      break;
    case ObjectMatch::kManufacturerModelMatch:
      if (!contents.model.empty()) {
        FindDevice(level.minRank, contents, visit);
      }
      break;
    case ObjectMatch::kConnectionMatch:
      if (contents.connectionUniqueID != 0) {
        VisitAll(byPort_, contents.connectionUniqueID, visit);
      }
      break;
    case ObjectMatch::kGeneralMIDIMatch:
      break;
  }
}

void ReferenceResolver::Index::FindDevice(int minRank, MatchContents const& contents,
                                          Visitor const& visit) const {
  constexpr int kSameModel = 3;
  auto const maker = byMaker_.find(contents.manufacturer);
  if (maker == byMaker_.end()) {
    return;
  }
  if (minRank >= kSameModel) {
    VisitAll(maker->second.byModel, contents.model, visit);
  } else {
    std::for_each(maker->second.all.begin(), maker->second.all.end(), visit);
  }
}

}  // namespace Ostinet
