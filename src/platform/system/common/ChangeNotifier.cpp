// SPDX-License-Identifier: MIT
#include "platform/system/common/ChangeNotifier.h"

#include <algorithm>
#include <mutex>
#include <utility>
#include <vector>

namespace Ostinet::Impl {

// A place's own mutex is held during its call, so that giving it up waits for the call. It is
// recursive because a listener may give up its place from within.
struct ChangeNotifier::Place {
  std::recursive_mutex calling;
  std::function<void()> changed;
  bool active = true;  // guarded by `calling`
};

struct ChangeNotifier::List {
  std::mutex mutex;
  std::vector<std::shared_ptr<Place>> places;  // guarded by `mutex`
};

ChangeNotifier::ChangeNotifier() : list_(std::make_shared<List>()) {}

ChangeNotifier::~ChangeNotifier() = default;

std::shared_ptr<void> ChangeNotifier::Add(std::function<void()> changed) {
  auto place = std::make_shared<Place>();
  place->changed = std::move(changed);
  {
    std::scoped_lock lock(list_->mutex);
    list_->places.push_back(place);
  }
  return std::shared_ptr<void>(place.get(), [list = list_, place](void*) {
    {
      std::scoped_lock lock(list->mutex);
      std::erase(list->places, place);
    }
    std::scoped_lock calling(place->calling);
    place->active = false;
  });
}

bool ChangeNotifier::HasListeners() const {
  std::scoped_lock lock(list_->mutex);
  return !list_->places.empty();
}

void ChangeNotifier::Notify() {
  std::vector<std::shared_ptr<Place>> places;
  {
    std::scoped_lock lock(list_->mutex);
    places = list_->places;
  }
  for (auto const& place : places) {
    std::scoped_lock calling(place->calling);
    if (place->active) place->changed();
  }
}

}  // namespace Ostinet::Impl
