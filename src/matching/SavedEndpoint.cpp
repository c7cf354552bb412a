// SPDX-License-Identifier: MIT
#include "matching/SavedEndpoint.h"

#include "matching/MatchDataReader.h"

namespace Ostinet::Impl {

namespace {

using Stream = MatchDataReader::Stream;

// Each field is read on its own, but a name is only taken for full if all three are there.
void ReadSection1(Stream stream, SavedEndpoint& saved) {
  bool const hasIDs =
      stream.ReadInt32(saved.uniqueID) && stream.ReadInt32(saved.connectionUniqueID);
  bool nameIsFull = false;
  saved.nameIsFull = hasIDs && stream.ReadBool(nameIsFull) && nameIsFull;
}

bool ReadFlag(Stream& stream, std::optional<bool>& flag) {
  bool value = false;
  if (!stream.ReadBool(value)) {
    return false;
  }
  flag = value;
  return true;
}

bool ReadSlot(Stream& stream, std::optional<SlotID>& slot) {
  SlotID value;
  if (!stream.ReadSlotID(value)) {
    return false;
  }
  slot = value;
  return true;
}

// Up to the first field that is missing: references made without a live endpoint end behind the
// third flag.
void ReadSection2(Stream stream, SavedEndpoint& saved) {
  static_cast<void>(stream.ReadString(saved.manufacturer) && stream.ReadString(saved.model) &&
                    ReadFlag(stream, saved.isDirect) && ReadFlag(stream, saved.isSoftware) &&
                    ReadFlag(stream, saved.supportsGeneralMIDI) &&
                    ReadFlag(stream, saved.isInternalSoftware) && ReadSlot(stream, saved.slot));
}

}  // namespace

SavedEndpoint::SavedEndpoint(MatchData const& data, Properties::Implementation backend) {
  MatchDataReader const reader(data);
  isValid = reader.IsValid();
  implementation = static_cast<Properties::Implementation>(reader.GetImplementation());
  objectType = reader.GetObjectType();
  name = reader.GetName();
  bool const isOurs =
      implementation == backend || implementation == Properties::kPluginHostImplementation;
  if (isOurs && isValid && reader.GetSection1().version == 0) {
    ReadSection1(reader.GetSection1Stream(), *this);
  }
  if (isValid && reader.GetSection2().version == 0) {
    ReadSection2(reader.GetSection2Stream(), *this);
  }
}

}  // namespace Ostinet::Impl
