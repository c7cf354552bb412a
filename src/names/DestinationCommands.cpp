// SPDX-License-Identifier: MIT
//
// Destination: selecting a mode or a patch on the instrument. What goes out passes the tracker of
// the port, so the patch that plays follows by itself; what is selected changes even if nothing
// can be sent.
#include "names/DestinationTree.h"
#include "names/NameHandles.h"
#include "ostinet/Setup.h"
#include "ostinet/core/Error.h"

namespace Ostinet {

using Impl::DestinationTree;
using Impl::ImplOf;

namespace {

// The ID by which the instrument answers to long messages, or else the one that all answer to.
unsigned char DeviceIDForSending(Impl::DestinationImpl const& destination) {
  constexpr unsigned char kAllCall = 126;
  signed char const id = destination.GetSysexDeviceID();
  return id >= 0 ? static_cast<unsigned char>(id) : kAllCall;
}

// Where the system cannot tell the time, messages go out at once.
Clocks Now() {
  try {
    return CurrentMIDITime();
  } catch (VantorError const&) {
    return Clocks();
  }
}

// What follows a buffer goes out with its last packet: a delay behind that is not waited for.
TimeStamp Behind(DataBuffer const& buffer, Clocks start) {
  return buffer.empty() ? TimeStamp(start) : buffer.back().stamp;
}

void SendAll(Destination const& destination, DataBuffer const& buffer) {
  if (buffer.empty()) {
    return;
  }
  std::unique_ptr<Impl::Sender> const sender = destination.MakeSender();
  if (sender == nullptr || !sender->CanSend()) {
    return;
  }
  for (std::size_t i = 0; i < buffer.size(); ++i) {
    sender->Send(buffer[i]);
  }
  sender->Flush();
}

void TellPatchesChanged(Impl::DestinationImpl& destination, unsigned short channels) {
  if (SetupListener* const listener = destination.GetSetup().GetListener()) {
    listener->CurrentPatchChanged(RCPtrMT<Impl::DestinationImpl>(&destination), channels);
  }
}

}  // namespace

void Destination::SendModeChange(DestinationMode const& mode) const {
  constexpr unsigned short kAllChannels = 0xFFFF;
  DestinationTree* const tree = DestinationTree::Of(*this);
  Impl::DestModeImpl* const impl = ImplOf(mode);
  if (tree == nullptr || impl == nullptr || tree->GetTree().currentMode.get() == impl) {
    return;
  }
  Clocks const now = Now();
  unsigned char const deviceID = DeviceIDForSending(tree->GetDestination());
  DataBuffer buffer;
  if (Impl::DestModeImpl const* const current = tree->GetTree().currentMode.get()) {
    current->DisableCommands().GenerateCommands(buffer, now, 0, deviceID);
  }
  impl->EnableCommands().GenerateCommands(buffer, Behind(buffer, now), 0, deviceID);
  SendAll(*this, buffer);
  tree->SelectMode(impl);
  TellPatchesChanged(tree->GetDestination(), kAllChannels);
}

void Destination::SendPatchChange(short channel, Patch const& patch) const {
  DestinationTree* const tree = DestinationTree::Of(*this);
  Impl::PatchImpl const* const impl = ImplOf(patch);
  if (tree == nullptr || impl == nullptr || channel < 0 || channel > 15) {
    return;
  }
  RCPtrMT<Impl::PatchBankImpl> const bank = impl->GetBank();
  Clocks const now = Now();
  unsigned char const deviceID = DeviceIDForSending(tree->GetDestination());
  DataBuffer buffer;
  if (bank.get() != nullptr) {
    bank->Commands().GenerateCommands(buffer, now, channel, deviceID);
  }
  impl->Commands().GenerateCommands(buffer, Behind(buffer, now), channel, deviceID);
  SendAll(*this, buffer);
  Impl::DestNameSetImpl* const nameSet = tree->GetCurrentNameSet(channel);
  if (nameSet != nullptr && bank.get() != nullptr) {
    nameSet->SetCurrentBank(bank);
  }
  TellPatchesChanged(tree->GetDestination(), static_cast<unsigned short>(1U << channel));
}

}  // namespace Ostinet
