// SPDX-License-Identifier: MIT
//
// References that were not made by a live endpoint.
//
//                section 1                              section 2
//   bare name    nothing                                two empty texts, three bools, all false
//   older form   kind (32 bits, the sign extended),     manufacturer, model; direct, software,
//                then by kind, as FieldsOfKind writes   General MIDI (always false)
//
// Section 1 keeps the older record's fields, so that a record which comes back is the one that
// went, whatever the device codes in use know of it.
#include <cstdint>
#include <cstring>
#include <memory>

#include "matching/DeviceCodes.h"
#include "matching/MatchDataReader.h"
#include "matching/MatchDataWriter.h"
#include "ostinet/Endpoint.h"

namespace Ostinet {

using Impl::DeviceCodesByText;
using Impl::DeviceNumbers;
using Impl::DeviceTexts;
using Impl::DeviceTextsByCode;
using Impl::EncodedText;
using Impl::MatchDataReader;
using Impl::MatchDataWriter;

namespace {

enum Kind : short {
  kNothing = -1,
  kExternalDevice = 0,  // known by its codes
  kSoftwareKind = 2,
  kDirectPort = 3,
  kOtherSoftware = 4,
};

bool IsSoftwareKind(short kind) { return kind == kSoftwareKind || kind == kOtherSoftware; }

void WriteFieldsOfKind(MatchDataWriter::Stream& stream, BreviaDestinationMatch const& record) {
  auto const& fields = record.fields;
  if (IsSoftwareKind(record.kind)) {
    stream.WriteUInt32(record.software.long2);
  } else if (record.kind == kExternalDevice || record.kind == kDirectPort) {
    stream.WriteUInt16(fields.word2);
    stream.WriteUInt32(fields.long4);
    stream.WriteInt16(fields.word8);
    stream.WriteInt16(fields.word10);
    if (record.kind == kExternalDevice) {
      stream.WriteInt32(fields.manufacturerCode);
      stream.WriteInt32(fields.modelCode);
      stream.WriteInt16(fields.word20);
    }
  }
}

// Members of a packed record cannot be bound to references.
template <class Field, class Value>
bool Take(bool (MatchDataReader::Stream::*read)(Value&), MatchDataReader::Stream& stream,
          Field&& store) {
  Value value = 0;
  if (!(stream.*read)(value)) {
    return false;
  }
  store(value);
  return true;
}

// Stops at the first field that is missing; it and those behind it stay as they were.
void ReadFieldsOfKind(MatchDataReader::Stream& stream, BreviaDestinationMatch& record) {
  using Stream = MatchDataReader::Stream;
  auto& fields = record.fields;
  if (IsSoftwareKind(record.kind)) {
    Take(&Stream::ReadUInt32, stream, [&](auto value) { record.software.long2 = value; });
  } else if (record.kind == kExternalDevice || record.kind == kDirectPort) {
    bool const hasPort =
        Take(&Stream::ReadUInt16, stream, [&](auto value) { fields.word2 = value; }) &&
        Take(&Stream::ReadUInt32, stream, [&](auto value) { fields.long4 = value; }) &&
        Take(&Stream::ReadInt16, stream, [&](auto value) { fields.word8 = value; }) &&
        Take(&Stream::ReadInt16, stream, [&](auto value) { fields.word10 = value; });
    if (hasPort && record.kind == kExternalDevice) {
      static_cast<void>(
          Take(&Stream::ReadInt32, stream, [&](auto value) { fields.manufacturerCode = value; }) &&
          Take(&Stream::ReadInt32, stream, [&](auto value) { fields.modelCode = value; }) &&
          Take(&Stream::ReadInt16, stream, [&](auto value) { fields.word20 = value; }));
    }
  }
}

// What section 2 of any reference tells.
struct Description {
  DeviceTexts texts;
  bool isDirect = false;
  bool isSoftware = false;
};

bool ReadDescription(MatchDataReader const& reader, Description& out) {
  MatchDataReader::Stream stream = reader.GetSection2Stream();
  EncodedText manufacturer;
  EncodedText model;
  if (reader.GetSection2().version != 0 || !stream.ReadString(manufacturer) ||
      !stream.ReadString(model) || !stream.ReadBool(out.isDirect) ||
      !stream.ReadBool(out.isSoftware)) {
    return false;
  }
  out.texts = {manufacturer.Decode(), model.Decode()};
  return true;
}

short KindOf(Description const& description) {
  if (description.isSoftware) {
    return kSoftwareKind;
  }
  return description.isDirect ? kDirectPort : kExternalDevice;
}

void ReadKept(MatchDataReader const& reader, BreviaDestinationMatch& record) {
  MatchDataReader::Stream stream = reader.GetSection1Stream();
  std::uint32_t kind = 0;
  if (reader.GetSection1().version == 0 &&
      reader.GetImplementation() == Properties::kOlderImplementation && stream.ReadUInt32(kind)) {
    record.kind = static_cast<short>(kind);
    ReadFieldsOfKind(stream, record);
  }
}

}  // namespace

MatchTranslator::MatchTranslator() = default;
MatchTranslator::~MatchTranslator() = default;

MatchData MatchTranslator::TranslateFromBrevia(BreviaDestinationMatch const& record,
                                               bool isSource) {
  UString const name(record.fields.name, UString::kLatin1);
  MatchDataWriter writer(Properties::kOlderImplementation,
                         isSource ? Source::kObjectID : Destination::kObjectID, name);
  MatchDataWriter::Stream& section1 = writer.GetSection1Stream();
  section1.WriteInt32(record.kind);
  WriteFieldsOfKind(section1, record);

  DeviceTexts texts;
  if (record.kind == kExternalDevice) {
    if (textsByCode_ == nullptr) {
      textsByCode_ = std::make_unique<DeviceTextsByCode>(Impl::DeviceCodesFile());
    }
    texts = textsByCode_->Find({record.fields.manufacturerCode, record.fields.modelCode});
  }
  MatchDataWriter::Stream& section2 = writer.GetSection2Stream();
  section2.WriteString(texts.manufacturer);
  section2.WriteString(texts.model);
  section2.WriteBool(record.kind != kExternalDevice && record.kind != kNothing);
  section2.WriteBool(IsSoftwareKind(record.kind));
  section2.WriteBool(false);
  return writer.Finish();
}

BreviaDestinationMatch MatchTranslator::TranslateToBrevia(MatchData const& data, bool& isSource) {
  BreviaDestinationMatch record{};
  std::memset(&record, 0, sizeof record);  // its gaps too: hosts compare whole records
  record.kind = kNothing;
  MatchDataReader const reader(data);
  if (!reader.NamesEndpoint()) {
    return record;
  }
  isSource = reader.GetObjectType() == Source::kObjectID;
  constexpr int kLongestName = 255;
  reader.GetName().Decode().pstring(record.fields.name, kLongestName, UString::kLatin1, '?');

  Description description;
  if (ReadDescription(reader, description)) {
    record.kind = KindOf(description);
    if (record.kind == kExternalDevice) {
      if (codesByText_ == nullptr) {
        codesByText_ = std::make_unique<DeviceCodesByText>(Impl::DeviceCodesFile());
      }
      DeviceNumbers const numbers = codesByText_->Find(description.texts);
      record.fields.manufacturerCode = numbers.manufacturer;
      record.fields.modelCode = numbers.model;
    }
  }
  ReadKept(reader, record);
  return record;
}

MatchData MatchTranslator::TranslateFromNameOnly(MatchObjectID type, UString const& name) {
  MatchDataWriter writer(Properties::kNoImplementation, type, name);
  MatchDataWriter::Stream& section2 = writer.GetSection2Stream();
  section2.WriteString(UString());
  section2.WriteString(UString());
  section2.WriteBool(false);
  section2.WriteBool(false);
  section2.WriteBool(false);
  return writer.Finish();
}

}  // namespace Ostinet
