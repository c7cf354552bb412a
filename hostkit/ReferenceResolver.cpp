// SPDX-License-Identifier: MIT
//
// Ranking an endpoint is cheap, but a studio of a thousand times a document of a thousand is not.
// So the lists of the index are asked one criterion after the other, the heaviest first. An
// endpoint that no list gave so far can reach no more than the weight of the criteria still to
// come: when that is less than what the last of the wanted candidates has, the rest is left out.
#include "ostinet/hostkit/ReferenceResolver.h"

#include <algorithm>
#include <array>
#include <iterator>
#include <utility>

#include "ReferenceIndex.h"
#include "ostinet/Setup.h"

namespace Ostinet {

namespace {

using Criterion = ObjectMatch::MatchType;
constexpr std::array<Criterion, 5> kCriteria = {
    ObjectMatch::kUniqueIDMatch, ObjectMatch::kNameMatch, ObjectMatch::kManufacturerModelMatch,
    ObjectMatch::kConnectionMatch, ObjectMatch::kGeneralMIDIMatch};

bool Counts(MatchLevel const& level, ObjectMatch const& match) {
  return match.HasValidRank(level.matchType) && match.GetRank(level.matchType) >= level.minRank;
}

int WeightOf(std::vector<MatchLevel> const& levels, ObjectMatch const& match) {
  int weight = 0;
  for (MatchLevel const& level : levels) {
    weight += Counts(level, match) ? level.weight : 0;
  }
  return weight;
}

// Each criterion once: those of the levels first, in their order.
std::vector<Criterion> FinerCriteria(std::vector<MatchLevel> const& levels) {
  std::vector<Criterion> criteria;
  auto const add = [&](Criterion criterion) {
    if (std::find(criteria.begin(), criteria.end(), criterion) == criteria.end()) {
      criteria.push_back(criterion);
    }
  };
  for (MatchLevel const& level : levels) {
    add(level.matchType);
  }
  std::for_each(kCriteria.begin(), kCriteria.end(), add);
  return criteria;
}

// What a criterion can add to a total at most.
struct Group {
  std::vector<MatchLevel> levels;
  int weight = 0;
};

// The levels that add weight, by criterion, the heaviest first.
std::vector<Group> GroupsOf(std::vector<MatchLevel> const& levels) {
  std::array<Group, kCriteria.size()> byCriterion;
  for (MatchLevel const& level : levels) {
    if (level.weight > 0) {
      Group& group = byCriterion[static_cast<std::size_t>(level.matchType)];
      group.levels.push_back(level);
      group.weight += level.weight;
    }
  }
  std::vector<Group> groups;
  std::copy_if(byCriterion.begin(), byCriterion.end(), std::back_inserter(groups),
               [](Group const& group) { return group.weight > 0; });
  std::stable_sort(groups.begin(), groups.end(),
                   [](Group const& a, Group const& b) { return a.weight > b.weight; });
  return groups;
}

}  // namespace

/// The endpoints considered for one reference.
class ReferenceResolver::Ranking {
 public:
  Ranking(Index const& index, MatchData const& reference, std::vector<MatchLevel> const& levels,
          std::size_t runnersUp)
      : index_(index),
        reference_(reference),
        levels_(levels),
        finer_(FinerCriteria(levels)),
        runnersUp_(runnersUp),
        seen_(index.Count()) {}

  void Consider(std::size_t place) {
    if (seen_[place]) {
      return;
    }
    seen_[place] = true;
    ObjectMatch const match = index_.At(place).MatchToData(reference_);
    int const weight = WeightOf(levels_, match);
    if (weight > 0) {
      entries_.push_back({place, weight, match});
    }
  }

  /// True if no endpoint of a total up to `weight` can change the answer.
  bool IsSettledAgainst(int weight) {
    Sort();
    std::size_t const wanted = CountBest() + runnersUp_;
    return !entries_.empty() && entries_.size() >= wanted && entries_[wanted - 1].weight > weight;
  }

  Answer Finish() {
    Sort();
    Answer answer;
    std::size_t const best = CountBest();
    answer.outcome = best == 0   ? Outcome::kNotFound
                     : best == 1 ? Outcome::kFound
                                 : Outcome::kAmbiguous;
    for (std::size_t i = 0; i < std::min(entries_.size(), best + runnersUp_); ++i) {
      (i < best ? answer.best : answer.runnersUp).push_back(CandidateOf(entries_[i]));
    }
    return answer;
  }

 private:
  struct Entry {
    std::size_t place;
    int weight;
    ObjectMatch match;
  };

