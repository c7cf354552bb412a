// SPDX-License-Identifier: MIT
#pragma once

#include <memory>
#include <vector>

#include "model/SelfStorageImplImpl.h"
#include "ostinet/Setup.h"

namespace Ostinet::Testing {

/// What went out through a peer.
struct SentLog {
  struct Packet {
    std::vector<unsigned char> bytes;
    unsigned long long clocks;
  };
  std::vector<Packet> packets;
  int flushes = 0;
  int sysexes = 0;
  int outputFlushes = 0;
  int sendersAlive = 0;
  std::vector<Impl::DeviceObjectImpl*> sendersMadeFor;
};

/// A peer without a platform: it keeps properties, records what it is told to send, and answers
/// as its fields say.
class TestPeer : public Impl::SelfStorageImplImpl {
 public:
  explicit TestPeer(Setup& setup, TestPeer* parent = nullptr) : setup_(setup), parent_(parent) {
    ++sAlive;
  }
  ~TestPeer() override { --sAlive; }

  bool Exists() const override { return owner_ != nullptr; }
  bool ReallyExists() const override { return Exists(); }
  bool IsFake() const override { return isFake; }
  bool IsPregen() const override { return isPregen; }
  SynapMidiPort* GetSynapMIDIPort() const override { return nullptr; }
  void* GetImplObjRef(Properties::Implementation implementation) const override {
    return implementation == Properties::kPlatformImplementation ? implObjRef : nullptr;
  }
  void Activate(Impl::DeviceObjectImpl* owner) override { owner_ = owner; }
  void Deactivate() override { owner_ = nullptr; }
  Properties::Implementation GetImplementation() const override {
    return Properties::kPlatformImplementation;
  }
  std::unique_ptr<Impl::Sender> MakeSender(Impl::DeviceObjectImpl* object) override;
  void SendSysex(TimeStamp, RCPtrMT<Impl::SysexImpl> const&) override { ++sent->sysexes; }
  void FlushOutput() override { ++sent->outputFlushes; }

  bool isFake = false;
  bool isPregen = false;
  bool canSend = true;
  bool makesSenders = true;
  void* implObjRef = nullptr;
  std::shared_ptr<SentLog> const sent = std::make_shared<SentLog>();
  std::vector<UString> changedKeys;  // as told to PropChangedInternal

  static int sAlive;

 protected:
  void PropChangedInternal(UString const& key) override {
    changedKeys.push_back(key);
    if (owner_ != nullptr) {
      setup_.PropChanged(owner_, key);
    }
  }
  SelfStorageImplImpl* GetParentSSImplImpl() const override { return parent_; }

 private:
  Setup& setup_;
  TestPeer* const parent_;  // lives in the parent object, which the tests keep
  Impl::DeviceObjectImpl* owner_ = nullptr;
};

}  // namespace Ostinet::Testing
