// SPDX-License-Identifier: MIT
#pragma once

#include <cstdint>
#include <vector>

#include "ostinet/MatchData.h"

namespace Ostinet::Impl {

// The long form of a reference. All integers are big-endian on every machine; n is the number of
// code units of the name.
//
//   offset       size    field
//   0            4       format version, 0
//   4            4       implementation: which backend wrote it
//   8            4       object type: a MatchObjectID
//   12           4       n
//   16           2n      name, UTF-16
//   16+2n        4       L1: length of section 1, plus 4
//   20+2n        4       version of section 1, 0
//   24+2n        L1-4    section 1: what means something to that backend alone
//   20+2n+L1     4       L2: length of section 2, plus 4
//   24+2n+L1     4       version of section 2, 0
//   28+2n+L1     L2-4    section 2: what any backend can compare
//
// In the sections a bool is one byte, a text the 32-bit count of its code units and then those,
// a slot six 32-bit words. What a section holds is told where it is written:
// EndpointReference.cpp for endpoints, MatchTranslator.cpp for everything else.

/// Builds a reference in the long form.
class MatchDataWriter {
 public:
  /// Appends fields to one section.
  class Stream {
   public:
    void WriteBool(bool value);
    void WriteInt16(std::int16_t value);
    void WriteUInt16(std::uint16_t value);
    void WriteInt32(std::int32_t value);
    void WriteUInt32(std::uint32_t value);
    void WriteString(UString const& value);
    void WriteSlotID(SlotID const& value);

   private:
    friend class MatchDataWriter;
    std::vector<char> bytes_;
  };

  MatchDataWriter(Properties::Implementation implementation, MatchObjectID objectType,
                  UString const& name, std::uint32_t section1Version = 0,
                  std::uint32_t section2Version = 0);

  Stream& GetSection1Stream() { return section1_; }
  Stream& GetSection2Stream() { return section2_; }
  MatchData Finish() const;

 private:
  Properties::Implementation const implementation_;
  MatchObjectID const objectType_;
  UString const name_;
  std::uint32_t const section1Version_;
  std::uint32_t const section2Version_;
  Stream section1_;
  Stream section2_;
};

}  // namespace Ostinet::Impl
