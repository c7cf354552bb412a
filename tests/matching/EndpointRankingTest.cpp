// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <algorithm>
#include <ostream>

#include "matching/HexBytes.h"
#include "matching/MatchDataWriter.h"
#include "support/TestSetup.h"

namespace Ostinet {

static void PrintTo(ObjectMatch const& match, std::ostream* out) {
  for (int type = 0; type < 5; ++type) {
    *out << (type > 0 ? ", " : "{") << match.GetRank(static_cast<ObjectMatch::MatchType>(type));
  }
  *out << "}";
}

namespace {

using Impl::EndpointKind;
using Impl::MatchDataWriter;
using Testing::TestSetup;

// In the order of MatchType: unique ID, name, manufacturer and model, connection, General MIDI.
ObjectMatch Ranks(int id, int name, int device, int connection, int generalMIDI) {
  ObjectMatch match;
  match.SetRank(ObjectMatch::kUniqueIDMatch, id);
  match.SetRank(ObjectMatch::kNameMatch, name);
  match.SetRank(ObjectMatch::kManufacturerModelMatch, device);
  match.SetRank(ObjectMatch::kConnectionMatch, connection);
  match.SetRank(ObjectMatch::kGeneralMIDIMatch, generalMIDI);
  return match;
}

ObjectMatch const kNothingExamined;

// What a reference says; the fields of section 2 behind `fields` are left out.
struct Saved {
  Properties::Implementation implementation = Properties::kPlatformImplementation;
  MatchObjectID type = Destination::kObjectID;
  UString name = "Pad";
  unsigned int version1 = 0;
  unsigned int version2 = 0;
  int uniqueID = 0;
  int connection = 0;
  bool nameIsFull = true;
  int fields1 = 3;
  UString manufacturer;
  UString model;
  bool direct = false;
  bool software = false;
  bool generalMIDI = false;
  bool internal = false;
  SlotID slot;
  int fields2 = 7;

  MatchData Write() const {
    MatchDataWriter writer(implementation, type, name, version1, version2);
    auto& section1 = writer.GetSection1Stream();
    if (fields1 > 0) section1.WriteInt32(uniqueID);
    if (fields1 > 1) section1.WriteInt32(connection);
    if (fields1 > 2) section1.WriteBool(nameIsFull);
    auto& section2 = writer.GetSection2Stream();
    if (fields2 > 0) section2.WriteString(manufacturer);
    if (fields2 > 1) section2.WriteString(model);
    bool const flags[] = {direct, software, generalMIDI, internal};
    for (int i = 0; i < std::min(fields2 - 2, 4); ++i) section2.WriteBool(flags[i]);
    if (fields2 > 6) section2.WriteSlotID(slot);
    return writer.Finish();
  }
};

class EndpointRanking : public testing::Test {
 protected:
  EndpointRanking() {
    setup.Reset();
    pad = setup.MakeInstrument("Pad");
    TestSetup::SetInt(pad, "uniqueID", 42);
    pad.SetManufacturer("Acme");
    pad.SetModel("Synth 1");
  }
  ~EndpointRanking() override { setup.Reset(); }

  int RankOf(ObjectMatch::MatchType type, Saved const& saved) {
    return pad.MatchToData(saved.Write()).GetRank(type);
  }
  int DeviceRank(char const* manufacturer, char const* model) {
    Saved saved;
    saved.manufacturer = manufacturer;
    saved.model = model;
    return RankOf(ObjectMatch::kManufacturerModelMatch, saved);
  }

