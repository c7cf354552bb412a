// SPDX-License-Identifier: MIT
//
// The answers of the resolver, on studios of any shape.
#include <gtest/gtest.h>

#include <random>

#include "ostinet/hostkit/ReferenceResolver.h"
#include "support/Printers.h"
#include "support/TestSetup.h"

namespace Ostinet {
namespace {

using Impl::EndpointKind;
using Outcome = ReferenceResolver::Outcome;
using Testing::TestSetup;

class ReferenceResolverTest : public testing::Test {
 protected:
  ReferenceResolverTest() { setup.Reset(); }
  ~ReferenceResolverTest() override { setup.Reset(); }

  Destination Port(char const* name, int id) {
    Destination const port = setup.MakePort(name);
    TestSetup::SetInt(port, "uniqueID", id);
    return port;
  }
  Destination Instrument(char const* name, int id, char const* maker = "", char const* model = "") {
    Destination const instrument = setup.MakeInstrument(name);
    TestSetup::SetInt(instrument, "uniqueID", id);
    instrument.SetManufacturer(maker);
    instrument.SetModel(model);
    return instrument;
  }
  static void Remove(Destination const& destination) {
    TestSetup::Get().DeleteDevice(destination.GetEntity().GetDevice());
  }
  static ReferenceResolver::Answer Resolve(
      MatchData const& data, std::vector<MatchLevel> const& levels = StandardMatch()) {
    return ReferenceResolver(levels).Resolve(data);
  }

