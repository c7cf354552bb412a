// SPDX-License-Identifier: MIT

// Large studios: what a change of the system's ports costs with a thousand of them and with ten
// thousand. Half of the ports are inputs.

#include <benchmark/benchmark.h>

#include <thread>

#include "BenchHost.h"
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

// Nothing changed: the most frequent case.
void ReconcileUnchanged(benchmark::State& state) {
  BenchHost host;
  AddPorts(host, state.range(0));
  host.SignIn();
  auto const session = std::make_shared<Impl::Session>(host.midi.GetSystem());
  auto const ports = Impl::EnumeratePorts(host.System(), *session->DirectMusic().get());
  for (auto _ : state) {
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
  for (auto _ : state) {
    Reconcile(host, session, {});
    Reconcile(host, session, ports);
  }
}

class ChangeListener : public SetupListener {
 public:
  void SetupChanged() override { ++changes; }
  void CurrentPatchChanged(Destination, unsigned short) override {}
  void DestinationNamesChanged(Destination, unsigned short) override {}
  int changes = 0;
};

// As the host sees it: the ports are listed anew, and a poll finds that one has come or gone.
void PollAfterAChange(benchmark::State& state) {
  BenchHost host;
  AddPorts(host, state.range(0));
  host.SignIn();
  ChangeListener listener;
  host.setup.SetListener(&listener);
  host.setup.PollSetupChanges();  // the first one always tells of a change
  bool isThere = false;
  for (auto _ : state) {
    state.PauseTiming();
    isThere = !isThere;
    if (isThere) {
      host.AddPort("One More", SimulatedPort::Kind::kDirectMusicOut);
    } else {
      host.midi.RemovePort("One More");
    }
    listener.changes = 0;
    state.ResumeTiming();
    host.setup.DevicesChanged();
    while (listener.changes == 0) {
      std::this_thread::yield();
      host.setup.PollSetupChanges();
    }
  }
  host.setup.SetListener(nullptr);
}

void Sizes(benchmark::internal::Benchmark* benchmark) {
  benchmark->Arg(1000)->Arg(10000)->Unit(benchmark::kMillisecond);
}

BENCHMARK(ReconcileUnchanged)->Name("reconcile, unchanged/ports")->Apply(Sizes);
BENCHMARK(ReconcileReplug)->Name("reconcile, all replugged/ports")->Apply(Sizes);
BENCHMARK(PollAfterAChange)->Name("reconcile, listing and poll/ports")->Apply(Sizes)->UseRealTime();

}  // namespace
}  // namespace Ostinet::Bench
