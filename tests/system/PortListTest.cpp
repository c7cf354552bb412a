// SPDX-License-Identifier: MIT
#include "system/SimulatedTest.h"

namespace Ostinet::Impl::Simulated {
namespace {

class PortList : public SimulatedTest {
 protected:
  PortList() { Sys().CreateDirectMusic(music_.Out()); }

  DMUS_PORTCAPS Caps(DWORD index) const {
    DMUS_PORTCAPS caps{};
    caps.dwSize = sizeof caps;
    EXPECT_EQ(music_->EnumPort(index, &caps), S_OK);
    return caps;
  }
  HRESULT Enum(DWORD index) const {
    DMUS_PORTCAPS caps{};
    caps.dwSize = sizeof caps;
    return music_->EnumPort(index, &caps);
  }
  std::string OutputName(UINT index) const {
    MIDIOUTCAPSW caps{};
    EXPECT_EQ(Sys().midiOutGetDevCapsW(index, &caps, sizeof caps), 0u);
    return Narrow(caps.szPname);
  }

  Held<IDirectMusic> music_;
};

TEST_F(PortList, WinMMPortsAlsoShowAsEmulated) {
  auto synth = PortOf("Synth", PortKind::kWinMMOut);
  synth.technology = 7;
  studio_.AddPort(PortOf("Out", PortKind::kWinMMOut));
  studio_.AddPort(PortOf("In", PortKind::kWinMMIn));
  studio_.AddPort(synth);
  EXPECT_EQ(Sys().midiOutGetNumDevs(), 2u);
  EXPECT_EQ(Sys().midiInGetNumDevs(), 1u);
  EXPECT_EQ(OutputName(1), "Synth");
  DMUS_PORTCAPS const out = Caps(0), in = Caps(1), soft = Caps(2);
  EXPECT_EQ(Narrow(out.wszDescription), "Out [Emulated]");
  EXPECT_EQ(out.dwType, 0u);
  EXPECT_EQ(out.dwClass, 1u);
  EXPECT_EQ(out.dwFlags, DWORD{DMUS_PC_EXTERNAL});
  EXPECT_EQ(Narrow(in.wszDescription), "In [Emulated]");
  EXPECT_EQ(in.dwClass, 0u);
  EXPECT_EQ(in.dwFlags, DWORD{DMUS_PC_EXTERNAL});
  EXPECT_EQ(soft.dwFlags, 0u);
}

TEST_F(PortList, APastTheEndIndexGivesOne) {
  EXPECT_EQ(Enum(0), 1);
  studio_.AddPort(PortOf("Out", PortKind::kWinMMOut));
  EXPECT_EQ(Enum(0), 0);
  EXPECT_EQ(Enum(1), 1);
}

TEST_F(PortList, APortCanBeOfWinMMAlone) {
  auto old = PortOf("Old", PortKind::kWinMMOut);
  old.directMusic = false;
  studio_.AddPort(old);
  EXPECT_EQ(Sys().midiOutGetNumDevs(), 1u);
  EXPECT_EQ(Enum(0), S_FALSE);
}

TEST_F(PortList, DirectMusicPortsShowTheirFlags) {
  auto port = PortOf("Native", PortKind::kDirectMusicOut);
  port.external = true;
  port.gmInHardware = true;
  studio_.AddPort(port);
  auto synth = PortOf("Synth", PortKind::kDirectMusicOut);
  synth.dls = true;
  studio_.AddPort(synth);
  auto lone = PortOf("Lone", PortKind::kDirectMusicIn);
  lone.emulated = true;
  studio_.AddPort(lone);
  EXPECT_EQ(Caps(0).dwFlags, DWORD{DMUS_PC_EXTERNAL | DMUS_PC_GMINHARDWARE});
  EXPECT_NE(Caps(0).dwType, 0u);
  EXPECT_EQ(Caps(1).dwFlags, DWORD{DMUS_PC_DLS | DMUS_PC_SOFTWARESYNTH});
  EXPECT_EQ(Narrow(Caps(2).wszDescription), "Lone [Emulated]");
  EXPECT_EQ(Caps(2).dwType, 0u);
  EXPECT_EQ(Sys().midiInGetNumDevs(), 0u);
}

TEST_F(PortList, LongNamesAreCutAlikeOnBothSides) {
  studio_.AddPort(PortOf("0123456789012345678901234567890123456789", PortKind::kWinMMOut));
  EXPECT_EQ(OutputName(0), "0123456789012345678901234567890");
  EXPECT_EQ(Narrow(Caps(0).wszDescription), "0123456789012345678901234567890 [Emulated]");
}

TEST_F(PortList, NamesAreUTF8AndNoPairIsCut) {
  // Thirty letters and a note that takes two units of UTF-16.
  studio_.AddPort(PortOf("012345678901234567890123456789\xF0\x9D\x85\xA0", PortKind::kWinMMOut));
  studio_.AddPort(PortOf("\xC3\xA9\xE2\x82\xAC\xFF", PortKind::kWinMMOut));
  MIDIOUTCAPSW caps{};
  Sys().midiOutGetDevCapsW(0, &caps, sizeof caps);
  EXPECT_EQ(caps.szPname[29], WCHAR('9'));
  EXPECT_EQ(caps.szPname[30], WCHAR(0));
  Sys().midiOutGetDevCapsW(1, &caps, sizeof caps);
  EXPECT_EQ(caps.szPname[0], WCHAR(0xE9));
  EXPECT_EQ(caps.szPname[1], WCHAR(0x20AC));
  EXPECT_EQ(caps.szPname[2], WCHAR(0xFFFD));
}

TEST_F(PortList, PortsComeGoAndChangeTheirNames) {
  studio_.AddPort(PortOf("A", PortKind::kWinMMOut));
  studio_.AddPort(PortOf("A", PortKind::kWinMMIn));
  EXPECT_TRUE(studio_.RenamePort("A", "B"));
  EXPECT_FALSE(studio_.RenamePort("A", "C"));
  EXPECT_EQ(OutputName(0), "B");
  EXPECT_TRUE(studio_.DuplicatePort("B"));
  EXPECT_EQ(Sys().midiOutGetNumDevs(), 2u);
  EXPECT_EQ(Sys().midiInGetNumDevs(), 2u);
  EXPECT_TRUE(studio_.RemovePort("B", PortKind::kWinMMIn));
  EXPECT_EQ(Sys().midiInGetNumDevs(), 0u);
  EXPECT_EQ(studio_.Ports().size(), 2u);
  EXPECT_TRUE(studio_.RemovePort("B"));
  EXPECT_FALSE(studio_.RemovePort("B"));
  EXPECT_FALSE(studio_.DuplicatePort("B"));
}

TEST_F(PortList, APortThatWentBetweenListingAndOpeningCannotBeOpened) {
  studio_.AddPort(PortOf("A", PortKind::kWinMMOut));
  DMUS_PORTCAPS const caps = Caps(0);
  studio_.RemovePort("A");
  studio_.AddPort(PortOf("A", PortKind::kWinMMOut));
  DMUS_PORTPARAMS8 params{};
  params.dwSize = sizeof params;
  Held<IDirectMusicPort> port;
  EXPECT_TRUE(FAILED(music_->CreatePort(caps.guidPort, &params, port.Out(), nullptr)));
  EXPECT_TRUE(FAILED(music_->CreatePort(GUID{}, &params, port.Out(), nullptr)));
  EXPECT_EQ(music_->CreatePort(Caps(0).guidPort, &params, port.Out(), nullptr), S_OK);
}

TEST_F(PortList, ImpossiblePortsAreRefused) {
  auto port = PortOf("A", PortKind::kDirectMusicOut);
  port.latencyMicroseconds = -1;
  EXPECT_THROW(studio_.AddPort(port), std::invalid_argument);
  EXPECT_EQ(Sys().midiOutGetDevCapsW(0, nullptr, 0), MMRESULT{MMSYSERR_BADDEVICEID});
}

}  // namespace
}  // namespace Ostinet::Impl::Simulated
