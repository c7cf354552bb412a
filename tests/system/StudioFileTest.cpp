// SPDX-License-Identifier: MIT
#include <filesystem>

#include "system/SimulatedTest.h"

namespace Ostinet::Impl::Simulated {
namespace {

constexpr long long kMillisecond = 10000;

std::string ErrorOf(std::string const& text) {
  try {
    SimulatedMIDI::FromJSON(text);
  } catch (StudioFileError const& error) {
    return error.what();
  }
  return "none";
}

TEST(StudioFile, HoldsPortsCablesAndInstruments) {
  auto const studio = SimulatedMIDI::FromJSON(R"({
    "ports": [
      {"name": "Interface 1", "kind": "winmm-out", "technology": 1},
      {"name": "Interface 1", "kind": "winmm-in"},
      {"name": "Old Port", "kind": "winmm-out", "directmusic": false},
      {"name": "Native", "kind": "directmusic-out", "external": true, "latency-us": 1499},
      {"name": "Soft Synth", "kind": "directmusic-out", "dls": true} ],
    "cables": [ {"from": "Interface 1", "to": "Interface 1"} ],
    "instruments": [ {"out": "Interface 1", "in": "Interface 1", "device-id": 16,
                      "identity": "41 00 19 00 10",
                      "replies": [ {"to": "F0 41 10 11 F7", "with": "F0 41 10 12 F7"} ]} ] })");
  auto const ports = studio.Ports();
  ASSERT_EQ(ports.size(), 5u);
  EXPECT_EQ(ports[0].name, "Interface 1");
  EXPECT_EQ(ports[0].kind, PortKind::kWinMMOut);
  EXPECT_TRUE(ports[0].directMusic);
  EXPECT_EQ(ports[1].kind, PortKind::kWinMMIn);
  EXPECT_FALSE(ports[2].directMusic);
  EXPECT_TRUE(ports[3].external);
  EXPECT_EQ(ports[3].latencyMicroseconds, 1499);
  EXPECT_FALSE(ports[4].external);
  EXPECT_TRUE(ports[4].dls);
  EXPECT_EQ(studio.CountInstruments(), 1);
}

class Timeline : public testing::Test {
 protected:
  explicit Timeline(char const* events)
      : studio_(SimulatedMIDI::FromJSON(std::string(R"({"ports": [
          {"name": "A", "kind": "winmm-out"}, {"name": "A", "kind": "winmm-in"}], "events": [)") +
                                        events + "]}")) {
    studio_.MoveClockByHand(0);
    watching_ = studio_.WatchDevices([this] { changes_.push_back(studio_.Now() / kMillisecond); });
  }
  std::vector<std::string> Names() const {
    std::vector<std::string> names;
    for (auto const& port : studio_.Ports()) names.push_back(port.name);
    return names;
  }

  SimulatedMIDI studio_;
  DeviceChangeSubscription watching_;
  std::vector<long long> changes_;
};

class PluggingTimeline : public Timeline {
 protected:
  PluggingTimeline()
      : Timeline(R"({"at-ms": 200, "add": {"name": "A", "kind": "winmm-out"}},
                    {"at-ms": 100, "remove": "A"},
                    {"at-ms": 300, "rename": {"from": "A", "to": "B"}},
                    {"at-ms": 400, "duplicate": "B"},
                    {"at-ms": 500, "add": {"name": "B", "kind": "winmm-in"}},
                    {"at-ms": 600, "remove": {"name": "B", "kind": "winmm-out"}})") {}
};

TEST_F(PluggingTimeline, StartsWhenAHostSignsIn) {
  studio_.AdvanceClocks(1000 * kMillisecond);
  EXPECT_TRUE(changes_.empty());
  Held<IDirectMusic> music;
  studio_.GetSystem()->CreateDirectMusic(music.Out());
  studio_.AdvanceClocks(100 * kMillisecond);
  EXPECT_EQ(changes_, (std::vector<long long>{1100}));
  ASSERT_EQ(studio_.Ports().size(), 1u);  // of the two of that name, the one added first is gone
  EXPECT_EQ(studio_.Ports()[0].kind, PortKind::kWinMMIn);
}

TEST_F(PluggingTimeline, HappensInTheOrderOfItsTimesAndIsToldAtEach) {
  studio_.StartTimeline();
  studio_.AdvanceClocks(300 * kMillisecond);
  EXPECT_EQ(Names(), (std::vector<std::string>{"B", "B"}));
  studio_.AdvanceClocks(700 * kMillisecond);
  EXPECT_EQ(Names(), (std::vector<std::string>{"B", "B", "B"}));
  for (SimulatedPort const& port : studio_.Ports()) EXPECT_EQ(port.kind, PortKind::kWinMMIn);
  EXPECT_EQ(changes_, (std::vector<long long>{100, 200, 300, 400, 500, 600}));
}

class PlayingTimeline : public Timeline {
 protected:
  PlayingTimeline()
      : Timeline(R"({"at-ms": 10, "every-ms": 5, "times": 3,
                     "input": {"port": "A", "bytes": "90 3C 40"}})") {}
};

