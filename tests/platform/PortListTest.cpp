// SPDX-License-Identifier: MIT

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "ostinet/SimulatedMIDI.h"
#include "platform/ComPtr.h"
#include "platform/PortList.h"
#include "platform/system/simulated/SimulatedSystem.h"

namespace Ostinet::Impl {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;

/// A simulated system and what the enumeration says of it, as "tag name".
class PortListTest : public ::testing::Test {
 protected:
  void Add(std::string const& name, SimulatedPort::Kind kind, bool emulated = false,
           bool directMusic = true) {
    SimulatedPort port;
    port.name = name;
    port.kind = kind;
    port.emulated = emulated;
    port.directMusic = directMusic;
    midi.AddPort(port);
  }

  std::vector<std::string> List() {
    ComPtr<IDirectMusic> directMusic;
    System& system = *midi.GetSystem();
    EXPECT_EQ(system.CreateDirectMusic(directMusic.Receive()), S_OK);
    std::vector<std::string> result;
    for (PortInfo const& port : EnumeratePorts(system, *directMusic.get())) {
      result.push_back(std::to_string(port.which()) + " " + NameOfPort(port).string());
    }
    return result;
  }

  static constexpr auto kLegacyOut = SimulatedPort::Kind::kWinMMOut;
  static constexpr auto kLegacyIn = SimulatedPort::Kind::kWinMMIn;
  static constexpr auto kMusicOut = SimulatedPort::Kind::kDirectMusicOut;
  static constexpr auto kMusicIn = SimulatedPort::Kind::kDirectMusicIn;
  SimulatedMIDI midi;
};

TEST_F(PortListTest, EmulatedPortsAreOpenedThroughTheirDriver) {
  Add("A", kLegacyOut);
  Add("A", kLegacyIn);
  EXPECT_THAT(List(), ElementsAre("3 A", "2 A"));
}

TEST_F(PortListTest, NativePortsWinOverADriverOfTheirName) {
  Add("A", kLegacyOut, false, false);
  Add("A", kMusicOut);
  EXPECT_THAT(List(), ElementsAre("1 A"));
}

TEST_F(PortListTest, ADriverThatDirectMusicDoesNotListYieldsNothing) {
  Add("Old", kLegacyOut, false, false);
  EXPECT_THAT(List(), IsEmpty());
}

TEST_F(PortListTest, PortsOfMicrosoftYieldNothingWhicheverSideListsThem) {
  Add("Microsoft GS Wavetable Synth", kLegacyOut);
  Add("Microsoft Synthesizer", kMusicOut);
  Add("The Microsoft In", kMusicIn);
  EXPECT_THAT(List(), IsEmpty());
}

TEST_F(PortListTest, SharedPortsComeFirstOutputsBeforeInputs) {
  Add("Native In", kMusicIn);
  Add("Native Out", kMusicOut);
  Add("In", kLegacyIn);
  Add("Out", kLegacyOut);
  EXPECT_THAT(List(), ElementsAre("3 Out", "2 In", "1 Native Out", "0 Native In"));
}

// Studios in use were found under this rule: see EnumeratePorts.
TEST_F(PortListTest, TheCountOfOutputsBoundsTheInputs) {
  Add("Out 1", kLegacyOut);
  Add("Out 2", kLegacyOut);
  for (char const* name : {"In 1", "In 2", "In 3"}) {
    Add(name, kLegacyIn);
  }
  EXPECT_THAT(List(), ElementsAre("3 Out 1", "3 Out 2", "2 In 1", "2 In 2", "0 In 3"));
}

TEST_F(PortListTest, InputsWithoutAnyOutputComeThroughDirectMusic) {
  Add("In", kLegacyIn);
  EXPECT_THAT(List(), ElementsAre("0 In"));
}

TEST_F(PortListTest, AnEmulatedPortWithoutItsDriverBearsTheBareName) {
  Add("Lone", kMusicOut, true);
  EXPECT_THAT(List(), ElementsAre("1 Lone"));
}

TEST_F(PortListTest, FurtherPortsOfOneNameAreDroppedBehindTheirDriver) {
  Add("A", kLegacyOut);
  Add("A", kMusicOut);
  EXPECT_EQ(List().size(), 1u);
}

TEST_F(PortListTest, ADeviceWithoutCapabilitiesLeavesItsPortToDirectMusic) {
  Add("A", kLegacyOut);
  Add("B", kLegacyOut);
  midi.Fail("midiOutGetDevCapsW", 1);
  EXPECT_THAT(List(), ElementsAre("3 B", "1 A"));
}

TEST_F(PortListTest, AnErrorOfTheListingIsItsEnd) {
  Add("A", kMusicOut);
  Add("B", kMusicOut);
  midi.Fail("EnumPort", 2);
  EXPECT_THAT(List(), ElementsAre("1 A"));
}

TEST_F(PortListTest, AListingWithoutEndIsCutOff) {
  Add("A", kMusicOut);
  midi.SetEndless("EnumPort", true);
  EXPECT_THAT(List(), ::testing::SizeIs(65536));
}

TEST(PortName, OnlyADriversPortLosesTheSuffix) {
  DMUS_PORTCAPS caps{};
  std::u16string const text = u"Synth [Emulated]";
  for (std::size_t i = 0; i < text.size(); ++i) {
    caps.wszDescription[i] = static_cast<WCHAR>(text[i]);
  }
  caps.dwType = DMUS_PORT_WINMM_DRIVER;
  EXPECT_EQ(NameOfPort(caps).name, UString("Synth"));
  EXPECT_TRUE(NameOfPort(caps).isEmulated);
  caps.dwType = DMUS_PORT_WINMM_DRIVER + 1;
  EXPECT_EQ(NameOfPort(caps).name, UString("Synth [Emulated]"));
  EXPECT_FALSE(NameOfPort(caps).isEmulated);
}

TEST(PortName, ATextThatFillsItsArrayEndsThere) {
  MIDIOUTCAPSW caps{};
  for (WCHAR& unit : caps.szPname) {
    unit = u'x';
  }
  EXPECT_EQ(NameOfPort(LegacyOutput{caps, 0}).length(), 32u);
}

}  // namespace
}  // namespace Ostinet::Impl
