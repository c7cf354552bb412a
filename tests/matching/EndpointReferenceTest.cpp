// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <cstdint>
#include <cstring>

#include "matching/HexBytes.h"
#include "support/TestSetup.h"

namespace Ostinet {
namespace {

using Impl::EndpointKind;
using Testing::FirstBytes;
using Testing::Hex;
using Testing::TestSetup;
using Testing::ToHex;

class EndpointReference : public testing::Test {
 protected:
  EndpointReference() { setup.Reset(); }
  ~EndpointReference() override { setup.Reset(); }

  TestSetup& setup = TestSetup::Get();
};

MatchData ShortForm(std::uint32_t a, std::uint32_t b, std::uint32_t c, std::uint32_t d) {
  std::uint32_t const words[] = {a, b, c, d};
  MatchData data(sizeof words);
  std::memcpy(data.begin(), words, sizeof words);
  return data;
}

TEST_F(EndpointReference, OfAPortHasTheseBytes) {
  Destination const port = setup.MakePort("MIDI 1");
  TestSetup::SetInt(port, "uniqueID", -2);
  EXPECT_EQ(ToHex(port.GetMatchData()),
            Hex("00 00 00 00  00 00 00 03  00 00 00 04  00 00 00 06 "
                "00 4D 00 49 00 44 00 49 00 20 00 31 "
                "00 00 00 0D  00 00 00 00  FF FF FF FE  00 00 00 00  01 "
                "00 00 00 28  00 00 00 00  00 00 00 00  00 00 00 00  01 00 00 00 "
                "00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00"));
}

TEST_F(EndpointReference, OfAnInstrumentTellsItsPort) {
  Destination const port = setup.MakePort("Port");
  TestSetup::SetInt(port, "uniqueID", 0x0A0B0C0D);
  Destination const pad = setup.MakeInstrument("Pad");
  TestSetup::SetInt(pad, "uniqueID", 0x01020304);
  pad.SetManufacturer("Ac");
  pad.SetModel("S");
  pad.SetSupportsGeneralMIDI(true);
  port.AddConnectedDestination(pad);
  EXPECT_EQ(ToHex(pad.GetMatchData()), Hex(Testing::kExternalDestination));
}

TEST_F(EndpointReference, OfInternalSoftwareTellsItsSlot) {
  Source const source = setup.MakeSource("FX", EndpointKind::Software(false, true));
  TestSetup::PeerOf(source).SetIntList("slotDescriptor", {1, 2, 3, 4, 5, 6, 7});
  SlotID const slot = source.GetMatchData().GetSlotID();
  EXPECT_EQ(slot, source.GetSlotID());
  EXPECT_EQ(slot.words[5], 6u);
  EXPECT_TRUE(source.GetMatchData().ObjectIsInternalSoftware());
  EXPECT_TRUE(source.GetMatchData().ObjectIsSoftware());
}

TEST_F(EndpointReference, ChangesWithWhatItTells) {
  Destination const port = setup.MakePort("Port");
  MatchData const before = port.GetMatchData();
  EXPECT_EQ(port.GetMatchData(), before);
  port.SetRawName("Other");
  EXPECT_NE(port.GetMatchData(), before);
}

TEST_F(EndpointReference, OfANullHandleIsEmpty) {
  Destination const none;
  EXPECT_TRUE(none.GetMatchData().empty());
  EXPECT_TRUE(none.GetShortMatchData().empty());
  EXPECT_FALSE(none.MatchToShortData(ShortForm(1, 3, 4, 0)));
}

TEST_F(EndpointReference, HasAShortFormInTheMachinesByteOrder) {
  Destination const port = setup.MakePort("Port");
  TestSetup::SetInt(port, "uniqueID", 77);
  EXPECT_EQ(port.GetShortMatchData(), ShortForm(1, 3, 4, 77));
  Source const source = setup.MakeSourcePort("Port");
  TestSetup::SetInt(source, "uniqueID", 78);
  EXPECT_EQ(source.GetShortMatchData(), ShortForm(1, 3, 3, 78));
}

TEST_F(EndpointReference, TheShortFormNamesOneEndpoint) {
  Destination const port = setup.MakePort("Port");
  TestSetup::SetInt(port, "uniqueID", 77);
  EXPECT_TRUE(port.MatchToShortData(port.GetShortMatchData()));
  EXPECT_FALSE(port.MatchToShortData(ShortForm(0, 3, 4, 77)));
  EXPECT_FALSE(port.MatchToShortData(ShortForm(1, 2, 4, 77)));
  EXPECT_FALSE(port.MatchToShortData(ShortForm(1, 3, 3, 77)));
  EXPECT_FALSE(port.MatchToShortData(ShortForm(1, 3, 4, 78)));
  EXPECT_FALSE(port.MatchToShortData(port.GetMatchData()));
}

TEST_F(EndpointReference, TheShortFormNeedsSixteenBytes) {
  Destination const port = setup.MakePort("Port");
  MatchData const data = port.GetShortMatchData();
  EXPECT_FALSE(port.MatchToShortData(FirstBytes(data, 15)));
  MatchData longer(17);
  std::copy(data.begin(), data.end(), longer.begin());
  EXPECT_TRUE(port.MatchToShortData(longer));
}

TEST_F(EndpointReference, MakesAVirtualEndpoint) {
  setup.CreateVirtualEndpoint(Testing::FromHex(Testing::kExternalDestination), Setup::kSourceEnd,
                              Setup::kNeitherEnd);
  ASSERT_EQ(setup.calls.size(), 1u);
  EXPECT_EQ(setup.calls[0], "CreateVirtualEndpoint Pad " + std::to_string(0x01020304) + " 0 2");
}

// Another backend's section means nothing here, the plug-in engine's included.
TEST_F(EndpointReference, MakesAVirtualEndpointWithoutAForeignID) {
  for (char const* const layout :
       {Testing::kInternalSource, Testing::kOlderSoftware, Testing::kNameOnly}) {
    setup.calls.clear();
    MatchData const data = Testing::FromHex(layout);
    auto const ends = setup.CreateVirtualEndpoint(data, Setup::kSourceEnd, Setup::kDestinationEnd);
    ASSERT_EQ(setup.calls.size(), 1u);
    EXPECT_EQ(setup.calls[0], "CreateVirtualEndpoint " + data.GetObjectName().string() + " 0 0 1");
    EXPECT_TRUE(ends.first.Exists());
    EXPECT_EQ(ends.second.GetMatchingVirtualSource(), ends.first);
  }
  setup.calls.clear();
  MatchData data = Testing::FromHex(Testing::kExternalDestination);
  data[29] = 1;  // the version of section 1
  setup.CreateVirtualEndpoint(data, Setup::kSourceEnd, Setup::kNeitherEnd);
  EXPECT_EQ(setup.calls.at(0), "CreateVirtualEndpoint Pad 0 0 2");
}

TEST_F(EndpointReference, OfNoEndpointMakesNoVirtualOne) {
  MatchTranslator translator;
  MatchData const data = Testing::FromHex(Testing::kExternalDestination);
  for (MatchData const& reference : {translator.TranslateFromNameOnly(MatchObjectID(1), "Device"),
                                     MatchData(), FirstBytes(data, data.size() - 1)}) {
    auto const ends = setup.CreateVirtualEndpoint(reference, Setup::kSourceEnd, Setup::kNeitherEnd);
    EXPECT_FALSE(ends.first.Exists());
    EXPECT_FALSE(ends.second.Exists());
  }
  EXPECT_TRUE(setup.calls.empty());
}

}  // namespace
}  // namespace Ostinet
