// SPDX-License-Identifier: MIT

// Packets from a callback thread to the polling thread: the library's queue beside general ones. A
// round is what one poll finds: a burst of short messages goes in, and all of them come out.

#include <benchmark/benchmark.h>

#include <atomic>
#include <thread>

#include "BenchHost.h"
#include "GeneralQueues.h"

namespace Ostinet::Bench {
namespace {

template <class Queue>
void Burst(benchmark::State& state) {
  auto const burst = static_cast<unsigned long long>(state.range(0));
  Queue queue;
  CountingReceiver receiver;
  Source const source;
  for (auto _ : state) {
    for (unsigned long long i = 0; i < burst; ++i) {
      queue.Put({kNoteOn, sizeof kNoteOn, TimeStamp(i)});
    }
    queue.TakeAll(receiver, source);
  }
  benchmark::DoNotOptimize(receiver.sum);
  state.SetItemsProcessed(static_cast<std::int64_t>(receiver.count));
}

// A thread puts packets in while this one drains; the time is that of one burst, in and out.
template <class Queue>
void TwoThreads(benchmark::State& state) {
  auto const burst = static_cast<std::size_t>(state.range(0));
  Queue queue;
  CountingReceiver receiver;
  Source const source;
  std::atomic<std::size_t> wanted{0};
  std::atomic<bool> quit{false};
  std::thread producer([&] {
    std::size_t put = 0;
    while (!quit.load(std::memory_order_acquire)) {
      for (std::size_t const goal = wanted.load(std::memory_order_acquire); put < goal; ++put) {
        queue.Put({kNoteOn, sizeof kNoteOn, TimeStamp(put)});
      }
    }
  });
  std::size_t goal = 0;
  for (auto _ : state) {
    goal += burst;
    wanted.store(goal, std::memory_order_release);
    while (receiver.count < goal) {
      queue.TakeAll(receiver, source);
    }
  }
  quit.store(true, std::memory_order_release);
  producer.join();
  benchmark::DoNotOptimize(receiver.sum);
  state.SetItemsProcessed(static_cast<std::int64_t>(receiver.count));
}

BENCHMARK(Burst<OurQueue>)->Name("queue/subject")->Arg(64);
BENCHMARK(Burst<BoostQueue>)->Name("queue/baseline: Boost.Lockfree")->Arg(64);
BENCHMARK(Burst<MoodycamelQueue<OwningPacket>>)->Name("queue/baseline: moodycamel")->Arg(64);
BENCHMARK(Burst<MoodycamelQueue<PlainPacket>>)
    ->Name("queue/for comparison: moodycamel, short messages only")
    ->Arg(64);
BENCHMARK(TwoThreads<OurQueue>)->Name("queue, two threads/subject")->Arg(1000)->UseRealTime();
BENCHMARK(TwoThreads<BoostQueue>)
    ->Name("queue, two threads/baseline: Boost.Lockfree")
    ->Arg(1000)
    ->UseRealTime();
BENCHMARK(TwoThreads<MoodycamelQueue<OwningPacket>>)
    ->Name("queue, two threads/baseline: moodycamel")
    ->Arg(1000)
    ->UseRealTime();

}  // namespace
}  // namespace Ostinet::Bench
