// SPDX-License-Identifier: MIT
//
// The half of the public face that tests use: time, faults, measurements.

#include <limits>
#include <stdexcept>

#include "ostinet/SimulatedMIDI.h"
#include "platform/system/simulated/SimulatedSystem.h"

namespace Ostinet {

using Impl::Simulated::Studio;

namespace {

constexpr std::uint64_t kForEver = std::numeric_limits<std::uint64_t>::max();

void CheckNth(std::uint64_t nth) {
  if (nth == 0) throw std::invalid_argument("Calls are counted from 1");
}

void CheckNotNegative(long long value) {
  if (value < 0) throw std::invalid_argument("The clock does not run backwards");
}

}  // namespace

long long SimulatedMIDI::Now() const { return Get().GetStudio().Clock().Now(); }

void SimulatedMIDI::UseRealTime() const { Get().GetStudio().UseRealTime(); }

void SimulatedMIDI::MoveClockByHand() const { Get().GetStudio().MoveClockByHand(nullptr); }

void SimulatedMIDI::MoveClockByHand(long long start) const {
  CheckNotNegative(start);
  std::int64_t const time = start;
  Get().GetStudio().MoveClockByHand(&time);
}

bool SimulatedMIDI::AdvanceClocks(long long clocks) const {
  CheckNotNegative(clocks);
  Studio& studio = Get().GetStudio();
  if (!studio.Clock().IsByHand()) {
    throw std::logic_error("The clock runs in real time, so it cannot be moved");
  }
  return studio.Advance(clocks);
}

void SimulatedMIDI::SetStepPerReading(long long clocks) const {
  CheckNotNegative(clocks);
  Get().GetStudio().Clock().SetStep(clocks);
}

void SimulatedMIDI::SetMasterClockStill(bool still) const {
  Get().GetStudio().Clock().SetStill(still);
}

void SimulatedMIDI::SetMasterClockTick(long long clocks) const {
  CheckNotNegative(clocks);
  Get().GetStudio().Clock().SetTick(clocks);
}

void SimulatedMIDI::SetMasterClockAbsent(bool absent) const {
  Get().GetStudio().Clock().SetAbsent(absent);
}

bool SimulatedMIDI::Settle(int milliseconds) const {
  return Get().GetStudio().Settle(milliseconds);
}

void SimulatedMIDI::StartTimeline() const { Get().GetStudio().StartTimeline(); }

void SimulatedMIDI::Fail(std::string const& operation, std::uint64_t nth) const {
  CheckNth(nth);
  Get().GetStudio().Book().AddFault(operation, nth, nth, nullptr);
}

void SimulatedMIDI::FailWith(std::string const& operation, long long result,
                             std::uint64_t nth) const {
  CheckNth(nth);
  Get().GetStudio().Book().AddFault(operation, nth, nth, &result);
}

void SimulatedMIDI::FailFrom(std::string const& operation, std::uint64_t nth) const {
  CheckNth(nth);
  Get().GetStudio().Book().AddFault(operation, nth, kForEver, nullptr);
}

void SimulatedMIDI::FailFromWith(std::string const& operation, long long result,
                                 std::uint64_t nth) const {
  CheckNth(nth);
  Get().GetStudio().Book().AddFault(operation, nth, kForEver, &result);
}

void SimulatedMIDI::ClearFaults() const { Get().GetStudio().Book().ClearFaults(); }

std::uint64_t SimulatedMIDI::CountCalls(std::string const& operation) const {
  return Get().GetStudio().Book().Count(operation);
}

void SimulatedMIDI::ResetCalls() const { Get().GetStudio().Book().ResetCounts(); }

void SimulatedMIDI::LogCalls(bool on) const { Get().GetStudio().Book().SetLogging(on); }

std::vector<SimulatedCall> SimulatedMIDI::TakeLog() const {
  return Get().GetStudio().Book().TakeLog();
}

void SimulatedMIDI::HoldLongMessages(int tries) const {
  Studio& studio = Get().GetStudio();
  std::lock_guard lock(studio.Mutex());
  studio.longMessageTries = tries;
}

void SimulatedMIDI::SetEndless(std::string const& operation, bool on) const {
  Studio& studio = Get().GetStudio();
  std::lock_guard lock(studio.Mutex());
  if (operation == "EnumPort") {
    studio.endlessPorts = on;
  } else if (operation == "EnumInstrument") {
    studio.endlessInstruments = on;
  } else if (operation == "Read") {
    studio.endlessRead = on;
  } else {
    throw std::invalid_argument("\"" + operation + "\" cannot be made endless");
  }
}

void SimulatedMIDI::SetCollection(std::vector<std::uint32_t> const& patches) const {
  Studio& studio = Get().GetStudio();
  std::lock_guard lock(studio.Mutex());
  studio.collection = patches;
}

int SimulatedMIDI::CountDownloaded(std::string const& port) const {
  return Get().GetStudio().CountDownloaded(port);
}

int SimulatedMIDI::CountObjects(std::string const& interfaceName) const {
  return Get().GetStudio().Objects().Count(interfaceName);
}

int SimulatedMIDI::CountOpenDevices() const {
  Studio& studio = Get().GetStudio();
  std::lock_guard lock(studio.Mutex());
  return static_cast<int>(studio.openInputs.size() + studio.openOutputs.size());
}

int SimulatedMIDI::CountWaitHandles() const { return Get().GetStudio().GetWaits().CountHandles(); }

void SimulatedMIDI::SetAudioSessions(std::vector<std::string> const& identifiers) const {
  Studio& studio = Get().GetStudio();
  std::lock_guard lock(studio.Mutex());
  studio.audioSessions = identifiers;
}

}  // namespace Ostinet