TEST_F(PlayingTimeline, InputArrivesAsOftenAsItSays) {
  InputLog log;
  ASSERT_EQ(log.Open(*studio_.GetSystem(), 0), 0u);
  studio_.GetSystem()->midiInStart(log.handle);
  studio_.StartTimeline();
  studio_.AdvanceClocks(1000 * kMillisecond);
  auto const told = log.Take();
  ASSERT_EQ(told.size(), 4u);
  EXPECT_EQ(told[1].milliseconds, 10u);
  EXPECT_EQ(told[3].milliseconds, 20u);
  studio_.GetSystem()->midiInClose(log.handle);
}

class CableTimeline : public Timeline {
 protected:
  CableTimeline()
      : Timeline(R"({"at-ms": 1, "connect": {"from": "A", "to": "A"}},
                    {"at-ms": 2, "disconnect": {"from": "A", "to": "A"}})") {}
};

TEST_F(CableTimeline, CablesComeAndGo) {
  studio_.StartTimeline();
  studio_.AdvanceClocks(kMillisecond);
  EXPECT_TRUE(studio_.RemoveCable("A", "A"));
  studio_.AddCable("A", "A");
  studio_.AdvanceClocks(kMillisecond);
  EXPECT_FALSE(studio_.RemoveCable("A", "A"));
}

TEST(StudioFile, ErrorsNameThePlace) {
  EXPECT_EQ(ErrorOf("{\n\n]"), "Line 3 is not well-formed JSON");
  EXPECT_EQ(ErrorOf(""), "Line 1 is not well-formed JSON");
  EXPECT_EQ(ErrorOf("[]"), "In the studio: an object is expected");
  EXPECT_EQ(ErrorOf(R"({"port": []})"), "In the studio: the key \"port\" is unknown");
  EXPECT_EQ(ErrorOf(R"({"ports": {}})"), "In the studio.ports: a list is expected");
  EXPECT_EQ(ErrorOf(R"({"ports": [{"kind": "winmm-in"}]})"),
            "In the studio.ports[0]: the key \"name\" is missing");
  EXPECT_EQ(ErrorOf(R"({"ports": [{"name": 5, "kind": "winmm-in"}]})"),
            "In the studio.ports[0].name: a text is expected");
  EXPECT_EQ(ErrorOf(R"({"ports": [{"name": "A", "kind": "usb"}]})"),
            "In the studio.ports[0]: \"usb\" is no kind of port; there are winmm-out, winmm-in, "
            "directmusic-out and directmusic-in");
  EXPECT_EQ(ErrorOf(R"({"ports": [{"name": "A", "kind": "winmm-out", "technology": 9}]})"),
            "In the studio.ports[0].technology: a whole number from 1 to 7 is expected");
  EXPECT_EQ(ErrorOf(R"({"ports": [{"name": "A", "kind": "winmm-out", "dls": 1}]})"),
            "In the studio.ports[0].dls: true or false is expected");
  EXPECT_EQ(ErrorOf(R"({"instruments": [{"out": "A", "identity": "4x"}]})"),
            "In the studio.instruments[0]: \"4x\" is not a row of hexadecimal bytes");
  EXPECT_EQ(ErrorOf(R"({"events": [{"at-ms": 1}]})"),
            "In the studio.events[0]: nothing happens: add, remove, rename, duplicate, connect, "
            "disconnect or input is expected");
  EXPECT_EQ(ErrorOf(R"({"events": [{"at-ms": 1, "remove": "A", "duplicate": "A"}]})"),
            "In the studio.events[0]: only one thing can happen in one event");
  EXPECT_EQ(ErrorOf(R"({"events": [{"at-ms": -1, "remove": "A"}]})"),
            "In the studio.events[0].at-ms: a whole number from 0 to 31536000000 is expected");
  EXPECT_EQ(ErrorOf(R"({"events": [{"at-ms": 1, "input": {"port": "A", "bytes": "GG"}}]})"),
            "In the studio.events[0].input.bytes: \"GG\" is not a row of hexadecimal bytes");
}

TEST(StudioFile, NumbersBeyondAllRangesAreRefused) {
  EXPECT_NE(ErrorOf(R"({"events": [{"at-ms": 18446744073709551615, "remove": "A"}]})"), "none");
  EXPECT_NE(ErrorOf(R"({"events": [{"at-ms": 1.5, "remove": "A"}]})"), "none");
}

TEST(StudioFile, AFileThatCannotBeReadIsNamed) {
  try {
    SimulatedMIDI::FromFile("no/such.json");
    FAIL();
  } catch (StudioFileError const& error) {
    EXPECT_STREQ(error.what(), "The studio file \"no/such.json\" cannot be read");
  }
}

TEST(StudioFile, TheStudiosThatComeAlongLoad) {
  int count = 0;
  for (auto const& entry : std::filesystem::directory_iterator(OSTINET_TEST_STUDIOS)) {
    if (entry.path().extension() != ".json") continue;
    EXPECT_NO_THROW(SimulatedMIDI::FromFile(entry.path().string())) << entry.path();
    ++count;
  }
  EXPECT_GE(count, 3);
}

}  // namespace
}  // namespace Ostinet::Impl::Simulated
