// SPDX-License-Identifier: MIT
//
// Modes and patches from the handle to the wire. The test setup has no master clock, so that now is
// clock 0.
#include <gmock/gmock.h>

#include "names/SmallTree.h"

namespace Ostinet::Testing {
namespace {

using Impl::DestModeImpl;
using Impl::DestNameSetImpl;
using Impl::SysexByte;
using ::testing::ElementsAre;
using ::testing::IsEmpty;

class SendingNames : public StudioTest {
 protected:
  SendingNames() : port(setup.MakePort("Port")), names(PlainNames::For(port)) {}

  RCPtrMT<DestModeImpl> AddMode(char const* name) {
    RCPtrMT<DestModeImpl> const mode(new DestModeImpl(ImplOf(port), name, false));
    names.Tree().modes.push_back(mode);
    return mode;
  }
  RCPtrMT<DestNameSetImpl> AddNameSet(char const* name) {
    RCPtrMT<DestNameSetImpl> const nameSet(new DestNameSetImpl(ImplOf(port), name));
    names.Tree().nameSets.push_back(nameSet);
    return nameSet;
  }
  SentLog& Sent() { return *TestSetup::PeerOf(port).sent; }
  std::vector<Bytes> SentBytes() {
    std::vector<Bytes> bytes;
    for (SentLog::Packet const& packet : Sent().packets) {
      bytes.push_back(packet.bytes);
    }
    return bytes;
  }
  std::vector<unsigned long long> SentTimes() {
    std::vector<unsigned long long> times;
    for (SentLog::Packet const& packet : Sent().packets) {
      times.push_back(packet.clocks);
    }
    return times;
  }
  Impl::PropertyDict Stored() {
    Impl::PropertyDict dict;
    TestSetup::PeerOf(port).GetDict("nameConfiguration", dict);
    return dict;
  }
  UString StoredMode() { return boost::get<UString>(Stored().entries["currentDeviceMode"]); }

  Destination const port;
  PlainNames& names;
};

class SendingPatches : public SendingNames {
 protected:
  SendingPatches() { names.Tree().currentNameSets[2] = nameSet; }

