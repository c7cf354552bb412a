// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <nlohmann/json.hpp>

#include "SomeStudio.h"
#include "StudioText.h"

namespace Ostinet::Tool {
namespace {

TEST(StudioLines, ShowTheStudioAsATree) {
  EXPECT_EQ(StudioLines(SomeStudio()), (std::vector<std::string>{
                                           "Devices",
                                           "  Synth  [Maker Model]  (online)  #101",
                                           "    Port 1",
                                           "      input  Synth  (online)  #103",
                                           "      output Synth  (online, channels 1-4, 10)  #104",
                                           "        on port Out 1",
                                           "Inputs",
                                           "  In 1  (online)  #105",
                                           "Outputs",
                                           "  Out 1  (online, interface)  #106",
                                           "    carries Synth",
                                       }));
}

TEST(StudioLines, AreNoneForAnEmptyStudio) { EXPECT_TRUE(StudioLines({}).empty()); }

TEST(StudioLines, TellWhatKindOfEndpointItIs) {
  StudioView studio;
  studio.sources = {SomeEndpoint(1, true, "A"), SomeEndpoint(2, true, "B"),
                    SomeEndpoint(3, true, "C")};
  studio.sources[0].online = false;
  studio.sources[0].isInterface = false;
  studio.sources[1].software = true;
  studio.sources[1].isInterface = false;
  studio.sources[2].software = studio.sources[2].internalSoftware = true;
  studio.sources[2].isVirtual = studio.sources[2].isPrivate = true;
  auto const lines = StudioLines(studio);
  ASSERT_EQ(lines.size(), 4u);
  EXPECT_EQ(lines[1], "  A  (offline, instrument)  #101");
  EXPECT_EQ(lines[2], "  B  (online, software)  #102");
  EXPECT_EQ(lines[3], "  C  (online, internal software, virtual, private)  #103");
}

std::vector<std::string> KeysOf(nlohmann::ordered_json const& object) {
  std::vector<std::string> keys;
  for (auto const& item : object.items()) {
    keys.push_back(item.key());
  }
  return keys;
}

TEST(StudioJSON, HasTheKeysThatScriptsRelyOn) {
  auto const studio = nlohmann::ordered_json::parse(StudioJSON(SomeStudio()));
  EXPECT_EQ(KeysOf(studio), (std::vector<std::string>{"devices", "sources", "destinations"}));
  auto const& device = studio["devices"][0];
  EXPECT_EQ(KeysOf(device), (std::vector<std::string>{"name", "uniqueID", "manufacturer", "model",
                                                      "direct", "online", "entities"}));
  auto const& entity = device["entities"][0];
  EXPECT_EQ(KeysOf(entity),
            (std::vector<std::string>{"name", "uniqueID", "sources", "destinations"}));
  std::vector<std::string> const endpointKeys = {
      "name",      "uniqueID", "direct",   "online",      "software",           "internalSoftware",
      "virtual",   "private",  "channels", "isInterface", "scheduleAheadMuSec", "port",
      "connected", "playing"};
  EXPECT_EQ(KeysOf(entity["destinations"][0]), endpointKeys);
  EXPECT_EQ(KeysOf(studio["sources"][0]), endpointKeys);
}

TEST(StudioJSON, HoldsTheFacts) {
  auto const studio = nlohmann::json::parse(StudioJSON(SomeStudio()));
  auto const& instrument = studio["devices"][0]["entities"][0]["destinations"][0];
  EXPECT_EQ(instrument["port"], "Out 1");
  EXPECT_EQ(instrument["channels"], 0x020F);
  EXPECT_TRUE(instrument["isInterface"].is_null());
  auto const& port = studio["destinations"][0];
  EXPECT_TRUE(port["port"].is_null());
  EXPECT_EQ(port["isInterface"], true);
  EXPECT_EQ(port["connected"], nlohmann::json({"Synth"}));
  EXPECT_EQ(port["uniqueID"], 106);
}

TEST(StudioJSON, GivesEmptyListsForAnEmptyStudio) {
  EXPECT_EQ(nlohmann::json::parse(StudioJSON({})),
            nlohmann::json::parse(R"({"devices": [], "sources": [], "destinations": []})"));
}

TEST(ChannelsText, JoinsRuns) {
  EXPECT_EQ(ChannelsText(0), "none");
  EXPECT_EQ(ChannelsText(0xFFFF), "1-16");
  EXPECT_EQ(ChannelsText(0x8001), "1, 16");
  EXPECT_EQ(ChannelsText(0x020F), "1-4, 10");
}

TEST(ParseChannels, ReadsWhatChannelsTextWrites) {
  for (unsigned mask = 1; mask <= 0xFFFF; mask += 97) {
    auto const channels = static_cast<unsigned short>(mask);
    EXPECT_EQ(ParseChannels(ChannelsText(channels)), channels);
  }
  EXPECT_EQ(ParseChannels("all"), 0xFFFF);
  EXPECT_EQ(ParseChannels("16"), 0x8000);
}

TEST(ParseChannels, TakesNothingElse) {
  for (char const* const text : {"", "none", "0", "17", "1-", "-1", "3-2", "1,,2", "1,", "a", "1.5",
                                 "1-2-3", "99999999999999999999"}) {
    EXPECT_FALSE(ParseChannels(text).has_value()) << text;
  }
}

}  // namespace
}  // namespace Ostinet::Tool
