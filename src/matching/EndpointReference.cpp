// SPDX-License-Identifier: MIT
//
// References of live endpoints.
//
//   section 1    unique ID             32 bits, signed; 0 is none
//                that of the port      32 bits, signed; of an instrument that hangs on a port
//                full name             bool, true: the name is the one to show
//   section 2    manufacturer, model   texts
//                direct, software, supports General MIDI, internal software
//                                      bools
//                slot                  slot
//
// The short form is for passing a reference on within a machine: 16 bytes, four words in the byte
// order of the machine: 1, implementation, object type, unique ID. A reader of the long form takes
// its first word for a version that it does not know.
#include <array>
#include <cstdint>
#include <cstring>

#include "matching/MatchDataWriter.h"
#include "model/Handles.h"
#include "model/PropertyKeys.h"
#include "ostinet/Setup.h"

namespace Ostinet {

using Impl::EndpointImpl;
using Impl::ImplOf;

namespace {

using ShortForm = std::array<std::uint32_t, 4>;

ShortForm ShortFormOf(EndpointImpl const& endpoint) {
  constexpr std::uint32_t kMark = 1;
  auto const& properties = endpoint.GetSetup().GetProperties();
  return {kMark, static_cast<std::uint32_t>(properties.GetImplementation()),
          static_cast<std::uint32_t>(endpoint.GetObjectID()),
          static_cast<std::uint32_t>(endpoint.GetInt(Impl::Keys::kUniqueID, 0))};
}

}  // namespace

MatchData Endpoint::GetMatchData() const {
  EndpointImpl const* const impl = ImplOf(*this);
  if (impl == nullptr) {
    return MatchData();
  }
  Impl::MatchDataWriter writer(impl->Peer()->GetImplementation(), impl->GetObjectID(), GetName());
  auto& section1 = writer.GetSection1Stream();
  EndpointImpl const* const port = impl->IsDirect() ? nullptr : impl->GetDirectEndpoint();
  section1.WriteInt32(GetUniqueID());
  section1.WriteInt32(port != nullptr ? port->GetInt(Impl::Keys::kUniqueID, 0) : 0);
  section1.WriteBool(true);

  auto& section2 = writer.GetSection2Stream();
  section2.WriteString(GetManufacturer());
  section2.WriteString(GetModel());
  section2.WriteBool(IsDirect());
  section2.WriteBool(IsSoftware());
  section2.WriteBool(SupportsGeneralMIDI());
  section2.WriteBool(IsInternalSoftware());
  section2.WriteSlotID(GetSlotID());
  return writer.Finish();
}

MatchData Endpoint::GetShortMatchData() const {
  EndpointImpl const* const impl = ImplOf(*this);
  if (impl == nullptr) {
    return MatchData();
  }
  ShortForm const words = ShortFormOf(*impl);
  MatchData data(sizeof words);
  std::memcpy(data.begin(), words.data(), sizeof words);
  return data;
}

// Bytes behind the sixteen do not matter.
bool Endpoint::MatchToShortData(MatchData const& data) const {
  EndpointImpl const* const impl = ImplOf(*this);
  ShortForm words;
  if (impl == nullptr || data.size() < sizeof words) {
    return false;
  }
  std::memcpy(words.data(), data.begin(), sizeof words);
  return words == ShortFormOf(*impl);
}

}  // namespace Ostinet
