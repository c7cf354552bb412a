// SPDX-License-Identifier: MIT
#pragma once

#include <algorithm>
#include <cstddef>
#include <memory>
#include <mutex>
#include <utility>
#include <vector>

#include "ostinet/core/Noncopyable.h"

// An observer pair whose two sides may live in different modules and on different threads.
//
// The list of dependents stands in a record of its own, which the provider and its dependents
// share, with the one mutex that guards it. Calls to dependents are made under that mutex, so
// whoever leaves on another thread waits until the call is over; it is recursive, so a dependent
// may leave, or others come and go, within a call. An entry that leaves while the list is walked
// becomes null, and the walk removes the nulls at its end.

namespace Ostinet {

template <class T>
class Dependent;

namespace Impl {

template <class T>
struct ProviderList {
  std::recursive_mutex mutex;
  std::vector<Dependent<T>*> dependents;  // null: left during a walk; each clears its own entry
  int walks = 0;
  bool closed = false;

  void Leave(Dependent<T>* dependent) {
    std::lock_guard<std::recursive_mutex> lock(mutex);
    auto const place = std::find(dependents.begin(), dependents.end(), dependent);
    if (place == dependents.end()) {
      return;
    }
    if (walks > 0) {
      *place = nullptr;
    } else {
      dependents.erase(place);
    }
  }

  void EndWalk() {
    if (--walks == 0) {
      dependents.erase(std::remove(dependents.begin(), dependents.end(), nullptr),
                       dependents.end());
    }
  }
};

}  // namespace Impl

/// Tells its dependents, objects of class `T`, when something happens.
///
/// Ownership    Neither side owns the other; each leaves the other when it is destroyed.
/// Threads      [any thread] A dependent that leaves or is destroyed on one thread waits for the
///              call that another thread is making to it. Do not destroy a dependent while
///              holding a lock that its own call needs. The provider itself is destroyed where
///              no other thread still uses it.
/// Errors       What a dependent throws ends ForEach and travels on.
template <class T>
class Provider : private Noncopyable<Provider<T>> {
 public:
  Provider() : list_(std::make_shared<Impl::ProviderList<T>>()) {}
  ~Provider() {
    std::lock_guard<std::recursive_mutex> lock(list_->mutex);
    list_->closed = true;
    list_->dependents.clear();
  }

  /// Adds a dependent; one that is there already stays there once.
  void AddDependent(T& dependent) { static_cast<Dependent<T>&>(dependent).Join(list_); }
  /// Removes a dependent, if it is there, and waits for a call to it on another thread.
  void RemoveDependent(T& dependent) { list_->Leave(&dependent); }

  std::size_t CountDependents() const {
    std::lock_guard<std::recursive_mutex> lock(list_->mutex);
    auto const& all = list_->dependents;
    return all.size() - static_cast<std::size_t>(std::count(all.begin(), all.end(), nullptr));
  }

  /// Calls `call(T&)` with each dependent that was there at the start and has not left by then.
  template <class Call>
  void ForEach(Call call) {
    std::shared_ptr<Impl::ProviderList<T>> const list = list_;  // a call may destroy this object
    std::lock_guard<std::recursive_mutex> lock(list->mutex);
    struct Walk {
      Impl::ProviderList<T>& list;
      ~Walk() { list.EndWalk(); }
    } const walk{*list};
    ++list->walks;
    std::size_t const count = list->dependents.size();
    for (std::size_t i = 0; i < count && i < list->dependents.size(); ++i) {
      if (Dependent<T>* const dependent = list->dependents[i]) {
        call(static_cast<T&>(*dependent));
      }
    }
  }

 private:
  std::shared_ptr<Impl::ProviderList<T>> list_;
};

/// Base of `T`, whose objects can be dependents of any number of providers.
///
/// Threads      [any thread] A class whose calls come from another thread calls LeaveProviders
///              first thing in its own destructor: this base leaves them only after the derived
///              object has gone.
template <class T>
class Dependent : private Noncopyable<Dependent<T>> {
 public:
  std::size_t CountProviders() const {
    std::size_t count = 0;
    for (auto const& list : Lists()) {
      std::lock_guard<std::recursive_mutex> lock(list->mutex);
      auto const& all = list->dependents;
      count += std::find(all.begin(), all.end(), this) != all.end() ? 1U : 0U;
    }
    return count;
  }

 protected:
  Dependent() = default;
  ~Dependent() { LeaveProviders(); }

  /// Leaves all providers and waits for calls that they are making on other threads.
  void LeaveProviders() {
    std::vector<std::shared_ptr<Impl::ProviderList<T>>> lists;
    {
      std::lock_guard<std::mutex> lock(mutex_);
      lists.swap(lists_);
    }
    for (auto const& list : lists) {
      list->Leave(this);
    }
  }

 private:
  friend class Provider<T>;
  using ListPtr = std::shared_ptr<Impl::ProviderList<T>>;

  // The two mutexes nest one way only: the provider's, then the dependent's.
  void Join(ListPtr const& list) {
    std::lock_guard<std::recursive_mutex> lock(list->mutex);
    auto& all = list->dependents;
    if (list->closed || std::find(all.begin(), all.end(), this) != all.end()) {
      return;
    }
    std::lock_guard<std::mutex> ownLock(mutex_);
    if (std::find(lists_.begin(), lists_.end(), list) == lists_.end()) {
      lists_.push_back(list);
    }
    all.push_back(this);
  }

  std::vector<ListPtr> Lists() const {
    std::lock_guard<std::mutex> lock(mutex_);
    return lists_;
  }

  mutable std::mutex mutex_;
  std::vector<ListPtr> lists_;  // those once joined; a provider that went left its list closed
};

}  // namespace Ostinet
