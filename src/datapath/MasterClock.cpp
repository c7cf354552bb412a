// SPDX-License-Identifier: MIT

// The master clock is read on any thread, the system's callbacks included, while the polling thread
// may take it away. Readers must not wait, so the state is one word: which of two places holds the
// clock, and how many readers have ever entered it. A reader enters and learns its place with one
// addition. Who takes the clock away swaps the word for the other place, thereby learns how many
// readers entered the old one, and waits until as many have left. Nobody can enter it any more, so
// the wait is as short as one reading of the clock.

#include <array>
#include <atomic>
#include <cstdint>
#include <mutex>
#include <thread>
#include <utility>

#include "datapath/TimeBase.h"

namespace Ostinet {
namespace Impl {
namespace {

class ClockHolder {
 public:
  unsigned long long Read() {
    Visit const visit(*this);
    return visit.Clock() != nullptr ? visit.Clock()->GetTime() : 0;
  }

  void Replace(std::unique_ptr<MasterClock> clock) {
    std::lock_guard const lock(replacing_);
    std::size_t const next = 1 - current_;
    places_[next].clock = std::move(clock);
    places_[next].left.store(0, std::memory_order_relaxed);
    // Release publishes the new clock; acquire keeps what follows behind the swap.
    std::uint64_t const old = state_.exchange(next << kPlaceShift, std::memory_order_acq_rel);
    Place& retired = places_[std::exchange(current_, next)];
    std::uint64_t const entered = old & kEnteredMask;
    while (retired.left.load(std::memory_order_acquire) != entered) {
      std::this_thread::yield();
    }
    retired.clock.reset();
  }

 private:
  static constexpr int kPlaceShift = 63;
  static constexpr std::uint64_t kEnteredMask = (std::uint64_t{1} << kPlaceShift) - 1;

  struct Place {
    std::unique_ptr<MasterClock> clock;
    std::atomic<std::uint64_t> left{0};  // added to by readers, compared by the replacing thread
  };

  class Visit {
   public:
    explicit Visit(ClockHolder& holder)
        : place_(holder.places_[holder.state_.fetch_add(1, std::memory_order_acquire) >>
                                kPlaceShift]) {}
    ~Visit() { place_.left.fetch_add(1, std::memory_order_release); }
    Visit(Visit const&) = delete;
    Visit& operator=(Visit const&) = delete;
    MasterClock const* Clock() const { return place_.clock.get(); }

   private:
    Place& place_;
  };

  std::array<Place, 2> places_;
  std::atomic<std::uint64_t> state_{0};
  std::mutex replacing_;
  std::size_t current_ = 0;  // guarded by replacing_
};

// Never destroyed: threads of the system may still ask for the time while the process ends.
ClockHolder& Holder() {
  static ClockHolder& holder = *new ClockHolder;
  return holder;
}

}  // namespace

void SetMasterClock(std::unique_ptr<MasterClock> clock) { Holder().Replace(std::move(clock)); }

}  // namespace Impl

Clocks CurrentMIDITime() { return Impl::Holder().Read(); }

}  // namespace Ostinet
