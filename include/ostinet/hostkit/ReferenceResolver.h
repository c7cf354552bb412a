// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <memory>
#include <string>
#include <vector>

#include "ostinet/Endpoint.h"
#include "ostinet/MatchData.h"
#include "ostinet/core/Noncopyable.h"

namespace Ostinet {

/// Finds the endpoint that a reference names, or says why there is none.
///
/// Each live endpoint is ranked against the reference (Endpoint::MatchToData) and weighed by a
/// list of levels: a level counts where its criterion was examined and the rank reaches its
/// `minRank`, and the weights of all that count are added up. The greatest total wins, if it is
/// above 0. Equal totals are told apart by the ranks themselves: first those of the criteria that
/// the levels name, in their order, then the others; not examined is no better and no worse than
/// not alike. What is still equal is ambiguous, and all of it is told, in the studio's order.
///
/// The endpoints are indexed by what the levels ask for, so that a reference is compared with the
/// few that can have a weight at all. The answer is the one that comparing all would give.
///
/// Ownership    The host's. It holds handles to the endpoints that it indexed.
/// Threads      The host's polling thread.
/// Errors       None are thrown.
class ReferenceResolver : private Noncopyable<ReferenceResolver> {
 public:
  enum class Outcome {
    kFound,       ///< exactly one is the best
    kAmbiguous,   ///< several are equally good
    kNotFound,    ///< no endpoint of the studio has any weight
    kUnreadable,  ///< the bytes hold no reference
    kNoEndpoint,  ///< the reference names something else: a device, a patch
  };

  /// One endpoint, and what speaks for it.
  struct Candidate {
    /// The endpoint; of the other two, the one of its kind, the other null.
    Endpoint endpoint;
    Source source;
    Destination destination;
    ObjectMatch match;
    /// The total of the levels that counted.
    int weight = 0;
    std::vector<MatchLevel> levels;

    /// The ranks in words: "same name, other interface".
    std::string InWords() const;
  };

  struct Answer {
    Outcome outcome = Outcome::kUnreadable;
    /// One when found, all that are equal when ambiguous, else none.
    std::vector<Candidate> best;
    /// The next ones, the best first, with a weight above 0.
    std::vector<Candidate> runnersUp;
    /// The winner, or null.
    Candidate const* Winner() const { return outcome == Outcome::kFound ? &best.front() : nullptr; }
    /// The outcome in words.
    std::string InWords() const;
  };

  /// Gives at most this many runners-up.
  static constexpr std::size_t kRunnersUp = 3;

  /// Indexes the public endpoints of Setup::Instance.
  explicit ReferenceResolver(std::vector<MatchLevel> levels = StandardMatch(),
                             std::size_t runnersUp = kRunnersUp);
  /// Indexes these.
  ReferenceResolver(std::vector<Source> const& sources,
                    std::vector<Destination> const& destinations,
                    std::vector<MatchLevel> levels = StandardMatch(),
                    std::size_t runnersUp = kRunnersUp);
  ~ReferenceResolver();

  /// Indexes the studio anew: to be called after SetupChanged, and after edits of the host's own
  /// that change names, IDs, makers, models, slots or connections.
  void Update();
  void Update(std::vector<Source> const& sources, std::vector<Destination> const& destinations);

  Answer Resolve(MatchData const& reference) const;
  /// The same by way of every endpoint, for those who doubt the index.
  Answer ResolveByComparingAll(MatchData const& reference) const;

  std::vector<MatchLevel> const& Levels() const { return levels_; }

 private:
  class Index;
  class Ranking;

  template <class Consider>
  Answer Resolve(MatchData const& reference, Consider const& consider) const;

  std::vector<MatchLevel> const levels_;
  std::size_t const runnersUp_;
  std::unique_ptr<Index> sources_;
  std::unique_ptr<Index> destinations_;
};

}  // namespace Ostinet