  TestSetup& setup = TestSetup::Get();
};

TEST_F(ReferenceResolverTest, FindsAnEndpointThatStayed) {
  Destination const pad = Instrument("Pad", 42, "Acme", "One");
  Instrument("Bass", 43, "Acme", "Two");
  auto const answer = Resolve(pad.GetMatchData());
  ASSERT_EQ(answer.outcome, Outcome::kFound);
  EXPECT_EQ(answer.Winner()->destination, pad);
  EXPECT_EQ(answer.Winner()->endpoint, pad);
  EXPECT_FALSE(answer.Winner()->source.Exists());
  EXPECT_EQ(answer.Winner()->weight, 8 + 6 + 4 + 2);
  EXPECT_EQ(answer.Winner()->levels.size(), 4u);
  EXPECT_EQ(answer.InWords(), "Pad: same ID, same name, same model");
  EXPECT_TRUE(answer.runnersUp.empty());
}

TEST_F(ReferenceResolverTest, TellsIdenticalInterfacesApartByTheirIDs) {
  Port("USB MIDI", 1);
  Destination const second = Port("USB MIDI", 2);
  auto const answer = Resolve(second.GetMatchData());
  ASSERT_EQ(answer.outcome, Outcome::kFound);
  EXPECT_EQ(answer.Winner()->destination, second);
  ASSERT_EQ(answer.runnersUp.size(), 1u);
  EXPECT_EQ(answer.runnersUp[0].InWords(), "other ID, same name");
}

TEST_F(ReferenceResolverTest, BreaksATieByTheFinerRank) {
  MatchData const saved = Port("Pad", 42).GetMatchData();
  setup.Reset();
  Port("PAD", 1);
  Destination const exact = Port("Pad", 2);
  auto const answer = Resolve(saved);
  ASSERT_EQ(answer.outcome, Outcome::kFound);
  EXPECT_EQ(answer.Winner()->destination, exact);
  ASSERT_EQ(answer.runnersUp.size(), 1u);
  EXPECT_EQ(answer.runnersUp[0].weight, answer.Winner()->weight);
}

// General MIDI is in no level of the list, but is finer than a guess.
TEST_F(ReferenceResolverTest, BreaksATieByACriterionOfNoLevel) {
  MatchTranslator translator;
  Destination const gm = Port("Pad", 1);
  gm.SetSupportsGeneralMIDI(true);
  Destination const plain = Port("Pad", 2);
  auto const answer = Resolve(translator.TranslateFromNameOnly(Destination::kObjectID, "Pad"));
  ASSERT_EQ(answer.outcome, Outcome::kFound);
  EXPECT_EQ(answer.Winner()->destination, plain);
}

TEST_F(ReferenceResolverTest, TheLevelsSayWhetherNameOrIDComesFirst) {
  Destination const pad = Port("Pad", 42);
  MatchData const saved = pad.GetMatchData();
  pad.SetRawName("Strings");
  Destination const namesake = Port("Pad", 43);
  EXPECT_EQ(Resolve(saved, IDAndNameMatch()).Winner()->destination, pad);
  // By the third list both have a total of 2: the first of its criteria decides.
  auto const byName = Resolve(saved, NameAndIDMatch());
  ASSERT_EQ(byName.outcome, Outcome::kFound);
  EXPECT_EQ(byName.Winner()->destination, namesake);
  EXPECT_EQ(byName.runnersUp.at(0).weight, byName.Winner()->weight);
}

TEST_F(ReferenceResolverTest, FindsInternalSoftwareByItsSlot) {
  Destination const plugin = setup.MakeDestination("FX", EndpointKind::Software(false, true));
  TestSetup::PeerOf(plugin).SetIntList("slotDescriptor", {1, 2, 3, 4, 5, 6});
  MatchData const saved = plugin.GetMatchData();
  plugin.SetRawName("Renamed");
  TestSetup::SetInt(plugin, "uniqueID", 99);
  auto const answer = Resolve(saved);
  ASSERT_EQ(answer.outcome, Outcome::kFound);
  EXPECT_EQ(answer.Winner()->InWords(), "same slot");
}

TEST_F(ReferenceResolverTest, SourcesAndDestinationsAreKeptApart) {
  Port("Pad", 1);
  Source const source = setup.MakeSourcePort("Pad");
  auto const answer = Resolve(source.GetMatchData());
  ASSERT_EQ(answer.outcome, Outcome::kFound);
  EXPECT_EQ(answer.Winner()->source, source);
  EXPECT_FALSE(answer.Winner()->destination.Exists());
}

TEST_F(ReferenceResolverTest, SaysWhyItFindsNothing) {
  MatchTranslator translator;
  Port("Pad", 1);
  auto const unknown = Resolve(translator.TranslateFromNameOnly(Destination::kObjectID, "Bass"));
  EXPECT_EQ(unknown.outcome, Outcome::kNotFound);
  EXPECT_EQ(unknown.InWords(), "nothing in the studio resembles it");
  EXPECT_EQ(unknown.Winner(), nullptr);
  auto const patch = Resolve(translator.TranslateFromNameOnly(MatchObjectID(7), "Pad"));
  EXPECT_EQ(patch.outcome, Outcome::kNoEndpoint);
  auto const broken = Resolve(MatchData());
  EXPECT_EQ(broken.outcome, Outcome::kUnreadable);
  EXPECT_EQ(broken.InWords(), "the bytes hold no reference");
}

TEST_F(ReferenceResolverTest, SeesChangesAfterAnUpdate) {
  ReferenceResolver resolver;
  MatchTranslator translator;
  MatchData const saved = translator.TranslateFromNameOnly(Destination::kObjectID, "Pad");
  EXPECT_EQ(resolver.Resolve(saved).outcome, Outcome::kNotFound);
  Destination const pad = Port("Pad", 1);
  resolver.Update();
  EXPECT_EQ(resolver.Resolve(saved).Winner()->destination, pad);
  setup.Reset();
  EXPECT_EQ(resolver.Resolve(saved).outcome, Outcome::kNotFound);
}

// A level without an upper bound on who meets it is asked of everyone.
TEST_F(ReferenceResolverTest, TakesLevelsThatHalfTheStudioMeets) {
  Port("A", 1);
  Destination const gm = Port("B", 2);
  gm.SetSupportsGeneralMIDI(true);
  MatchData const saved = gm.GetMatchData();
  std::vector<MatchLevel> const levels = {{ObjectMatch::kGeneralMIDIMatch, 2, 1}};
  EXPECT_EQ(Resolve(saved, levels).Winner()->destination, gm);
  std::vector<MatchLevel> const anyRank = {{ObjectMatch::kNameMatch, 0, 1}};
  EXPECT_EQ(Resolve(saved, anyRank).runnersUp.size(), 1u);
}

std::string Text(ReferenceResolver::Answer const& answer) {
  std::string text = answer.InWords();
  for (auto const* const list : {&answer.best, &answer.runnersUp}) {
    for (auto const& candidate : *list) {
      text += "\n" + std::to_string(candidate.endpoint.GetKey()) + " " +
              std::to_string(candidate.weight) + " " + std::to_string(candidate.levels.size()) +
              " " + candidate.InWords();
    }
    text += "\n--";
  }
  return text;
}

// Few names, IDs, makers and models, so that everything coincides with everything.
class CrowdedStudio : public ReferenceResolverTest {
 protected:
  int Draw(int count) { return std::uniform_int_distribution<int>(0, count - 1)(random_); }
  char const* DrawName() {
    constexpr char const* kNames[] = {"Pad", "PAD", "p a d", "Bass", "bass", "Lead", ""};
    return kNames[Draw(7)];
  }

