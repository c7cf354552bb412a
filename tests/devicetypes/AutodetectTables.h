// SPDX-License-Identifier: MIT
#pragma once

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "devicetypes/AutodetectImpl.h"

namespace Ostinet {

inline bool operator==(MatchEntry const& a, MatchEntry const& b) {
  return a.kind == b.kind && a.value == b.value;
}

inline void PrintTo(MatchEntry const& entry, std::ostream* out) {
  *out << "{" << int{entry.kind} << ", 0x" << std::hex << int{entry.value} << std::dec << "}";
}

namespace Testing {

using Table = std::vector<MatchEntry>;
using Bytes = std::vector<unsigned char>;

/// Hexadecimal bytes with blanks between; "ID" is the device ID's place, "ID+20" with an offset.
inline Table TableOf(std::string const& text) {
  Table table;
  for (std::size_t i = 0; i < text.size(); i = text.find_first_not_of(' ', i)) {
    std::size_t const end = std::min(text.find(' ', i), text.size());
    std::string const word = text.substr(i, end - i);
    bool const isID = word.rfind("ID", 0) == 0;
    std::string const digits = isID ? (word.size() > 3 ? word.substr(3) : "0") : word;
    table.push_back({static_cast<unsigned char>(isID ? 1 : 0),
                     static_cast<unsigned char>(std::stoi(digits, nullptr, 16))});
    i = end;
  }
  return table;
}

inline Bytes BytesOf(std::string const& text) {
  Bytes bytes;
  for (MatchEntry const& entry : TableOf(text)) {
    bytes.push_back(entry.value);
  }
  return bytes;
}

using Captured = Array<unsigned char, 7>;

inline Captured Untouched() { return {{0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF}}; }
inline Bytes BytesOf(Captured const& captured) {
  return Bytes(captured.elements, captured.elements + 7);
}

inline RCPtrMT<Impl::AutodetectResponseImpl> Answer(std::string const& table) {
  RCPtrMT<Impl::AutodetectResponseImpl> const response = new Impl::AutodetectResponseImpl;
  response->table = TableOf(table);
  return response;
}

inline RCPtrMT<Impl::AutodetectRequestImpl> Question(std::string const& message) {
  RCPtrMT<Impl::AutodetectRequestImpl> const request = new Impl::AutodetectRequestImpl;
  request->messages.push_back(TableOf(message));
  return request;
}

inline RCPtrMT<Impl::DeviceTypeInfoImpl> SomeType(char const* model) {
  return new Impl::DeviceTypeInfoImpl(UString("Maker"), UString(model));
}

inline RCPtrMT<Impl::DeviceTypeInfoImpl> TypeWithIdentity(char const* model,
                                                          std::string const& identity) {
  auto const type = SomeType(model);
  Bytes const bytes = BytesOf(identity);
  std::copy(bytes.begin(), bytes.end(), type->inquiryResponse.bytes);
  return type;
}

inline RCPtrMT<Impl::DeviceTypeInfoImpl> TypeWithIDs(char const* model, int first, int last) {
  auto const type = SomeType(model);
  type->hasDeviceID = true;
  type->defaultDeviceID = type->minDeviceID = static_cast<unsigned char>(first);
  type->maxDeviceID = static_cast<unsigned char>(last);
  return type;
}

}  // namespace Testing
}  // namespace Ostinet
