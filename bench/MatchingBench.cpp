// SPDX-License-Identifier: MIT

// References: making one, reading one, ranking one endpoint by it, and finding the endpoints of a
// thousand references among a thousand, by the resolver's index beside comparing all with all.

#include <benchmark/benchmark.h>

#include <memory>
#include <string>
#include <vector>

#include "BenchHost.h"
#include "ostinet/hostkit/ReferenceResolver.h"

namespace Ostinet::Bench {
namespace {

constexpr int kDevices = 125;
constexpr int kDestinationsEach = 8;

/// A studio of a thousand destinations: devices of eight, four devices of each model.
class ReferenceBench : public benchmark::Fixture {
 public:
  void SetUp(benchmark::State&) override {
    host_ = std::make_unique<BenchHost>();
    host_->SignIn();
    for (int i = 0; i < kDevices; ++i) {
      AddDevice(i);
    }
    for (int i = 0; i < host_->setup.CountDestinations(); ++i) {
      references_.push_back(host_->setup.GetDestination(i).GetMatchData());
    }
  }

  void TearDown(benchmark::State&) override {
    references_.clear();
    host_.reset();
  }

 protected:
  Destination First() const { return host_->setup.GetDestination(0); }

  // The resolver is made anew in each round: a host resolves a document at once.
  template <class Resolve>
  void ResolveAll(benchmark::State& state, Resolve const& resolve) {
    std::size_t found = 0;
    for (auto _ : state) {
      ReferenceResolver const resolver;
      for (MatchData const& reference : references_) {
        found += resolve(resolver, reference).best.size();
      }
    }
    benchmark::DoNotOptimize(found);
    state.SetItemsProcessed(state.iterations() * static_cast<std::int64_t>(references_.size()));
  }

  std::vector<MatchData> references_;

 private:
  void AddDevice(int number) {
    std::string const name = "Synthesizer " + std::to_string(number);
    Device const device = host_->setup.CreateDevice(UString(name.c_str()));
    device.SetManufacturer("Maker");
    device.SetModel(UString(("Model " + std::to_string(number / 4)).c_str()));
    host_->setup.CreateEntity(device, "Port", 0, kDestinationsEach);
  }

  std::unique_ptr<BenchHost> host_;
};

BENCHMARK_F(ReferenceBench, Write)(benchmark::State& state) {
  Destination const destination = First();
  for (auto _ : state) {
    benchmark::DoNotOptimize(destination.GetMatchData());
  }
}

BENCHMARK_F(ReferenceBench, Parse)(benchmark::State& state) {
  for (auto _ : state) {
    benchmark::DoNotOptimize(references_.front().GetContents());
  }
}

BENCHMARK_F(ReferenceBench, MatchItsOwnEndpoint)(benchmark::State& state) {
  Destination const destination = First();
  for (auto _ : state) {
    benchmark::DoNotOptimize(destination.MatchToData(references_.front()));
  }
}

BENCHMARK_F(ReferenceBench, MatchAnotherEndpoint)(benchmark::State& state) {
  Destination const destination = First();
  for (auto _ : state) {
    benchmark::DoNotOptimize(destination.MatchToData(references_.back()));
  }
}

BENCHMARK_F(ReferenceBench, ResolveThousandAmongThousand)(benchmark::State& state) {
  ResolveAll(state, [](ReferenceResolver const& resolver, MatchData const& reference) {
    return resolver.Resolve(reference);
  });
}

BENCHMARK_F(ReferenceBench, ResolveThousandAmongThousandBaseline)(benchmark::State& state) {
  ResolveAll(state, [](ReferenceResolver const& resolver, MatchData const& reference) {
    return resolver.ResolveByComparingAll(reference);
  });
}

}  // namespace
}  // namespace Ostinet::Bench
