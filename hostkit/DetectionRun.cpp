// SPDX-License-Identifier: MIT
//
// A run is one row of phases for each port: send a question's messages at the pace of a cable, wait
// for the answers, and at the end listen on for a while. Step carries it on as far as the clock
// allows, so that a host that steps seldom loses nothing but time. The clock is that of the
// library, which tests move by hand.
#include "ostinet/hostkit/DetectionRun.h"

#include <algorithm>
#include <utility>

#include "PortQuestions.h"
#include "ReplyReader.h"
#include "ostinet/Setup.h"

namespace Ostinet {

namespace {

constexpr double kClocksPerSecond = 1e7;

double Now() { return static_cast<double>(CurrentMIDITime().Value()) / kClocksPerSecond; }

std::vector<Autodetect::Request> RequestsOfCatalog() {
  DeviceTypeCatalog const& catalog = DeviceTypeCatalog::Instance();
  std::vector<Autodetect::Request> requests;
  for (int i = 0; i < catalog.CountAutodetectRequests(); ++i) {
    requests.push_back(catalog.GetAutodetectRequest(i));
  }
  return requests;
}

// Ports that things can hang on, and that are there.
bool IsUsable(Endpoint const& endpoint, std::vector<Endpoint> const& excluded) {
  return endpoint.IsDirect() && endpoint.IsOnline() && endpoint.HasConnections() &&
         std::find(excluded.begin(), excluded.end(), endpoint) == excluded.end();
}

}  // namespace

class DetectionRun::Impl {
 public:
  Impl(DetectionRun& run, std::vector<Destination> const& destinations,
       std::vector<Source> const& sources, Options options)
      : run_(run), options_(std::move(options)) {
    for (Destination const& destination : destinations) {
      ports_.push_back({destination, Outcome::kWaiting, {}});
    }
    for (Source const& source : sources) {
      if (!IsHeard(source)) {
        listeners_.push_back({source, nullptr, nullptr});
      }
    }
    if (options_.requests.empty()) {
      options_.requests = RequestsOfCatalog();
    }
  }

  bool Step() {
    if (phase_ == Phase::kNotBegun) {
      Listen();
      StartPort();
    }
    if (phase_ != Phase::kEnded && !Setup::Instance().IsSignedIn()) {
      Cancel();
    }
    double const now = phase_ == Phase::kEnded ? 0.0 : Now();
    while (phase_ != Phase::kEnded && Advance(now)) {
    }
    return phase_ != Phase::kEnded;
  }

  // The host may be gone already: it hears of nothing any more.
  void Drop() {
    options_.onProgress = nullptr;
    Cancel();
  }

  void Cancel() {
    if (phase_ == Phase::kEnded) {
      return;
    }
    FinishReplies();
    for (std::size_t i = port_; i < ports_.size(); ++i) {
      ports_[i].outcome = Outcome::kCancelled;
    }
    End();
  }

  bool IsDone() const { return phase_ == Phase::kEnded; }
  std::vector<Port> const& Ports() const { return ports_; }

  Progress GetProgress() const {
    Progress progress;
    progress.port = port_;
    progress.ports = ports_.size();
    if (questions_ != nullptr) {
      progress.requests = questions_->CountAll();
      std::size_t const begun = questions_->CountDone();
      progress.request = phase_ == Phase::kLate ? begun : begun - std::min<std::size_t>(begun, 1);
    }
    // Listening on at the end counts as one more request.
    double const within =
        static_cast<double>(progress.request) / static_cast<double>(progress.requests + 1);
    progress.fraction = IsDone() || ports_.empty() ? 1.0
                                                   : (static_cast<double>(port_) + within) /
                                                         static_cast<double>(ports_.size());
    return progress;
  }

  void Take(DataPacket const& packet, Source const& source) {
    for (Listener& listener : listeners_) {
      if (listener.source == source && listener.reader != nullptr) {
        Read(listener, listener.reader->Take(packet));
      }
    }
  }

 private:
  enum class Phase { kNotBegun, kNewPort, kNewQuestion, kSending, kWaiting, kLate, kEnded };

  struct Listener {
    Source source;
    Receiver* before;  // the host's, which outlives the run
    std::unique_ptr<ReplyReader> reader;
  };

  bool IsHeard(Source const& source) const {
    return std::any_of(listeners_.begin(), listeners_.end(),
                       [&](Listener const& listener) { return listener.source == source; });
  }

  // One step of the present phase; false if nothing is due.
  bool Advance(double now) {
    if (phase_ == Phase::kNewPort) {
      return BeginPort(now);
    }
    if (options_.portTimeLimit > 0.0 && now - portStart_ >= options_.portTimeLimit) {
      return EndPort(Outcome::kTimeLimit);
    }
    if (!ports_[port_].destination.IsOnline()) {
      return EndPort(Outcome::kOffline);
    }
    switch (phase_) {
      case Phase::kNewQuestion:
        return BeginQuestion(now);
      case Phase::kSending:
        return SendDue(now);
      case Phase::kWaiting:
        return now >= due_ && SetPhase(Phase::kNewQuestion);
      default:
        return now >= due_ && EndPort(Outcome::kDone);
    }
  }

  bool BeginPort(double now) {
    portStart_ = now;
    ports_[port_].outcome = Outcome::kAsking;
    questions_ = std::make_unique<PortQuestions>(options_.requests, options_.inquireOfAll);
    for (Listener& listener : listeners_) {
      listener.reader = std::make_unique<ReplyReader>(questions_->Answers());
    }
    SetPhase(Phase::kNewQuestion);
    Tell();
    return true;
  }

