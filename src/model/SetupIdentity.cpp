// SPDX-License-Identifier: MIT
//
// Setup: names and numbers that keep the objects of a studio apart.
#include <algorithm>
#include <cstdlib>
#include <unordered_set>

#include "model/PropertyKeys.h"
#include "model/SetupState.h"
#include "model/UniqueIDIndex.h"

namespace Ostinet {

namespace Keys = Impl::Keys;

namespace {

// Calls `look` with each object of the six lists until it returns true.
template <class Look>
bool AnyObject(Impl::Studio const& studio, Look const& look) {
  auto const inList = [&](auto const& list) {
    return std::any_of(list.begin(), list.end(), [&](auto const& object) { return look(*object); });
  };
  return inList(studio.devices) || inList(studio.entities) || inList(studio.sources) ||
         inList(studio.destinations) || inList(studio.privateSources) ||
         inList(studio.privateDestinations);
}

}  // namespace

UString Setup::MakeUniqueDevName(UString const& name) {
  UString unique = name;
  for (int n = 2; HaveDeviceWithName(unique); ++n) {
    unique.resize(name.length());
    unique.Stream() << " " << n;
  }
  return unique;
}

bool Setup::HaveDeviceWithName(UString const& name) const {
  auto const& devices = GetStudio().devices;
  return std::any_of(devices.begin(), devices.end(), [&](RCPtrMT<Impl::DeviceImpl> const& device) {
    return device->GetName().equal(name, UString::kLooselyEqual);
  });
}

bool Setup::UniqueIDInUse(int id) const {
  // 0 is what objects without an ID read, so no store tells of it.
  if (id != 0 && !Impl::IsUniqueIDStored(id)) {
    return false;
  }
  return AnyObject(GetStudio(), [&](Impl::DeviceObjectImpl const& object) {
    return object.GetInt(Keys::kUniqueID, 0) == id;
  });
}

void Setup::MaybeAssignUniqueID(Impl::DeviceObjectImpl& object) {
  int id = 0;
  if (object.Peer()->GetInt(Keys::kUniqueID, id)) {
    return;
  }
  // A number that any store holds is passed over, be its object in the studio or not: that needs no
  // walk over the studio, even where `rand` has few numbers and so repeats itself often.
  constexpr int kDraws = 100000;
  for (int draw = 0; draw < kDraws; ++draw) {
    int const drawn = std::rand();
    if (drawn != 0 && !Impl::IsUniqueIDStored(drawn)) {
      object.Peer()->SetInt(Keys::kUniqueID, drawn);
      return;
    }
  }
  // Where the numbers of rand are all in use.
  std::unordered_set<int> used;
  AnyObject(GetStudio(), [&](Impl::DeviceObjectImpl const& other) {
    used.insert(other.GetInt(Keys::kUniqueID, 0));
    return false;
  });
  id = 1;
  while (used.count(id) != 0) {
    ++id;
  }
  object.Peer()->SetInt(Keys::kUniqueID, id);
}

}  // namespace Ostinet
