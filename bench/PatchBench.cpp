// SPDX-License-Identifier: MIT

// Patches: finding one in a name set of 16 banks of 128, exactly and as the best fit to what was
// seen on the wire, beside walks over flat arrays of the same numbers; and generating a patch
// change, beside filling a buffer with the finished bytes.

#include <benchmark/benchmark.h>

#include <cstdint>
#include <map>
#include <string>
#include <vector>

#include "names/NameHandles.h"

namespace Ostinet::Bench {
namespace {

using Impl::DestNameSetImpl;
using Impl::PatchBankImpl;
using Impl::PatchImpl;

constexpr unsigned char kBanks = 16;
constexpr unsigned char kPatchesEach = 128;
constexpr unsigned char kNone = 255;

RCPtrMT<PatchBankImpl> MakeBank(unsigned char number) {
  RCPtrMT<PatchBankImpl> const bank(new PatchBankImpl("Bank"));
  bank->Commands().AddThreeBytes(0xB0, 0, 1);
  bank->Commands().AddThreeBytes(0xB0, 32, number);
  for (unsigned char program = 0; program < kPatchesEach; ++program) {
    UString const text(std::to_string(program).c_str());
    RCPtrMT<PatchImpl> const patch(new PatchImpl(text, "Patch " + text));
    patch->Commands().AddTwoBytes(0xC0, program);
    bank->AddPatch(patch);
  }
  return bank;
}

/// The same numbers three times: as a tree, in one array, and in a table sorted by them.
class PatchBench : public benchmark::Fixture {
 public:
  struct Entry {
    PatchNumbers numbers;
    bool isCurrent;
    PatchImpl* patch;
  };

  void SetUp(benchmark::State&) override {
    nameSet_ = new DestNameSetImpl(nullptr, "Set");
    for (unsigned char bank = 0; bank < kBanks; ++bank) {
      nameSet_->AddBank(MakeBank(bank));
    }
    nameSet_->SetCurrentBank(nameSet_->GetBanks().front());
    for (RCPtrMT<PatchBankImpl> const& bank : nameSet_->GetBanks()) {
      for (RCPtrMT<PatchImpl> const& patch : bank->GetPatches()) {
        PatchNumbers const numbers = patch->GetNumbers();
        flat_.push_back({numbers, bank == nameSet_->GetCurrentBank(), patch.get()});
        sorted_[Key(numbers)] = patch.get();
      }
    }
  }

  void TearDown(benchmark::State&) override {
    flat_.clear();
    sorted_.clear();
    nameSet_ = nullptr;
  }

 protected:
  static std::uint32_t Key(PatchNumbers const& numbers) {
    return numbers.program | static_cast<std::uint32_t>(numbers.msb << 8) |
           static_cast<std::uint32_t>(numbers.lsb << 16);
  }
  // Another patch in each round, over all banks.
  PatchNumbers Next() {
    round_ = (round_ + 1031) % flat_.size();
    return flat_[round_].numbers;
  }
  PatchImpl* FindInArray(PatchNumbers const& wanted) const {
    for (Entry const& entry : flat_) {
      if (Key(entry.numbers) == Key(wanted)) {
        return entry.patch;
      }
    }
    return nullptr;
  }
  PatchImpl* FindBestInArray(PatchNumbers const& seen) const {
    constexpr int kOfBankAndPatch = 8;
    PatchImpl* best = nullptr;
    int bestScore = -1;
    for (Entry const& entry : flat_) {
      if (entry.numbers.program == seen.program) {
        int const score = Fits(seen.msb, entry.numbers.msb) + Fits(seen.lsb, entry.numbers.lsb);
        int const all = score * kOfBankAndPatch + (entry.isCurrent ? 1 : 0);
        if (all > bestScore) {
          bestScore = all;
          best = entry.patch;
        }
      }
    }
    return best;
  }

  RCPtrMT<DestNameSetImpl> nameSet_;
  std::vector<Entry> flat_;
  std::map<std::uint32_t, PatchImpl*> sorted_;

 private:
  static int Fits(unsigned char seen, unsigned char number) {
    return seen == kNone || seen == number ? 1 : 0;
  }

  std::size_t round_ = 0;
};

BENCHMARK_DEFINE_F(PatchBench, Exact)(benchmark::State& state) {
  for (auto _ : state) {
    benchmark::DoNotOptimize(nameSet_->FindPatch(Next()));
  }
}
BENCHMARK_DEFINE_F(PatchBench, ExactInArray)(benchmark::State& state) {
  for (auto _ : state) {
    benchmark::DoNotOptimize(FindInArray(Next()));
  }
}
BENCHMARK_DEFINE_F(PatchBench, ExactInMap)(benchmark::State& state) {
  for (auto _ : state) {
    benchmark::DoNotOptimize(sorted_.find(Key(Next())));
  }
}
BENCHMARK_DEFINE_F(PatchBench, Playing)(benchmark::State& state) {
  for (auto _ : state) {
    benchmark::DoNotOptimize(nameSet_->FindPlayingPatch(Next()));
  }
}
BENCHMARK_DEFINE_F(PatchBench, PlayingInArray)(benchmark::State& state) {
  for (auto _ : state) {
    benchmark::DoNotOptimize(FindBestInArray(Next()));
  }
}
BENCHMARK_REGISTER_F(PatchBench, Exact)->Name("names, exact lookup/subject");
BENCHMARK_REGISTER_F(PatchBench, ExactInArray)->Name("names, exact lookup/baseline: one array");
BENCHMARK_REGISTER_F(PatchBench, ExactInMap)->Name("names, exact lookup/for comparison: std::map");
BENCHMARK_REGISTER_F(PatchBench, Playing)->Name("names, scored lookup/subject");
BENCHMARK_REGISTER_F(PatchBench, PlayingInArray)->Name("names, scored lookup/baseline: one array");

void GeneratePatchChange(benchmark::State& state) {
  RCPtrMT<PatchBankImpl> const bank = MakeBank(3);
  PatchImpl const& patch = *bank->GetPatches()[5];
  for (auto _ : state) {
    DataBuffer buffer;
    bank->Commands().GenerateCommands(buffer, Clocks(1), 2, 0);
    patch.Commands().GenerateCommands(buffer, Clocks(1), 2, 0);
    benchmark::DoNotOptimize(buffer);
  }
}
BENCHMARK(GeneratePatchChange)->Name("names, patch change/subject");

void FillABuffer(benchmark::State& state) {
  unsigned char const bytes[] = {0xB2, 0, 1, 0xB2, 32, 3, 0xC2, 5};
  for (auto _ : state) {
    DataBuffer buffer;
    buffer.Add(Clocks(1), bytes, 3);
    buffer.Add(Clocks(1), bytes + 3, 3);
    buffer.Add(Clocks(1), bytes + 6, 2);
    benchmark::DoNotOptimize(buffer);
  }
}
BENCHMARK(FillABuffer)->Name("names, patch change/baseline: the bytes alone");

}  // namespace
}  // namespace Ostinet::Bench