  // Below, at or above 0, as `a` fits better, as well or worse. What was not examined counts as
  // not alike: it is no lower grade.
  int Compare(Entry const& a, Entry const& b) const {
    if (a.weight != b.weight) {
      return a.weight > b.weight ? -1 : 1;
    }
    for (Criterion const criterion : finer_) {
      int const rankA = std::max(a.match.GetRank(criterion), 0);
      int const rankB = std::max(b.match.GetRank(criterion), 0);
      if (rankA != rankB) {
        return rankA > rankB ? -1 : 1;
      }
    }
    return 0;
  }

  void Sort() {
    std::sort(entries_.begin(), entries_.end(), [this](Entry const& a, Entry const& b) {
      int const order = Compare(a, b);
      return order != 0 ? order < 0 : a.place < b.place;
    });
  }

  // Of the sorted entries, those that are equal to the first.
  std::size_t CountBest() const {
    auto const end = std::find_if(entries_.begin(), entries_.end(), [this](Entry const& entry) {
      return Compare(entries_.front(), entry) != 0;
    });
    return static_cast<std::size_t>(end - entries_.begin());
  }

  Candidate CandidateOf(Entry const& entry) const {
    Candidate candidate = index_.CandidateAt(entry.place);
    candidate.match = entry.match;
    candidate.weight = entry.weight;
    std::copy_if(levels_.begin(), levels_.end(), std::back_inserter(candidate.levels),
                 [&](MatchLevel const& level) { return Counts(level, entry.match); });
    return candidate;
  }

  Index const& index_;
  MatchData const& reference_;
  std::vector<MatchLevel> const& levels_;
  std::vector<Criterion> const finer_;
  std::size_t const runnersUp_;
  std::vector<bool> seen_;
  std::vector<Entry> entries_;
};

ReferenceResolver::ReferenceResolver(std::vector<MatchLevel> levels, std::size_t runnersUp)
    : levels_(std::move(levels)), runnersUp_(runnersUp) {
  Update();
}

ReferenceResolver::ReferenceResolver(std::vector<Source> const& sources,
                                     std::vector<Destination> const& destinations,
                                     std::vector<MatchLevel> levels, std::size_t runnersUp)
    : levels_(std::move(levels)), runnersUp_(runnersUp) {
  Update(sources, destinations);
}

ReferenceResolver::~ReferenceResolver() = default;

void ReferenceResolver::Update() {
  Setup const& setup = Setup::Instance();
  std::vector<Source> sources;
  for (int i = 0; i < setup.CountSources(); ++i) {
    sources.push_back(setup.GetSource(i));
  }
  std::vector<Destination> destinations;
  for (int i = 0; i < setup.CountDestinations(); ++i) {
    destinations.push_back(setup.GetDestination(i));
  }
  Update(sources, destinations);
}

void ReferenceResolver::Update(std::vector<Source> const& sources,
                               std::vector<Destination> const& destinations) {
  sources_ = std::make_unique<Index>(sources);
  destinations_ = std::make_unique<Index>(destinations);
}

template <class Consider>
ReferenceResolver::Answer ReferenceResolver::Resolve(MatchData const& reference,
                                                     Consider const& consider) const {
  MatchContents const contents = reference.GetContents();
  bool const isSource = contents.objectType == Source::kObjectID;
  Answer answer;
  if (!contents.isValid) {
    answer.outcome = Outcome::kUnreadable;
  } else if (!isSource && contents.objectType != Destination::kObjectID) {
    answer.outcome = Outcome::kNoEndpoint;
  } else {
    Index const& index = isSource ? *sources_ : *destinations_;
    Ranking ranking(index, reference, levels_, runnersUp_);
    consider(index, contents, ranking);
    answer = ranking.Finish();
  }
  return answer;
}

ReferenceResolver::Answer ReferenceResolver::ResolveByComparingAll(
    MatchData const& reference) const {
  return Resolve(reference, [](Index const& index, MatchContents const&, Ranking& ranking) {
    for (std::size_t place = 0; place < index.Count(); ++place) {
      ranking.Consider(place);
    }
  });
}

ReferenceResolver::Answer ReferenceResolver::Resolve(MatchData const& reference) const {
  bool const isCovered = std::all_of(levels_.begin(), levels_.end(), [](MatchLevel const& level) {
    return level.weight <= 0 || Index::Covers(level);
  });
  if (!isCovered) {
    return ResolveByComparingAll(reference);
  }
  return Resolve(
      reference, [this](Index const& index, MatchContents const& contents, Ranking& ranking) {
        int remaining = 0;
        std::vector<Group> const groups = GroupsOf(levels_);
        for (Group const& group : groups) {
          remaining += group.weight;
        }
        for (Group const& group : groups) {
          if (ranking.IsSettledAgainst(remaining)) {
            break;
          }
          for (MatchLevel const& level : group.levels) {
            index.Find(level, contents, [&](std::size_t place) { ranking.Consider(place); });
          }
          remaining -= group.weight;
        }
      });
}

}  // namespace Ostinet
