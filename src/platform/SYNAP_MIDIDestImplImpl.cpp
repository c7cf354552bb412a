// SPDX-License-Identifier: MIT

#include "platform/SYNAP_MIDIDestImplImpl.h"

#include <utility>

#include "datapath/SysexImpl.h"
#include "model/DeviceObjectImpl.h"
#include "model/PropertyKeys.h"
#include "model/SlotDescriptor.h"
#include "ostinet/Setup.h"
#include "platform/PluginRecords.h"

namespace Ostinet::Impl {

namespace {

UString const kMaster("master");

/// Program changes are not followed here: the host's engine knows what its plug-in plays.
class SynapSender : public Sender {
 public:
  explicit SynapSender(SynapDestinationRef const& destination) : destination_(destination) {}

  void Send(DataPacket const& packet) override {
    SendMIDIPacketToSYNAPDestination(packet, destination_.get());
  }
  void Flush() override {}
  bool CanSend() const override { return destination_.get() != nullptr; }

 private:
  SynapDestinationRef const destination_;
};

}  // namespace

SynapDestinationRef::SynapDestinationRef(ISynapMIDIDestination* destination)
    : destination_(destination) {
  if (destination_ != nullptr) {
    destination_->Retain();
  }
}

void SynapDestinationRef::Reset() {
  if (ISynapMIDIDestination* const destination = std::exchange(destination_, nullptr)) {
    destination->Release();
  }
}

SYNAP_MIDIDestImplImpl::SYNAP_MIDIDestImplImpl(Setup& setup, SynapMidiPort* port)
    : setup_(setup),
      midiPort_(port),
      destination_(port != nullptr ? port->GetDestination() : nullptr) {}

void SYNAP_MIDIDestImplImpl::Activate(DeviceObjectImpl* owner) {
  activatedFor_ = owner;
  if (midiPort_ != nullptr) {
    midiPort_->SetActivatedObject(this);
  }
}

void SYNAP_MIDIDestImplImpl::Deactivate() {
  // The link goes first, so that a plug-in that deletes its destination from within hears it once.
  if (SynapMidiPort* const port = std::exchange(midiPort_, nullptr)) {
    port->SetActivatedObject(nullptr);
  }
  activatedFor_ = nullptr;
  destination_.Reset();
}

Properties::Implementation SYNAP_MIDIDestImplImpl::GetImplementation() const {
  return Properties::kPluginHostImplementation;
}

std::unique_ptr<Sender> SYNAP_MIDIDestImplImpl::MakeSender(DeviceObjectImpl*) {
  return destination_.get() != nullptr ? std::make_unique<SynapSender>(destination_) : nullptr;
}

void SYNAP_MIDIDestImplImpl::SendSysex(TimeStamp stamp, RCPtrMT<SysexImpl> const& sysex) {
  if (sysex) {
    SendLongMessage(stamp, sysex->begin(), sysex->Size(), destination_.get());
  }
}

void SYNAP_MIDIDestImplImpl::FlushOutput() {
  if (destination_.get() != nullptr) {
    destination_.get()->Flush();
  }
}

UString SYNAP_MIDIDestImplImpl::GetName() const {
  UString name;
  GetString(Keys::kName, name);
  return name;
}

void SYNAP_MIDIDestImplImpl::GetManufAndModel(UString& manufacturer, UString& model) const {
  manufacturer = UString();
  model = UString();
  GetString(Keys::kManufacturer, manufacturer);
  GetString(Keys::kModel, model);
}

void SYNAP_MIDIDestImplImpl::SetManufAndModel(UString const& manufacturer, UString const& model) {
  SetString(Keys::kManufacturer, manufacturer);
  SetString(Keys::kModel, model);
}

void SYNAP_MIDIDestImplImpl::GetMasterNamesProperty(UString& path) const {
  path = UString();
  PropertyDict configuration;
  GetDict(Keys::kNameConfiguration, configuration);
  auto const master = configuration.entries.find(kMaster);
  if (master != configuration.entries.end()) {
    if (auto const* const file = boost::get<PropertyPath>(&master->second)) {
      path = file->path;
    }
  }
}

void SYNAP_MIDIDestImplImpl::SetMasterNamesProperty(UString const& path) {
  PropertyDict configuration;
  GetDict(Keys::kNameConfiguration, configuration);
  if (path.empty()) {
    configuration.entries.erase(kMaster);
  } else {
    configuration.entries[kMaster] = PropertyPath{path};
  }
  SetDict(Keys::kNameConfiguration, configuration);
}

SlotID SYNAP_MIDIDestImplImpl::GetSlotID() const { return SlotIDOf(*this); }

int SYNAP_MIDIDestImplImpl::GetUniqueID() const {
  int id = 0;
  GetInt(Keys::kUniqueID, id);
  return id;
}

void SYNAP_MIDIDestImplImpl::SetAdvanceScheduleTime(int microseconds) {
  SetInt(Keys::kScheduleAheadMuSec, microseconds);
}

void SYNAP_MIDIDestImplImpl::SetChanMask(int mask) { SetInt(Keys::kReceiveChannels, mask); }

void SYNAP_MIDIDestImplImpl::SetChanName(int channel, UString const& name) {
  if (channel >= 0 && channel < static_cast<int>(Keys::kChannelNames.size())) {
    SetString(Keys::kChannelNames[static_cast<std::size_t>(channel)], name);
  }
}

void SYNAP_MIDIDestImplImpl::PropChangedInternal(UString const& key) {
  if (activatedFor_ != nullptr) {
    setup_.PropChanged(activatedFor_, key);
  }
}

}  // namespace Ostinet::Impl
