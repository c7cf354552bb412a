// SPDX-License-Identifier: MIT
#include <algorithm>

#include "hostkit/DetectionTest.h"

namespace Ostinet {
namespace {

using namespace Testing;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::UnorderedElementsAre;
using Outcome = DetectionRun::Outcome;

constexpr char kIdentity[] = "41 00 19 00 10";

class Detection : public DetectionTest {
 protected:
  // The universal inquiry for an instrument "Synth" of that identity, as the catalog has it.
  static RCPtrMT<Impl::AutodetectRequestImpl> Inquiry() {
    return QuestionFor("F0 7E ID 06 01 F7", "F0 7E ID 06 02 F9 FC FD FE FF",
                       {TypeWithIdentity("Synth", "41 FF FF 00 19 00 10")});
  }
  static RCPtrMT<Impl::AutodetectRequestImpl> Simple(std::string const& number) {
    return QuestionFor("F0 " + number + " 01 F7", "F0 " + number + " 02 ID F8",
                       {SomeType(("Model " + number).c_str())});
  }
  std::vector<Bytes> Sent() const { return SentTo("Out 1"); }
};

TEST_F(Detection, FindsAnInstrumentByItsIdentity) {
  options.requests = {Inquiry()};
  AddIdentity(kIdentity, 16);
  auto const findings = RunAll();
  EXPECT_THAT(TextsOf(findings), ElementsAre("Synth #16"));
  ASSERT_EQ(findings.size(), 1u);
  EXPECT_EQ(findings[0].identity, BytesOf("41 00 19 00 10"));
  EXPECT_EQ(findings[0].reply, BytesOf("F0 7E 10 06 02 41 00 19 00 10 00 00 00 00 F7"));
  EXPECT_EQ(findings[0].source, Src("In 1"));
  EXPECT_EQ(Run().Ports()[0].destination, Dest("Out 1"));
  EXPECT_EQ(Run().Ports()[0].outcome, Outcome::kDone);
}

TEST_F(Detection, FindsNothingOnSilentPorts) {
  AddPair("2");
  options.requests = {Inquiry(), Simple("42")};
  EXPECT_THAT(RunAll(), IsEmpty());
  ASSERT_EQ(Run().Ports().size(), 2u);
  EXPECT_EQ(Run().Ports()[0].outcome, Outcome::kDone);
  EXPECT_EQ(Run().Ports()[1].outcome, Outcome::kDone);
  EXPECT_THAT(Run().Ports()[1].findings, IsEmpty());
  EXPECT_FALSE(SentTo("Out 2").empty());
}

TEST_F(Detection, TellsTwoInstrumentsOnOnePortApart) {
  options.requests = {Inquiry()};
  AddIdentity(kIdentity, 3);
  AddIdentity(kIdentity, 4);
  EXPECT_THAT(TextsOf(RunAll()), UnorderedElementsAre("Synth #3", "Synth #4"));
}

TEST_F(Detection, PutsFindingsToThePortThatWasAsked) {
  AddPair("2");
  options.requests = {Simple("42")};
  AddInstrument("F0 42 01 F7", "F0 42 02 05 F7");
  RunAll();
  EXPECT_THAT(TextsOf(Run().Ports()[0].findings), ElementsAre("Model 42 #5"));
  EXPECT_THAT(Run().Ports()[1].findings, IsEmpty());
}

TEST_F(Detection, HearsAnswersOnEverySource) {
  AddPair("2");
  options.requests = {Simple("42")};
  SimulatedInstrument instrument;
  instrument.out = "Out 1";
  instrument.in = "In 2";
  instrument.replies = {{"F0 42 01 F7", "F0 42 02 05 F7"}};
  midi.AddInstrument(instrument);
  auto const findings = RunAll();
  ASSERT_EQ(findings.size(), 1u);
  EXPECT_EQ(findings[0].source, Src("In 2"));
}

TEST_F(Detection, AsksOnlyWhatIsNotExcluded) {
  AddPair("2");
  SignIn();
  auto const destinations = DetectionRun::DestinationsToAsk({Dest("Out 1"), Src("In 2")});
  auto const sources = DetectionRun::SourcesToHear({Dest("Out 1"), Src("In 2")});
  EXPECT_THAT(destinations, ElementsAre(Dest("Out 2")));
  EXPECT_THAT(sources, ElementsAre(Src("In 1")));
}

TEST_F(Detection, AsksNoPortsThatCannotAnswer) {
  SignIn();
  setup.CreateDevice(UString("Described"));
  midi.RemovePort("In 1");
  Rescan();
  EXPECT_THAT(DetectionRun::SourcesToHear(), IsEmpty());
  EXPECT_THAT(DetectionRun::DestinationsToAsk(), ElementsAre(Dest("Out 1")));
}

TEST_F(Detection, TakesAReplyInPiecesCutAnywhere) {
  options.requests = {Inquiry()};
  Bytes const reply = BytesOf("F0 7E 10 06 02 41 00 19 00 10 01 02 03 04 F7");
  for (std::size_t cut = 1; cut < reply.size(); ++cut) {
    DetectionRun& run = Begin();
    for (auto const& piece : {Bytes(reply.begin(), reply.begin() + static_cast<long>(cut)),
                              Bytes(reply.begin() + static_cast<long>(cut), reply.end())}) {
      DataPacket packet;
      packet.data = piece.data();
      packet.length = piece.size();
      EXPECT_TRUE(run.WantsPacket(packet, Src("In 1")));
      run.HandlePacket(packet, Src("In 1"));
    }
    EXPECT_THAT(TextsOf(run.Ports()[0].findings), ElementsAre("Synth #16")) << "cut at " << cut;
  }
}

TEST_F(Detection, TakesAReplyThatAPortDeliversInPieces) {
  options.requests = {Inquiry()};
  Bytes const reply = BytesOf("F0 7E 10 06 02 41 00 19 00 10 01 02 03 04 F7");
  for (std::size_t cut = 1; cut < reply.size(); ++cut) {
    Begin();
    midi.Inject("In 1", Bytes(reply.begin(), reply.begin() + static_cast<long>(cut)));
    Pass(0.1);
    midi.Inject("In 1", Bytes(reply.begin() + static_cast<long>(cut), reply.end()));
    Pass(0.1);
    EXPECT_THAT(TextsOf(Run().Ports()[0].findings), ElementsAre("Synth #16")) << "cut at " << cut;
    Run().Cancel();
  }
}

TEST_F(Detection, TakesRealTimeBetweenThePiecesForWhatItIs) {
  options.requests = {Inquiry()};
  Begin();
  Arrive("F0 7E 10 F8 06 02 41 FE 00 19 00 10 F7");
  EXPECT_THAT(TextsOf(Run().Ports()[0].findings), ElementsAre("Synth #16"));
}

TEST_F(Detection, IgnoresPlayingMeanwhile) {
  options.requests = {Inquiry()};
  Begin();
  Arrive("90 3C 40 F0 7E 10 06 02 41 00 19 00 10 F7 80 3C 40");
  EXPECT_THAT(TextsOf(Run().Ports()[0].findings), ElementsAre("Synth #16"));
}

TEST_F(Detection, CountsWhatHasComeOfAReplyWithoutEnd) {
  options.requests = {Inquiry()};
  DetectionRun& run = Begin();
  Bytes const beginning = BytesOf("F0 7E 10 06 02 41 00 19 00 10 01");
  DataPacket packet;
  packet.data = beginning.data();
  packet.length = beginning.size();
  run.HandlePacket(packet, Src("In 1"));
  EXPECT_THAT(Run().Ports()[0].findings, IsEmpty()) << "it may go on";
  Pass(600.0);
  EXPECT_THAT(TextsOf(Run().Ports()[0].findings), ElementsAre("Synth #16"));
}

TEST_F(Detection, TakesAnAnswerThatComesDuringLaterQuestions) {
  options.requests = {Simple("42"), Simple("43"), Simple("44")};
  Begin();
  Pass(1.5);  // the first question waits for one second
  EXPECT_EQ(Run().GetProgress().request, 1u);
  Arrive("F0 42 02 05 F7");
  EXPECT_THAT(TextsOf(Run().Ports()[0].findings), ElementsAre("Model 42 #5"));
}

TEST_F(Detection, TakesAnAnswerThatComesAfterTheLastQuestion) {
  options.requests = {Simple("42")};
  options.lateAnswers = 2.0;
  Begin();
  Pass(2.5);
  EXPECT_EQ(Run().Ports()[0].outcome, Outcome::kAsking);
  Arrive("F0 42 02 05 F7");
  EXPECT_FALSE(Pass(1.0));
  EXPECT_THAT(TextsOf(Run().Ports()[0].findings), ElementsAre("Model 42 #5"));
}

TEST_F(Detection, TakesALateAnswerForThatOfTheLatestQuestionThatKnowsIt) {
  auto const other = QuestionFor("F0 42 09 F7", "F0 42 02 ID F8", {SomeType("Relative")});
  options.requests = {Simple("42"), other, Simple("43")};
  Begin();
  Arrive("F0 42 02 01 F7");
  Pass(1.5);
  Arrive("F0 42 02 02 F7");
  Pass(1.0);
  Arrive("F0 42 02 03 F7");
  EXPECT_THAT(TextsOf(Run().Ports()[0].findings),
              ElementsAre("Model 42 #1", "Relative #2", "Relative #3"));
}

TEST_F(Detection, WaitsAsLongAsEachRequestSays) {
  auto const two = Simple("42");
  two->messages.push_back(TableOf("F0 50 F7"));
  options.requests = {two, Simple("43")};
  options.secondsPerByte = 0.0;
  options.lateAnswers = 0.5;
  Begin();
  Pass(1.15);
  EXPECT_EQ(Sent().size(), 2u);
  Pass(0.1);
  EXPECT_EQ(Sent().size(), 3u);
  EXPECT_TRUE(Pass(1.4));
  EXPECT_FALSE(Pass(0.2)) << "1.2 s, 1.0 s and 0.5 s";
}

TEST_F(Detection, SendsNoFasterThanACable) {
  auto const sweep = QuestionFor("F0 42 ID F7", "F0 42 02", {TypeWithIDs("Synth", 0, 15)});
  sweep->maxDeviceID = 99;
  options.requests = {sweep};
  options.secondsPerByte = 0.001;
  Begin();
  EXPECT_EQ(Sent().size(), 1u) << "the first goes at once";
  Pass(0.2, 0.001);
  EXPECT_NEAR(static_cast<double>(Sent().size()), 50.0, 2.0);
  Pass(0.1, 0.1);
  EXPECT_NEAR(static_cast<double>(Sent().size()), 75.0, 2.0) << "a slow host catches up";
}

TEST_F(Detection, AsksTheInquiryOfAllIDsToo) {
  options.requests = {Inquiry()};
  options.secondsPerByte = 0.0;
  Begin();
  EXPECT_THAT(Sent(), ElementsAre(BytesOf("F0 7E 7F 06 01 F7"), BytesOf("F0 7E 00 06 01 F7")));
  Run().Cancel();
  midi.ClearSent();
  options.inquireOfAll = false;
  Begin();
  EXPECT_THAT(Sent(), ElementsAre(BytesOf("F0 7E 00 06 01 F7")));
}

TEST_F(Detection, PutsAQuestionOnce) {
  auto const again = QuestionFor("F0 42 01 F7", "F0 42 07", {SomeType("Relative")});
  options.requests = {Simple("42"), again};
  AddInstrument("F0 42 01 F7", "F0 42 07 F7");
  EXPECT_THAT(TextsOf(RunAll()), ElementsAre("Relative"));
  EXPECT_EQ(Sent().size(), 1u);
}

TEST_F(Detection, TakesNoEchoForAnAnswer) {
  auto const careless = QuestionFor("F0 42 01 F7", "F0 42", {SomeType("Synth")});
  options.requests = {careless};
  midi.AddCable("Out 1", "In 1");
  EXPECT_THAT(RunAll(), IsEmpty());
  AddInstrument("F0 42 01 F7", "F0 42 02 F7");
  EXPECT_THAT(TextsOf(RunAll()), ElementsAre("Synth")) << "beside an echo";
}

TEST_F(Detection, NamesAnIdentityThatNoTypeHas) {
  options.requests = {Inquiry()};
  AddIdentity("43 01 02 03 04", 2);
  auto const findings = RunAll();
  EXPECT_THAT(TextsOf(findings), ElementsAre(" #2"));
  EXPECT_EQ(findings.at(0).identity, BytesOf("43 01 02 03 04"));
}

TEST_F(Detection, ReadsAnIdentityInTheSizeOfItsMaker) {
  auto const inquiry = Inquiry();
  inquiry->responses.push_back(Answer("F0 7E ID 06 02 F9 FA FB FC FD FE FF"));
  inquiry->responses[1]->deviceTypes = {TypeWithIdentity("Pad", "00 20 29 01 02 03 04")};
  options.requests = {inquiry};
  AddIdentity("00 20 29 01 02 03 04", 1);
  AddIdentity("00 20 29 01 02 03 05", 2);
  AddIdentity(kIdentity, 3);
  auto const findings = RunAll();
  ASSERT_THAT(TextsOf(findings), UnorderedElementsAre("Pad #1", " #2", "Synth #3"));
  EXPECT_EQ(findings[0].identity, BytesOf("00 20 29 01 02 03 04"));
  EXPECT_EQ(findings[1].identity, BytesOf("00 20 29 01 02 03 05"));
  EXPECT_EQ(findings[2].identity, BytesOf("41 00 19 00 10"));
}

TEST_F(Detection, TakesSeveralAnswersOfOneInstrumentTogether) {
  auto const synth = TypeWithIdentity("Synth", "41 FF FF 00 19 00 10");
  auto const inquiry = Inquiry();
  inquiry->responses[0]->deviceTypes = {synth};
  options.requests = {inquiry,
                      QuestionFor("F0 41 01 F7", "F0 41 01 ID", {synth, SomeType("Relative")})};
  AddIdentity(kIdentity, 127);
  AddInstrument("F0 41 01 F7", "F0 41 01 05 F7");
  auto const findings = RunAll();
  EXPECT_THAT(TextsOf(findings), ElementsAre("Synth #5"))
      << "all IDs is no ID, and both answers allow one type";
  EXPECT_EQ(findings.at(0).identity, BytesOf("41 00 19 00 10"));
}

TEST_F(Detection, TakesAnUnknownIdentityAndAnAnswerOfItsMakerTogether) {
  options.requests = {Inquiry(), QuestionFor("F0 43 01 F7", "F0 43 01", {SomeType("Organ")})};
  AddIdentity("43 01 02 03 04", 2);
  AddInstrument("F0 43 01 F7", "F0 43 01 09 F7");
  auto const findings = RunAll();
  EXPECT_THAT(TextsOf(findings), ElementsAre("Organ #2"));
  EXPECT_EQ(findings.at(0).identity, BytesOf("43 01 02 03 04"));
}

TEST_F(Detection, KeepsTwoModelsOfOneIDApart) {
  options.requests = {QuestionFor("F0 41 01 F7", "F0 41 01 ID", {SomeType("A")}),
                      QuestionFor("F0 41 02 F7", "F0 41 02 ID", {SomeType("B")})};
  AddInstrument("F0 41 01 F7", "F0 41 01 10 F7");
  AddInstrument("F0 41 02 F7", "F0 41 02 10 F7");
  EXPECT_THAT(TextsOf(RunAll()), ElementsAre("A #16", "B #16"));
}

TEST_F(Detection, NamesEveryTypeThatAnAnswerAllows) {
  options.requests = {
      QuestionFor("F0 41 01 F7", "F0 41 01",
                  {TypeWithIdentity("A", "41 FF FF 01 01 01 01"), SomeType("B"), SomeType("C")})};
  AddInstrument("F0 41 01 F7", "F0 41 01 09 F7");
  EXPECT_THAT(TextsOf(RunAll()), ElementsAre("B, A, C")) << "first the one that the library means";
}

class DetectionWithFollowUps : public Detection {
 protected:
  DetectionWithFollowUps() {
    first->responses[0]->requests = {next};
    options.requests = {first, Simple("44")};
    AddInstrument("F0 42 01 F7", "F0 42 02 05 F7");
  }

