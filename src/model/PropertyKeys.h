// SPDX-License-Identifier: MIT
#pragma once

#include "ostinet/core/UString.h"

namespace Ostinet::Impl {

// The vocabulary of properties. The texts are stored in users' setup files, so they never change.
namespace Keys {
extern UString const kName;                 // "name"
extern UString const kManufacturer;         // "manufacturer"
extern UString const kModel;                // "model"
extern UString const kUniqueID;             // "uniqueID"
extern UString const kConnUniqueID;         // "connUniqueID"
extern UString const kDeviceID;             // "deviceID"
extern UString const kScheduleAheadMuSec;   // "scheduleAheadMuSec"
extern UString const kOffline;              // "offline"
extern UString const kWhichAPI;             // "which API"
extern UString const kSupportsGeneralMIDI;  // "supports General MIDI"
}  // namespace Keys

}  // namespace Ostinet::Impl
