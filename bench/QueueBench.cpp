// SPDX-License-Identifier: MIT

// Input packets from a callback thread to the polling thread: the library's queue beside two
// general ones that carry the same packet. A round is what one poll finds: a burst of short
// messages goes in, and all of them come out.

#include <benchmark/benchmark.h>
#include <concurrentqueue/concurrentqueue.h>

#include <atomic>
#include <boost/lockfree/queue.hpp>
#include <cstring>
#include <thread>

#include "datapath/PacketQueue.h"

namespace Ostinet::Impl {
namespace {

constexpr unsigned char kNoteOn[] = {0x90, 60, 100};

class CountingReceiver : public Receiver {
 public:
  bool WantsPacket(DataPacket const&, Source const&) override { return true; }
  void HandlePacket(DataPacket const& packet, Source const&) override {
    sum += packet.data[1] + packet.stamp.AsMIDITime().Value();
    ++count;
  }

  unsigned long long sum = 0;
  std::size_t count = 0;
};

// The library's queue.
class OurQueue {
 public:
  void Put(DataPacket const& packet) { queue_.Enqueue(packet); }
  void TakeAll(Receiver& receiver) { queue_.Drain(&receiver, nullptr, source_, false); }

 private:
  PacketQueue queue_;
  Source const source_;
};

// What the general queues carry: the same stamp, length and bytes, as a plain structure.
struct PlainPacket {
  TimeStamp stamp;
  unsigned long long length;
  unsigned char bytes[16];
};

PlainPacket MakePlain(DataPacket const& packet) {
  PlainPacket plain;
  plain.stamp = packet.stamp;
  plain.length = packet.length;
  std::memcpy(plain.bytes, packet.data, static_cast<std::size_t>(packet.length));
  return plain;
}

class BoostQueue {
 public:
  void Put(DataPacket const& packet) { queue_.push(MakePlain(packet)); }
  void TakeAll(Receiver& receiver) {
    queue_.consume_all([&](PlainPacket const& plain) {
      receiver.HandlePacket({plain.bytes, plain.length, plain.stamp}, source_);
    });
  }

 private:
  boost::lockfree::queue<PlainPacket> queue_{1024};
  Source const source_;
};

class MoodycamelQueue {
 public:
  void Put(DataPacket const& packet) { queue_.enqueue(MakePlain(packet)); }
  void TakeAll(Receiver& receiver) {
    PlainPacket plain[64];
    while (std::size_t const count = queue_.try_dequeue_bulk(plain, std::size(plain))) {
      for (std::size_t i = 0; i < count; ++i) {
        receiver.HandlePacket({plain[i].bytes, plain[i].length, plain[i].stamp}, source_);
      }
    }
  }

 private:
  moodycamel::ConcurrentQueue<PlainPacket> queue_{1024};
  Source const source_;
};

template <class Queue>
void Burst(benchmark::State& state) {
  auto const burst = static_cast<unsigned long long>(state.range(0));
  Queue queue;
  CountingReceiver receiver;
  for (auto _ : state) {
    for (unsigned long long i = 0; i < burst; ++i) {
      queue.Put({kNoteOn, sizeof kNoteOn, TimeStamp(i)});
    }
    queue.TakeAll(receiver);
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
      queue.TakeAll(receiver);
    }
  }
  quit.store(true, std::memory_order_release);
  producer.join();
  benchmark::DoNotOptimize(receiver.sum);
  state.SetItemsProcessed(static_cast<std::int64_t>(receiver.count));
}

BENCHMARK(Burst<OurQueue>)->Name("Queue/burst/subject")->Arg(64);
BENCHMARK(Burst<BoostQueue>)->Name("Queue/burst/baseline:boost-lockfree")->Arg(64);
BENCHMARK(Burst<MoodycamelQueue>)->Name("Queue/burst/baseline:moodycamel")->Arg(64);
BENCHMARK(TwoThreads<OurQueue>)->Name("Queue/threads/subject")->Arg(1000)->UseRealTime();
BENCHMARK(TwoThreads<BoostQueue>)
    ->Name("Queue/threads/baseline:boost-lockfree")
    ->Arg(1000)
    ->UseRealTime();
BENCHMARK(TwoThreads<MoodycamelQueue>)
    ->Name("Queue/threads/baseline:moodycamel")
    ->Arg(1000)
    ->UseRealTime();

}  // namespace
}  // namespace Ostinet::Impl
