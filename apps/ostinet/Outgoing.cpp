// SPDX-License-Identifier: MIT
#include "Outgoing.h"

#include <algorithm>

#include "Errors.h"
#include "Lookup.h"
#include "ostinet/Setup.h"

namespace Ostinet::Tool {
namespace {

using std::chrono::duration;
using std::chrono::duration_cast;

// A WinMM port queues 256 messages ahead of their time and drops the rest.
constexpr size_t kMaxAhead = 128;
// A MIDI cable carries 3125 bytes a second.
constexpr double kSecondsPerByte = 1.0 / 3125;
// Between a message's time and its leaving lie a thread and, on JACK, a period of audio.
constexpr auto kLinger = std::chrono::milliseconds(50);
constexpr double kClocksPerMs = 10000;

PollLoop::Duration Milliseconds(double ms) {
  return duration_cast<PollLoop::Duration>(duration<double, std::milli>(ms));
}

PollLoop::Duration WireTime(Destination const& destination, size_t bytes) {
  double const seconds =
      destination.IsSoftware() ? 0 : static_cast<double>(bytes) * kSecondsPerByte;
  return duration_cast<PollLoop::Duration>(duration<double>(seconds));
}

}  // namespace

Destination FindDestination(Setup const& setup, std::string const& name) {
  std::vector<Destination> destinations = DestinationsOf(setup);
  for (int i = 0; i < setup.CountPrivateDestinations(); ++i) {
    destinations.push_back(setup.GetPrivateDestination(i));  // The near end of a virtual source.
  }
  Destination const found = Find(destinations, name, "destination");
  if (!found.IsOnline()) {
    throw Failure("the destination \"" + found.GetName().string() + "\" is offline");
  }
  return found;
}

Outgoing::Outgoing(Destination const& destination, std::vector<ScheduledMessage> messages)
    : destination_(destination), messages_(std::move(messages)) {}

void Outgoing::Step() {
  if (!started_) {
    Start();
  }
  auto const now = Clock::now();
  while (next_ < messages_.size()) {
    bool const queueIsFull = next_ >= kMaxAhead && DueOf(messages_[next_ - kMaxAhead]) > now;
    if (queueIsFull) {
      return;
    }
    Send(messages_[next_]);
    ++next_;
  }
}

bool Outgoing::IsDone() const {
  return started_ && CountLeft() == 0 && Clock::now() >= busyUntil_ + kLinger;
}

void Outgoing::Start() {
  started_ = true;
  start_ = Clock::now();
  busyUntil_ = start_;
  startClocks_ = CurrentMIDITime().Value();
}

void Outgoing::Send(ScheduledMessage const& message) {
  // A sender keeps the port that it was made with, so each message asks for a new one.
  std::unique_ptr<Impl::Sender> const sender = destination_.MakeSender();
  if (sender == nullptr || !sender->CanSend()) {
    throw Failure("the destination \"" + destination_.GetName().string() + "\" takes no messages");
  }
  TimeStamp stamp = kNoTimeStamp;
  if (message.afterMs > 0) {
    auto const ahead = static_cast<unsigned long long>(message.afterMs * kClocksPerMs);
    stamp = TimeStamp(Clocks(startClocks_ + ahead));
  }
  sender->Send({message.bytes.data(), message.bytes.size(), stamp});
  sender->Flush();
  busyUntil_ = std::max(busyUntil_, DueOf(message)) + WireTime(destination_, message.bytes.size());
}

Outgoing::Clock::time_point Outgoing::DueOf(ScheduledMessage const& message) const {
  return start_ + Milliseconds(message.afterMs);
}

}  // namespace Ostinet::Tool
