// SPDX-License-Identifier: MIT
#pragma once

#include "model/PropertyKeys.h"
#include "ostinet/core/XML.h"

namespace Ostinet::Impl {

/// One flag of a device type: the attribute that a file states it with, and the property that a
/// device gets. Reading and applying walk the same tables.
struct DeviceTypeFlag {
  XMLLib::Name attribute;  // empty: no file can state it
  UString const& key;
};

// Clock has no attribute, on purpose: hosts take a device for one that follows the clock unless the
// user says otherwise, and no type may decide that for him.

inline DeviceTypeFlag const kCapabilityFlags[7] = {
    {"SupportsGeneralMIDI", Keys::kSupportsGeneralMIDI},
    {"SupportsMMC", Keys::kSupportsMMC},
    {"CanRoute", Keys::kCanRoute},
    {"IsSampler", Keys::kIsSampler},
    {"IsDrumMachine", Keys::kIsDrumMachine},
    {"IsMixer", Keys::kIsMixer},
    {"IsEffectUnit", Keys::kIsEffectUnit},
};

inline DeviceTypeFlag const kReceiveFlags[7] = {
    {"MTC", Keys::kReceivesMTC},
    {"", Keys::kReceivesClock},
    {"Notes", Keys::kReceivesNotes},
    {"ProgramChanges", Keys::kReceivesProgramChanges},
    {"BankSelectMSB", Keys::kReceivesBankSelectMSB},
    {"BankSelectLSB", Keys::kReceivesBankSelectLSB},
    {"PanDisruptsStereo", Keys::kPanDisruptsStereo},
};

inline DeviceTypeFlag const kTransmitFlags[6] = {
    {"MTC", Keys::kTransmitsMTC},
    {"", Keys::kTransmitsClock},
    {"Notes", Keys::kTransmitsNotes},
    {"ProgramChanges", Keys::kTransmitsProgramChanges},
    {"BankSelectMSB", Keys::kTransmitsBankSelectMSB},
    {"BankSelectLSB", Keys::kTransmitsBankSelectLSB},
};

}  // namespace Ostinet::Impl
