// SPDX-License-Identifier: MIT
#pragma once

#include "matching/MatchDataReader.h"

namespace Ostinet::Impl {

/// Overwrites single fields of a reference in place; its length stays.
///
/// Ownership    A view; the reference outlives it and keeps its length.
class MatchDataUpdater {
 public:
  class UpdateStream;

  explicit MatchDataUpdater(MatchData& data) : data_(data), reader_(data) {}

  MatchDataReader const& GetReader() const { return reader_; }
  UpdateStream GetSection2Stream();

 private:
  MatchData& data_;
  MatchDataReader const reader_;
};

/// A reading stream that can write too. What does not fit is not written at all.
class MatchDataUpdater::UpdateStream : public MatchDataReader::Stream {
 public:
  /// `begin` to `end` lie in `data`.
  UpdateStream(MatchData& data, char const* begin, char const* end)
      : Stream(begin, end), data_(data) {}

  void WriteSlotID(SlotID const& slot);
  void WriteBool(bool value);

 private:
  char* WritablePosition();

  MatchData& data_;
};

}  // namespace Ostinet::Impl
