// SPDX-License-Identifier: MIT
#include "devicetypes/AutodetectInquiry.h"

namespace Ostinet::Impl {

namespace {

constexpr MatchEntry kDeviceID = {1, 0};

// Both answers end at the member code: revisions differ in length, and so does what follows.
constexpr MatchEntry kMessage[] = {{0, 0xF0}, {0, 0x7E}, kDeviceID,
                                   {0, 0x06}, {0, 0x01}, {0, 0xF7}};
constexpr MatchEntry kShortAnswer[] = {{0, 0xF0}, {0, 0x7E}, kDeviceID, {0, 0x06}, {0, 0x02},
                                       {0, 0xF9}, {0, 0xFC}, {0, 0xFD}, {0, 0xFE}, {0, 0xFF}};
constexpr MatchEntry kLongAnswer[] = {{0, 0xF0}, {0, 0x7E}, kDeviceID, {0, 0x06},
                                      {0, 0x02}, {0, 0xF9}, {0, 0xFA}, {0, 0xFB},
                                      {0, 0xFC}, {0, 0xFD}, {0, 0xFE}, {0, 0xFF}};

template <std::size_t N>
std::vector<MatchEntry> TableOf(MatchEntry const (&entries)[N]) {
  return std::vector<MatchEntry>(entries, entries + N);
}

template <std::size_t N>
RCPtrMT<AutodetectResponseImpl> Answer(MatchEntry const (&entries)[N]) {
  RCPtrMT<AutodetectResponseImpl> const response = new AutodetectResponseImpl;
  response->table = TableOf(entries);
  return response;
}

}  // namespace

RCPtrMT<AutodetectRequestImpl> BuildInquiryRequest(DeviceTypes const& types) {
  RCPtrMT<AutodetectResponseImpl> const shortAnswer = Answer(kShortAnswer);
  RCPtrMT<AutodetectResponseImpl> const longAnswer = Answer(kLongAnswer);
  for (auto const& type : types) {
    if (type->inquiryResponse == ModelInfo()) {
      continue;
    }
    bool const isShort = type->inquiryResponse.bytes[1] == 0xFF;
    (isShort ? shortAnswer : longAnswer)->deviceTypes.push_back(type);
  }
  RCPtrMT<AutodetectRequestImpl> const request = new AutodetectRequestImpl;
  request->messages.push_back(TableOf(kMessage));
  request->responses = {shortAnswer, longAnswer};
  return request;
}

}  // namespace Ostinet::Impl