  bool BeginQuestion(double now) {
    due_ = now;
    if (!questions_->Next()) {
      due_ = now + options_.lateAnswers;
      SetPhase(Phase::kLate);
      Tell();
      return true;
    }
    messages_ = questions_->TakeMessages();
    sent_ = 0;
    if (!messages_.empty()) {  // Else all of it was asked before.
      SetPhase(Phase::kSending);
      Tell();
    }
    return true;
  }

  // A message may go when the one before it has left the cable.
  bool SendDue(double now) {
    while (sent_ < messages_.size()) {
      if (now < due_) {
        return false;
      }
      Bytes const& message = messages_[sent_++];
      DataPacket packet;
      packet.data = message.data();
      packet.length = message.size();
      ports_[port_].destination.SendOnePacket(packet);
      due_ += static_cast<double>(message.size()) * options_.secondsPerByte;
    }
    due_ = std::max(due_, now) + questions_->Timeout();
    return SetPhase(Phase::kWaiting);
  }

  bool EndPort(Outcome outcome) {
    FinishReplies();
    ports_[port_].outcome = outcome;
    for (Listener& listener : listeners_) {
      listener.reader = nullptr;
    }
    questions_ = nullptr;
    ++port_;
    StartPort();
    return true;
  }

  void StartPort() {
    SetPhase(Phase::kNewPort);
    if (port_ >= ports_.size()) {
      End();
    }
  }

  void End() {
    SetPhase(Phase::kEnded);
    port_ = ports_.size();
    StopListening();
    Tell();
  }

  void Listen() {
    for (Listener& listener : listeners_) {
      listener.before = listener.source.getDirectReceiver();
      listener.source.setDirectReceiver(&run_);
    }
  }

  // A host that has put in another receiver meanwhile keeps that.
  void StopListening() {
    for (Listener const& listener : listeners_) {
      if (listener.source.getDirectReceiver() == &run_) {
        listener.source.setDirectReceiver(listener.before);
      }
    }
  }

  // What has come of replies that did not end counts.
  void FinishReplies() {
    for (Listener& listener : listeners_) {
      if (listener.reader != nullptr) {
        Read(listener, listener.reader->Finish());
      }
    }
  }

  void Read(Listener const& listener, std::vector<Reply> const& replies) {
    for (Reply const& reply : replies) {
      if (auto meaning = questions_->Read(reply)) {
        meaning->finding.source = listener.source;
        AddMeaning(ports_[port_].findings, *meaning);
      }
    }
  }

  bool SetPhase(Phase phase) {
    phase_ = phase;
    return true;
  }

  void Tell() const {
    if (options_.onProgress) {
      options_.onProgress();
    }
  }

  DetectionRun& run_;
  Options options_;
  std::vector<Port> ports_;
  std::vector<Listener> listeners_;
  Phase phase_ = Phase::kNotBegun;
  std::size_t port_ = 0;
  double portStart_ = 0.0;  // seconds, as all times here
  double due_ = 0.0;        // when the present phase goes on
  std::unique_ptr<PortQuestions> questions_;
  std::vector<Bytes> messages_;
  std::size_t sent_ = 0;
};

DetectionRun::DetectionRun(std::vector<Destination> const& destinations,
                           std::vector<Source> const& sources, Options options)
    : impl_(std::make_unique<Impl>(*this, destinations, sources, std::move(options))) {}

DetectionRun::DetectionRun(std::vector<Destination> const& destinations,
                           std::vector<Source> const& sources)
    : DetectionRun(destinations, sources, Options()) {}

DetectionRun::~DetectionRun() { impl_->Drop(); }

std::vector<Destination> DetectionRun::DestinationsToAsk(std::vector<Endpoint> const& excluded) {
  Setup const& setup = Setup::Instance();
  std::vector<Destination> destinations;
  for (int i = 0; i < setup.CountDestinations(); ++i) {
    if (IsUsable(setup.GetDestination(i), excluded)) {
      destinations.push_back(setup.GetDestination(i));
    }
  }
  return destinations;
}

std::vector<Source> DetectionRun::SourcesToHear(std::vector<Endpoint> const& excluded) {
  Setup const& setup = Setup::Instance();
  std::vector<Source> sources;
  for (int i = 0; i < setup.CountSources(); ++i) {
    if (IsUsable(setup.GetSource(i), excluded)) {
      sources.push_back(setup.GetSource(i));
    }
  }
  return sources;
}

bool DetectionRun::Step() { return impl_->Step(); }
void DetectionRun::Cancel() { impl_->Cancel(); }
bool DetectionRun::IsDone() const { return impl_->IsDone(); }
std::vector<DetectionRun::Port> const& DetectionRun::Ports() const { return impl_->Ports(); }
DetectionRun::Progress DetectionRun::GetProgress() const { return impl_->GetProgress(); }

bool DetectionRun::IsSysex(DataPacket const& packet) {
  constexpr unsigned char kSysex = 0xF0;
  constexpr unsigned char kEndOfExclusive = 0xF7;
  constexpr unsigned char kFirstStatus = 0x80;
  return packet.length != 0 && (packet.data[0] < kFirstStatus || packet.data[0] == kSysex ||
                                packet.data[0] == kEndOfExclusive);
}

bool DetectionRun::WantsPacket(DataPacket const& packet, Source const&) { return IsSysex(packet); }

void DetectionRun::HandlePacket(DataPacket const& packet, Source const& source) {
  impl_->Take(packet, source);
}

}  // namespace Ostinet
