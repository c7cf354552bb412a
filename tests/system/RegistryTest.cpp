// SPDX-License-Identifier: MIT
#include "ostinet/core/Error.h"
#include "platform/system/Registry.h"
#include "system/SimulatedTest.h"

namespace Ostinet::Impl::Simulated {
namespace {

std::string const kStudios = OSTINET_TEST_STUDIOS;

TEST(Registry, AFileNamesTheStudio) {
  auto const system = ChooseSystem((kStudios + "/demo.json").c_str());
  EXPECT_GT(system->midiOutGetNumDevs(), 0u);
}

TEST(Registry, WithoutAFileTheChoiceIsTheMachinesOrAnEmptyStudio) {
  EXPECT_NE(ChooseSystem(nullptr), nullptr);
  EXPECT_NE(ChooseSystem(""), nullptr);
}

TEST(Registry, AStudioThatDoesNotLoadIsAnErrorAndNotReplaced) {
  try {
    ChooseSystem("no/such/file.json");
    FAIL() << "nothing was thrown";
  } catch (VantorError const& error) {
    EXPECT_EQ(error.Text(), "The studio file \"no/such/file.json\" cannot be read");
  }
}

TEST(Registry, TheChoiceIsMadeOnce) { EXPECT_EQ(CurrentSystem(), CurrentSystem()); }

TEST(Registry, AnInstalledStudioTakesTheAutomaticOnesPlace) {
  auto const automatic = CurrentSystem();
  SimulatedMIDI const studio;
  studio.Install();
  EXPECT_NE(CurrentSystem(), automatic);
  EXPECT_EQ(CurrentSystem()->midiOutGetNumDevs(), 0u);
  SimulatedMIDI const other;
  other.Remove();  // is not in use
  EXPECT_NE(CurrentSystem(), automatic);
  studio.Remove();
  EXPECT_EQ(CurrentSystem(), automatic);
}

TEST(Registry, HandlesNameTheSameStudio) {
  SimulatedMIDI const studio;
  studio.Install();
  SimulatedMIDI::InUse().AddPort(PortOf("A", PortKind::kWinMMOut));
  EXPECT_EQ(studio.Ports().size(), 1u);
  studio.Remove();
}

}  // namespace
}  // namespace Ostinet::Impl::Simulated