  TestSetup& setup = TestSetup::Get();
  Destination pad;
};

TEST_F(EndpointRanking, AnEndpointFitsItsOwnReference) {
  Destination const port = setup.MakePort("Port");
  port.AddConnectedDestination(pad);
  EXPECT_EQ(pad.MatchToData(pad.GetMatchData()), Ranks(2, 2, 4, 1, 1));
  pad.SetSupportsGeneralMIDI(true);
  EXPECT_EQ(pad.MatchToData(pad.GetMatchData()), Ranks(2, 2, 4, 1, 2));
  EXPECT_EQ(port.MatchToData(port.GetMatchData()), Ranks(2, 2, -1, -1, 1));
}

TEST_F(EndpointRanking, NullAndDeadHandlesAreNotExamined) {
  MatchData const data = pad.GetMatchData();
  EXPECT_EQ(Destination().MatchToData(data), kNothingExamined);
  setup.DeleteDevice(pad.GetEntity().GetDevice());
  EXPECT_EQ(pad.MatchToData(data), kNothingExamined);
}

TEST_F(EndpointRanking, ASourceNeverFitsADestination) {
  Saved saved;
  saved.uniqueID = 42;
  EXPECT_EQ(pad.MatchToData(saved.Write()), Ranks(2, 2, -1, -1, 1));
  saved.type = Source::kObjectID;
  EXPECT_EQ(pad.MatchToData(saved.Write()), kNothingExamined);
  saved.type = Device::kObjectID;
  EXPECT_EQ(pad.MatchToData(saved.Write()), kNothingExamined);
}

TEST_F(EndpointRanking, ABrokenReferenceIsNotExamined) {
  MatchData const data = pad.GetMatchData();
  for (std::size_t count = 0; count < data.size(); ++count) {
    EXPECT_EQ(pad.MatchToData(Testing::FirstBytes(data, count)), kNothingExamined) << count;
  }
}

TEST_F(EndpointRanking, ABareNameTellsNameAndGeneralMIDI) {
  MatchTranslator translator;
  MatchData const data = translator.TranslateFromNameOnly(Destination::kObjectID, "Pad");
  EXPECT_EQ(pad.MatchToData(data), Ranks(-1, 2, -1, -1, 1));
  pad.SetSupportsGeneralMIDI(true);
  EXPECT_EQ(pad.MatchToData(data), Ranks(-1, 2, -1, -1, 0));
}

TEST_F(EndpointRanking, AnOlderReferenceReachesTheDevice) {
  Saved saved;
  saved.implementation = Properties::kOlderImplementation;
  saved.uniqueID = 42;
  saved.connection = 7;
  saved.manufacturer = "Acme";
  saved.model = "Synth 1";
  saved.fields2 = 5;
  EXPECT_EQ(pad.MatchToData(saved.Write()), Ranks(-1, 2, 4, -1, 1));
}

TEST_F(EndpointRanking, AnotherVersionOfASectionIsLeftAlone) {
  Saved saved;
  saved.uniqueID = 42;
  saved.model = "Synth 1";
  saved.version2 = 1;
  EXPECT_EQ(pad.MatchToData(saved.Write()), Ranks(2, 2, -1, -1, -1));
  saved.version1 = 1;
  EXPECT_EQ(pad.MatchToData(saved.Write()), Ranks(-1, 2, -1, -1, -1));
}

TEST_F(EndpointRanking, TheUniqueIDIsTheSameOrNot) {
  Saved saved;
  saved.uniqueID = 41;
  EXPECT_EQ(RankOf(ObjectMatch::kUniqueIDMatch, saved), 0);
  saved.uniqueID = 42;
  EXPECT_EQ(RankOf(ObjectMatch::kUniqueIDMatch, saved), 2);
  saved.implementation = Properties::kPluginHostImplementation;
  EXPECT_EQ(RankOf(ObjectMatch::kUniqueIDMatch, saved), 2);
}

// Else it would fit each endpoint without an ID.
TEST_F(EndpointRanking, AUniqueIDOfZeroSaysNothing) {
  TestSetup::SetInt(pad, "uniqueID", 0);
  EXPECT_EQ(RankOf(ObjectMatch::kUniqueIDMatch, Saved()), -1);
}

TEST_F(EndpointRanking, TheUniqueIDOfSoftwareSaysNothingOfHardware) {
  Saved saved;
  saved.uniqueID = 42;
  saved.software = true;
  EXPECT_EQ(RankOf(ObjectMatch::kUniqueIDMatch, saved), -1);
  saved.fields2 = 3;  // the flag cannot be read
  EXPECT_EQ(RankOf(ObjectMatch::kUniqueIDMatch, saved), 2);
}

TEST_F(EndpointRanking, TheNameIsExactlyOrLooselyTheSame) {
  Saved saved;
  EXPECT_EQ(RankOf(ObjectMatch::kNameMatch, saved), 2);
  saved.name = " pA d";
  EXPECT_EQ(RankOf(ObjectMatch::kNameMatch, saved), 1);
  saved.name = "Pads";
  EXPECT_EQ(RankOf(ObjectMatch::kNameMatch, saved), 0);
  saved.name = "";
  EXPECT_EQ(RankOf(ObjectMatch::kNameMatch, saved), 0);
}

TEST_F(EndpointRanking, AnEndpointWithoutANameIsNotComparedByIt) {
  Destination const port = setup.MakePort("");
  EXPECT_EQ(port.MatchToData(Saved().Write()).GetRank(ObjectMatch::kNameMatch), -1);
}

// The endpoint's own "name", where its full name holds the device's too.
TEST_F(EndpointRanking, ANameThatIsNotFullIsComparedWithTheEndpointsOwn) {
  Device const device = setup.MakeDevice("Box");
  Entity const entity = setup.MakeEntity(device, "Port", 0, 2);
  Destination const first = entity.GetDestination(0);
  first.SetRawName("A");
  ASSERT_EQ(first.GetName(), UString("Box A"));
  Saved saved;
  saved.name = "A";
  auto const rank = [&] {
    return first.MatchToData(saved.Write()).GetRank(ObjectMatch::kNameMatch);
  };
  EXPECT_EQ(rank(), 0);
  saved.nameIsFull = false;
  EXPECT_EQ(rank(), 2);
  saved.nameIsFull = true;
  for (saved.fields1 = 0; saved.fields1 < 3; ++saved.fields1) {
    EXPECT_EQ(rank(), 2) << saved.fields1;
  }
  // Of another backend's section 1 nothing is read, and the name counts as full.
  saved.implementation = Properties::kNoImplementation;
  EXPECT_EQ(rank(), 0);
}

TEST_F(EndpointRanking, GradesManufacturerAndModel) {
  EXPECT_EQ(DeviceRank("Acme", "Synth 1"), 4);
  EXPECT_EQ(DeviceRank("ACME", "Synth 1"), 3);
  EXPECT_EQ(DeviceRank("Acme", "synth1"), 3);
  EXPECT_EQ(DeviceRank("acme", "synth1"), 3);
  EXPECT_EQ(DeviceRank("Acme", "Synth 2"), 2);
  EXPECT_EQ(DeviceRank("acme", "Synth 2"), 1);
  EXPECT_EQ(DeviceRank("Best", "Synth 1"), 0);
  EXPECT_EQ(DeviceRank("", "Synth 1"), 0);
  EXPECT_EQ(DeviceRank("Acme", ""), -1);
}

TEST_F(EndpointRanking, TheConnectionIsThatOfAnExternalInstrument) {
  Destination const port = setup.MakePort("Port");
  TestSetup::SetInt(port, "uniqueID", 7);
  Saved saved;
  saved.connection = 7;
  EXPECT_EQ(RankOf(ObjectMatch::kConnectionMatch, saved), 0);
  port.AddConnectedDestination(pad);
  EXPECT_EQ(RankOf(ObjectMatch::kConnectionMatch, saved), 1);
  saved.connection = 8;
  EXPECT_EQ(RankOf(ObjectMatch::kConnectionMatch, saved), 0);
  saved.connection = 0;
  EXPECT_EQ(RankOf(ObjectMatch::kConnectionMatch, saved), -1);
  saved.connection = 7;
  saved.direct = true;
  EXPECT_EQ(RankOf(ObjectMatch::kConnectionMatch, saved), -1);
  saved.direct = false;
  saved.software = true;
  EXPECT_EQ(RankOf(ObjectMatch::kConnectionMatch, saved), -1);
  saved.software = false;
  saved.fields2 = 3;
  EXPECT_EQ(RankOf(ObjectMatch::kConnectionMatch, saved), -1);
  saved.fields2 = 7;
  EXPECT_EQ(port.MatchToData(saved.Write()).GetRank(ObjectMatch::kConnectionMatch), 0);
}

TEST_F(EndpointRanking, ATruncatedSecondSectionIsUsedAsFarAsItReads) {
  Saved saved;
  saved.manufacturer = "Acme";
  saved.model = "Synth 1";
  saved.fields2 = 4;
  EXPECT_EQ(pad.MatchToData(saved.Write()), Ranks(-1, 2, 4, -1, -1));
  saved.fields2 = 1;
  EXPECT_EQ(pad.MatchToData(saved.Write()), Ranks(-1, 2, -1, -1, -1));
  saved.fields2 = 0;
  EXPECT_EQ(pad.MatchToData(saved.Write()), Ranks(-1, 2, -1, -1, -1));
}

TEST_F(EndpointRanking, InternalSoftwareIsToldByItsSlotAlone) {
  Destination const plugin = setup.MakeDestination("Pad", EndpointKind::Software(false, true));
  TestSetup::PeerOf(plugin).SetIntList("slotDescriptor", {1, 2, 3, 4, 5, 6});
  EXPECT_EQ(plugin.MatchToData(plugin.GetMatchData()), Ranks(2, -1, -1, -1, -1));
  Saved saved;
  saved.software = true;
  saved.internal = true;
  saved.slot.words[0] = 9;
  EXPECT_EQ(plugin.MatchToData(saved.Write()), Ranks(0, -1, -1, -1, -1));
  saved.slot = SlotID();
  TestSetup::PeerOf(plugin).SetIntList("slotDescriptor", {0, 0, 0, 0, 0, 0});
  EXPECT_EQ(plugin.MatchToData(saved.Write()), Ranks(0, -1, -1, -1, -1));
  // Without the slot, or against anything else, the rest decides.
  saved.fields2 = 6;
  EXPECT_EQ(plugin.MatchToData(saved.Write()), Ranks(-1, 2, -1, -1, 1));
  saved.fields2 = 7;
  EXPECT_EQ(pad.MatchToData(saved.Write()), Ranks(-1, 2, -1, -1, 1));
}

}  // namespace
}  // namespace Ostinet
