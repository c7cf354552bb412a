// SPDX-License-Identifier: MIT
//
// What a reference tells of its object. Each query reads the bytes anew: hosts change them.
#include "matching/MatchDataUpdater.h"
#include "matching/SavedEndpoint.h"

namespace Ostinet {

using Impl::MatchDataReader;
using Impl::MatchDataUpdater;

namespace {

// The flags of section 2, in the order in which they stand behind its two texts.
enum Flag { kDirect = 0, kSoftware, kGeneralMIDI, kInternalSoftware, kFlags };

bool SkipTextsAndFlags(MatchDataReader::Stream& stream, int flags) {
  bool ok = stream.SkipString() && stream.SkipString();
  for (int i = 0; ok && i < flags; ++i) {
    ok = stream.SkipBool();
  }
  return ok;
}

bool HasEndpointSection2(MatchDataReader const& reader) {
  return reader.NamesEndpoint() && reader.GetSection2().version == 0;
}

bool ReadFlag(MatchData const& data, Flag flag) {
  MatchDataReader const reader(data);
  MatchDataReader::Stream stream = reader.GetSection2Stream();
  bool value = false;
  return HasEndpointSection2(reader) && SkipTextsAndFlags(stream, flag) && stream.ReadBool(value) &&
         value;
}

}  // namespace

UString MatchData::GetObjectName() const {
  MatchDataReader const reader(*this);
  return reader.GetObjectType() != 0 ? reader.GetName().Decode() : UString();
}

MatchObjectID MatchData::GetObjectType() const { return MatchDataReader(*this).GetObjectType(); }

bool MatchData::ObjectIsSoftware() const { return ReadFlag(*this, kSoftware); }

bool MatchData::ObjectIsInternalSoftware() const { return ReadFlag(*this, kInternalSoftware); }

SlotID MatchData::GetSlotID() const {
  MatchDataReader const reader(*this);
  MatchDataReader::Stream stream = reader.GetSection2Stream();
  SlotID slot;
  if (HasEndpointSection2(reader) && SkipTextsAndFlags(stream, kFlags)) {
    stream.ReadSlotID(slot);
  }
  return slot;
}

void MatchData::SetSlotID(SlotID const& slot) {
  MatchDataUpdater updater(*this);
  MatchDataUpdater::UpdateStream stream = updater.GetSection2Stream();
  if (HasEndpointSection2(updater.GetReader()) && SkipTextsAndFlags(stream, kFlags)) {
    stream.WriteSlotID(slot);
  }
}

MatchContents MatchData::GetContents() const {
  Impl::SavedEndpoint const saved(*this, Properties::kPlatformImplementation);
  MatchContents contents;
  contents.isValid = saved.isValid;
  contents.implementation = saved.implementation;
  contents.objectType = saved.objectType;
  contents.name = saved.name.Decode();
  contents.nameIsFull = saved.nameIsFull;
  contents.uniqueID = saved.uniqueID;
  contents.connectionUniqueID = saved.connectionUniqueID;
  contents.manufacturer = saved.manufacturer.Decode();
  contents.model = saved.model.Decode();
  contents.isDirect = saved.isDirect;
  contents.isSoftware = saved.isSoftware;
  contents.supportsGeneralMIDI = saved.supportsGeneralMIDI;
  contents.isInternalSoftware = saved.isInternalSoftware;
  contents.slot = saved.slot;
  return contents;
}

}  // namespace Ostinet
