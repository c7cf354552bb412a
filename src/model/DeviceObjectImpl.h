// SPDX-License-Identifier: MIT
#pragma once

#include <boost/container/flat_set.hpp>
#include <boost/container/small_vector.hpp>
#include <cstddef>
#include <functional>
#include <memory>

#include "model/ImplImpl.h"
#include "model/ObjectImpl.h"

namespace Ostinet::Impl {

/// The property keys that changed since the last round: few, so that most of them need no memory of
/// their own.
using PropertyKeys = boost::container::flat_set<UString, std::less<UString>,
                                                boost::container::small_vector<UString, 1>>;

/// What devices, entities and endpoints share: a peer with properties, and whether the platform
/// (direct) or the user (not direct) made the thing.
class DeviceObjectImpl : public ObjectImpl {
 public:
  ~DeviceObjectImpl() override;

  UString GetName() const override;
  /// Takes the object out of the studio. `fromParent` tells that the parent is going too and
  /// clears its own list.
  virtual void Deactivate(bool fromParent);
  virtual void SetName(UString const& name);
  virtual bool IsOnline() const;
  /// True if connections must be worked out anew.
  virtual bool HandlePropertyChanges(PropertyKeys const& keys);
  virtual void WriteXML(XMLLib::Writer& writer) const = 0;

  /// Where the platform's notes of changes have this object; theirs alone to read and write.
  std::size_t placeInChanges = 0;

  ImplImpl* Peer() const { return peer_.get(); }
  bool IsDirect() const { return isDirect_; }
  bool Exists() const { return peer_->Exists(); }
  int GetInt(UString const& key, int fallback) const;
  UString GetString(UString const& key, UString const& fallback = UString()) const;
  /// 0 to 127, or -1 for none.
  signed char GetSysexDeviceID() const;
  ModelInfo GetModelInfo() const;
  SlotID GetSlotID() const;

 protected:
  /// Takes the peer over; the most derived constructor activates it.
  DeviceObjectImpl(std::unique_ptr<ImplImpl> peer, bool isDirect);
  /// The "Properties" element: what the peer itself holds.
  void WriteProperties(XMLLib::Writer& writer) const;

 private:
  std::unique_ptr<ImplImpl> const peer_;
  bool const isDirect_;
};

}  // namespace Ostinet::Impl
