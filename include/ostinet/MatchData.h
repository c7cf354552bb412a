// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <iterator>
#include <vector>

#include "ostinet/Common.h"

namespace Ostinet {

/// What kind of object a reference names: the kObjectID of its class; 0 is none.
enum MatchObjectID : int {};

/// The place of a software instrument in the host.
struct OSTINET_EXPORT SlotID {
  unsigned int words[6];

  /// All 0: none.
  SlotID();
  bool operator==(SlotID const& other) const;
  bool operator!=(SlotID const& other) const;
};

/// A persistent reference to an object of the studio: bytes that the host keeps in its documents
/// and hands back later, perhaps in another session or on another machine.
///
/// Ownership    A value.
/// Null handle  Default-constructed: no bytes. It names nothing.
/// Threads      [any thread], one object on one thread at a time.
/// Errors       Only `at` throws. Bytes that cannot be read name nothing.
class OSTINET_EXPORT MatchData {
 public:
  /// The size that hosts may count on as a limit, in bytes.
  static const size_t kMaxSize = 1048576;

  MatchData();
  /// `size` bytes of 0, for the host to fill.
  explicit MatchData(size_t size);
  MatchData(MatchData const& other);
  MatchData& operator=(MatchData const& other);
  ~MatchData();
  /// Byte for byte: two references to one object can differ.
  bool operator==(MatchData const& other) const;
  bool operator!=(MatchData const& other) const;
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
  /// Unchecked.
  char& operator[](size_t index);
  char const& operator[](size_t index) const;
  /// Throws std::out_of_range, "Ostinet::MatchData", for an index of no byte.
  char& at(size_t index);
  char const& at(size_t index) const;

  UString GetObjectName() const;
  MatchObjectID GetObjectType() const;
  bool ObjectIsSoftware() const;
  bool ObjectIsInternalSoftware() const;
  SlotID GetSlotID() const;
  /// Replaces the slot of a reference that has room for one.
  void SetSlotID(SlotID const& slot);

 private:
  std::vector<char> bytes_;
};

/// How well an object fits a reference: one rank for each criterion.
///
/// Ownership    A value.
class OSTINET_EXPORT ObjectMatch {
 public:
  enum MatchType {
    kUniqueIDMatch = 0,
    kNameMatch,
    kManufacturerModelMatch,
    kConnectionMatch,
    kGeneralMIDIMatch
  };

  /// All ranks -1: nothing was examined.
  ObjectMatch();
  /// -1 for what was not examined, and for a value that is no MatchType.
  int GetRank(MatchType type) const;
  void SetRank(MatchType type, int rank);
  /// True for a rank of 0 or more.
  bool HasValidRank(MatchType type) const;
  bool operator==(ObjectMatch const& other) const;
  bool operator!=(ObjectMatch const& other) const;

 private:
  static const int kTypes = 5;
  int ranks_[kTypes];
};

/// One line of a matching policy: the rank that it asks for, and what meeting it weighs.
struct MatchLevel {
  ObjectMatch::MatchType matchType;
  int minRank;
  int weight;
};

/// The policies that hosts resolve references by; each list lives to the end of the process.
OSTINET_EXPORT std::vector<MatchLevel> const& StandardMatch();
OSTINET_EXPORT std::vector<MatchLevel> const& IDAndNameMatch();
OSTINET_EXPORT std::vector<MatchLevel> const& NameAndIDMatch();

/// A reference in the form of an older MIDI system, in the machine's byte order.
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

/// Turns references of other forms into MatchData, and back.
///
/// Threads      The host's polling thread.
class OSTINET_EXPORT MatchTranslator {
 public:
  MatchTranslator();
  ~MatchTranslator();
  MatchData TranslateFromBrevia(BreviaDestinationMatch const&, bool isSource);
  BreviaDestinationMatch TranslateToBrevia(MatchData const&, bool& isSource);
  MatchData TranslateFromNameOnly(MatchObjectID, UString const& name);
};

}  // namespace Ostinet
