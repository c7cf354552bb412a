// SPDX-License-Identifier: MIT
#include "ostinet/SystemPorts.h"
#include "system/SimulatedTest.h"

namespace Ostinet::Impl::Simulated {
namespace {

class SystemPorts : public SimulatedTest {
 protected:
  SystemPorts() { studio_.Install(); }
  ~SystemPorts() override { studio_.Remove(); }

  /// Kind, index and name of each port.
  std::vector<std::string> Listed() const {
    std::vector<std::string> lines;
    for (SystemPort const& port : ListSystemPorts()) {
      lines.push_back(std::to_string(port.kind) + " " + std::to_string(port.index) + " " +
                      port.name.string());
    }
    return lines;
  }
};

TEST_F(SystemPorts, AreListedAsTheSystemHasThem) {
  SimulatedPort old = PortOf("Old", PortKind::kWinMMOut);
  old.directMusic = false;
  old.technology = 4;
  SimulatedPort synth = PortOf("Synth", PortKind::kDirectMusicOut);
  synth.dls = true;
  studio_.AddPort(PortOf("In", PortKind::kWinMMIn));
  studio_.AddPort(old);
  studio_.AddPort(PortOf("Out", PortKind::kWinMMOut));
  studio_.AddPort(synth);
  studio_.AddPort(PortOf("Native In", PortKind::kDirectMusicIn));
  EXPECT_EQ(Listed(),
            (std::vector<std::string>{"0 0 Old", "0 1 Out", "1 0 In", "3 0 In [Emulated]",
                                      "2 1 Out [Emulated]", "2 2 Synth", "3 3 Native In"}));
  std::vector<SystemPort> const ports = ListSystemPorts();
  EXPECT_EQ(ports[0].technology, 4u);
  EXPECT_EQ(ports[1].technology, 1u);
  EXPECT_EQ(ports[4].flags, unsigned{DMUS_PC_EXTERNAL});
  EXPECT_EQ(ports[5].flags & DMUS_PC_DLS, unsigned{DMUS_PC_DLS});
}

TEST_F(SystemPorts, OfAnEmptySystemAreNone) { EXPECT_TRUE(ListSystemPorts().empty()); }

TEST_F(SystemPorts, ADeviceThatIsNotDescribedIsListedWithTheReason) {
  studio_.AddPort(PortOf("Out", PortKind::kWinMMOut));
  studio_.AddPort(PortOf("In", PortKind::kWinMMIn));
  studio_.FailWith("midiOutGetDevCapsW", MMSYSERR_NODRIVER);
  std::vector<SystemPort> const ports = ListSystemPorts();
  ASSERT_EQ(ports.size(), 4u);
  EXPECT_EQ(ports[0].error, unsigned{MMSYSERR_NODRIVER});
  EXPECT_TRUE(ports[0].name.empty());
  EXPECT_EQ(ports[1].error, 0u);
}

// A sign-in fails then, and a report tells what is left.
TEST_F(SystemPorts, WithoutDirectMusicAreThoseOfWinMM) {
  studio_.AddPort(PortOf("Out", PortKind::kWinMMOut));
  studio_.Fail("CreateDirectMusic");
  EXPECT_EQ(Listed(), std::vector<std::string>{"0 0 Out"});
}

TEST_F(SystemPorts, LeaveNothingOpen) {
  studio_.AddPort(PortOf("Native", PortKind::kDirectMusicOut));
  ListSystemPorts();
  EXPECT_EQ(studio_.CountObjects(), 0);
}

TEST_F(SystemPorts, AListWithoutEndIsCutOff) {
  studio_.AddPort(PortOf("Native", PortKind::kDirectMusicOut));
  studio_.SetEndless("EnumPort", true);
  EXPECT_EQ(ListSystemPorts().size(), 65536u);
}

}  // namespace
}  // namespace Ostinet::Impl::Simulated
