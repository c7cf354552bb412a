// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include "SomeStudio.h"
#include "StudioChanges.h"

namespace Ostinet::Tool {
namespace {

std::vector<std::string> Told(StudioView const& before, StudioView const& after) {
  std::vector<std::string> lines;
  for (Change const& change : FindChanges(before, after)) {
    lines.push_back(ChangeText(change));
  }
  return lines;
}

using Lines = std::vector<std::string>;

TEST(FindChanges, FindsNothingInTheSameStudio) {
  EXPECT_TRUE(FindChanges(SomeStudio(), SomeStudio()).empty());
}

TEST(FindChanges, TellsWhatWentBeforeWhatCame) {
  StudioView after = SomeStudio();
  after.sources.clear();
  after.destinations.push_back(SomeEndpoint(9, false, "New"));
  EXPECT_EQ(Told(SomeStudio(), after),
            (Lines{"removed      source      In 1", "added        destination New"}));
}

TEST(FindChanges, TellsADeviceWithItsEndpoints) {
  EXPECT_EQ(Told({}, SomeStudio()),
            (Lines{"added        device      Synth", "added        source      Synth",
                   "added        destination Synth", "added        source      In 1",
                   "added        destination Out 1"}));
}

TEST(FindChanges, TellsOnlineAndOffline) {
  StudioView after = SomeStudio();
  after.sources[0].online = false;
  EXPECT_EQ(Told(SomeStudio(), after), (Lines{"offline      source      In 1"}));
  EXPECT_EQ(Told(after, SomeStudio()), (Lines{"online       source      In 1"}));
}

TEST(FindChanges, TellsTheNameBefore) {
  StudioView after = SomeStudio();
  after.devices[0].name = "Organ";
  EXPECT_EQ(Told(SomeStudio(), after), (Lines{"renamed      device      Organ  (was Synth)"}));
}

TEST(FindChanges, TellsConnectionsAtThePort) {
  StudioView after = SomeStudio();
  after.destinations[0].connected = {"Organ"};
  EXPECT_EQ(Told(SomeStudio(), after), (Lines{"disconnected destination Out 1  (Synth)",
                                              "connected    destination Out 1  (Organ)"}));
}

TEST(FindChanges, TellsOtherFactsOnce) {
  StudioView after = SomeStudio();
  after.destinations[0].channels = 1;
  after.destinations[0].isInterface = false;
  after.devices[0].model = "Other";
  EXPECT_EQ(Told(SomeStudio(), after),
            (Lines{"changed      device      Synth", "changed      destination Out 1"}));
}

TEST(ChangeJSON, HasAnEventAndWhatBelongsToIt) {
  Change change;
  change.event = "renamed";
  change.kind = "source";
  change.name = "New";
  change.uniqueID = 7;
  change.was = "Old";
  EXPECT_EQ(ChangeJSON(change),
            R"({"event":"renamed","kind":"source","name":"New","uniqueID":7,"was":"Old"})");
  change.was.reset();
  change.event = "patch";
  change.mask = static_cast<unsigned short>(3);
  EXPECT_EQ(ChangeJSON(change),
            R"({"event":"patch","kind":"source","name":"New","uniqueID":7,"channels":3})");
  EXPECT_EQ(ChangeText(change), "patch        source      New  (channels 1-2)");
}

TEST(Filtered, KeepsTheWholeStudioWithoutAWish) {
  StudioView studio = SomeStudio();
  studio.devices[0].entities.clear();
  StudioView const filtered = Filtered(studio, ViewFilter());
  EXPECT_EQ(filtered.devices.size(), 1u);
  EXPECT_EQ(filtered.sources, studio.sources);
}

}  // namespace
}  // namespace Ostinet::Tool
