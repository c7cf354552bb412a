// SPDX-License-Identifier: MIT
#include "devicetypes/AutodetectFileReader.h"

#include "devicetypes/AttributeText.h"

namespace Ostinet::Impl {

namespace {

namespace RequestWords {

XMLLib::Name const kRoot("MIDIAutoDetect");
XMLLib::Name const kRequest("Request");
XMLLib::Name const kRequestMIDI("RequestMIDI");
XMLLib::Name const kResponse("Response");
XMLLib::Name const kResponseMIDI("ResponseMIDI");
XMLLib::Name const kDevice("Device");
XMLLib::Name const kManufacturer("Manufacturer");
XMLLib::Name const kModel("Model");
XMLLib::Name const kDeviceID("DeviceID");
XMLLib::Name const kOffset("Offset");
XMLLib::Name const kAny("Any");

}  // namespace RequestWords

constexpr unsigned char kEndOfExclusive = 0xF7;
constexpr unsigned char kLastSlot = 0xFF;
constexpr unsigned kHighestOffset = 255;

// The value of a hexadecimal digit, or -1.
int DigitOrNone(char16_t unit) {
  if (unit >= u'0' && unit <= u'9') return unit - u'0';
  if (unit >= u'A' && unit <= u'F') return unit - u'A' + 10;
  if (unit >= u'a' && unit <= u'f') return unit - u'a' + 10;
  return -1;
}

// Whatever is no digit repeats the one before it. Tables in the field hold such characters, and
// what they match depends on it.
void AddBytes(UString const& text, std::vector<MatchEntry>& table) {
  int last = 0;
  int high = -1;  // the first digit of a pair that waits for its second
  for (char16_t const unit : text) {
    if (XMLLib::Parser::IsWhitespace(unit)) {
      continue;
    }
    int const digit = DigitOrNone(unit);
    last = digit < 0 ? last : digit;
    if (high < 0) {
      high = last;
    } else {
      table.push_back({0, static_cast<unsigned char>(high * 16 + last)});
      high = -1;
    }
  }
}

// A reply whose tail was cut, or runs into other data, fits as well: its last byte may be anything.
void LoosenEnd(std::vector<MatchEntry>& table) {
  if (!table.empty() && table.back().kind == 0 && table.back().value == kEndOfExclusive) {
    table.back().value = kAnyByte;
  }
}

}  // namespace

void AutodetectFileReader::ReadRequests(AutodetectRequests& requests) {
  if (!parser_.DownToReqChildNounexp(RequestWords::kRoot)) {
    return;
  }
  for (; parser_.DownToChildNounexp(RequestWords::kRequest); parser_.UpToParent()) {
    requests.push_back(ReadRequest());
  }
}

// A search passes over what is not wanted, so responses count only behind their message, and a
// request without a message has none.
RCPtrMT<AutodetectRequestImpl> AutodetectFileReader::ReadRequest() {
  RCPtrMT<AutodetectRequestImpl> const request = new AutodetectRequestImpl;
  if (parser_.DownToReqChildNounexp(RequestWords::kRequestMIDI)) {
    request->messages.push_back(ReadTemplate(Template::kRequest));
    parser_.UpToParent();
  }
  bool found = false;
  for (; parser_.DownToReqChildrenNounexp(RequestWords::kResponse, found); parser_.UpToParent()) {
    request->responses.push_back(ReadResponse());
  }
  return request;
}

RCPtrMT<AutodetectResponseImpl> AutodetectFileReader::ReadResponse() {
  RCPtrMT<AutodetectResponseImpl> const response = new AutodetectResponseImpl;
  if (parser_.DownToReqChildNounexp(RequestWords::kResponseMIDI)) {
    response->table = ReadTemplate(Template::kResponse);
    parser_.UpToParent();
  }
  for (; parser_.DownToChild(); parser_.UpToParent()) {
    if (parser_.CurrentElement() == RequestWords::kDevice) {
      response->deviceTypes.push_back(ReadDevice());
    } else if (parser_.CurrentElement() == RequestWords::kRequest) {
      response->requests.push_back(ReadRequest());
    }
  }
  LoosenEnd(response->table);
  return response;
}

std::vector<MatchEntry> AutodetectFileReader::ReadTemplate(Template which) {
  std::vector<MatchEntry> table;
  for (;; parser_.UpToParent()) {
    AddBytes(parser_.ReadText(), table);
    if (!parser_.DownToChild()) {
      return table;
    }
    if (parser_.CurrentElement() == RequestWords::kDeviceID) {
      unsigned const offset =
          ReadDecimal(parser_, RequestWords::kOffset, kHighestOffset).value_or(0);
      table.push_back({1, static_cast<unsigned char>(offset)});
    } else if (which == Template::kResponse && parser_.CurrentElement() == RequestWords::kAny) {
      table.push_back({0, kLastSlot});
    }
  }
}

// A type without a name is never looked for: it may be none that a file defines.
RCPtrMT<DeviceTypeInfoImpl> AutodetectFileReader::ReadDevice() {
  UString manufacturer;
  UString model;
  if (parser_.ReadReqAttribute(RequestWords::kManufacturer, manufacturer) &&
      parser_.ReadReqAttribute(RequestWords::kModel, model)) {
    for (auto const& type : types_) {
      if (type->manufacturer.equal(manufacturer, UString::kCatalogKey) &&
          type->model.equal(model, UString::kCatalogKey)) {
        return type;
      }
    }
  }
  types_.push_back(new DeviceTypeInfoImpl(manufacturer, model));
  return types_.back();
}

}  // namespace Ostinet::Impl
