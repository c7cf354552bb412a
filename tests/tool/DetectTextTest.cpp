// SPDX-License-Identifier: MIT
#include <gmock/gmock.h>

#include <nlohmann/json.hpp>

#include "DetectText.h"

namespace Ostinet::Tool {
namespace {

using testing::ElementsAre;
using Outcome = DetectionRun::Outcome;

FindingView SomeFinding() {
  FindingView finding;
  finding.types = {{"Maker", "Synth"}};
  finding.deviceID = 16;
  finding.source = {"In 1", 7};
  return finding;
}

DetectedPort SomePort(std::vector<FindingView> findings) {
  DetectedPort port;
  port.port = {"Out 1", 5};
  port.outcome = Outcome::kDone;
  port.findings = std::move(findings);
  return port;
}

TEST(DetectText, TellsEachInstrumentOfAPort) {
  FindingView other = SomeFinding();
  other.types = {{"Other", "Pad"}};
  other.deviceID.reset();
  EXPECT_THAT(
      DetectLines(SomePort({SomeFinding(), other})),
      ElementsAre("Out 1  #5", "  Maker Synth  device ID 16  on In 1", "  Other Pad  on In 1"));
}

TEST(DetectText, NamesAllTypesThatItCanBe) {
  FindingView finding = SomeFinding();
  finding.types = {{"Maker", "A"}, {"Maker", "B"}, {"Maker", "C"}};
  EXPECT_THAT(DetectLines(SomePort({finding}))[1], testing::StartsWith("  Maker A, B or C  "));
  finding.types = {{"Maker", "A"}, {"Other", "B"}};
  EXPECT_THAT(DetectLines(SomePort({finding}))[1], testing::StartsWith("  Maker A or Other B  "));
}

TEST(DetectText, TellsTheIdentityOfWhatItDoesNotKnow) {
  FindingView finding = SomeFinding();
  finding.types.clear();
  finding.identity = "41 2B 02 00 00";
  EXPECT_EQ(DetectLines(SomePort({finding}))[1],
            "  an instrument of no known type, identity 41 2B 02 00 00  device ID 16  on In 1");
}

TEST(DetectText, TellsTheDeviceThatWasMade) {
  FindingView finding = SomeFinding();
  finding.device = PortName{"Synth", 9};
  EXPECT_EQ(DetectLines(SomePort({finding}))[1],
            "  Maker Synth  device ID 16  on In 1  made Synth #9");
}

TEST(DetectText, TellsOfSilentPorts) {
  EXPECT_THAT(DetectLines(SomePort({})), ElementsAre("Out 1  #5", "  nothing answered"));
}

TEST(DetectText, TellsWhyAPortWasNotAskedToTheEnd) {
  DetectedPort port = SomePort({SomeFinding()});
  port.outcome = Outcome::kTimeLimit;
  EXPECT_EQ(DetectLines(port).back(), "  (its time was over before everything was asked)");
  port.findings.clear();
  for (Outcome const outcome : {Outcome::kOffline, Outcome::kCancelled, Outcome::kWaiting}) {
    port.outcome = outcome;
    EXPECT_THAT(DetectLines(port), testing::Each(testing::Not("  nothing answered")));
    EXPECT_EQ(DetectLines(port).size(), 2u);
  }
}

TEST(DetectText, IsOneJSONObject) {
  FindingView finding = SomeFinding();
  finding.identity = "41 00 19 00 10";
  finding.reply = "F0 F7";
  FindingView bare;
  bare.source = {"In 2", 8};
  auto const json = nlohmann::json::parse(DetectJSON({SomePort({finding, bare})}));
  EXPECT_EQ(json, nlohmann::json::parse(R"({"ports": [{
    "name": "Out 1", "uniqueID": 5, "outcome": "done", "instruments": [
      {"types": [{"manufacturer": "Maker", "model": "Synth"}], "deviceID": 16,
       "source": {"name": "In 1", "uniqueID": 7}, "identity": "41 00 19 00 10",
       "reply": "F0 F7", "device": null},
      {"types": [], "deviceID": null, "source": {"name": "In 2", "uniqueID": 8},
       "identity": null, "reply": null, "device": null}]}]})"));
}

TEST(DetectText, NamesEachOutcomeInJSON) {
  auto const outcomeOf = [](Outcome outcome) {
    DetectedPort port = SomePort({});
    port.outcome = outcome;
    return nlohmann::json::parse(DetectJSON({port}))["ports"][0]["outcome"].get<std::string>();
  };
  EXPECT_EQ(outcomeOf(Outcome::kTimeLimit), "time-limit");
  EXPECT_EQ(outcomeOf(Outcome::kOffline), "offline");
  EXPECT_EQ(outcomeOf(Outcome::kCancelled), "cancelled");
  EXPECT_EQ(outcomeOf(Outcome::kWaiting), "cancelled");
}

TEST(DetectText, ShowsProgressOnOneLine) {
  DetectionRun::Progress progress;
  progress.port = 1;
  progress.ports = 4;
  progress.fraction = 0.25;
  EXPECT_EQ(ProgressLine(progress, "Out 2", 80), "[#####...............] 25 %  port 2 of 4  Out 2");
  progress.fraction = 1.0;
  EXPECT_EQ(ProgressLine(progress, "Out 2", 22), "[####################]");
  EXPECT_EQ(ProgressLine(progress, "Out 2", 0), "");
}

TEST(DetectText, CutsTheLineOfProgressBetweenCharacters) {
  DetectionRun::Progress progress;
  progress.ports = 1;
  std::string const line = ProgressLine(progress, "\xC3\xA9\xC3\xA9\xC3\xA9", 43);
  EXPECT_THAT(line, testing::EndsWith("\xC3\xA9"));
  EXPECT_THAT(line, testing::Not(testing::EndsWith("\xC3\xA9\xC3\xA9\xC3\xA9")));
}

}  // namespace
}  // namespace Ostinet::Tool
