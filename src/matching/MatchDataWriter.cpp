// SPDX-License-Identifier: MIT
#include "matching/MatchDataWriter.h"

#include <algorithm>

#include "matching/ByteOrder.h"

namespace Ostinet::Impl {

namespace {

template <class Unsigned>
void Append(std::vector<char>& bytes, Unsigned value) {
  char buffer[sizeof(Unsigned)];
  bytes.insert(bytes.end(), buffer, WriteBigEndian(buffer, value));
}

void Append(std::vector<char>& bytes, UString const& text) {
  Append(bytes, static_cast<std::uint32_t>(text.length()));
  for (char16_t const unit : text) {
    Append(bytes, static_cast<std::uint16_t>(unit));
  }
}

void AppendSection(std::vector<char>& bytes, std::uint32_t version,
                   std::vector<char> const& content) {
  Append(bytes, static_cast<std::uint32_t>(sizeof(version) + content.size()));
  Append(bytes, version);
  bytes.insert(bytes.end(), content.begin(), content.end());
}

}  // namespace

void MatchDataWriter::Stream::WriteBool(bool value) { bytes_.push_back(value ? '\1' : '\0'); }

void MatchDataWriter::Stream::WriteInt16(std::int16_t value) {
  WriteUInt16(static_cast<std::uint16_t>(value));
}

void MatchDataWriter::Stream::WriteUInt16(std::uint16_t value) { Append(bytes_, value); }

void MatchDataWriter::Stream::WriteInt32(std::int32_t value) {
  WriteUInt32(static_cast<std::uint32_t>(value));
}

void MatchDataWriter::Stream::WriteUInt32(std::uint32_t value) { Append(bytes_, value); }

void MatchDataWriter::Stream::WriteString(UString const& value) { Append(bytes_, value); }

void MatchDataWriter::Stream::WriteSlotID(SlotID const& value) {
  for (unsigned int const word : value.words) {
    WriteUInt32(word);
  }
}

MatchDataWriter::MatchDataWriter(Properties::Implementation implementation,
                                 MatchObjectID objectType, UString const& name,
                                 std::uint32_t section1Version, std::uint32_t section2Version)
    : implementation_(implementation),
      objectType_(objectType),
      name_(name),
      section1Version_(section1Version),
      section2Version_(section2Version) {}

MatchData MatchDataWriter::Finish() const {
  constexpr std::size_t kFixedBytes = 32;
  std::vector<char> bytes;
  bytes.reserve(kFixedBytes + 2 * name_.length() + section1_.bytes_.size() +
                section2_.bytes_.size());
  Append(bytes, std::uint32_t{0});
  Append(bytes, static_cast<std::uint32_t>(implementation_));
  Append(bytes, static_cast<std::uint32_t>(objectType_));
  Append(bytes, name_);
  AppendSection(bytes, section1Version_, section1_.bytes_);
  AppendSection(bytes, section2Version_, section2_.bytes_);
  MatchData data(bytes.size());
  std::copy(bytes.begin(), bytes.end(), data.begin());
  return data;
}

}  // namespace Ostinet::Impl
