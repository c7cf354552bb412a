// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <iterator>
#include <vector>

#include "ostinet/Common.h"

namespace Ostinet {
enum MatchObjectID : int {};
struct SlotID {
  unsigned int words[6];
  SlotID();
  bool operator==(SlotID const&) const;
  bool operator!=(SlotID const&) const;
};
class MatchData {
 public:
  static const size_t kMaxSize = 1048576;
  MatchData();
  explicit MatchData(size_t);
  MatchData(MatchData const&);
  MatchData& operator=(MatchData const&);
  ~MatchData();
  bool operator==(MatchData const&) const;
  bool operator!=(MatchData const&) const;
  size_t size() const;
  bool empty() const;
  char* begin();
  char const* begin() const;
  char* end();
  char const* end() const;
  std::reverse_iterator<char*> rbegin();
  std::reverse_iterator<char const*> rbegin() const;
  std::reverse_iterator<char*> rend();
  std::reverse_iterator<char const*> rend() const;
  char& operator[](size_t);
  char const& operator[](size_t) const;
  char& at(size_t);
  char const& at(size_t) const;
  UString GetObjectName() const;
  MatchObjectID GetObjectType() const;
  bool ObjectIsSoftware() const;
  bool ObjectIsInternalSoftware() const;
  SlotID GetSlotID() const;
  void SetSlotID(SlotID const&);
};
class ObjectMatch {
 public:
  enum MatchType {
    kUniqueIDMatch = 0,
    kNameMatch,
    kManufacturerModelMatch,
    kConnectionMatch,
    kGeneralMIDIMatch
  };
  ObjectMatch();
  int GetRank(MatchType) const;
  void SetRank(MatchType, int);
  bool HasValidRank(MatchType) const;
  bool operator==(ObjectMatch const&) const;
  bool operator!=(ObjectMatch const&) const;
};
struct MatchLevel {
  ObjectMatch::MatchType matchType;
  int minRank;
  int weight;
};
std::vector<MatchLevel> const& StandardMatch();
std::vector<MatchLevel> const& IDAndNameMatch();
std::vector<MatchLevel> const& NameAndIDMatch();
#pragma pack(push, 2)
union BreviaDestinationMatch {
  short kind;
  struct {
    short kind_;
    unsigned short word2;
    unsigned int long4;
    short word8, word10;
    int manufacturerCode, modelCode;
    short word20;
    unsigned char name[256];
  } fields;
  struct {
    short kind_;
    unsigned int long2;
  } software;
  unsigned char bytes[278];
};
#pragma pack(pop)
class MatchTranslator {
 public:
  MatchTranslator();
  ~MatchTranslator();
  MatchData TranslateFromBrevia(BreviaDestinationMatch const&, bool isSource);
  BreviaDestinationMatch TranslateToBrevia(MatchData const&, bool& isSource);
  MatchData TranslateFromNameOnly(MatchObjectID, UString const& name);
};
}  // namespace Ostinet
