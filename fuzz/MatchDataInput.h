// SPDX-License-Identifier: MIT
#pragma once

#include <algorithm>
#include <cstddef>
#include <cstdint>

#include "ostinet/MatchData.h"

namespace Ostinet::Fuzz {

/// Asks everything of a reference of these bytes. True if the answers agree with each other.
inline bool TryMatchData(std::uint8_t const* bytes, std::size_t count) {
  MatchData data(count);
  std::copy(bytes, bytes + count, data.begin());
  MatchData const before = data;

  MatchContents const contents = data.GetContents();
  bool ok = contents.objectType == data.GetObjectType();
  ok = ok && (contents.objectType == 0 || contents.name == data.GetObjectName());
  ok = ok && contents.name.length() * 2 <= count;
  data.ObjectIsSoftware();
  ok = ok && (contents.slot || !data.ObjectIsInternalSoftware() || contents.isInternalSoftware);

  MatchTranslator translator;
  bool isSource = false;
  BreviaDestinationMatch const record = translator.TranslateToBrevia(data, isSource);
  MatchData const again = translator.TranslateFromBrevia(record, isSource);
  ok = ok && again.GetContents().isValid;

  SlotID const slot = data.GetSlotID();
  SlotID other = slot;
  other.words[0] ^= 1;
  data.SetSlotID(other);
  ok = ok && data.size() == count && (data == before || data.GetSlotID() == other);
  data.SetSlotID(slot);
  return ok && data == before;
}

}  // namespace Ostinet::Fuzz
