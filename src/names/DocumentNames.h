// SPDX-License-Identifier: MIT
#pragma once

#include "ostinet/NamesCatalog.h"
#include "ostinet/core/XML.h"

namespace Ostinet::Impl {

// The words of the MIDI Name Document format, version 1.0, for its readers and writers.
namespace DocumentNames {

inline constexpr char kPublicID[] =
    "-//MIDI Manufacturers Association//DTD MIDINameDocument 1.0//EN";
inline constexpr char kSystemID[] = "http://www.midi.org/dtds/MIDINameDocument10.dtd";

// The instruction that marks the documents that the library itself writes.
inline constexpr char kMarkTarget[] = "com_vantor_LM";
inline constexpr char kMarkTargetStart[] = "com_vantor";
inline constexpr char kMarkData[] = "temp=\"yes\"";

// Elements.
inline XMLLib::Name const kDocument("MIDINameDocument");
inline XMLLib::Name const kAuthor("Author");
inline XMLLib::Name const kMasterDeviceNames("MasterDeviceNames");
inline XMLLib::Name const kExtendingDeviceNames("ExtendingDeviceNames");
inline XMLLib::Name const kStandardDeviceMode("StandardDeviceMode");
inline XMLLib::Name const kManufacturer("Manufacturer");
inline XMLLib::Name const kModel("Model");
inline XMLLib::Name const kDevice("Device");
inline XMLLib::Name const kCustomDeviceMode("CustomDeviceMode");
inline XMLLib::Name const kSupportsStandardDeviceMode("SupportsStandardDeviceMode");
inline XMLLib::Name const kDeviceModeEnable("DeviceModeEnable");
inline XMLLib::Name const kDeviceModeDisable("DeviceModeDisable");
inline XMLLib::Name const kMIDICommands("MIDICommands");
inline XMLLib::Name const kPatchMIDICommands("PatchMIDICommands");
inline XMLLib::Name const kChannelNameSetAssignments("ChannelNameSetAssignments");
inline XMLLib::Name const kChannelNameSetAssign("ChannelNameSetAssign");
inline XMLLib::Name const kChannelNameSet("ChannelNameSet");
inline XMLLib::Name const kAvailableForChannels("AvailableForChannels");
inline XMLLib::Name const kAvailableChannel("AvailableChannel");
inline XMLLib::Name const kPatchBank("PatchBank");
inline XMLLib::Name const kPatchNameList("PatchNameList");
inline XMLLib::Name const kUsesPatchNameList("UsesPatchNameList");
inline XMLLib::Name const kPatch("Patch");
inline XMLLib::Name const kNoteNameList("NoteNameList");
inline XMLLib::Name const kUsesNoteNameList("UsesNoteNameList");
inline XMLLib::Name const kNoteGroup("NoteGroup");
inline XMLLib::Name const kNote("Note");
inline XMLLib::Name const kControlNameList("ControlNameList");
inline XMLLib::Name const kUsesControlNameList("UsesControlNameList");
inline XMLLib::Name const kControl("Control");
inline XMLLib::Name const kValues("Values");
inline XMLLib::Name const kValueNameList("ValueNameList");
inline XMLLib::Name const kUsesValueNameList("UsesValueNameList");
inline XMLLib::Name const kValue("Value");
inline XMLLib::Name const kMIDIDelay("MIDIDelay");
inline XMLLib::Name const kLocalControl("LocalControl");
inline XMLLib::Name const kSysEx("SysEx");
inline XMLLib::Name const kSysExDeviceID("SysExDeviceID");
inline XMLLib::Name const kSysExChannel("SysExChannel");

// Attributes. kModel, kValue, kNote and kControl are names of attributes too.
inline XMLLib::Name const kName("Name");
inline XMLLib::Name const kNumber("Number");
inline XMLLib::Name const kUniqueID("UniqueID");
inline XMLLib::Name const kChannel("Channel");
inline XMLLib::Name const kNameSet("NameSet");
inline XMLLib::Name const kAvailable("Available");
inline XMLLib::Name const kProgramChange("ProgramChange");
inline XMLLib::Name const kType("Type");
inline XMLLib::Name const kMin("Min");
inline XMLLib::Name const kMax("Max");
inline XMLLib::Name const kDefault("Default");
inline XMLLib::Name const kUnits("Units");
inline XMLLib::Name const kMilliseconds("Milliseconds");
inline XMLLib::Name const kOffset("Offset");
inline XMLLib::Name const kMultiplier("Multiplier");

}  // namespace DocumentNames

inline constexpr XMLLib::AttributeMap<ControlType>::Entry kControlTypeWords[] = {
    {"7bit", ControlType(0)},
    {"14bit", ControlType(1)},
    {"RPN", ControlType(2)},
    {"NRPN", ControlType(3)}};
inline constexpr XMLLib::AttributeMap<ControlType> kControlTypes{kControlTypeWords};

inline constexpr XMLLib::AttributeMap<bool>::Entry kOnOffWords[] = {{"on", true}, {"off", false}};
inline constexpr XMLLib::AttributeMap<bool> kOnOff{kOnOffWords};

}  // namespace Ostinet::Impl