  RCPtrMT<DestNameSetImpl> const nameSet = AddNameSet("Set");
  RCPtrMT<Impl::PatchBankImpl> const bank = AddBank(*nameSet, "Bank", 1, 3);
  RCPtrMT<Impl::PatchImpl> const patch = AddPatch(*bank, 5);
};

TEST_F(SendingPatches, SendsTheBankBeforeTheProgram) {
  port.SendPatchChange(2, patch);
  EXPECT_THAT(SentBytes(), ElementsAre(Bytes{0xB2, 0, 1}, Bytes{0xB2, 32, 3}, Bytes{0xC2, 5}));
  EXPECT_THAT(SentTimes(), ElementsAre(0, 0, 0));
  EXPECT_EQ(Sent().flushes, 1);
}

TEST_F(SendingPatches, TellsAtOnceWhichChannel) {
  port.SendPatchChange(2, patch);
  EXPECT_THAT(listener.patches, ElementsAre(std::make_pair(port, 1 << 2)));
  EXPECT_THAT(listener.names, IsEmpty());
}

TEST_F(SendingPatches, TellsAfterTheBankIsSelected) {
  bool wasSelected = false;
  listener.onPatchChanged = [&] { wasSelected = nameSet->GetCurrentBank() == bank; };
  port.SendPatchChange(2, patch);
  EXPECT_TRUE(wasSelected);
}

TEST_F(SendingPatches, GoesOnWhereTheBankEnded) {
  bank->Commands().AddDelay(2);
  bank->Commands().AddThreeBytes(0xB0, 7, 100);
  bank->Commands().AddDelay(50);
  port.SendPatchChange(2, patch);
  EXPECT_THAT(SentTimes(), ElementsAre(0, 0, 20000, 20000));
}

TEST_F(SendingPatches, ABankThatSendsNothingIsSelectedAllTheSame) {
  RCPtrMT<Impl::PatchBankImpl> const plain = AddBank(*nameSet, "Plain");
  port.SendPatchChange(2, AddPatch(*plain, 9));
  EXPECT_THAT(SentBytes(), ElementsAre(Bytes{0xC2, 9}));
  EXPECT_EQ(nameSet->GetCurrentBank(), plain);
}

TEST_F(SendingPatches, NothingToSendMakesNoSender) {
  RCPtrMT<Impl::PatchBankImpl> const plain = AddBank(*nameSet, "Plain");
  port.SendPatchChange(2, AddPatch(*plain, kNoNumber));
  EXPECT_THAT(Sent().sendersMadeFor, IsEmpty());
  EXPECT_EQ(nameSet->GetCurrentBank(), plain);
  EXPECT_EQ(listener.patches.size(), 1u);
}

TEST_F(SendingPatches, ChangesTheStateEvenIfNothingCanBeSent) {
  TestSetup::PeerOf(port).canSend = false;
  port.SendPatchChange(2, patch);
  EXPECT_THAT(SentBytes(), IsEmpty());
  EXPECT_EQ(Sent().flushes, 0);
  EXPECT_EQ(nameSet->GetCurrentBank(), bank);
  EXPECT_EQ(listener.patches.size(), 1u);
  TestSetup::PeerOf(port).makesSenders = false;
  port.SendPatchChange(2, patch);
  EXPECT_EQ(listener.patches.size(), 2u);
}

TEST_F(SendingPatches, NeedsNoListener) {
  setup.SetListener(nullptr);
  port.SendPatchChange(2, patch);
  EXPECT_EQ(SentBytes().size(), 3u);
}

TEST_F(SendingPatches, OfNoBankSendsThePatchAlone) {
  port.SendPatchChange(2, MakePatch(7));
  EXPECT_THAT(SentBytes(), ElementsAre(Bytes{0xC2, 7}));
  EXPECT_FALSE(nameSet->GetCurrentBank());
  EXPECT_THAT(listener.patches, ElementsAre(std::make_pair(port, 1 << 2)));
}

TEST_F(SendingPatches, OnAChannelWithoutNameSetSelectsNoBank) {
  port.SendPatchChange(15, patch);
  EXPECT_EQ(SentBytes().size(), 3u);
  EXPECT_FALSE(nameSet->GetCurrentBank());
  EXPECT_THAT(listener.patches, ElementsAre(std::make_pair(port, 1 << 15)));
}

TEST_F(SendingPatches, ANullPatchDoesNothing) {
  port.SendPatchChange(2, Patch());
  EXPECT_THAT(SentBytes(), IsEmpty());
  EXPECT_THAT(listener.patches, IsEmpty());
}

TEST_F(SendingPatches, AChannelThatThereIsNotDoesNothing) {
  port.SendPatchChange(16, patch);
  port.SendPatchChange(-1, patch);
  EXPECT_THAT(SentBytes(), IsEmpty());
  EXPECT_THAT(listener.patches, IsEmpty());
}

TEST_F(SendingPatches, GoesOutThroughThePort) {
  Destination const instrument = setup.MakeInstrument("Synth");
  PlainNames& ofInstrument = PlainNames::For(instrument);
  ofInstrument.Tree().currentNameSets[0] = nameSet;
  port.AddConnectedDestination(instrument);
  instrument.SendPatchChange(0, patch);
  EXPECT_THAT(SentBytes(), ElementsAre(Bytes{0xB0, 0, 1}, Bytes{0xB0, 32, 3}, Bytes{0xC0, 5}));
  EXPECT_EQ(nameSet->GetCurrentBank(), bank);
  EXPECT_THAT(listener.patches, ElementsAre(std::make_pair(instrument, 1)));
}

TEST_F(SendingPatches, SelectsABankOfItsOwnWithinTheProgram) {
  RCPtrMT<Impl::PatchImpl> const own = AddPatch(*bank, 6, 9, 9);
  port.SendPatchChange(2, own);
  EXPECT_THAT(SentBytes(), ElementsAre(Bytes{0xB2, 0, 1}, Bytes{0xB2, 32, 3}, Bytes{0xB2, 0, 9},
                                       Bytes{0xB2, 32, 9}, Bytes{0xC2, 6}));
}

class SendingModes : public SendingNames {
 protected:
  RCPtrMT<DestModeImpl> const first = AddMode("First");
  RCPtrMT<DestModeImpl> const second = AddMode("Second");
};

TEST_F(SendingModes, SendsTheEndOfTheOldAndTheStartOfTheNew) {
  first->DisableCommands().AddThreeBytes(0xB0, 7, 0);
  second->EnableCommands().AddThreeBytes(0xB0, 7, 127);
  names.Tree().currentMode = first;
  port.SendModeChange(second);
  EXPECT_THAT(SentBytes(), ElementsAre(Bytes{0xB0, 7, 0}, Bytes{0xB0, 7, 127}));
  EXPECT_EQ(Sent().flushes, 1);
  EXPECT_EQ(names.GetTree().currentMode, second);
  EXPECT_THAT(listener.patches, ElementsAre(std::make_pair(port, 0xFFFF)));
}

// A delay at the very end is not waited for.
TEST_F(SendingModes, StartsTheNewWithTheLastPacketOfTheOld) {
  first->DisableCommands().AddThreeBytes(0xB0, 7, 0);
  first->DisableCommands().AddDelay(1);
  first->DisableCommands().AddThreeBytes(0xB0, 7, 1);
  first->DisableCommands().AddDelay(500);
  second->EnableCommands().AddThreeBytes(0xB0, 7, 127);
  names.Tree().currentMode = first;
  port.SendModeChange(second);
  EXPECT_THAT(SentTimes(), ElementsAre(0, 10000, 10000));
}

TEST_F(SendingModes, TheCurrentModeIsNotSentAgain) {
  first->EnableCommands().AddThreeBytes(0xB0, 7, 127);
  names.Tree().currentMode = first;
  port.SendModeChange(first);
  EXPECT_THAT(SentBytes(), IsEmpty());
  EXPECT_THAT(listener.patches, IsEmpty());
}

TEST_F(SendingModes, ANullModeDoesNothing) {
  first->DisableCommands().AddThreeBytes(0xB0, 7, 0);
  names.Tree().currentMode = first;
  port.SendModeChange(DestinationMode());
  EXPECT_THAT(SentBytes(), IsEmpty());
  EXPECT_EQ(names.GetTree().currentMode, first);
  EXPECT_THAT(listener.patches, IsEmpty());
}

TEST_F(SendingModes, TakesTheNameSetsEmptySlotsIncluded) {
  RCPtrMT<DestNameSetImpl> const nameSet = AddNameSet("Set");
  names.Tree().currentNameSets.fill(AddNameSet("Old"));
  second->SetNameSet(3, nameSet);
  port.SendModeChange(second);
  EXPECT_EQ(names.GetTree().currentNameSets[3], nameSet);
  EXPECT_FALSE(names.GetTree().currentNameSets[0]);
  EXPECT_EQ(StoredMode(), UString("Second"));
  auto const stored = boost::get<std::vector<UString>>(Stored().entries["currentChannelNameSets"]);
  ASSERT_EQ(stored.size(), 16u);
  EXPECT_EQ(stored[3], UString("Set"));
  EXPECT_EQ(stored[0], UString());
}

TEST_F(SendingModes, KeepsWhatElseIsStored) {
  Impl::PropertyDict dict;
  dict.entries["master"] = Impl::PropertyPath{"/names/Synth.midnam"};
  TestSetup::PeerOf(port).SetDict("nameConfiguration", dict);
  port.SendModeChange(second);
  EXPECT_EQ(Stored().entries.size(), 3u);
  EXPECT_EQ(boost::get<Impl::PropertyPath>(Stored().entries["master"]).path,
            UString("/names/Synth.midnam"));
}

TEST_F(SendingModes, IsStoredBeforeTheHostHears) {
  UString mode;
  listener.onPatchChanged = [&] { mode = StoredMode(); };
  port.SendModeChange(second);
  EXPECT_EQ(mode, UString("Second"));
}

class SendingDeviceIDs : public SendingModes {
 protected:
  SendingDeviceIDs() {
    second->EnableCommands().BeginSysex();
    second->EnableCommands().AddSysexByte(0xF0);
    second->EnableCommands().AddSysexByte(0x41);
    second->EnableCommands().AddSysexMarker(SysexByte::kDeviceIDMarker, 0, 1);
    second->EnableCommands().AddSysexByte(0xF7);
  }
};

TEST_F(SendingDeviceIDs, SendsTheDevicesOwn) {
  TestSetup::SetInt(port, "deviceID", 16);
  port.SendModeChange(second);
  EXPECT_THAT(SentBytes(), ElementsAre(Bytes{0xF0, 0x41, 0x10, 0xF7}));
}

TEST_F(SendingDeviceIDs, SendsTheAllCallIDWhereNoneIsKnown) {
  port.SendModeChange(second);
  EXPECT_THAT(SentBytes(), ElementsAre(Bytes{0xF0, 0x41, 0x7E, 0xF7}));
}

TEST_F(SendingDeviceIDs, SendsTheAllCallIDWhereTheKnownOneIsNone) {
  TestSetup::SetInt(port, "deviceID", 128);
  port.SendModeChange(second);
  EXPECT_THAT(SentBytes(), ElementsAre(Bytes{0xF0, 0x41, 0x7E, 0xF7}));
}

// Only sending knows the all-call ID; a host that asks for the bytes gets what it passes.
TEST_F(SendingDeviceIDs, GeneratingPutsInWhatItIsGiven) {
  DataBuffer buffer;
  DestinationMode(second).GetEnablingCommand(buffer, Clocks(0), 255);
  EXPECT_THAT(Packets(buffer), ElementsAre(Bytes{0xF0, 0x41, 0xFF, 0xF7}));
}

TEST_F(SendingDeviceIDs, PatchesGetItToo) {
  RCPtrMT<DestNameSetImpl> const nameSet = AddNameSet("Set");
  RCPtrMT<Impl::PatchBankImpl> const bank = AddBank(*nameSet, "Bank");
  bank->Commands().BeginSysex();
  bank->Commands().AddSysexMarker(SysexByte::kDeviceIDMarker, 0, 1);
  bank->Commands().AddSysexMarker(SysexByte::kChannelMarker, 1, 2);
  port.SendPatchChange(3, AddPatch(*bank, 5));
  EXPECT_THAT(SentBytes(), ElementsAre(Bytes{0x7E, 8}, Bytes{0xC3, 5}));
}

}  // namespace
}  // namespace Ostinet::Testing
