// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <iterator>
#include <memory>
#include <optional>
#include <vector>

#include "ostinet/Common.h"

namespace Ostinet {

namespace Impl {
class DeviceTextsByCode;
class DeviceCodesByText;
}  // namespace Impl

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

/// What a reference says of an endpoint. What it does not say, or what cannot be read, has the
/// values below.
///
/// Ownership    A value.
struct MatchContents {
  /// True if the bytes hold a whole reference in the long form.
  bool isValid = false;
  /// Which backend wrote it.
  Properties::Implementation implementation = Properties::kNoImplementation;
  MatchObjectID objectType = MatchObjectID(0);
  UString name;
  /// Whether that is the name to show, as GetName has it; else it is that of GetRawName.
  bool nameIsFull = true;
  /// 0: none.
  int uniqueID = 0;
  /// Of the port that the instrument hung on; 0: none.
  int connectionUniqueID = 0;
  UString manufacturer;
  UString model;
  std::optional<bool> isDirect;
  std::optional<bool> isSoftware;
  std::optional<bool> supportsGeneralMIDI;
  std::optional<bool> isInternalSoftware;
  std::optional<SlotID> slot;
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

  /// Under which name the object was saved, also if what follows the name is cut off.
  UString GetObjectName() const;
  /// What kind of object it was: its class's kObjectID, or 0 if that cannot be read.
  MatchObjectID GetObjectType() const;
  /// True for an endpoint made by software. False for anything else and where nothing is said.
  bool ObjectIsSoftware() const;
  /// True for an endpoint within the host.
  bool ObjectIsInternalSoftware() const;
  /// The place of an endpoint within the host; all 0 where nothing is said.
  SlotID GetSlotID() const;
  /// Replaces the slot of a reference that has room for one, as those of live endpoints have. Any
  /// other stays as it is, and nobody is told.
  void SetSlotID(SlotID const& slot);
  /// All that the reference says of an endpoint, for showing it and for searching by it.
  MatchContents GetContents() const;

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

/// Turns references of other forms into MatchData, and back. The numbers of makers and models in
/// the older form are related to texts by the resource "BVDevices.xml", which is read when it is
/// first needed, once by each translator and each direction: keep one for many references.
///
/// Ownership    Not copied.
/// Threads      One object on one thread at a time.
/// Errors       None are thrown. Codes and texts that the file does not know give nothing.
class OSTINET_EXPORT MatchTranslator {
 public:
  MatchTranslator();
  ~MatchTranslator();
  /// The reference keeps all fields of the record, so TranslateToBrevia gives the same record.
  MatchData TranslateFromBrevia(BreviaDestinationMatch const& record, bool isSource);
  /// `kind` is -1, and `isSource` stays as it was, for a reference to anything but an endpoint.
  /// The name is cut at 255 characters; one beyond U+00FF becomes "?".
  BreviaDestinationMatch TranslateToBrevia(MatchData const& data, bool& isSource);
  /// A reference by which any object of that type and name can be found.
  MatchData TranslateFromNameOnly(MatchObjectID type, UString const& name);

 private:
  std::unique_ptr<Impl::DeviceCodesByText> codesByText_;
  std::unique_ptr<Impl::DeviceTextsByCode> textsByCode_;
};

}  // namespace Ostinet
