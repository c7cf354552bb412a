// SPDX-License-Identifier: MIT
#pragma once

#include "model/SelfStorageImplImpl.h"
#include "ostinet/PluginHost.h"

namespace Ostinet {
class Setup;
}

namespace Ostinet::Impl {

/// A counted reference to where a plug-in's MIDI goes, by the host's own count.
class SynapDestinationRef {
 public:
  explicit SynapDestinationRef(ISynapMIDIDestination* destination);
  SynapDestinationRef(SynapDestinationRef const& other) : SynapDestinationRef(other.destination_) {}
  SynapDestinationRef& operator=(SynapDestinationRef const&) = delete;
  ~SynapDestinationRef() { Reset(); }

  ISynapMIDIDestination* get() const { return destination_; }
  void Reset();

 private:
  ISynapMIDIDestination* destination_;  // null or retained
};

/// The peer of a destination that is a plug-in in the host's engine: no port stands behind it, and
/// what is sent to it goes to the plug-in at once.
class SYNAP_MIDIDestImplImpl : public SelfStorageImplImpl {
 public:
  /// `port` is the host's; null makes a destination that leads nowhere.
  SYNAP_MIDIDestImplImpl(Setup& setup, SynapMidiPort* port);

  bool Exists() const override { return activatedFor_ != nullptr; }
  bool ReallyExists() const override { return Exists(); }
  bool IsFake() const override { return false; }
  bool IsPregen() const override { return midiPort_ != nullptr && midiPort_->IsPregen(); }
  SynapMidiPort* GetSynapMIDIPort() const override { return midiPort_; }
  void* GetImplObjRef(Properties::Implementation) const override { return nullptr; }
  /// Tells the plug-in of this peer; the owner's constructor calls it.
  void Activate(DeviceObjectImpl* owner) override;
  /// Tells the plug-in that it has no peer any more, and lets go of it.
  void Deactivate() override;
  Properties::Implementation GetImplementation() const override;

  /// Null when there is nowhere to send to. A sender keeps its plug-in's end for as long as it
  /// lives, so it stays harmless when the destination goes.
  std::unique_ptr<Sender> MakeSender(DeviceObjectImpl* object) override;
  void SendSysex(TimeStamp stamp, RCPtrMT<SysexImpl> const& sysex) override;
  void FlushOutput() override;

  // What the host's engine calls.
  UString GetName() const;
  void GetManufAndModel(UString& manufacturer, UString& model) const;
  void SetManufAndModel(UString const& manufacturer, UString const& model);
  void GetMasterNamesProperty(UString& path) const;
  void SetMasterNamesProperty(UString const& path);
  SlotID GetSlotID() const;
  int GetUniqueID() const;
  void SetAdvanceScheduleTime(int microseconds);
  void SetChanMask(int mask);
  void SetChanName(int channel, UString const& name);

 protected:
  void PropChangedInternal(UString const& key) override;
  SelfStorageImplImpl* GetParentSSImplImpl() const override { return nullptr; }

 private:
  Setup& setup_;
  SynapMidiPort* midiPort_;  // the host's; cleared by Deactivate
  SynapDestinationRef destination_;
  DeviceObjectImpl* activatedFor_ = nullptr;  // cleared by Deactivate, before the owner goes
};

}  // namespace Ostinet::Impl
