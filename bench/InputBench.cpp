// SPDX-License-Identifier: MIT

// The way in, from the system's callback to the host's receiver: a burst of short messages is
// called back, and the next poll hands them over.

#include <benchmark/benchmark.h>

#include "BenchHost.h"
#include "GeneralQueues.h"
#include "TappedSystem.h"

namespace Ostinet::Bench {
namespace {

constexpr int kBurst = 64;

void CallbackToReceiver(benchmark::State& state) {
  BenchHost host;
  auto const tapped = std::make_shared<TappedSystem>(host.midi.GetSystem());
  Impl::InstallSystem(tapped);
  host.AddPort("Out", SimulatedPort::Kind::kWinMMOut);  // as many inputs are listed as outputs
  host.AddPort("In", SimulatedPort::Kind::kWinMMIn);
  host.SignIn();
  for (auto _ : state) {
    for (int i = 0; i < kBurst; ++i) {
      tapped->CallBack(kNoteOnWord, 5);
    }
    host.setup.ProcessInput();
  }
  if (host.receiver.count != static_cast<std::size_t>(state.iterations()) * kBurst) {
    state.SkipWithError("packets got lost");
  }
  state.SetItemsProcessed(static_cast<std::int64_t>(host.receiver.count));
  host.setup.SignOut(false);
  Impl::InstallSystem(host.midi.GetSystem());
}

// The least that a callback can do with a general queue: unpack, stamp, ask, push.
template <class Queue>
struct BareInput {
  static void CALLBACK OnMessage(HMIDIIN, UINT, DWORD_PTR instance, DWORD_PTR message,
                                 DWORD_PTR milliseconds) {
    auto& input = *reinterpret_cast<BareInput*>(instance);
    unsigned char const bytes[] = {static_cast<unsigned char>(message),
                                   static_cast<unsigned char>(message >> 8),
                                   static_cast<unsigned char>(message >> 16)};
    double const eventTime = static_cast<double>(milliseconds) / 1000.0;
    DataPacket const packet{bytes, sizeof bytes, EventTimeToMIDITime(eventTime)};
    Receiver& receiver = input.receiver;
    if (receiver.WantsPacket(packet, input.source)) {
      input.queue.Put(packet);
    }
  }

  Queue queue;
  CountingReceiver receiver;
  Source const source;
};

template <class Queue>
void BareCallbackToReceiver(benchmark::State& state) {
  BareInput<Queue> input;
  TappedSystem::Callback* callback = &BareInput<Queue>::OnMessage;
  benchmark::DoNotOptimize(callback);
  for (auto _ : state) {
    for (int i = 0; i < kBurst; ++i) {
      callback(nullptr, MIM_DATA, reinterpret_cast<DWORD_PTR>(&input), kNoteOnWord, 5);
    }
    input.queue.TakeAll(input.receiver, input.source);
  }
  benchmark::DoNotOptimize(input.receiver.sum);
  state.SetItemsProcessed(static_cast<std::int64_t>(input.receiver.count));
}

BENCHMARK(CallbackToReceiver)->Name("input/subject");
BENCHMARK(BareCallbackToReceiver<BoostQueue>)->Name("input/baseline: Boost.Lockfree");
BENCHMARK(BareCallbackToReceiver<MoodycamelQueue<OwningPacket>>)
    ->Name("input/baseline: moodycamel");

}  // namespace
}  // namespace Ostinet::Bench
