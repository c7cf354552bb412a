// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <functional>
#include <map>
#include <unordered_map>
#include <vector>

#include "ostinet/hostkit/ReferenceResolver.h"

namespace Ostinet {

/// The endpoints of one direction, to be found by each criterion of a reference.
///
/// A list gives every endpoint at which a level can count, and may give more: whoever asks ranks
/// what it gives.
class ReferenceResolver::Index {
 public:
  using Places = std::vector<std::size_t>;
  using Visitor = std::function<void(std::size_t)>;

  explicit Index(std::vector<Source> const& sources);
  explicit Index(std::vector<Destination> const& destinations);

  std::size_t Count() const { return endpoints_.size(); }
  /// A candidate of the endpoint at a place, not yet ranked.
  Candidate CandidateAt(std::size_t place) const;
  Endpoint const& At(std::size_t place) const { return endpoints_[place]; }

  /// True if there is a list for what the level asks. Of General MIDI there is none, as half of a
  /// studio may share it, nor of a rank that nearly every endpoint reaches.
  static bool Covers(MatchLevel const& level);
  /// Calls `visit` with each place where a covered level can count, some of them twice.
  void Find(MatchLevel const& level, MatchContents const& contents, Visitor const& visit) const;

 private:
  struct LooseLess {
    bool operator()(UString const& a, UString const& b) const {
      return a.less(b, UString::kLooselyEqual);
    }
  };
  struct SlotLess {
    bool operator()(SlotID const& a, SlotID const& b) const;
  };
  using ByID = std::unordered_map<int, Places>;
  using ByText = std::map<UString, Places, LooseLess>;
  struct Maker {
    Places all;
    ByText byModel;
  };

  void Add(Endpoint const& endpoint, Endpoint const& port);
  void FindDevice(int minRank, MatchContents const& contents, Visitor const& visit) const;

  std::vector<Endpoint> endpoints_;
  std::vector<Source> sources_;  // one of these two has an entry for each endpoint
  std::vector<Destination> destinations_;
  ByID byUniqueID_;
  ByID byPort_;
  ByText byFullName_;
  ByText byRawName_;
  std::map<UString, Maker, LooseLess> byMaker_;
  std::map<SlotID, Places, SlotLess> bySlot_;
};

}  // namespace Ostinet
