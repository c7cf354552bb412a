// SPDX-License-Identifier: MIT
#pragma once

#include "platform/WinMIDIImplImpl.h"

namespace Ostinet::Impl {

/// The peer of every direct endpoint. While the system has the port, everything goes to the port
/// object; while it has not, to a dummy that keeps the properties. Each operation of a peer is
/// forwarded to whichever of the two is there.
///
/// What a host writes while the port is online is gone at detach, and the dummy answers again
/// with what it held before: saved studios rely on it. Three keys stay: the name, the unique ID
/// and the connections, by which the endpoint is found again.
class WinMIDIPort : public ImplImpl {
 public:
  /// Which side of the system the attached port was opened on.
  enum WhichAPI { kOffline = 0, kDirectMusic = 2, kLegacy = 3 };

  explicit WinMIDIPort(WinMIDISetup& setup);
  ~WinMIDIPort() override;

  WhichAPI GetWhichAPI() const { return whichAPI_; }
  /// Null while offline.
  WinMIDIImplImpl* GetActiveImpl() const { return active_.get(); }
  /// The port object behind a direct endpoint; null for endpoints of another kind.
  static WinMIDIPort* Of(EndpointImpl const& endpoint);

  /// Installs an opened port, which takes over what the dummy holds and it does not.
  void Attach(WhichAPI api, std::unique_ptr<WinMIDIImplImpl> port);
  /// Closes and destroys the port object. Harmless while offline.
  void Detach();

  bool Exists() const override;
  bool ReallyExists() const override;
  bool IsFake() const override;
  bool IsPregen() const override;
  SynapMidiPort* GetSynapMIDIPort() const override;
  void* GetImplObjRef(Properties::Implementation implementation) const override;
  void Activate(DeviceObjectImpl* owner) override;
  void Deactivate() override;
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
  Properties::Implementation GetImplementation() const override;
  void RemoveProperty(UString const& key) override;
  void TouchProperty(UString const& key) override;
  void WriteProperties(XMLLib::Writer& writer) const override;
  std::unique_ptr<Sender> MakeSender(DeviceObjectImpl* object) override;
  void SendSysex(TimeStamp stamp, RCPtrMT<SysexImpl> const& sysex) override;
  void FlushOutput() override;

 private:
  /// Keeps the properties of a port that is not there.
  class Dummy : public SelfStorageImplImpl {
   public:
    explicit Dummy(WinMIDISetup& setup) : setup_(setup) {}

    bool Exists() const override { return !isDeactivated_; }
    bool ReallyExists() const override { return false; }
    bool IsFake() const override { return false; }
    bool IsPregen() const override { return false; }
    SynapMidiPort* GetSynapMIDIPort() const override { return nullptr; }
    void* GetImplObjRef(Properties::Implementation) const override { return nullptr; }
    void Activate(DeviceObjectImpl* owner) override { owner_ = owner; }
    void Deactivate() override;
    Properties::Implementation GetImplementation() const override;
    std::unique_ptr<Sender> MakeSender(DeviceObjectImpl*) override { return nullptr; }
    void SendSysex(TimeStamp, RCPtrMT<SysexImpl> const&) override {}
    void FlushOutput() override {}
    DeviceObjectImpl* Owner() const { return owner_; }

   protected:
    void PropChangedInternal(UString const& key) override;
    SelfStorageImplImpl* GetParentSSImplImpl() const override { return nullptr; }

   private:
    WinMIDISetup& setup_;
    DeviceObjectImpl* owner_ = nullptr;  // cleared by Deactivate
    bool isDeactivated_ = false;
  };

  SelfStorageImplImpl& Current();
  SelfStorageImplImpl const& Current() const;

  Dummy dummy_;
  WhichAPI whichAPI_ = kOffline;
  std::unique_ptr<WinMIDIImplImpl> active_;
};

}  // namespace Ostinet::Impl
