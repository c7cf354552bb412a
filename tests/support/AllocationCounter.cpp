// SPDX-License-Identifier: MIT
#include "support/AllocationCounter.h"

#include <atomic>
#include <cstdlib>
#include <new>

// The thread sanitizer has these operators itself, and lets a program look on.
#if defined(__has_feature)
#if __has_feature(thread_sanitizer)
#define OSTINET_HOOKED_ALLOCATOR 1
#include <sanitizer/allocator_interface.h>
#endif
#endif

namespace {

std::atomic<std::size_t> gAllocations{0};

#if OSTINET_HOOKED_ALLOCATOR

void CountAllocation(void const volatile*, std::size_t) {
  gAllocations.fetch_add(1, std::memory_order_relaxed);
}
void IgnoreRelease(void const volatile*) {}

[[maybe_unused]] int const gHooks =
    __sanitizer_install_malloc_and_free_hooks(CountAllocation, IgnoreRelease);

}  // namespace

#else

void* TryToAllocate(std::size_t size) noexcept {
  gAllocations.fetch_add(1, std::memory_order_relaxed);
  return std::malloc(size > 0 ? size : 1);
}

void* Allocate(std::size_t size) {
  void* const memory = TryToAllocate(size);
  if (memory == nullptr) {
    throw std::bad_alloc();
  }
  return memory;
}

}  // namespace

void* operator new(std::size_t size) { return Allocate(size); }
void* operator new[](std::size_t size) { return Allocate(size); }
void* operator new(std::size_t size, std::nothrow_t const&) noexcept { return TryToAllocate(size); }
void* operator new[](std::size_t size, std::nothrow_t const&) noexcept {
  return TryToAllocate(size);
}
void operator delete(void* memory) noexcept { std::free(memory); }
void operator delete[](void* memory) noexcept { std::free(memory); }
void operator delete(void* memory, std::size_t) noexcept { std::free(memory); }
void operator delete[](void* memory, std::size_t) noexcept { std::free(memory); }

#endif

namespace Ostinet::Testing {

AllocationCounter::AllocationCounter() : start_(gAllocations.load(std::memory_order_relaxed)) {}

std::size_t AllocationCounter::Count() const {
  return gAllocations.load(std::memory_order_relaxed) - start_;
}

}  // namespace Ostinet::Testing
