// SPDX-License-Identifier: MIT
#include "model/SelfStorageImplImpl.h"

#include <utility>

#include "model/PropertyKeys.h"
#include "model/PropertyXML.h"
#include "model/UniqueIDIndex.h"

namespace Ostinet::Impl {

namespace {

template <class Value>
void Assign(Value const& value, Value& out) {
  out = value;
}

void Assign(PropertyPath const& value, UString& out) { out = value.path; }

void CountIn(PropertyValue const& uniqueID) {
  if (int const* const id = boost::get<int>(&uniqueID)) {
    NoteStoredUniqueID(*id);
  }
}

void CountOut(PropertyValue const& uniqueID) {
  if (int const* const id = boost::get<int>(&uniqueID)) {
    ForgetStoredUniqueID(*id);
  }
}

}  // namespace

SelfStorageImplImpl::~SelfStorageImplImpl() { Erase(Keys::kUniqueID); }

template <class Value, class Out>
bool SelfStorageImplImpl::Read(UString const& key, Out& out) const {
  for (SelfStorageImplImpl const* peer = this; peer != nullptr;
       peer = peer->GetParentSSImplImpl()) {
    auto const place = peer->store_.find(key);
    if (place != peer->store_.end()) {
      Value const* const value = boost::get<Value>(&place->second);
      if (value == nullptr) {
        return false;
      }
      Assign(*value, out);
      return true;
    }
  }
  return false;
}

bool SelfStorageImplImpl::GetFile(UString const& key, UString& path) const {
  return Read<PropertyPath>(key, path);
}

bool SelfStorageImplImpl::GetDict(UString const& key, PropertyDict& out) const {
  return Read<PropertyDict>(key, out);
}

bool SelfStorageImplImpl::GetIntList(UString const& key, std::vector<int>& out) const {
  return Read<std::vector<int>>(key, out);
}

bool SelfStorageImplImpl::GetString(UString const& key, UString& out) const {
  return Read<UString>(key, out);
}

bool SelfStorageImplImpl::GetInt(UString const& key, int& out) const { return Read<int>(key, out); }

bool SelfStorageImplImpl::SetFile(UString const& key, UString const& path) {
  return Write(key, PropertyPath{path});
}

bool SelfStorageImplImpl::SetDict(UString const& key, PropertyDict const& value) {
  return Write(key, value);
}

bool SelfStorageImplImpl::SetIntList(UString const& key, std::vector<int> const& value) {
  return Write(key, value);
}

bool SelfStorageImplImpl::SetString(UString const& key, UString const& value) {
  return Write(key, value);
}

bool SelfStorageImplImpl::SetInt(UString const& key, int value) { return Write(key, value); }

// The studio hears of every write and removal, also of those that change nothing: hosts touch a
// property to have what depends on it worked out anew.
bool SelfStorageImplImpl::Write(UString const& key, PropertyValue value) {
  Put(key, std::move(value));
  PropChangedInternal(key);
  return true;
}

void SelfStorageImplImpl::RemoveProperty(UString const& key) {
  // The key may be the store's own.
  UString const removed = key;  // NOLINT(performance-unnecessary-copy-initialization)
  Erase(removed);
  PropChangedInternal(removed);
}

void SelfStorageImplImpl::TouchProperty(UString const&) {}

void SelfStorageImplImpl::WriteProperties(XMLLib::Writer& writer) const {
  for (auto const& [key, value] : store_) {
    WriteProperty(writer, key, value);
  }
}

void SelfStorageImplImpl::AdoptMissingProperties(SelfStorageImplImpl const& other) {
  for (auto const& [key, value] : other.store_) {
    if (store_.count(key) == 0) {
      Put(key, value);
    }
  }
}

void SelfStorageImplImpl::CopyProperty(SelfStorageImplImpl const& other, UString const& key) {
  auto const place = other.store_.find(key);
  if (place != other.store_.end()) {
    Put(key, place->second);
  } else {
    Erase(key);
  }
}

void SelfStorageImplImpl::Put(UString const& key, PropertyValue value) {
  auto const [place, isNew] = store_.try_emplace(key);
  bool const isID = place->first == Keys::kUniqueID;
  if (isID && !isNew) {
    CountOut(place->second);
  }
  place->second = std::move(value);
  if (isID) {
    CountIn(place->second);
  }
}

void SelfStorageImplImpl::Erase(UString const& key) {
  auto const place = store_.find(key);
  if (place == store_.end()) {
    return;
  }
  if (place->first == Keys::kUniqueID) {
    CountOut(place->second);
  }
  store_.erase(place);
}

}  // namespace Ostinet::Impl
