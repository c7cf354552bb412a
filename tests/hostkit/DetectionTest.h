// SPDX-License-Identifier: MIT
#pragma once

#include <memory>
#include <string>
#include <vector>

#include "devicetypes/AutodetectTables.h"
#include "ostinet/hostkit/DetectionRun.h"
#include "platform/PlatformTest.h"

namespace Ostinet::Testing {

/// A studio whose clock is moved by hand, with the ports "Out 1" and "In 1", and questions of the
/// test's own.
class DetectionTest : public PlatformTest {
 protected:
  using Findings = std::vector<DetectionRun::Finding>;

  DetectionTest() {
    midi.MoveClockByHand(10'000'000);
    midi.SetStepPerReading(1);  // a sign-in measures the tick
    AddPair("1");
  }

  void AddPair(std::string const& number) {
    AddOut("Out " + number);
    AddIn("In " + number);
  }

  /// An instrument between "Out 1" and "In 1" that gives `with` for `to`.
  void AddInstrument(std::string const& to, std::string const& with) {
    SimulatedInstrument instrument;
    instrument.out = "Out 1";
    instrument.in = "In 1";
    instrument.replies = {{to, with}};
    midi.AddInstrument(instrument);
  }

  void AddIdentity(std::string const& identity, int deviceID) {
    SimulatedInstrument instrument;
    instrument.out = "Out 1";
    instrument.in = "In 1";
    instrument.identity = identity;
    instrument.deviceID = deviceID;
    midi.AddInstrument(instrument);
  }

  /// Begins a run over all ports.
  DetectionRun& Begin() {
    if (!setup.IsSignedIn()) {
      SignIn();
      midi.SetStepPerReading(0);
    }
    run_ = std::make_unique<DetectionRun>(DetectionRun::DestinationsToAsk(),
                                          DetectionRun::SourcesToHear(), options);
    run_->Step();
    return *run_;
  }

  DetectionRun& Run() { return *run_; }
  void Drop() { run_ = nullptr; }

  /// Lets seconds pass. False if the run has ended.
  bool Pass(double seconds, double step = 0.05) {
    bool goesOn = true;
    for (double passed = 0.0; passed < seconds && goesOn; passed += step) {
      midi.AdvanceClocks(static_cast<long long>(step * 1e7));
      setup.ProcessInput();
      goesOn = run_->Step();
    }
    return goesOn;
  }

  /// Runs from the beginning to the end, and gives what was found on the first port.
  Findings RunAll() {
    Begin();
    EXPECT_FALSE(Pass(600.0)) << "the run does not end";
    return Run().Ports().at(0).findings;
  }

  /// Bytes arrive at "In 1" and are taken.
  void Arrive(std::string const& bytes) {
    midi.Inject("In 1", BytesOf(bytes));
    midi.Settle();
    setup.ProcessInput();
  }

  DetectionRun::Options options;

 private:
  std::unique_ptr<DetectionRun> run_;
};

inline Autodetect::Request Asks(RCPtrMT<Impl::AutodetectRequestImpl> const& request) {
  return Autodetect::Request(request);
}

/// A question with one answer that means these types.
inline RCPtrMT<Impl::AutodetectRequestImpl> QuestionFor(
    std::string const& message, std::string const& answer,
    std::vector<RCPtrMT<Impl::DeviceTypeInfoImpl>> const& types) {
  auto const request = Question(message);
  request->responses = {Answer(answer)};
  request->responses[0]->deviceTypes = types;
  return request;
}

inline std::string ModelsOf(DetectionRun::Finding const& finding) {
  std::string models;
  for (DeviceTypeInfo const& type : finding.types) {
    models += (models.empty() ? "" : ", ") + type.GetModelName().string();
  }
  return models;
}

/// "A, B #3": the types and the device ID.
inline std::vector<std::string> TextsOf(std::vector<DetectionRun::Finding> const& findings) {
  std::vector<std::string> texts;
  for (DetectionRun::Finding const& finding : findings) {
    bool const hasID = finding.deviceID != DetectionRun::kNoDeviceID;
    texts.push_back(ModelsOf(finding) + (hasID ? " #" + std::to_string(finding.deviceID) : ""));
  }
  return texts;
}

}  // namespace Ostinet::Testing
