// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include "platform/system/native/PortNames.h"

namespace Ostinet::Impl {
namespace {

TEST(PortNames, AlsaNamesLoseTheAddressThatChangesFromBootToBoot) {
  EXPECT_EQ(AlsaPortName("FLUID Synth:Input 128:0"), "FLUID Synth:Input");
  EXPECT_EQ(AlsaPortName("FLUID Synth:Input 131:12"), "FLUID Synth:Input");
}

TEST(PortNames, AlsaNamesKeepTheClientOnceOnly) {
  EXPECT_EQ(AlsaPortName("Midi Through:Midi Through Port-0 14:0"), "Midi Through Port-0");
  EXPECT_EQ(AlsaPortName("UM-ONE:UM-ONE MIDI 1 20:0"), "UM-ONE MIDI 1");
}

TEST(PortNames, NumbersThatBelongToAPortStay) {
  EXPECT_EQ(AlsaPortName("Synth:Out 2"), "Synth:Out 2");
  EXPECT_EQ(AlsaPortName("Synth:Out 4:2x"), "Synth:Out 4:2x");
  EXPECT_EQ(JackPortName("system:midi_capture_1"), "system:midi_capture_1");
}

TEST(PortNames, JackNamesOfBridgedPortsLoseBridgeAndNumber) {
  EXPECT_EQ(JackPortName("a2j:Synth [20] (capture): Synth MIDI 1"), "Synth MIDI 1");
  EXPECT_EQ(JackPortName("a2j:Synth [128] (playback): Keys"), "Synth:Keys");
  EXPECT_EQ(JackPortName("a2j:Synth [20]: Keys"), "a2j:Synth [20]: Keys");
}

TEST(PortNames, OddFormsAreKeptAsTheyAre) {
  EXPECT_EQ(AlsaPortName(""), "");
  EXPECT_EQ(AlsaPortName("12:0"), "12:0");
  EXPECT_EQ(JackPortName("no client"), "no client");
  EXPECT_EQ(JackPortName("client:"), "client");
}

TEST(PortNames, ALongNameIsShortenedAtItsClient) {
  std::u16string const fit = FitPortName("Some Very Long Interface Name:MIDI 12");
  EXPECT_EQ(fit.size(), kMaxPortName);
  EXPECT_EQ(fit, u"Some Very Long Interfac:MIDI 12");
  EXPECT_EQ(FitPortName("exactly thirty-one characters.."), u"exactly thirty-one characters..");
}

TEST(PortNames, ALongPortAloneIsCutAtItsEnd) {
  EXPECT_EQ(FitPortName("A:" + std::string(40, 'x')), std::u16string(kMaxPortName, u'x'));
  EXPECT_EQ(FitPortName(std::string(40, 'x')), std::u16string(kMaxPortName, u'x'));
}

TEST(PortNames, ACutNeverPartsOneCharacter) {
  std::string const note = "\xF0\x9D\x84\x9E";  // one character of two units
  EXPECT_EQ(FitPortName(std::string(30, 'x') + note), std::u16string(30, u'x'));
  EXPECT_EQ(FitPortName(std::string(29, 'x') + note).size(), kMaxPortName);
}

TEST(PortNames, ATakenNameGetsTheSmallestFreeNumber) {
  EXPECT_EQ(MakePortNameUnique(u"Keys", {}), u"Keys");
  EXPECT_EQ(MakePortNameUnique(u"Keys", {u"Keys"}), u"Keys 2");
  EXPECT_EQ(MakePortNameUnique(u"Keys", {u"Keys", u"Keys 3"}), u"Keys 2");
  std::u16string const longName(kMaxPortName, u'x');
  EXPECT_EQ(MakePortNameUnique(longName, {longName}), std::u16string(29, u'x') + u" 2");
}

}  // namespace
}  // namespace Ostinet::Impl
