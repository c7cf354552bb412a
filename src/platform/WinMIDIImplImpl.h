// SPDX-License-Identifier: MIT
#pragma once

#include <vector>

#include "model/SelfStorageImplImpl.h"

namespace Ostinet::Impl {

class WinMIDISetup;

/// The peer of devices, entities and their endpoints, which no port of the system stands behind,
/// and the base of all port classes.
class WinMIDIImplImpl : public SelfStorageImplImpl {
 public:
  /// `parent`, which may be null, answers for properties that this peer does not hold. It clears
  /// that link when it goes first.
  WinMIDIImplImpl(WinMIDISetup& setup, WinMIDIImplImpl* parent);
  ~WinMIDIImplImpl() override;

  bool Exists() const override { return owner_ != nullptr; }
  bool ReallyExists() const override { return Exists(); }
  bool IsFake() const override { return false; }
  bool IsPregen() const override { return false; }
  SynapMidiPort* GetSynapMIDIPort() const override { return nullptr; }
  void* GetImplObjRef(Properties::Implementation) const override { return nullptr; }
  void Activate(DeviceObjectImpl* owner) override { owner_ = owner; }
  void Deactivate() override;
  Properties::Implementation GetImplementation() const override;
  std::unique_ptr<Sender> MakeSender(DeviceObjectImpl* object) override;
  void SendSysex(TimeStamp, RCPtrMT<SysexImpl> const&) override {}
  void FlushOutput() override {}

 protected:
  void PropChangedInternal(UString const& key) override;
  SelfStorageImplImpl* GetParentSSImplImpl() const override { return parent_; }
  WinMIDISetup& GetSetup() const { return setup_; }
  DeviceObjectImpl* Owner() const { return owner_; }
  /// What Deactivate does short of telling that the studio changed.
  void ClearOwner() { owner_ = nullptr; }

 private:
  WinMIDISetup& setup_;
  WinMIDIImplImpl* parent_;                 // cleared by the parent's destructor
  std::vector<WinMIDIImplImpl*> children_;  // each leaves in its destructor
  DeviceObjectImpl* owner_ = nullptr;       // cleared by Deactivate, before the owner goes
};

}  // namespace Ostinet::Impl
