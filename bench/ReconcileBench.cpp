// SPDX-License-Identifier: MIT

// Large studios: what a change of the system's ports costs with a thousand of them and with ten
// thousand. Half of the ports are inputs. Ports change once in hours, when nothing of the studio is
// in the processor's caches any more; so each round starts with caches full of other things, or
// else the smaller studio alone would be measured in them.

#include <benchmark/benchmark.h>

#include <cstddef>
#include <thread>
#include <vector>

#include "BenchHost.h"
#include "CacheFiller.h"
#include "platform/PortAttacher.h"
#include "platform/Reconciliation.h"

namespace Ostinet::Bench {
namespace {

void AddPorts(BenchHost& host, std::int64_t count) {
  for (std::int64_t i = 0; i < count; ++i) {
    bool const isOutput = i % 2 == 0;
    host.AddPort("Port " + std::to_string(i / 2), isOutput ? SimulatedPort::Kind::kDirectMusicOut
                                                           : SimulatedPort::Kind::kDirectMusicIn);
  }
}

void Reconcile(BenchHost& host, std::shared_ptr<Impl::Session> const& session,
               Impl::PortList const& ports) {
  Impl::PortAttacher attacher(host.setup, session);
  benchmark::DoNotOptimize(Impl::Reconcile(host.setup, attacher, ports));
}

/// What lies between two changes: the host polls, so that nothing is pending, and works.
void Rest(benchmark::State& state, BenchHost& host, CacheFiller& filler) {
  state.PauseTiming();
  host.setup.PollSetupChanges();
  filler.Fill();
  state.ResumeTiming();
}

// Nothing changed: the most frequent case.
void ReconcileUnchanged(benchmark::State& state) {
  BenchHost host;
  AddPorts(host, state.range(0));
  host.SignIn();
  auto const session = std::make_shared<Impl::Session>(host.midi.GetSystem());
  auto const ports = Impl::EnumeratePorts(host.System(), *session->DirectMusic().get());
  CacheFiller filler;
  for (auto _ : state) {
    Rest(state, host, filler);
    Reconcile(host, session, ports);
  }
}

// All ports go, and all come back.
void ReconcileReplug(benchmark::State& state) {
  BenchHost host;
  AddPorts(host, state.range(0));
  host.SignIn();
  auto const session = std::make_shared<Impl::Session>(host.midi.GetSystem());
  auto const ports = Impl::EnumeratePorts(host.System(), *session->DirectMusic().get());
  CacheFiller filler;
  for (auto _ : state) {
    Rest(state, host, filler);
    Reconcile(host, session, {});
    Reconcile(host, session, ports);
  }
}

// As the host sees it: the ports are listed anew, and a poll finds that one has come or gone.
void PollAfterAChange(benchmark::State& state) {
  BenchHost host;
  AddPorts(host, state.range(0));
  host.SignIn();
  CacheFiller filler;
  bool isThere = false;
  for (auto _ : state) {
    Rest(state, host, filler);
    state.PauseTiming();
    isThere = !isThere;
    if (isThere) {
      host.AddPort("One More", SimulatedPort::Kind::kDirectMusicOut);
    } else {
      host.midi.RemovePort("One More");
    }
    state.ResumeTiming();
    host.setup.DevicesChanged();
    while (!host.setup.HasListedPorts()) {
      std::this_thread::yield();
    }
    host.setup.PollSetupChanges();
  }
}

void Sizes(benchmark::internal::Benchmark* benchmark) {
  benchmark->Arg(1000)->Arg(10000)->Unit(benchmark::kMillisecond);
}

BENCHMARK(ReconcileUnchanged)->Name("reconcile, unchanged/ports")->Apply(Sizes);
BENCHMARK(ReconcileReplug)->Name("reconcile, all replugged/ports")->Apply(Sizes);
BENCHMARK(PollAfterAChange)->Name("reconcile, listing and poll/ports")->Apply(Sizes)->UseRealTime();

}  // namespace
}  // namespace Ostinet::Bench
