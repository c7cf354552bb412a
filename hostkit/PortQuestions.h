// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <deque>
#include <optional>
#include <set>
#include <vector>

#include "Findings.h"
#include "ReplyReader.h"
#include "ostinet/hostkit/DetectionRun.h"

namespace Ostinet {

/// What is asked of one port, and what its answers mean.
///
/// Each reply is shown to the answers of all requests, also of those whose turn is over or yet to
/// come: a late reply still counts, and a question that was put to the port already need not be
/// put again.
class PortQuestions {
 public:
  using Bytes = DetectionRun::Bytes;

  PortQuestions(std::vector<Autodetect::Request> const& requests, bool inquireOfAll);

  /// Goes on to the next question; false when there is none left.
  bool Next();
  /// The messages of the present question, without those that the port was sent before.
  std::vector<Bytes> TakeMessages();
  /// How long to wait for the answers to the present question, in seconds.
  double Timeout() const;

  /// All answers that are known now. The vector stays where it is, and only grows.
  std::vector<KnownAnswer> const& Answers() const { return answers_; }
  /// What a reply means, if anything. Questions that follow on its answer are asked next.
  std::optional<Meaning> Read(Reply const& reply);

  std::size_t CountDone() const { return asked_; }
  std::size_t CountAll() const { return questions_.size(); }

 private:
  struct Question {
    Autodetect::Request request;
    std::optional<std::size_t> follows;  // the answer that it follows on
    std::size_t turn = 0;                // which one it was that was asked; 0: none yet
  };
  using Hits = std::vector<Hit>;

  void Add(Autodetect::Request const& request, std::optional<std::size_t> follows);
  void FollowUp(std::size_t answer);
  Hits HitsWithTypes(Hits const& hits) const;
  Hits HitsOfLatestQuestion(Hits const& hits) const;
  bool ComesFirst(Hit const& a, Hit const& b) const;
  Question const& QuestionOf(Hit const& hit) const;

  bool const inquireOfAll_;
  std::vector<Question> questions_;
  std::vector<KnownAnswer> answers_;
  std::deque<std::size_t> waiting_;  // questions
  std::size_t present_ = 0;
  std::size_t asked_ = 0;
  std::set<Bytes> sent_;
  std::set<std::size_t> followed_;  // answers
};

}  // namespace Ostinet
