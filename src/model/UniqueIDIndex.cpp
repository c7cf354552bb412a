// SPDX-License-Identifier: MIT
#include "model/UniqueIDIndex.h"

#include <mutex>
#include <unordered_map>

namespace Ostinet::Impl {

namespace {

struct Index {
  std::mutex mutex;
  std::unordered_map<int, int> counts;  // guarded by mutex
};

// Never destroyed: handles in the host's own static objects may free stores after this file's.
Index& TheIndex() {
  static Index* const index = new Index;
  return *index;
}

}  // namespace

void NoteStoredUniqueID(int id) {
  Index& index = TheIndex();
  std::lock_guard<std::mutex> lock(index.mutex);
  ++index.counts[id];
}

void ForgetStoredUniqueID(int id) {
  Index& index = TheIndex();
  std::lock_guard<std::mutex> lock(index.mutex);
  auto const place = index.counts.find(id);
  if (place != index.counts.end() && --place->second == 0) {
    index.counts.erase(place);
  }
}

bool IsUniqueIDStored(int id) {
  Index& index = TheIndex();
  std::lock_guard<std::mutex> lock(index.mutex);
  return index.counts.count(id) != 0;
}

}  // namespace Ostinet::Impl
