// SPDX-License-Identifier: MIT
#include "PortQuestions.h"

#include <algorithm>
#include <iterator>

namespace Ostinet {

namespace {

using Bytes = DetectionRun::Bytes;

constexpr int kHighestDeviceID = 127;

// F0 7E ID 06 01 F7
bool IsInquiry(Bytes const& message) {
  return message.size() == 6 && message[1] == 0x7E && message[3] == 0x06 && message[4] == 0x01;
}

std::vector<Bytes> MessagesOf(Autodetect::Request const& request) {
  DataBuffer const buffer = request.GetMessageW(kNoTimeStamp);
  std::vector<Bytes> messages;
  for (std::size_t i = 0; i < buffer.size(); ++i) {
    messages.emplace_back(buffer[i].data, buffer[i].data + buffer[i].length);
  }
  return messages;
}

// Instruments whose ID lies outside of what the types tell answer the call to all.
void AddInquiryOfAll(std::vector<Bytes>& messages) {
  if (std::any_of(messages.begin(), messages.end(), IsInquiry)) {
    messages.insert(messages.begin(), {0xF0, 0x7E, DetectionRun::kAllDeviceIDs, 0x06, 0x01, 0xF7});
  }
}

int DeviceIDOf(std::vector<Hit> const& hits) {
  auto const hit = std::find_if(hits.begin(), hits.end(),
                                [](Hit const& each) { return each.deviceID <= kHighestDeviceID; });
  return hit == hits.end() ? DetectionRun::kNoDeviceID : hit->deviceID;
}

}  // namespace

PortQuestions::PortQuestions(std::vector<Autodetect::Request> const& requests, bool inquireOfAll)
    : inquireOfAll_(inquireOfAll) {
  for (Autodetect::Request const& request : requests) {
    waiting_.push_back(questions_.size());
    Add(request, std::nullopt);
  }
}

void PortQuestions::Add(Autodetect::Request const& request, std::optional<std::size_t> follows) {
  for (int i = 0; i < request.CountResponses(); ++i) {
    Autodetect::Response const response = request.GetResponse(i);
    answers_.push_back({questions_.size(), response, response.GetMatcher()});
  }
  questions_.push_back({request, follows, 0});
}

bool PortQuestions::Next() {
  if (waiting_.empty()) {
    return false;
  }
  present_ = waiting_.front();
  waiting_.pop_front();
  questions_[present_].turn = ++asked_;
  return true;
}

// The answers to a question that follows on another are new, so it is put in any case.
std::vector<Bytes> PortQuestions::TakeMessages() {
  Question const& question = questions_[present_];
  std::vector<Bytes> messages = MessagesOf(question.request);
  if (inquireOfAll_) {
    AddInquiryOfAll(messages);
  }
  std::vector<Bytes> fresh;
  std::copy_if(messages.begin(), messages.end(), std::back_inserter(fresh),
               [&](Bytes const& message) {
                 return sent_.insert(message).second || question.follows.has_value();
               });
  return fresh;
}

double PortQuestions::Timeout() const { return questions_[present_].request.GetTimeout(); }

PortQuestions::Question const& PortQuestions::QuestionOf(Hit const& hit) const {
  return questions_[answers_[hit.answer].question];
}

std::optional<Meaning> PortQuestions::Read(Reply const& reply) {
  bool const isEcho = sent_.count(reply.bytes) != 0;
  if (reply.hits.empty() || isEcho) {
    return std::nullopt;
  }
  Hits const typed = HitsWithTypes(reply.hits);
  Hits const hits = HitsOfLatestQuestion(typed.empty() ? reply.hits : typed);
  Meaning meaning;
  for (Hit const& hit : hits) {
    for (DeviceTypeInfo const& type : TypesOf(answers_[hit.answer].response, hit)) {
      meaning.finding.types.push_back(type);
    }
  }
  meaning.finding.identity = IdentityOf(reply.hits);
  meaning.finding.deviceID = DeviceIDOf(hits);
  meaning.finding.reply = reply.bytes;
  if (auto const parent = QuestionOf(hits.front()).follows) {
    Autodetect::Response const& response = answers_[*parent].response;
    for (int i = 0; i < response.CountDeviceTypeInfos(); ++i) {
      meaning.refines.push_back(response.GetDeviceTypeInfo(i));
    }
  }
  for (Hit const& hit : hits) {
    FollowUp(hit.answer);
  }
  bool const saysNothing = meaning.finding.types.empty() && meaning.finding.identity.empty();
  return saysNothing ? std::nullopt : std::optional<Meaning>(std::move(meaning));
}

PortQuestions::Hits PortQuestions::HitsWithTypes(Hits const& hits) const {
  Hits typed;
  std::copy_if(hits.begin(), hits.end(), std::back_inserter(typed), [&](Hit const& hit) {
    return !TypesOf(answers_[hit.answer].response, hit).empty();
  });
  return typed;
}

// Several questions may know a reply. It belongs to the one that was put last: that of the present
// wait, or else the last one before it.
PortQuestions::Hits PortQuestions::HitsOfLatestQuestion(Hits const& hits) const {
  Hit const latest = *std::max_element(
      hits.begin(), hits.end(), [&](Hit const& a, Hit const& b) { return ComesFirst(b, a); });
  std::size_t const question = answers_[latest.answer].question;
  Hits result;
  std::copy_if(hits.begin(), hits.end(), std::back_inserter(result),
               [&](Hit const& hit) { return answers_[hit.answer].question == question; });
  return result;
}

bool PortQuestions::ComesFirst(Hit const& a, Hit const& b) const {
  std::size_t const turnA = QuestionOf(a).turn;
  std::size_t const turnB = QuestionOf(b).turn;
  return turnA != turnB ? turnA > turnB : answers_[a.answer].question < answers_[b.answer].question;
}

void PortQuestions::FollowUp(std::size_t answer) {
  if (!followed_.insert(answer).second) {
    return;
  }
  Autodetect::Response const response = answers_[answer].response;
  for (int i = response.CountRequests() - 1; i >= 0; --i) {
    waiting_.push_front(questions_.size());
    Add(response.GetRequest(i), answer);
  }
}

}  // namespace Ostinet
