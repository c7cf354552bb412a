// SPDX-License-Identifier: MIT
#include "devicetypes/DevTypeFileReader.h"

#include <algorithm>
#include <optional>
#include <utility>

#include "core/UStringCompare.h"
#include "devicetypes/AttributeText.h"

namespace Ostinet::Impl {

namespace {

namespace TypeWords {
XMLLib::Name const kRoot("MIDIDeviceTypes");
XMLLib::Name const kAuthor("Author");
XMLLib::Name const kType("MIDIDeviceType");
XMLLib::Name const kInquiryResponse("InquiryResponse");
XMLLib::Name const kDeviceID("DeviceID");
XMLLib::Name const kPortGroup("MIDIPortGroup");
XMLLib::Name const kIn("MIDIIn");
XMLLib::Name const kOut("MIDIOut");
XMLLib::Name const kReceives("Receives");
XMLLib::Name const kTransmits("Transmits");

XMLLib::Name const kManufacturer("Manufacturer");
XMLLib::Name const kModel("Model");
XMLLib::Name const kImage("Image");
XMLLib::Name const kFamily("Family");
XMLLib::Name const kMember("Member");
XMLLib::Name const kDefault("Default");
XMLLib::Name const kMin("Min");
XMLLib::Name const kMax("Max");
XMLLib::Name const kBase("Base");
XMLLib::Name const kName("Name");
XMLLib::Name const kMaxChannels("MaxChannels");
}  // namespace TypeWords

constexpr unsigned kHighestDeviceNumber = 255;
constexpr unsigned kChannels = 16;

UString Quoted(XMLLib::Name const& name) { return "\"" + UString(name.Text()) + "\""; }
UString Quoted(UString const& text) { return "\"" + text + "\""; }

// Three bytes of manufacturer, or one with 0xFF in the places of the two that it lacks.
bool SetManufacturer(std::optional<std::vector<unsigned char>> const& bytes, ModelInfo& info) {
  if (!bytes || (bytes->size() != 1 && bytes->size() != 3)) {
    return false;
  }
  std::fill(info.bytes, info.bytes + 3, static_cast<unsigned char>(0xFF));
  std::copy(bytes->begin(), bytes->end(), info.bytes);
  return true;
}

bool SetPair(std::optional<std::vector<unsigned char>> const& bytes, unsigned char* out) {
  if (!bytes || bytes->size() != 2) {
    return false;
  }
  std::copy(bytes->begin(), bytes->end(), out);
  return true;
}

std::optional<std::vector<unsigned char>> ReadHexBytes(XMLLib::Parser const& parser,
                                                       XMLLib::Name const& name) {
  UString text;
  return parser.ReadReqAttribute(name, text) ? ParseHexBytes(text) : std::nullopt;
}

// What the panel shows as `base` is 0 on the wire. Eight bits, as the wire has them.
std::uint8_t OnWire(unsigned panelNumber, unsigned base) {
  return static_cast<std::uint8_t>(panelNumber - base);
}

}  // namespace

void DevTypeFileReader::Read() {
  XMLLib::Parser parser(file_);
  Read(parser);
}

void DevTypeFileReader::Read(XMLLib::Parser& parser) {
  if (!parser.DownToReqChildNounexp(TypeWords::kRoot)) {
    Note(parser, "the root element is not " + Quoted(TypeWords::kRoot) + ": nothing is read");
    return;
  }
  NoteAttributes(parser, {});
  for (; parser.DownToChild(); parser.UpToParent()) {
    if (parser.CurrentElement() == TypeWords::kType) {
      ReadType(parser);
    } else if (parser.CurrentElement() == TypeWords::kAuthor) {
      NoteAttributes(parser, {});
      author_ = parser.ReadText();
    } else {
      NoteElement(parser, "MIDIDeviceTypes");
    }
  }
}

void DevTypeFileReader::ReadType(XMLLib::Parser& parser) {
  UString manufacturer;
  UString model;
  bool const hasManufacturer = parser.ReadReqAttribute(TypeWords::kManufacturer, manufacturer);
  bool const hasModel = parser.ReadReqAttribute(TypeWords::kModel, model);
  if (!hasManufacturer || !hasModel) {
    Note(parser, "a type without " +
                     Quoted(hasManufacturer ? TypeWords::kModel : TypeWords::kManufacturer) +
                     " is skipped with all that is in it");
    return;
  }
  int const line = parser.CurrentLine();
  RCPtrMT<Type> const type(new Type(std::move(manufacturer), std::move(model)));
  parser.ReadAttribute(TypeWords::kImage, type->image);
  for (std::size_t i = 0; i < type->capabilities.size(); ++i) {
    ReadFlag(parser, kCapabilityFlags[i], type->capabilities[i]);
  }
  NoteAttributes(parser, {&TypeWords::kManufacturer, &TypeWords::kModel, &TypeWords::kImage},
                 kCapabilityFlags);
  for (; parser.DownToChild(); parser.UpToParent()) {
    ReadTypeChild(parser, *type);
  }
  types_.push_back(type);
  lines_.push_back(line);
}

void DevTypeFileReader::ReadTypeChild(XMLLib::Parser& parser, Type& type) {
  XMLLib::Name const& element = parser.CurrentElement();
  if (element == TypeWords::kPortGroup) {
    ReadPortGroup(parser, type);
  } else if (element == TypeWords::kReceives) {
    ReadTraffic(parser, kReceiveFlags, type.receives);
  } else if (element == TypeWords::kTransmits) {
    ReadTraffic(parser, kTransmitFlags, type.transmits);
  } else if (element == TypeWords::kInquiryResponse) {
    ReadInquiryResponse(parser, type);
  } else if (element == TypeWords::kDeviceID) {
    ReadDeviceID(parser, type);
  } else {
    NoteElement(parser, "MIDIDeviceType");
  }
}

// All three or none, and the first that is whole counts.
void DevTypeFileReader::ReadInquiryResponse(XMLLib::Parser const& parser, Type& type) {
  NoteAttributes(parser, {&TypeWords::kManufacturer, &TypeWords::kFamily, &TypeWords::kMember});
  if (!(type.inquiryResponse == ModelInfo())) {
    Note(parser, "the type has an \"InquiryResponse\" already: this one is skipped");
    return;
  }
  ModelInfo info;
  if (!SetManufacturer(ReadHexBytes(parser, TypeWords::kManufacturer), info)) {
    Note(parser,
         "\"Manufacturer\" is not one byte or three, of two digits 0-9 and A-F up to 7F: the "
         "\"InquiryResponse\" is skipped");
    return;
  }
  unsigned char* out = info.bytes + 3;
  for (XMLLib::Name const* name : {&TypeWords::kFamily, &TypeWords::kMember}) {
    if (!SetPair(ReadHexBytes(parser, *name), out)) {
      Note(parser, Quoted(*name) +
                       " is not two bytes, of two digits 0-9 and A-F up to 7F: the "
                       "\"InquiryResponse\" is skipped");
      return;
    }
    out += 2;
  }
  type.inquiryResponse = info;
}

void DevTypeFileReader::ReadDeviceID(XMLLib::Parser const& parser, Type& type) {
  NoteAttributes(parser,
                 {&TypeWords::kDefault, &TypeWords::kMin, &TypeWords::kMax, &TypeWords::kBase});
  if (type.hasDeviceID) {
    Note(parser, "the type has a \"DeviceID\" already: this one is skipped");
    return;
  }
  XMLLib::Name const* const names[] = {&TypeWords::kDefault, &TypeWords::kMin, &TypeWords::kMax,
                                       &TypeWords::kBase};
  unsigned numbers[4] = {};
  for (std::size_t i = 0; i < 4; ++i) {
    auto const number = ReadDecimal(parser, *names[i], kHighestDeviceNumber);
    if (!number) {
      Note(parser, Quoted(*names[i]) + " is no number from 0 to 255: the \"DeviceID\" is skipped");
      return;
    }
    numbers[i] = *number;
  }
  type.hasDeviceID = true;
  type.defaultDeviceID = OnWire(numbers[0], numbers[3]);
  type.minDeviceID = OnWire(numbers[1], numbers[3]);
  type.maxDeviceID = OnWire(numbers[2], numbers[3]);
}

// A name that is absent leaves the text empty, and its port is called as its entity calls it.
void DevTypeFileReader::ReadPortGroup(XMLLib::Parser& parser, Type& type) {
  DeviceTypePortGroup group;
  NoteAttributes(parser, {&TypeWords::kName});
  UString text;
  parser.ReadAttribute(TypeWords::kName, text);
  group.name = text;
  for (; parser.DownToChild(); parser.UpToParent()) {
    bool const isIn = parser.CurrentElement() == TypeWords::kIn;
    if (!isIn && parser.CurrentElement() != TypeWords::kOut) {
      NoteElement(parser, "MIDIPortGroup");
      continue;
    }
    NoteAttributes(parser, {&TypeWords::kName});
    parser.ReadAttribute(TypeWords::kName, text);
    (isIn ? group.ins : group.outs).push_back(text);
  }
  type.portGroups.push_back(std::move(group));
}

void DevTypeFileReader::ReadFlag(XMLLib::Parser const& parser, DeviceTypeFlag const& flag,
                                 TriBool& value) {
  UString word;
  if (flag.attribute.empty() || !parser.ReadAttribute(flag.attribute, word)) {
    return;
  }
  bool isTrue = false;
  if (XMLLib::kBoolAttribute.Find(word, isTrue)) {
    value = isTrue ? TriBool::kTrue : TriBool::kFalse;
  } else {
    Note(parser, Quoted(flag.attribute) + " is neither \"true\" nor \"false\": it is skipped");
  }
}

template <std::size_t N>
void DevTypeFileReader::ReadTraffic(XMLLib::Parser const& parser, DeviceTypeFlag const (&flags)[N],
                                    DeviceTypeTraffic<N>& traffic) {
  NoteAttributes(parser, {&TypeWords::kMaxChannels}, flags);
  UString text;
  if (parser.ReadAttribute(TypeWords::kMaxChannels, text)) {
    if (auto const channels = ParseDecimal(text, kChannels)) {
      traffic.maxChannels = static_cast<std::uint16_t>(*channels);
    } else {
      Note(parser, "\"MaxChannels\" is no number from 0 to 16: it is skipped");
    }
  }
  for (std::size_t i = 0; i < N; ++i) {
    ReadFlag(parser, flags[i], traffic.flags[i]);
  }
}

UString DevTypeFileReader::FindImage(UString const& name) const {
  Folder const folder = file_.ParentFolder();
  for (Folder const& place : {folder, folder.GetSubFolder("Images")}) {
    File const image = place.GetFile(name);
    if (!name.empty() && image.IsFile()) {
      return image.GetFullPath();
    }
  }
  return UString();
}

void DevTypeFileReader::Note(XMLLib::Parser const& parser, UString const& text) {
  if (notes_ != nullptr) {
    notes_->push_back({parser.CurrentLine(), text});
  }
}

void DevTypeFileReader::NoteElement(XMLLib::Parser const& parser, char const* place) {
  if (notes_ != nullptr) {
    Note(parser, "nothing is known of " + Quoted(parser.CurrentElement()) + " inside " +
                     Quoted(UString(place)) + ": it is skipped");
  }
}

void DevTypeFileReader::NoteAttributes(XMLLib::Parser const& parser,
                                       std::initializer_list<XMLLib::Name const*> known,
                                       std::span<DeviceTypeFlag const> flags) {
  if (notes_ == nullptr) {
    return;
  }
  for (XMLLib::Name const& name : parser.AttributeNames()) {
    bool const isKnown =
        std::any_of(known.begin(), known.end(), [&](auto* other) { return *other == name; }) ||
        std::any_of(flags.begin(), flags.end(), [&](auto& flag) { return flag.attribute == name; });
    if (!isKnown) {
      Note(parser, Quoted(parser.CurrentElement()) + " knows no attribute " + Quoted(name) +
                       ": it is skipped");
    }
  }
}

bool IsSameModel(DeviceTypeInfoImpl const& a, DeviceTypeInfoImpl const& b) {
  return a.manufacturer.equal(b.manufacturer, UString::kCatalogKey) &&
         a.model.equal(b.model, UString::kCatalogKey);
}

bool ComesBefore(DeviceTypeInfoImpl const& a, DeviceTypeInfoImpl const& b) {
  int const makers =
      CompareUnits(a.manufacturer.utf16_str(), b.manufacturer.utf16_str(), UString::kCatalogKey);
  return makers != 0 ? makers < 0 : a.model.less(b.model, UString::kCatalogKey);
}

}  // namespace Ostinet::Impl