  Destination DrawEndpoint() {
    constexpr char const* kMakers[] = {"Acme", "ACME", "Best", ""};
    constexpr char const* kModels[] = {"One", "one", "Two", ""};
    switch (Draw(4)) {
      case 0:
        return Port(DrawName(), Draw(9));
      case 1: {
        Destination const plugin =
            setup.MakeDestination(DrawName(), EndpointKind::Software(false, Draw(2) == 0));
        TestSetup::PeerOf(plugin).SetIntList("slotDescriptor", {Draw(3), 0, 0, 0, 0, 0});
        TestSetup::SetInt(plugin, "uniqueID", Draw(9));
        return plugin;
      }
      default: {
        Destination const instrument =
            Instrument(DrawName(), Draw(9), kMakers[Draw(4)], kModels[Draw(4)]);
        instrument.SetSupportsGeneralMIDI(Draw(2) == 0);
        if (ports_.empty() || Draw(4) == 0) {
          ports_.push_back(Port(DrawName(), 20 + Draw(4)));
        }
        ports_[static_cast<std::size_t>(Draw(static_cast<int>(ports_.size())))]
            .AddConnectedDestination(instrument);
        return instrument;
      }
    }
  }

  std::vector<MatchLevel> DrawLevels() {
    std::vector<MatchLevel> levels;
    for (int i = Draw(5) + 1; i > 0; --i) {
      levels.push_back({static_cast<ObjectMatch::MatchType>(Draw(5)), Draw(5), Draw(9) - 2});
    }
    return levels;
  }

  std::mt19937 random_{20};
  std::vector<Destination> ports_;
};

TEST_F(CrowdedStudio, TheIndexAnswersAsComparingAllDoes) {
  for (int round = 0; round < 6; ++round) {
    setup.Reset();
    ports_.clear();
    std::vector<MatchData> references;
    for (int i = 0; i < 30; ++i) {
      references.push_back(DrawEndpoint().GetMatchData());
    }
    // Half of them as they were saved elsewhere.
    setup.Reset();
    ports_.clear();
    for (int i = 0; i < 30; ++i) {
      references.push_back(DrawEndpoint().GetMatchData());
    }
    for (auto const& levels : {StandardMatch(), IDAndNameMatch(), NameAndIDMatch(), DrawLevels(),
                               DrawLevels(), DrawLevels()}) {
      for (std::size_t const runnersUp : {0u, 1u, 3u, 1000u}) {
        ReferenceResolver const resolver(levels, runnersUp);
        for (MatchData const& reference : references) {
          ASSERT_EQ(Text(resolver.Resolve(reference)),
                    Text(resolver.ResolveByComparingAll(reference)));
        }
      }
    }
  }
}

}  // namespace
}  // namespace Ostinet
