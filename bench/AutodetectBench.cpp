// SPDX-License-Identifier: MIT

// Autodetect: what a byte of a reply costs in a matcher, beside the least that looks at each byte
// against a table: a comparison of two rows of bytes, by hand and by the standard library.

#include <benchmark/benchmark.h>

#include <cstring>
#include <vector>

#include "ostinet/Autodetect.h"

namespace Ostinet::Bench {
namespace {

constexpr std::size_t kReplyBytes = 256;

/// The inquiry's reply, and then a dump that the table spells out.
class AutodetectBench : public benchmark::Fixture {
 public:
  void SetUp(benchmark::State&) override {
    table_ = {{0, 0xF0}, {0, 0x7E}, {1, 0},    {0, 0x06}, {0, 0x02},
              {0, 0xF9}, {0, 0xFC}, {0, 0xFD}, {0, 0xFE}, {0, 0xFF}};
    reply_ = {0xF0, 0x7E, 0x10, 0x06, 0x02, 0x41, 0x00, 0x19, 0x00, 0x10};
    while (reply_.size() < kReplyBytes) {
      auto const byte = static_cast<unsigned char>(reply_.size() & 0x7F);
      reply_.push_back(byte);
      table_.push_back({0, byte});
    }
    expected_ = reply_;
  }

 protected:
  void Count(benchmark::State& state) {
    state.SetItemsProcessed(state.iterations() * static_cast<std::int64_t>(reply_.size()));
  }

  std::vector<MatchEntry> table_;
  std::vector<unsigned char> reply_;
  std::vector<unsigned char> expected_;
};

BENCHMARK_DEFINE_F(AutodetectBench, Match)(benchmark::State& state) {
  Autodetect::Matcher const matcher(table_, false);
  Array<unsigned char, 7> captured = {};
  unsigned char deviceID = 0;
  for (auto _ : state) {
    benchmark::DoNotOptimize(reply_.data());
    benchmark::DoNotOptimize(
        matcher.Match(Data(reply_.data(), reply_.size()), matcher.Start(), deviceID, captured));
    benchmark::ClobberMemory();
  }
  Count(state);
}
BENCHMARK_REGISTER_F(AutodetectBench, Match)->Name("autodetect, a byte matched/subject");

BENCHMARK_DEFINE_F(AutodetectBench, CompareByHand)(benchmark::State& state) {
  for (auto _ : state) {
    benchmark::DoNotOptimize(reply_.data());
    std::size_t i = 0;
    while (i < reply_.size() && reply_[i] == expected_[i]) {
      ++i;
    }
    benchmark::DoNotOptimize(i);
    benchmark::ClobberMemory();
  }
  Count(state);
}
BENCHMARK_REGISTER_F(AutodetectBench, CompareByHand)
    ->Name("autodetect, a byte matched/baseline: a loop that compares bytes");

BENCHMARK_DEFINE_F(AutodetectBench, Memcmp)(benchmark::State& state) {
  for (auto _ : state) {
    benchmark::DoNotOptimize(reply_.data());
    benchmark::DoNotOptimize(std::memcmp(reply_.data(), expected_.data(), reply_.size()));
    benchmark::ClobberMemory();
  }
  Count(state);
}
BENCHMARK_REGISTER_F(AutodetectBench, Memcmp)
    ->Name("autodetect, a byte matched/for comparison: memcmp");

}  // namespace
}  // namespace Ostinet::Bench
