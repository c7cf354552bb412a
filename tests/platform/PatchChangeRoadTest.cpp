// SPDX-License-Identifier: MIT
//
// The road of a patch change, from its name to the bytes at the port and to what the host hears;
// and of an edited name, to the next session.
#include <filesystem>
#include <fstream>

#include "core/Paths.h"
#include "core/SystemServices.h"
#include "names/NamesCatalogImpl.h"
#include "ostinet/NamesCatalog.h"
#include "platform/PlatformTest.h"
#include "support/TemporaryFolder.h"

namespace Ostinet::Testing {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;

constexpr char kDocument[] = R"(<?xml version="1.0"?>
<MIDINameDocument><Author>Acme</Author>
 <MasterDeviceNames><Manufacturer>Acme</Manufacturer><Model>One</Model>
  <CustomDeviceMode Name="Normal"><ChannelNameSetAssignments>
   <ChannelNameSetAssign Channel="1" NameSet="Main"/><ChannelNameSetAssign Channel="3" NameSet="Main"/>
  </ChannelNameSetAssignments></CustomDeviceMode>
  <CustomDeviceMode Name="Multi">
   <DeviceModeEnable><MIDICommands><SysEx>F0 41 <SysExDeviceID/> 01 F7</SysEx></MIDICommands>
   </DeviceModeEnable><ChannelNameSetAssignments/></CustomDeviceMode>
  <ChannelNameSet Name="Main">
   <PatchBank Name="Preset"><MIDICommands><ControlChange Control="0" Value="1"/>
    <ControlChange Control="32" Value="3"/></MIDICommands>
    <PatchNameList><Patch Number="A1" Name="Piano" ProgramChange="5"/>
     <Patch Number="A2" Name="Organ" ProgramChange="6"/></PatchNameList></PatchBank>
  </ChannelNameSet>
 </MasterDeviceNames></MIDINameDocument>)";

/// An instrument "Synth" on the port "Out 1".
class PatchChangeRoadTest : public PlatformTest {
 protected:
  PatchChangeRoadTest() {
    SystemServices::SetEnvironment("OSTINET_USER_FOLDER", Impl::FromPath(folder.Path() / "user"));
    SystemServices::SetEnvironment("OSTINET_SYSTEM_FOLDER", Impl::FromPath(folder.Path() / "none"));
    folder.Write("user/One.midnam", kDocument);
    Impl::NamesCatalogImpl::Instance().LoadState(prefs);
    AddOut("Out 1");
    SignIn();
    Device const device = setup.CreateDevice("Synth");
    device.SetManufacturer("Acme");
    device.SetModel("One");
    Dest("Out 1").AddConnectedDestination(device.GetEntity(0).GetDestination(0));
    Settle();
  }
  ~PatchChangeRoadTest() override {
    listener.names.clear();
    SystemServices::SetEnvironment("OSTINET_USER_FOLDER", UString());
    SystemServices::SetEnvironment("OSTINET_SYSTEM_FOLDER", UString());
  }

  /// Until no property waits to be heard of.
  void Settle() {
    setup.PollSetupChanges();
    setup.PollSetupChanges();
    setup.Poll();
    listener.patches.clear();
    listener.names.clear();
  }
  Destination Synth() { return Dest("Synth"); }
  Patch PatchNamed(char const* name) {
    PatchBank const bank = Synth().GetNameSet(0).GetBank(0);
    for (int i = 0; i < bank.CountPatches(); ++i) {
      if (bank.GetPatch(i).GetName() == UString(name)) {
        return bank.GetPatch(i);
      }
    }
    return Patch();
  }

  TemporaryFolder folder;
};

TEST_F(PatchChangeRoadTest, BankSelectGoesBeforeProgramChangeAndTheHostHearsInOrder) {
  Destination const synth = Synth();
  Destination const port = Dest("Out 1");
  Patch const piano = PatchNamed("Piano");
  EXPECT_EQ(synth.GetCurrentPatch(2), Patch::kNoPatch);
  synth.SendPatchChange(2, piano);
  EXPECT_THAT(SentTo("Out 1"), ElementsAre(Bytes{0xB2, 0, 1}, Bytes{0xB2, 32, 3}, Bytes{0xC2, 5}));
  // At once the instrument alone; from the next poll what hangs on the port, then the port.
  EXPECT_THAT(listener.patches, ElementsAre(RecordingListener::Patch(synth, 4)));
  EXPECT_EQ(synth.GetCurrentPatch(2), piano);
  EXPECT_EQ(synth.GetCurrentBank(2), piano.GetBank());
  setup.Poll();
  EXPECT_THAT(listener.patches,
              ElementsAre(RecordingListener::Patch(synth, 4), RecordingListener::Patch(synth, 4),
                          RecordingListener::Patch(port, 4)));
  setup.Poll();
  EXPECT_EQ(listener.patches.size(), 3U);
}

TEST_F(PatchChangeRoadTest, APatchThatAnotherPartOfTheHostSendsIsFollowed) {
  Send(Synth(), {0xC0, 6});
  EXPECT_THAT(listener.patches, IsEmpty());
  setup.Poll();
  EXPECT_EQ(listener.patches.size(), 2U);
  EXPECT_EQ(Synth().GetCurrentPatch(0), PatchNamed("Organ"));
}

TEST_F(PatchChangeRoadTest, AModeSendsItsScriptAndIsThereInTheNextSession) {
  Synth().SetSysexDeviceID(16);
  Synth().SendModeChange(Synth().GetMode(1));
  EXPECT_THAT(SentTo("Out 1"), ElementsAre(Bytes{0xF0, 0x41, 16, 1, 0xF7}));
  EXPECT_THAT(listener.patches, ElementsAre(RecordingListener::Patch(Synth(), 65535)));
  Settle();
  SignOut(true);
  SignIn();
  EXPECT_EQ(Synth().GetCurrentMode().GetName(), UString("Multi"));
  EXPECT_EQ(Synth().GetCurrentNameSet(0), DestinationNameSet::kNoDestinationNameSet);
}

TEST_F(PatchChangeRoadTest, AnEditedNoteIsFoundAfterARestart) {
  PatchNamed("Organ").GetNoteNames().SetNoteName(60, "Bell");
  SignOut(true);
  SignIn();
  EXPECT_EQ(PatchNamed("Organ").GetNoteNames().GetNoteNameForPitch(60), UString("Bell"));
  EXPECT_EQ(PatchNamed("Piano").GetNoteNames().GetNoteNameForPitch(60), UString());
  EXPECT_EQ(Synth().GetOverrideNames(PatchNamed("Organ").GetBank()).GetType(),
            Names::kEditedOverrideNames);
  SignOut(true);
  SignIn();
  EXPECT_EQ(PatchNamed("Organ").GetNoteNames().GetNoteNameForPitch(60), UString("Bell"));
}

TEST_F(PatchChangeRoadTest, EditsAreWrittenEveryThirtiethRound) {
  PatchNamed("Organ").GetNoteNames().SetNoteName(60, "Bell");
  auto const written = prefs.folder / "MIDINameDocuments";
  for (int round = 0; round < 30 && !std::filesystem::exists(written); ++round) {
    setup.PollSetupChanges();
  }
  EXPECT_TRUE(std::filesystem::exists(written));
}

}  // namespace
}  // namespace Ostinet::Testing
