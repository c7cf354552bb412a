// SPDX-License-Identifier: MIT
#include "matching/MatchDataUpdater.h"

#include "matching/ByteOrder.h"

namespace Ostinet::Impl {

MatchDataUpdater::UpdateStream MatchDataUpdater::GetSection2Stream() {
  MatchDataReader::Section const& section = reader_.GetSection2();
  return UpdateStream(data_, section.begin, section.end);
}

char* MatchDataUpdater::UpdateStream::WritablePosition() {
  return data_.begin() + (Position() - data_.begin());
}

void MatchDataUpdater::UpdateStream::WriteSlotID(SlotID const& slot) {
  if (Remaining() < sizeof(slot.words)) {
    return;
  }
  char* out = WritablePosition();
  for (unsigned int const word : slot.words) {
    out = WriteBigEndian(out, word);
  }
  Skip(sizeof(slot.words));
}

void MatchDataUpdater::UpdateStream::WriteBool(bool value) {
  if (Remaining() > 0) {
    *WritablePosition() = value ? '\1' : '\0';
    Skip(1);
  }
}

}  // namespace Ostinet::Impl
