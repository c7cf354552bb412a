// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <atomic>
#include <functional>
#include <memory>
#include <stdexcept>
#include <thread>

#include "ostinet/core/Provider.h"
#include "support/Latch.h"
#include "support/Threads.h"

namespace Ostinet {
namespace {

class Listener : public Dependent<Listener> {
 public:
  explicit Listener(std::function<void()> call = [] {}) : call_(std::move(call)) {}
  ~Listener() { LeaveProviders(); }
  void DevicesChanged() {
    ++calls;
    call_();
  }
  std::atomic<int> calls{0};

 private:
  std::function<void()> call_;
};

using ListenerProvider = Provider<Listener>;

void Tell(ListenerProvider& provider) {
  provider.ForEach([](Listener& listener) { listener.DevicesChanged(); });
}

TEST(Provider, TellsEachDependentOnce) {
  ListenerProvider provider;
  Listener a;
  Listener b;
  provider.AddDependent(a);
  provider.AddDependent(b);
  provider.AddDependent(a);
  EXPECT_EQ(provider.CountDependents(), 2U);
  EXPECT_EQ(a.CountProviders(), 1U);
  Tell(provider);
  EXPECT_EQ(a.calls, 1);
  EXPECT_EQ(b.calls, 1);
}

TEST(Provider, ForgetsADependentThatIsRemovedOrDestroyed) {
  ListenerProvider provider;
  Listener a;
  provider.AddDependent(a);
  {
    Listener b;
    provider.AddDependent(b);
  }
  EXPECT_EQ(provider.CountDependents(), 1U);
  provider.RemoveDependent(a);
  provider.RemoveDependent(a);
  EXPECT_EQ(a.CountProviders(), 0U);
  Tell(provider);
  EXPECT_EQ(a.calls, 0);
}

TEST(Provider, IsForgottenByItsDependentsWhenItGoes) {
  Listener a;
  ListenerProvider other;
  other.AddDependent(a);
  {
    ListenerProvider provider;
    provider.AddDependent(a);
    EXPECT_EQ(a.CountProviders(), 2U);
  }
  EXPECT_EQ(a.CountProviders(), 1U);
}

TEST(Provider, TakesBackADependentThatLeft) {
  ListenerProvider provider;
  Listener a;
  provider.AddDependent(a);
  provider.RemoveDependent(a);
  provider.AddDependent(a);
  Tell(provider);
  EXPECT_EQ(a.calls, 1);
}

TEST(Provider, LetsDependentsLeaveDuringACall) {
  ListenerProvider provider;
  auto last = std::make_unique<Listener>();
  Listener* first = nullptr;
  Listener leaver([&] {
    provider.RemoveDependent(*first);
    last.reset();
  });
  Listener a([&] { EXPECT_EQ(provider.CountDependents(), 3U); });
  first = &a;
  provider.AddDependent(a);
  provider.AddDependent(leaver);
  provider.AddDependent(*last);
  Tell(provider);
  EXPECT_EQ(provider.CountDependents(), 1U);
  Tell(provider);
  EXPECT_EQ(a.calls, 1);
  EXPECT_EQ(leaver.calls, 2);
}

TEST(Provider, DoesNotTellThoseThatJoinDuringACall) {
  ListenerProvider provider;
  Listener late;
  Listener joiner([&] { provider.AddDependent(late); });
  provider.AddDependent(joiner);
  Tell(provider);
  EXPECT_EQ(late.calls, 0);
  Tell(provider);
  EXPECT_EQ(late.calls, 1);
}

TEST(Provider, LetsADependentLeaveAndComeBackDuringACall) {
  ListenerProvider provider;
  Listener* self = nullptr;
  Listener a([&] {
    provider.RemoveDependent(*self);
    provider.AddDependent(*self);
  });
  self = &a;
  provider.AddDependent(a);
  Tell(provider);
  EXPECT_EQ(a.calls, 1);
  EXPECT_EQ(provider.CountDependents(), 1U);
}

TEST(Provider, MayBeDestroyedByACall) {
  auto provider = std::make_unique<ListenerProvider>();
  Listener a([&provider] { provider.reset(); });
  Listener b;
  provider->AddDependent(a);
  provider->AddDependent(b);
  Tell(*provider);
  EXPECT_EQ(a.calls, 1);
  EXPECT_EQ(b.calls, 0);
  EXPECT_EQ(a.CountProviders(), 0U);
}

TEST(Provider, StaysWholeWhenADependentThrows) {
  ListenerProvider provider;
  Listener a([] { throw std::runtime_error("no"); });
  provider.AddDependent(a);
  EXPECT_THROW(Tell(provider), std::runtime_error);
  provider.RemoveDependent(a);
  EXPECT_EQ(provider.CountDependents(), 0U);
}

TEST(ProviderThreads, WaitForACallBeforeTheDependentGoes) {
  ListenerProvider provider;
  Testing::Latch called(1);
  std::atomic<bool> isCalling{false};
  auto listener = std::make_unique<Listener>([&] {
    isCalling = true;
    called.count_down();
    for (int i = 0; i < 1000; ++i) {
      std::this_thread::yield();
    }
    isCalling = false;
  });
  provider.AddDependent(*listener);
  std::thread caller([&provider] { Tell(provider); });
  called.wait();
  listener.reset();
  EXPECT_FALSE(isCalling);
  caller.join();
}

TEST(ProviderThreads, LetDependentsComeAndGoWhileOthersAreTold) {
  ListenerProvider provider;
  Testing::RunTogether(4, [&provider](int index) {
    for (int round = 0; round < 2000; ++round) {
      if (index == 0) {
        Tell(provider);
      } else {
        Listener listener;
        provider.AddDependent(listener);
        EXPECT_EQ(listener.CountProviders(), 1U);
      }
    }
  });
  EXPECT_EQ(provider.CountDependents(), 0U);
}

}  // namespace
}  // namespace Ostinet
