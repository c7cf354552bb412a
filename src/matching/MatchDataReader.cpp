// SPDX-License-Identifier: MIT
#include "matching/MatchDataReader.h"

#include "ostinet/Endpoint.h"

namespace Ostinet::Impl {

MatchDataReader::MatchDataReader(MatchData const& data) {
  Stream stream(data.begin(), data.end());
  ReadHeader(stream);
}

// Stops at the first thing that is not there; what was read before it stays, so that a reference
// cut short behind its name can still be shown under it.
void MatchDataReader::ReadHeader(Stream& stream) {
  std::uint32_t version = 0;
  std::uint32_t type = 0;
  if (!stream.ReadUInt32(version) || version != 0 || !stream.ReadUInt32(implementation_) ||
      !stream.ReadUInt32(type)) {
    return;
  }
  objectType_ = static_cast<MatchObjectID>(type);
  isValid_ =
      stream.ReadString(name_) && ReadSection(stream, section1_) && ReadSection(stream, section2_);
}

// The length counts the version too. A section gets its bounds only when it is there as a whole:
// its fields are looked for nowhere else.
bool MatchDataReader::ReadSection(Stream& stream, Section& section) {
  std::uint32_t length = 0;
  if (!stream.ReadUInt32(length) || length > stream.Remaining()) {
    return false;
  }
  Stream content(stream.Position(), stream.Position() + length);
  stream.Skip(length);
  if (!content.ReadUInt32(section.version)) {
    return false;
  }
  section.begin = content.Position();
  section.end = stream.Position();
  return true;
}

MatchDataReader::Stream MatchDataReader::GetSection1Stream() const {
  return Stream(section1_.begin, section1_.end);
}

MatchDataReader::Stream MatchDataReader::GetSection2Stream() const {
  return Stream(section2_.begin, section2_.end);
}

bool MatchDataReader::NamesEndpoint() const {
  return objectType_ == Source::kObjectID || objectType_ == Destination::kObjectID;
}

bool MatchDataReader::Stream::Skip(std::size_t count) {
  bool const fits = count <= Remaining();
  position_ = fits ? position_ + count : end_;
  return fits;
}

template <class Integer>
bool MatchDataReader::Stream::ReadInteger(Integer& value) {
  char const* const bytes = position_;
  if (!Skip(sizeof(Integer))) {
    return false;
  }
  std::uint32_t bits = 0;
  for (std::size_t i = 0; i < sizeof(Integer); ++i) {
    bits = bits << 8 | static_cast<unsigned char>(bytes[i]);
  }
  value = static_cast<Integer>(bits);
  return true;
}

bool MatchDataReader::Stream::ReadBool(bool& value) {
  unsigned char byte = 0;
  if (!ReadInteger(byte)) {
    return false;
  }
  value = byte != 0;
  return true;
}

bool MatchDataReader::Stream::ReadInt16(std::int16_t& value) { return ReadInteger(value); }
bool MatchDataReader::Stream::ReadUInt16(std::uint16_t& value) { return ReadInteger(value); }
bool MatchDataReader::Stream::ReadInt32(std::int32_t& value) { return ReadInteger(value); }
bool MatchDataReader::Stream::ReadUInt32(std::uint32_t& value) { return ReadInteger(value); }

bool MatchDataReader::Stream::ReadString(EncodedText& value) {
  std::uint32_t count = 0;
  if (!ReadUInt32(count)) {
    return false;
  }
  if (count > Remaining() / 2) {
    position_ = end_;
    return false;
  }
  value = EncodedText(position_, count);
  return Skip(std::size_t{2} * count);
}

bool MatchDataReader::Stream::SkipString() {
  EncodedText text;
  return ReadString(text);
}

bool MatchDataReader::Stream::ReadSlotID(SlotID& value) {
  SlotID slot;
  for (unsigned int& word : slot.words) {
    if (!ReadUInt32(word)) {
      return false;
    }
  }
  value = slot;
  return true;
}

}  // namespace Ostinet::Impl
