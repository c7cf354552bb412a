// SPDX-License-Identifier: MIT
#pragma once

#include <functional>
#include <memory>

namespace Ostinet::Impl {

/// The list of those who want to know of changed ports, for the systems behind the seam.
///
/// Ownership  Places outlive the notifier harmlessly.
/// Threads    Any. A place is given up only when no call of it runs any more, unless it is given up
///            from within its own call.
class ChangeNotifier {
 public:
  ChangeNotifier();
  ~ChangeNotifier();
  ChangeNotifier(ChangeNotifier const&) = delete;
  ChangeNotifier& operator=(ChangeNotifier const&) = delete;

  /// The place is given up when the last copy of the result goes.
  std::shared_ptr<void> Add(std::function<void()> changed);
  bool HasListeners() const;
  /// Calls each listener on the calling thread.
  void Notify();

 private:
  struct List;
  struct Place;
  std::shared_ptr<List> list_;
};

}  // namespace Ostinet::Impl