  RCPtrMT<Impl::DeviceTypeInfoImpl> const a = SomeType("A");
  RCPtrMT<Impl::DeviceTypeInfoImpl> const b = SomeType("B");
  RCPtrMT<Impl::AutodetectRequestImpl> const first =
      QuestionFor("F0 42 01 F7", "F0 42 02 ID F8", {a, b});
  RCPtrMT<Impl::AutodetectRequestImpl> const next =
      QuestionFor("F0 43 01 F7", "F0 43 02", {SomeType("B mk2")});
};

TEST_F(DetectionWithFollowUps, RefinesAnAnswer) {
  AddInstrument("F0 43 01 F7", "F0 43 02 F7");
  EXPECT_THAT(TextsOf(RunAll()), ElementsAre("B mk2 #5"));
  EXPECT_THAT(Sent(),
              ElementsAre(BytesOf("F0 42 01 F7"), BytesOf("F0 43 01 F7"), BytesOf("F0 44 01 F7")))
      << "right behind the question that it follows on";
}

TEST_F(DetectionWithFollowUps, KeepsTheFirstAnswerWithoutASecondOne) {
  EXPECT_THAT(TextsOf(RunAll()), ElementsAre("A, B #5"));
}

TEST_F(DetectionWithFollowUps, AsksOnceForSeveralInstruments) {
  AddInstrument("F0 42 01 F7", "F0 42 02 06 F7");
  EXPECT_THAT(TextsOf(RunAll()), UnorderedElementsAre("A, B #5", "A, B #6"));
  EXPECT_EQ(Sent().size(), 3u);
}

TEST_F(DetectionWithFollowUps, PutsTheSameMessageAgain) {
  next->messages = {TableOf("F0 42 01 F7")};
  next->responses = {Answer("F0 42 02 05")};
  next->responses[0]->deviceTypes = {b};
  EXPECT_THAT(TextsOf(RunAll()), ElementsAre("B #5"));
}

TEST_F(Detection, EndsAPortWhenItsTimeIsOver) {
  AddPair("2");
  options.requests = {Simple("42"), Simple("43"), Simple("44")};
  options.portTimeLimit = 1.5;
  Begin();
  EXPECT_TRUE(Pass(1.4));
  EXPECT_EQ(Run().GetProgress().port, 0u);
  EXPECT_TRUE(Pass(0.2));
  EXPECT_EQ(Run().Ports()[0].outcome, Outcome::kTimeLimit);
  EXPECT_EQ(Run().GetProgress().port, 1u);
  EXPECT_FALSE(Pass(1.6));
  EXPECT_EQ(Run().Ports()[1].outcome, Outcome::kTimeLimit);
}

TEST_F(Detection, KeepsWhatWasFoundWhenItIsCancelled) {
  AddPair("2");
  options.requests = {Simple("42"), Simple("43")};
  AddInstrument("F0 42 01 F7", "F0 42 02 05 F7");
  Begin();
  Pass(0.5);
  Run().Cancel();
  EXPECT_TRUE(Run().IsDone());
  EXPECT_FALSE(Run().Step());
  EXPECT_EQ(Run().Ports()[0].outcome, Outcome::kCancelled);
  EXPECT_EQ(Run().Ports()[1].outcome, Outcome::kCancelled);
  EXPECT_EQ(Run().Ports()[0].findings.size(), 1u);
  EXPECT_EQ(Sent().size(), 1u);
}

TEST_F(Detection, LeavesAPortThatIsPulledOut) {
  AddPair("2");
  options.requests = {Simple("42"), Simple("43")};
  Begin();
  Pass(0.5);
  midi.RemovePort("Out 1");
  Rescan();
  Pass(0.1);
  EXPECT_EQ(Run().Ports()[0].outcome, Outcome::kOffline);
  EXPECT_FALSE(Pass(600.0));
  EXPECT_EQ(Run().Ports()[1].outcome, Outcome::kDone);
}

TEST_F(Detection, TellsNobodyWhenItIsDropped) {
  options.requests = {Simple("42")};
  int told = 0;
  options.onProgress = [&] { ++told; };
  Begin();
  int const before = told;
  Drop();
  EXPECT_EQ(told, before);
  EXPECT_FALSE(Src("In 1").hasDirectReceiver());
}

TEST_F(Detection, EndsWithTheSignOut) {
  options.requests = {Simple("42")};
  Begin();
  SignOut();
  EXPECT_FALSE(Run().Step());
  EXPECT_EQ(Run().Ports()[0].outcome, Outcome::kCancelled);
}

TEST_F(Detection, IsDoneAtOnceWithoutPorts) {
  SignIn();
  DetectionRun run({}, {});
  EXPECT_FALSE(run.IsDone());
  EXPECT_FALSE(run.Step());
  EXPECT_TRUE(run.IsDone());
  EXPECT_EQ(run.GetProgress().fraction, 1.0);
}

TEST_F(Detection, TellsItsProgress) {
  AddPair("2");
  options.requests = {Simple("42"), Simple("43")};
  int told = 0;
  options.onProgress = [&] { ++told; };
  Begin();
  std::vector<double> fractions;
  do {
    auto const progress = Run().GetProgress();
    EXPECT_EQ(progress.ports, 2u);
    EXPECT_LE(progress.request, progress.requests);
    EXPECT_TRUE(fractions.empty() || progress.fraction >= fractions.back());
    fractions.push_back(progress.fraction);
  } while (Pass(0.05));
  EXPECT_EQ(fractions.front(), 0.0);
  // Two questions and the wait at the end, on each of two ports.
  fractions.erase(std::unique(fractions.begin(), fractions.end()), fractions.end());
  EXPECT_EQ(fractions.size(), 6u);
  EXPECT_EQ(Run().GetProgress().fraction, 1.0);
  EXPECT_EQ(Run().GetProgress().port, 2u);
  EXPECT_GE(told, 7);
}

TEST_F(Detection, HasTheInputToItselfAndGivesItBack) {
  options.requests = {Simple("42")};
  Begin();
  EXPECT_TRUE(Src("In 1").hasDirectReceiver());
  Arrive("90 3C 40");
  EXPECT_THAT(receiver.packets, IsEmpty());
  Pass(600.0);
  EXPECT_FALSE(Src("In 1").hasDirectReceiver());
  Arrive("90 3C 40");
  EXPECT_EQ(receiver.packets.size(), 1u);
}

// The callbacks of the system ask the receiver of the sign-in alone.
TEST_F(Detection, HearsWhatTheReceiverOfTheSignInWants) {
  options.requests = {Simple("42")};
  receiver.filter = [](Bytes const&) { return false; };
  Begin();
  Arrive("F0 42 02 05 F7");
  EXPECT_THAT(Run().Ports()[0].findings, IsEmpty());
  receiver.filter = [](Bytes const& bytes) {
    DataPacket packet;
    packet.data = bytes.data();
    packet.length = bytes.size();
    return DetectionRun::IsSysex(packet);
  };
  Arrive("F0 42 02 05 F7");
  EXPECT_EQ(Run().Ports()[0].findings.size(), 1u);
}

TEST_F(Detection, GivesBackTheReceiverThatASourceHad) {
  options.requests = {Simple("42")};
  SignIn();
  midi.SetStepPerReading(0);
  TestReceiver own;
  Src("In 1").setDirectReceiver(&own);
  Begin();
  EXPECT_NE(Src("In 1").getDirectReceiver(), &own);
  Run().Cancel();
  EXPECT_EQ(Src("In 1").getDirectReceiver(), &own);
  Begin();
  TestReceiver other;
  Src("In 1").setDirectReceiver(&other);
  Run().Cancel();
  EXPECT_EQ(Src("In 1").getDirectReceiver(), &other) << "one that came meanwhile stays";
  Src("In 1").setDirectReceiver(nullptr);
}

TEST_F(Detection, KeepsTheBeginningOfALongReply) {
  auto const dump = QuestionFor("F0 42 01 F7", "F0 42 02", {SomeType("Sampler")});
  options.requests = {dump};
  Begin();
  std::string bytes = "F0 42 02";
  for (int i = 0; i < 2000; ++i) {
    bytes += " 11";
  }
  Arrive(bytes + " F7");
  auto const& findings = Run().Ports()[0].findings;
  EXPECT_THAT(TextsOf(findings), ElementsAre("Sampler"));
  EXPECT_EQ(findings.at(0).reply.size(), DetectionRun::kMostReplyBytes);
}

}  // namespace
}  // namespace Ostinet
