// SPDX-License-Identifier: MIT
#include "ReferenceText.h"

#include <algorithm>

#include "Errors.h"
#include "HexBytes.h"
#include "JsonText.h"

namespace Ostinet::Tool {
namespace {

using Outcome = ReferenceResolver::Outcome;

struct TypeName {
  int type;
  char const* word;
};

// "bank" and "patch" share a tag.
constexpr TypeName kTypeNames[] = {{1, "device"},        {2, "entity"},
                                   {3, "source"},        {4, "destination"},
                                   {5, "mode"},          {6, "name-set"},
                                   {7, "patch"},         {7, "bank"},
                                   {9, "note-list"},     {10, "default-note-list"},
                                   {11, "control-list"}, {12, "default-control-list"}};

constexpr char const* kCriterionKeys[] = {"uniqueID", "name", "model", "connection", "generalMIDI"};

char const* OutcomeText(Outcome outcome) {
  switch (outcome) {
    case Outcome::kFound:
      return "found";
    case Outcome::kAmbiguous:
      return "ambiguous";
    case Outcome::kNotFound:
      return "not-found";
    case Outcome::kNoEndpoint:
      return "no-endpoint";
    case Outcome::kUnreadable:
      break;
  }
  return "unreadable";
}

template <class T>
Json OrNull(std::optional<T> const& value) {
  return value ? Json(*value) : Json(nullptr);
}

Json RanksJSON(ObjectMatch const& match) {
  Json ranks = Json::object();
  for (int i = 0; i < 5; ++i) {
    auto const criterion = static_cast<ObjectMatch::MatchType>(i);
    ranks[kCriterionKeys[i]] =
        match.HasValidRank(criterion) ? Json(match.GetRank(criterion)) : nullptr;
  }
  return ranks;
}

Json CandidateJSON(ReferenceResolver::Candidate const& candidate) {
  Json levels = Json::array();
  for (MatchLevel const& level : candidate.levels) {
    levels.push_back({{"criterion", kCriterionKeys[level.matchType]},
                      {"minRank", level.minRank},
                      {"weight", level.weight}});
  }
  return {{"name", candidate.endpoint.GetName().string()},
          {"type", candidate.source.Exists() ? "source" : "destination"},
          {"uniqueID", candidate.endpoint.GetUniqueID()},
          {"weight", candidate.weight},
          {"why", candidate.InWords()},
          {"ranks", RanksJSON(candidate.match)},
          {"levels", levels}};
}

Json CandidatesJSON(std::vector<ReferenceResolver::Candidate> const& candidates) {
  Json list = Json::array();
  for (auto const& candidate : candidates) {
    list.push_back(CandidateJSON(candidate));
  }
  return list;
}

std::string CandidateLine(ReferenceResolver::Candidate const& candidate) {
  return candidate.endpoint.GetName().string() + " (#" +
         std::to_string(candidate.endpoint.GetUniqueID()) + ", weight " +
         std::to_string(candidate.weight) + "): " + candidate.InWords();
}

}  // namespace

std::string ReferenceText(MatchData const& data) {
  std::string text = ToHex(Bytes(data.begin(), data.end()));
  text.erase(std::remove(text.begin(), text.end(), ' '), text.end());
  return text;
}

MatchData ParseReference(std::string const& text) {
  Bytes const bytes = ParseHex(text);
  MatchData data(bytes.size());
  std::copy(bytes.begin(), bytes.end(), data.begin());
  return data;
}

MatchObjectID ParseObjectType(std::string const& word) {
  std::string known;
  for (TypeName const& entry : kTypeNames) {
    if (word == entry.word) {
      return MatchObjectID(entry.type);
    }
    known += known.empty() ? entry.word : std::string(", ") + entry.word;
  }
  throw UsageError("\"" + word + "\" is no type; there are " + known);
}

std::string ObjectTypeText(MatchObjectID type) {
  auto const place = std::find_if(std::begin(kTypeNames), std::end(kTypeNames),
                                  [=](TypeName const& entry) { return entry.type == type; });
  return place != std::end(kTypeNames) ? place->word : std::to_string(static_cast<int>(type));
}

std::string ReferenceJSON(MatchData const& data) {
  MatchContents const contents = data.GetContents();
  Json json = {{"reference", ReferenceText(data)}, {"valid", contents.isValid}};
  if (contents.isValid) {
    json["implementation"] = static_cast<int>(contents.implementation);
    json["type"] = ObjectTypeText(contents.objectType);
    json["name"] = contents.name.string();
    json["uniqueID"] = contents.uniqueID;
    json["connectionUniqueID"] = contents.connectionUniqueID;
    json["manufacturer"] = contents.manufacturer.string();
    json["model"] = contents.model.string();
    json["direct"] = OrNull(contents.isDirect);
    json["software"] = OrNull(contents.isSoftware);
    json["generalMIDI"] = OrNull(contents.supportsGeneralMIDI);
    json["internalSoftware"] = OrNull(contents.isInternalSoftware);
  }
  return JsonText(json);
}

std::vector<std::string> AnswerLines(ReferenceResolver::Answer const& answer) {
  std::vector<std::string> lines;
  for (auto const& candidate : answer.best) {
    lines.push_back(CandidateLine(candidate));
  }
  for (auto const& candidate : answer.runnersUp) {
    lines.push_back("  next: " + CandidateLine(candidate));
  }
  return lines;
}

std::string AnswerJSON(ReferenceResolver::Answer const& answer) {
  return JsonText({{"outcome", OutcomeText(answer.outcome)},
                   {"text", answer.InWords()},
                   {"best", CandidatesJSON(answer.best)},
                   {"runnersUp", CandidatesJSON(answer.runnersUp)}});
}

std::string PairsJSON(std::vector<NamePair> const& pairs, std::vector<std::string> const& sources,
                      std::vector<std::string> const& destinations) {
  Json list = Json::array();
  for (NamePair const& pair : pairs) {
    list.push_back({{"name", pair.common},
                    {"source", sources[pair.source]},
                    {"destination", destinations[pair.destination]},
                    {"kind", KindText(pair.kind)}});
  }
  return JsonText({{"pairs", list}});
}

}  // namespace Ostinet::Tool
