// SPDX-License-Identifier: MIT
#pragma once

#include <array>

#include "ostinet/core/UString.h"

namespace Ostinet::Impl {

// The vocabulary of properties. The texts are stored in users' setup files, so they never change.
//
// Each key is an inline variable: whoever includes this header may use it in the initialisers of
// his own static objects.
namespace Keys {

// Who it is.
inline UString const kName("name");
inline UString const kManufacturer("manufacturer");
inline UString const kModel("model");
inline UString const kUniqueID("uniqueID");
inline UString const kConnUniqueID("connUniqueID");
inline UString const kSlotDescriptor("slotDescriptor");
inline UString const kDeviceType("com_vantor_DeviceType");
inline UString const kPortNumber("com_vantor_PortNumber");
inline UString const kImage("image");

// Where MIDI flows.
inline UString const kDeviceID("deviceID");
inline UString const kScheduleAheadMuSec("scheduleAheadMuSec");
inline UString const kOffline("offline");
inline UString const kWhichAPI("which API");
inline UString const kEmbedded("embedded");
inline UString const kBroadcast("broadcast");
inline UString const kDriver("driver");
inline UString const kReceiveChannels("receiveChannels");
inline UString const kTransmitChannels("transmitChannels");
inline UString const kMaxReceiveChannels("max receive channels");
inline UString const kMaxTransmitChannels("max transmit channels");
inline UString const kSingleRealtimeEntity("single realtime entity");

// What it is.
inline UString const kIsDrumMachine("is drum machine");
inline UString const kIsEffectUnit("is effect unit");
inline UString const kIsMixer("is mixer");
inline UString const kIsSampler("is sampler");
inline UString const kCanRoute("can route");
inline UString const kPanDisruptsStereo("pan disrupts stereo");
inline UString const kIsOpenInMIDIMonitor("com_vantor_lm_MIDIMonitorListOpenFlag");

// What it understands and sends.
inline UString const kReceivesBankSelectLSB("receives bank select LSB");
inline UString const kReceivesBankSelectMSB("receives bank select MSB");
inline UString const kReceivesClock("receives clock");
inline UString const kReceivesMTC("receives MTC");
inline UString const kReceivesNotes("receives notes");
inline UString const kReceivesProgramChanges("receives program changes");
inline UString const kTransmitsBankSelectLSB("transmits bank select LSB");
inline UString const kTransmitsBankSelectMSB("transmits bank select MSB");
inline UString const kTransmitsClock("transmits clock");
inline UString const kTransmitsMTC("transmits MTC");
inline UString const kTransmitsNotes("transmits notes");
inline UString const kTransmitsProgramChanges("transmits program changes");
inline UString const kSupportsGeneralMIDI("supports General MIDI");
inline UString const kSupportsMMC("supports MMC");

// What its patches are called.
inline UString const kNameConfiguration("nameConfiguration");
inline UString const kSavedManufacturer("com_vantor_savedManufacturer");
inline UString const kSavedModel("com_vantor_savedModel");
inline UString const kSavedMasterNameFile("com_vantor_savedMasterNameFile");

// In users' files, where other programs put them; nothing here reads or writes these.
inline UString const kDriverVersion("driverVersion");
inline UString const kMaxSysExSpeed("maxSysExSpeed");
inline UString const kPrivate("private");

/// What the user calls each channel, by channel.
inline std::array<UString, 16> const kChannelNames = {
    "com_vantor_ChannelName0",  "com_vantor_ChannelName1",  "com_vantor_ChannelName2",
    "com_vantor_ChannelName3",  "com_vantor_ChannelName4",  "com_vantor_ChannelName5",
    "com_vantor_ChannelName6",  "com_vantor_ChannelName7",  "com_vantor_ChannelName8",
    "com_vantor_ChannelName9",  "com_vantor_ChannelName10", "com_vantor_ChannelName11",
    "com_vantor_ChannelName12", "com_vantor_ChannelName13", "com_vantor_ChannelName14",
    "com_vantor_ChannelName15"};

}  // namespace Keys

/// One fact about an endpoint under two keys: a destination answers by what it receives, a source
/// by what it transmits.
struct KeyPair {
  UString const& forDestination;
  UString const& forSource;

  UString const& For(bool isDestination) const {
    return isDestination ? forDestination : forSource;
  }
};

namespace KeyPairs {
inline KeyPair const kBankSelectLSB = {Keys::kReceivesBankSelectLSB, Keys::kTransmitsBankSelectLSB};
inline KeyPair const kBankSelectMSB = {Keys::kReceivesBankSelectMSB, Keys::kTransmitsBankSelectMSB};
inline KeyPair const kChannels = {Keys::kReceiveChannels, Keys::kTransmitChannels};
inline KeyPair const kClock = {Keys::kReceivesClock, Keys::kTransmitsClock};
inline KeyPair const kMaxChannels = {Keys::kMaxReceiveChannels, Keys::kMaxTransmitChannels};
inline KeyPair const kMTC = {Keys::kReceivesMTC, Keys::kTransmitsMTC};
inline KeyPair const kNotes = {Keys::kReceivesNotes, Keys::kTransmitsNotes};
inline KeyPair const kProgramChanges = {Keys::kReceivesProgramChanges,
                                        Keys::kTransmitsProgramChanges};
}  // namespace KeyPairs

}  // namespace Ostinet::Impl
