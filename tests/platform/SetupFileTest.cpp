// SPDX-License-Identifier: MIT

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <map>
#include <regex>

#include "core/AtomicFile.h"
#include "platform/PlatformTest.h"

namespace Ostinet::Testing {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;

/// "Ostinet.xml" in the host's folder.
class SetupFile : public PlatformTest {
 protected:
  void Write(std::string const& studio) {
    prefs.MakeFile("Ostinet.xml", "<?xml version=\"1.0\"?>\n<Ostinet>" + studio);
  }
  void WriteWhole(std::string const& studio) { Write(studio + "</Ostinet>"); }
  std::string Read() const {
    std::ifstream stream(prefs.folder / "Ostinet.xml", std::ios::binary);
    return {std::istreambuf_iterator<char>(stream), std::istreambuf_iterator<char>()};
  }
  static std::string Port(std::string const& element, std::string const& name, int id) {
    return "<" + element + " direct=\"true\" software=\"false\">" + Properties(name, id) + "</" +
           element + ">";
  }
  static std::string Properties(std::string const& name, int id) {
    return "<Properties><String key=\"name\">" + name + "</String><Int key=\"uniqueID\">" +
           std::to_string(id) + "</Int><String key=\"manufacturer\">Acme</String></Properties>";
  }
};

TEST_F(SetupFile, AMissingOneIsNoError) {
  AddOut("Out");
  SignIn();
  EXPECT_THAT(DestNames(), ElementsAre("Out"));
}

TEST_F(SetupFile, APortThatIsGoneIsThereOffline) {
  WriteWhole(Port("Destination", "Gone", 77));
  SignIn();
  Destination const gone = Dest("Gone");
  EXPECT_TRUE(gone.Exists());
  EXPECT_TRUE(gone.IsDirect());
  EXPECT_FALSE(gone.IsOnline());
  EXPECT_EQ(OfflineProperty(gone), 1);
  EXPECT_EQ(gone.GetUniqueID(), 77);
  EXPECT_EQ(gone.GetManufacturer(), UString("Acme"));
}

TEST_F(SetupFile, APortThatIsThereJoinsItsEndpoint) {
  AddOut("Out");
  WriteWhole(Port("Destination", "Out", 78));
  SignIn();
  EXPECT_THAT(DestNames(), ElementsAre("Out"));
  EXPECT_TRUE(Dest("Out").IsOnline());
  EXPECT_EQ(Dest("Out").GetUniqueID(), 78);
}

TEST_F(SetupFile, ElementsThatCannotBeAreSkippedAndTheirSiblingsRead) {
  WriteWhole("<Source direct=\"true\" software=\"true\">" + Properties("Soft", 1) + "</Source>" +
             "<Source direct=\"false\" software=\"false\">" + Properties("Loose", 2) + "</Source>" +
             "<Source software=\"false\">" + Properties("Unsaid", 3) + "</Source>" +
             "<Device direct=\"true\"/><Device/><Stranger/>" + Port("Source", "Good", 4));
  SignIn();
  EXPECT_THAT(SourceNames(), ElementsAre("Good"));
  EXPECT_EQ(setup.CountDevices(), 0);
}

TEST_F(SetupFile, EndpointsOfAnEntityMayStandInAnyOrder) {
  WriteWhole("<Device direct=\"false\">" + Properties("Synth", 10) + "<Entity direct=\"false\">" +
             Properties("Port", 11) + "<Destination direct=\"false\" software=\"false\">" +
             Properties("First", 12) +
             "</Destination><Source direct=\"false\" software=\"false\">" +
             Properties("Second", 13) + "</Source><Source direct=\"true\" software=\"false\">" +
             Properties("Direct", 14) + "</Source></Entity></Device>");
  SignIn();
  ASSERT_EQ(setup.CountDevices(), 1);
  Entity const entity = setup.GetDevice(0).GetEntity(0);
  ASSERT_EQ(entity.CountDestinations(), 1);
  ASSERT_EQ(entity.CountSources(), 1);
  EXPECT_EQ(entity.GetDestination(0).GetUniqueID(), 12);
  EXPECT_EQ(entity.GetSource(0).GetUniqueID(), 13);
}

// The search for the properties passes over what comes first.
TEST_F(SetupFile, PropertiesStandInFront) {
  std::string const entity = "<Entity direct=\"false\">" + Properties("Port", 11) + "</Entity>";
  WriteWhole("<Device direct=\"false\">" + entity + Properties("Synth", 10) + entity + "</Device>" +
             "<Device direct=\"false\">" + entity + "</Device>");
  SignIn();
  ASSERT_EQ(setup.CountDevices(), 2);
  EXPECT_EQ(setup.GetDevice(0).GetName(), UString("Synth"));
  EXPECT_EQ(setup.GetDevice(0).CountEntities(), 1);
  EXPECT_EQ(setup.GetDevice(1).CountEntities(), 0);
}

// Other programs read the file, so its form is part of what is promised.
TEST_F(SetupFile, IsOfThisForm) {
  AddOut("Out");
  SignIn();
  Device const device = setup.CreateDevice(UString("Synth"));
  Dest("Out").AddConnectedDestination(device.GetEntity(0).GetDestination(0));
  Dest("Out").SetManufacturer(UString("Acme"));
  std::string const port = ">" + std::to_string(Dest("Out").GetUniqueID()) + "<";
  std::string const synth = ">" + std::to_string(device._get_impl_id()) + "<";
  SignOut(true);
  std::string const named = std::regex_replace(Read(), std::regex(port), ">PORT<");
  EXPECT_EQ(std::regex_replace(named, std::regex(synth), ">SYNTH<"),
            R"(<?xml version="1.0" encoding="UTF-8"?>
<Ostinet>
  <Destination direct="true" software="false" fake="false">
    <Properties>
      <IntList key="connUniqueID">
        <IntItem>SYNTH</IntItem>
      </IntList>
      <String key="manufacturer">Acme</String>
      <String key="name">Out</String>
      <Int key="offline">0</Int>
      <Int key="uniqueID">PORT</Int>
      <Int key="which API">2</Int>
    </Properties>
  </Destination>
  <Device direct="false" fake="false">
    <Properties>
      <String key="name">Synth</String>
      <Int key="uniqueID">SYNTH</Int>
    </Properties>
    <Entity direct="false" fake="false">
      <Properties>
        <String key="name">Port 1</String>
      </Properties>
      <Source direct="false" software="false" fake="false">
        <Properties/>
      </Source>
      <Destination direct="false" software="false" fake="false">
        <Properties>
          <IntList key="connUniqueID">
            <IntItem>PORT</IntItem>
          </IntList>
        </Properties>
        <Connection name="Out" manufacturer="Acme" model=""/>
      </Destination>
    </Entity>
  </Device>
</Ostinet>
)");
}

TEST_F(SetupFile, SavingAndLoadingTwiceGivesTheSame) {
  AddOut("Out");
  AddIn("In");
  SignIn();
  Device const device = setup.CreateDevice(UString("Synth"));
  setup.SetEntityDestinations(device.GetEntity(0), 3);
  // The ends of a device bear the device's ID, so what is saved names the first of them.
  Dest("Out").AddConnectedDestination(device.GetEntity(0).GetDestination(0));
  device.SetChannelName(3, UString("Bass"));
  SignOut(true);
  std::string const saved = Read();
  EXPECT_NE(saved.find("<Connection"), std::string::npos);
  SignIn();
  setup.PollSetupChanges();
  Destination const again = setup.GetDevice(0).GetEntity(0).GetDestination(0);
  EXPECT_EQ(again.GetDirectDestination(), Dest("Out"));
  SignOut(true);
  EXPECT_EQ(Read(), saved);
}

TEST_F(SetupFile, WhatStandsBeforeTheDamageIsKept) {
  Write(Port("Source", "Before", 20) +
        "<Source direct=\"true\" soft<ware=" + Port("Source", "Behind", 21));
  SignIn();
  EXPECT_THAT(SourceNames(), ElementsAre("Before"));
}

TEST_F(SetupFile, VirtualEndpointsAreNotWritten) {
  SignIn();
  setup.CreateVirtualEndpoint(UString("Loop"), Setup::kSourceEnd, Setup::kSourceEnd);
  SignOut(true);
  EXPECT_EQ(Read().find("Loop"), std::string::npos);
}

TEST_F(SetupFile, AFolderThatIsGoneLosesTheSaveAndNothingElse) {
  AddOut("Out");
  SignIn();
  std::filesystem::remove_all(prefs.folder);
  std::ofstream(prefs.folder) << "a file where the folder was";
  SignOut(true);
  EXPECT_TRUE(std::filesystem::is_regular_file(prefs.folder));
  std::filesystem::remove_all(prefs.folder);
  SignIn();
  EXPECT_THAT(DestNames(), ElementsAre("Out"));
}

// A host that never ran before has no folder for its settings yet.
TEST_F(SetupFile, TheFirstSaveMakesTheFolder) {
  std::filesystem::path const parent = prefs.folder;
  prefs.folder = parent / "settings" / "of a host";
  AddOut("Out");
  SignIn();
  EXPECT_FALSE(std::filesystem::exists(parent / "settings")) << "a load makes nothing";
  SignOut(true);
  EXPECT_NE(Read().find("Out"), std::string::npos);
  prefs.folder = parent;
}

// Each write fails once, as on a full disk; the studio in the file is never lost.
TEST_F(SetupFile, ASaveThatFailsAtAnyWriteKeepsTheOldFile) {
  AddOut("Out");
  SignIn();
  SignOut(true);
  std::string const old = Read();
  bool hasFailed = true;
  for (int nth = 1; hasFailed; ++nth) {
    ASSERT_LT(nth, 1000);
    SignIn();
    Dest("Out").SetModel(UString("changed"));
    int left = nth;
    hasFailed = false;
    Impl::AtomicFile::SetFaultHook([&](Impl::AtomicFile::Step) {
      hasFailed = hasFailed || --left == 0;
      return left == 0 ? 28 : 0;  // no space left
    });
    SignOut(true);
    Impl::AtomicFile::SetFaultHook({});
    if (hasFailed) {
      EXPECT_EQ(Read(), old) << nth;
    }
  }
  EXPECT_NE(Read().find("changed"), std::string::npos);
}

// At each step of a save, what a crash would leave behind is the old file, whole.
TEST_F(SetupFile, ACrashAtAnyStepOfASaveLeavesTheOldFile) {
  SignIn();
  for (int i = 0; i < 150; ++i) {  // so many that it takes several writes
    setup.CreateDevice(UString("Synth")).SetChannelName(0, UString(std::string(500, 'x')));
  }
  SignOut(true);
  std::string const old = Read();
  SignIn();
  setup.GetDevice(0).SetRawName(UString("changed"));
  std::map<Impl::AtomicFile::Step, int> steps;
  Impl::AtomicFile::SetFaultHook([&](Impl::AtomicFile::Step step) {
    ++steps[step];
    EXPECT_EQ(Read() == old, true) << steps.size();
    return 0;
  });
  SignOut(true);
  Impl::AtomicFile::SetFaultHook({});
  EXPECT_GT(steps[Impl::AtomicFile::Step::kWrite], 1);
  EXPECT_EQ(steps.size(), 5u) << "created, written, flushed, closed and put in place";
  EXPECT_NE(Read().find("changed"), std::string::npos);
}

// What a crash leaves beside the file.
TEST_F(SetupFile, ALeftOverOfACrashDisturbsNoSaveAndNoLoad) {
  prefs.MakeFile(".Ostinet.xml.1-1.tmp", "<Ostinet><Devi");
  AddOut("Out");
  SignIn();
  Dest("Out").SetModel(UString("kept"));
  SignOut(true);
  SignIn();
  EXPECT_EQ(Dest("Out").GetModel(), UString("kept"));
}

// Connections come back by the stored IDs; the element is for imports.
TEST_F(SetupFile, TheConnectionElementIsNotReadAtLoad) {
  AddOut("Out");
  WriteWhole(
      "<Device direct=\"false\">" + Properties("Synth", 10) + "<Entity direct=\"false\">" +
      Properties("Port", 11) + "<Destination direct=\"false\" software=\"false\">" +
      Properties("In", 12) +
      "<Connection name=\"Out\" manufacturer=\"\" model=\"\"/></Destination></Entity></Device>");
  SignIn();
  setup.PollSetupChanges();
  EXPECT_FALSE(setup.GetDevice(0).GetEntity(0).GetDestination(0).GetDirectDestination().Exists());
}

TEST_F(SetupFile, AnImportWhosePortIsNotThereIsReadToItsEnd) {
  SignIn();
  std::string const end =
      "<Destination direct=\"false\" software=\"false\">" + Properties("In", 12) +
      "<Connection name=\"Nowhere\" manufacturer=\"\" model=\"\"/></Destination>";
  UString const path =
      prefs.MakeFile("device.xml", "<Device direct=\"false\">" + Properties("Synth", 10) +
                                       "<Entity direct=\"false\">" + Properties("Port", 11) + end +
                                       end + "</Entity></Device>");
  XMLLib::Parser parser{File(FileSpecification(path))};
  ASSERT_TRUE(parser.DownToChild());
  Entity const entity = setup.CreateDevice(parser).GetEntity(0);
  ASSERT_EQ(entity.CountDestinations(), 2);
  EXPECT_FALSE(entity.GetDestination(1).GetDirectDestination().Exists());
}

TEST_F(SetupFile, ADirectDeviceIsNotImported) {
  SignIn();
  UString const path = prefs.MakeFile("device.xml", "<Device direct=\"true\"/>");
  XMLLib::Parser parser{File(FileSpecification(path))};
  ASSERT_TRUE(parser.DownToChild());
  EXPECT_FALSE(setup.CreateDevice(parser).Exists());
  EXPECT_EQ(setup.CountDevices(), 0);
}

TEST_F(SetupFile, PrivateAndSoftwareEndpointsAreNotWritten) {
  AddOut("Chip", 4);
  SignIn();
  setup.CreateVirtualEndpoint(UString("Hidden"), Setup::kNeitherEnd, Setup::kNeitherEnd);
  SignOut(true);
  EXPECT_EQ(Read().find("Chip"), std::string::npos);
  EXPECT_EQ(Read().find("Hidden"), std::string::npos);
}

TEST_F(SetupFile, IsWrittenInTheOrderOfTheListsSourcesFirst) {
  AddOut("B");
  AddOut("A");
  AddIn("Z");
  SignIn();
  setup.CreateDevice(UString("D 2"));
  setup.CreateDevice(UString("D 1"));
  SignOut(true);
  std::string const saved = Read();
  std::vector<std::size_t> places;
  for (char const* const name : {">Z<", ">B<", ">A<", ">D 2<", ">D 1<"}) {
    places.push_back(saved.find(name));
  }
  EXPECT_TRUE(std::is_sorted(places.begin(), places.end()));
  EXPECT_NE(places.back(), std::string::npos);
}

TEST_F(SetupFile, AnImportedDeviceGetsNewIDsAndHangsOnThePortThatItNames) {
  AddOut("Out");
  SignIn();
  UString const path = prefs.MakeFile(
      "device.xml", "<Device direct=\"false\">" + Properties("Synth", 10) +
                        "<Entity direct=\"false\">" + Properties("Port", 11) +
                        "<Destination direct=\"false\" software=\"false\">" + Properties("In", 12) +
                        "<Connection name=\"Out\" manufacturer=\"\" "
                        "model=\"\"/></Destination></Entity></Device>");
  XMLLib::Parser parser{File(FileSpecification(path))};
  ASSERT_TRUE(parser.DownToChild());
  Device const device = setup.CreateDevice(parser);
  ASSERT_TRUE(device.Exists());
  EXPECT_EQ(device.GetManufacturer(), UString("Acme"));
  Destination const in = device.GetEntity(0).GetDestination(0);
  EXPECT_NE(in.GetUniqueID(), 12);
  EXPECT_NE(in.GetUniqueID(), 0);
  setup.PollSetupChanges();
  EXPECT_EQ(in.GetDirectDestination(), Dest("Out"));
}

}  // namespace
}  // namespace Ostinet::Testing
