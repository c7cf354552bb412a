// SPDX-License-Identifier: MIT
#pragma once

#include <memory>
#include <vector>

#include "model/PropertyValue.h"
#include "ostinet/Endpoint.h"
#include "ostinet/core/Noncopyable.h"
#include "ostinet/core/XML.h"

class SynapMidiPort;

namespace Ostinet::Impl {

/// The platform peer of a device object: where the object meets the platform. It keeps the
/// properties, tells whether the thing still exists, and makes senders.
///
/// Ownership  Owned by its DeviceObjectImpl from construction to destruction.
/// Threads    The host's polling thread.
class ImplImpl : public Noncopyable<void> {
 public:
  virtual ~ImplImpl() = default;

  virtual bool Exists() const = 0;
  virtual bool ReallyExists() const = 0;
  virtual bool IsFake() const = 0;
  virtual bool IsPregen() const = 0;
  virtual SynapMidiPort* GetSynapMIDIPort() const = 0;
  virtual void* GetImplObjRef(Properties::Implementation) const = 0;

  /// Called by the constructor of the owner, and when the owner leaves the studio.
  virtual void Activate(DeviceObjectImpl* owner) = 0;
  virtual void Deactivate() = 0;

  /// Getters leave the output as it was and return false when the key is missing along the chain
  /// of parents, or is held with another type.
  virtual bool GetFile(UString const& key, UString& path) const = 0;
  virtual bool GetDict(UString const& key, PropertyDict& out) const = 0;
  virtual bool GetIntList(UString const& key, std::vector<int>& out) const = 0;
  virtual bool GetString(UString const& key, UString& out) const = 0;
  virtual bool GetInt(UString const& key, int& out) const = 0;

  virtual bool SetFile(UString const& key, UString const& path) = 0;
  virtual bool SetDict(UString const& key, PropertyDict const& value) = 0;
  virtual bool SetIntList(UString const& key, std::vector<int> const& value) = 0;
  virtual bool SetString(UString const& key, UString const& value) = 0;
  virtual bool SetInt(UString const& key, int value) = 0;

  virtual Properties::Implementation GetImplementation() const = 0;
  virtual void RemoveProperty(UString const& key) = 0;
  virtual void TouchProperty(UString const& key) = 0;
  virtual void WriteProperties(XMLLib::Writer& writer) const = 0;

  virtual std::unique_ptr<Sender> MakeSender(DeviceObjectImpl* object) = 0;
  virtual void SendSysex(TimeStamp stamp, RCPtrMT<SysexImpl> const& sysex) = 0;
  virtual void FlushOutput() = 0;
};

}  // namespace Ostinet::Impl
