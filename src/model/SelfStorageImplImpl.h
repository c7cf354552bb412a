// SPDX-License-Identifier: MIT
#pragma once

#include <boost/container/flat_map.hpp>

#include "model/ImplImpl.h"

namespace Ostinet::Impl {

/// A peer that keeps its properties itself. Reads climb to the parent's store; writes stay here.
/// A key that is held with another type than asked for ends the climb without a value.
class SelfStorageImplImpl : public ImplImpl {
 public:
  /// In one block: a studio may have ten thousand peers, each with a handful of properties.
  using Store = boost::container::flat_map<UString, PropertyValue>;

  SelfStorageImplImpl() = default;
  ~SelfStorageImplImpl() override;

  bool GetFile(UString const& key, UString& path) const override;
  bool GetDict(UString const& key, PropertyDict& out) const override;
  bool GetIntList(UString const& key, std::vector<int>& out) const override;
  bool GetString(UString const& key, UString& out) const override;
  bool GetInt(UString const& key, int& out) const override;

  bool SetFile(UString const& key, UString const& path) override;
  bool SetDict(UString const& key, PropertyDict const& value) override;
  bool SetIntList(UString const& key, std::vector<int> const& value) override;
  bool SetString(UString const& key, UString const& value) override;
  bool SetInt(UString const& key, int value) override;

  void RemoveProperty(UString const& key) override;
  void TouchProperty(UString const& key) override;
  void WriteProperties(XMLLib::Writer& writer) const override;

  /// What this peer itself holds, without its parents.
  Store const& OwnProperties() const { return store_; }
  /// Takes over every property of `other` that this peer does not hold yet; tells nobody.
  void AdoptMissingProperties(SelfStorageImplImpl const& other);
  /// Copies one property of `other` as it stands there (or its absence); tells nobody.
  void CopyProperty(SelfStorageImplImpl const& other, UString const& key);

 protected:
  /// Tells the studio that a key changed.
  virtual void PropChangedInternal(UString const& key) = 0;
  /// The peer whose store is asked next; null at the top.
  virtual SelfStorageImplImpl* GetParentSSImplImpl() const = 0;

 private:
  template <class Value, class Out>
  bool Read(UString const& key, Out& out) const;
  bool Write(UString const& key, PropertyValue value);
  // The only two that change the store: they keep the index of unique IDs right.
  void Put(UString const& key, PropertyValue value);
  void Erase(UString const& key);

  Store store_;
};

}  // namespace Ostinet::Impl
