// SPDX-License-Identifier: MIT

// The way out, from Sender::Send to the operating system, beside the bare calls of the system that
// do the same.

#include <benchmark/benchmark.h>

#include "BenchHost.h"
#include "NullMusicPort.h"
#include "platform/Session.h"
#include "platform/ports/DMusSender.h"

namespace Ostinet::Bench {
namespace {

using Kind = SimulatedPort::Kind;

void SendOnWinMM(benchmark::State& state, TimeStamp stamp) {
  BenchHost host;
  host.AddPort("Out", Kind::kWinMMOut);
  host.SignIn();
  auto const sender = host.Dest("Out").MakeSender();
  for (auto _ : state) {
    sender->Send({kNoteOn, sizeof kNoteOn, stamp});
  }
}

void SendNowOnWinMM(benchmark::State& state) { SendOnWinMM(state, kNoTimeStamp); }
// A stamp of the past: the clock is read, and the message goes out at once.
void SendLateOnWinMM(benchmark::State& state) { SendOnWinMM(state, TimeStamp(1)); }

void BareShortMessage(benchmark::State& state) {
  BenchHost host;
  host.SignIn();
  host.AddPort("Bare", Kind::kWinMMOut);
  HMIDIOUT device = nullptr;
  host.System().midiOutOpen(&device, 0, 0, 0, CALLBACK_NULL);
  for (auto _ : state) {
    benchmark::DoNotOptimize(host.System().midiOutShortMsg(device, kNoteOnWord));
  }
  host.System().midiOutClose(device);
}

constexpr int kBatch = 8;  // what a sender's buffer holds without being played in between

// Both pack batches for a port that plays nothing, so that what is measured is the packing.
void PackWithASender(benchmark::State& state) {
  BenchHost host;
  auto const session = std::make_shared<Impl::Session>(host.midi.GetSystem());
  NullMusicPort port(session->Clock());
  auto const line = std::make_shared<Impl::DMusLine>(
      session, Impl::ComPtr<IDirectMusicPort>(static_cast<IDirectMusicPort*>(&port)));
  RCPtrMT<Impl::ChannelPatchState> const tracker(new Impl::ChannelPatchState);
  Impl::DMusSender sender(tracker, line);
  for (auto _ : state) {
    for (int i = 0; i < kBatch; ++i) {
      sender.Send({kNoteOn, sizeof kNoteOn, TimeStamp(1000)});
    }
    sender.Flush();
  }
  state.SetItemsProcessed(state.iterations() * kBatch);
}

void BarePacking(benchmark::State& state) {
  BenchHost host;
  auto const session = std::make_shared<Impl::Session>(host.midi.GetSystem());
  NullMusicPort port(session->Clock());
  auto const loan = Impl::BufferPool::Borrow(session->Pool());
  IDirectMusicBuffer& buffer = *loan->buffer.get();
  for (auto _ : state) {
    for (int i = 0; i < kBatch; ++i) {
      benchmark::DoNotOptimize(buffer.PackStructured(1000, 0, kNoteOnWord));
    }
    port.PlayBuffer(&buffer);
    buffer.Flush();
  }
  state.SetItemsProcessed(state.iterations() * kBatch);
}

// The same on a port of the simulated system, which plays the batch.
void SendOnDirectMusic(benchmark::State& state) {
  BenchHost host;
  host.AddPort("Out", Kind::kDirectMusicOut);
  host.SignIn();
  auto const sender = host.Dest("Out").MakeSender();
  for (auto _ : state) {
    for (int i = 0; i < kBatch; ++i) {
      sender->Send({kNoteOn, sizeof kNoteOn, TimeStamp(1)});
    }
    sender->Flush();
  }
  state.SetItemsProcessed(state.iterations() * kBatch);
}

BENCHMARK(SendNowOnWinMM)->Name("send, WinMM/subject");
BENCHMARK(BareShortMessage)->Name("send, WinMM/baseline: midiOutShortMsg");
BENCHMARK(SendLateOnWinMM)->Name("send, WinMM, stamped/subject");
BENCHMARK(BareShortMessage)->Name("send, WinMM, stamped/baseline: midiOutShortMsg");
BENCHMARK(PackWithASender)->Name("send, DirectMusic/subject");
BENCHMARK(BarePacking)->Name("send, DirectMusic/baseline: PackStructured");
BENCHMARK(SendOnDirectMusic)->Name("send, DirectMusic/for comparison: with the system's playing");

}  // namespace
}  // namespace Ostinet::Bench
