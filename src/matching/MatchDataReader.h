// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <cstdint>

#include "matching/EncodedText.h"
#include "ostinet/MatchData.h"

namespace Ostinet::Impl {

/// The header of a reference in the long form, and where its two sections lie. The layout stands
/// in MatchDataWriter.h.
///
/// Bytes come from documents of any age and state, so nothing here trusts them: what cannot be
/// read stays at 0 or empty, a section that was not reached in full has no bytes, and nothing is
/// allocated, whatever a count claims.
///
/// Ownership    A view; the reference outlives it and stays as it is.
class MatchDataReader {
 public:
  class Stream;

  /// Of one section: its version, and what lies behind that.
  struct Section {
    std::uint32_t version = 0;
    char const* begin = nullptr;
    char const* end = nullptr;
  };

  explicit MatchDataReader(MatchData const& data);

  /// True if header and both sections are there.
  bool IsValid() const { return isValid_; }
  /// Which backend wrote the reference: a Properties::Implementation.
  std::uint32_t GetImplementation() const { return implementation_; }
  /// 0 if the reference does not reach so far. It may be there in one that is not valid.
  MatchObjectID GetObjectType() const { return objectType_; }
  /// The same holds for the name.
  EncodedText GetName() const { return name_; }
  Section const& GetSection1() const { return section1_; }
  Section const& GetSection2() const { return section2_; }
  Stream GetSection1Stream() const;
  Stream GetSection2Stream() const;

  bool NamesEndpoint() const;

 private:
  void ReadHeader(Stream& stream);
  static bool ReadSection(Stream& stream, Section& section);

  bool isValid_ = false;
  std::uint32_t implementation_ = 0;
  MatchObjectID objectType_ = MatchObjectID(0);
  EncodedText name_;
  Section section1_;
  Section section2_;
};

/// Reads the fields of a section one after the other. A read that does not fit gives false,
/// leaves its output as it was, and moves to the end.
class MatchDataReader::Stream {
 public:
  Stream(char const* begin, char const* end) : position_(begin), end_(end) {}

  char const* Position() const { return position_; }
  std::size_t Remaining() const { return static_cast<std::size_t>(end_ - position_); }

  /// Any byte but 0 is true.
  bool ReadBool(bool& value);
  bool ReadInt16(std::int16_t& value);
  bool ReadUInt16(std::uint16_t& value);
  bool ReadInt32(std::int32_t& value);
  bool ReadUInt32(std::uint32_t& value);
  bool ReadString(EncodedText& value);
  bool ReadSlotID(SlotID& value);

  bool SkipBool() { return Skip(1); }
  bool SkipString();
  bool Skip(std::size_t count);

 private:
  template <class Integer>
  bool ReadInteger(Integer& value);

  char const* position_;
  char const* end_;
};

}  // namespace Ostinet::Impl
