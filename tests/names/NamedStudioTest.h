// SPDX-License-Identifier: MIT
#pragma once

#include "model/NamesHooks.h"
#include "model/PropertyKeys.h"
#include "names/DestinationNameManager.h"
#include "names/NameFolders.h"
#include "names/NameHandles.h"
#include "names/NamesInstallation.h"
#include "support/StudioTest.h"

namespace Ostinet::Testing {

/// A mode that puts the name set "Main" on each channel.
inline std::string ModeWith(std::string const& name, std::string const& nameSet) {
  std::string content;
  for (int channel = 1; channel <= 16; ++channel) {
    content += "<ChannelNameSetAssign Channel='" + std::to_string(channel) + "' NameSet='" +
               nameSet + "'/>";
  }
  return "<CustomDeviceMode Name='" + name + "'><ChannelNameSetAssignments>" + content +
         "</ChannelNameSetAssignments></CustomDeviceMode>";
}

/// A name set with banks of two patches each, numbered from 0: bank n is selected by control 0
/// of value n and control 32 of value 1.
inline std::string NameSetWith(std::string const& name, std::vector<std::string> const& banks) {
  std::string content = "<ChannelNameSet Name='" + name + "'>";
  for (std::size_t i = 0; i < banks.size(); ++i) {
    content += "<PatchBank Name='" + banks[i] +
               "'><MIDICommands><ControlChange Control='0' Value='" + std::to_string(i) +
               "'/><ControlChange Control='32' Value='1'/></MIDICommands>" +
               "<PatchNameList><Patch Number='1' Name='" + banks[i] +
               " 1' ProgramChange='0'/><Patch Number='2' Name='" + banks[i] +
               " 2' ProgramChange='1'/></PatchNameList></PatchBank>";
  }
  return content + "</ChannelNameSet>";
}

/// A patch list of one patch, for a bank to take in place of its own.
inline std::string ListOf(std::string const& name, std::string const& patch) {
  return "<PatchNameList Name='" + name + "'><Patch Number='7' Name='" + patch +
         "' ProgramChange='7'/></PatchNameList>";
}

/// A studio whose destinations have names, with these documents:
///
///   Acme One          modes "Normal" (name set "Main": banks "Preset", "User") and "Multi"
///   ("Drums") Default Names     a standard mode with one bank "Numbers" General MIDI      a
///   standard mode with one bank "GM"
class NamedStudioTest : public StudioTest {
 protected:
  NamedStudioTest() {
    Impl::InstallNames();
    folders.Write("user/One.midnam", OneDocument());
    folders.Write("system/Standard.midnam", NameDocument(Standard("Default Names", "Numbers") +
                                                         Standard("General MIDI", "GM")));
    setup.SignIn("host", nullptr, &prefs);
  }
  ~NamedStudioTest() override {
    listener.names.clear();
    listener.patches.clear();
    setup.Reset();
    Impl::InstallNamesHooks(nullptr);
  }

  static std::string OneDocument(std::string const& mode = "Normal") {
    return NameDocument(Master("Acme", "One",
                               ModeWith(mode, "Main") + ModeWith("Multi", "Drums") +
                                   NameSetWith("Main", {"Preset", "User"}) +
                                   NameSetWith("Drums", {"Kits"})));
  }
  static std::string Standard(std::string const& mode, std::string const& bank) {
    std::string const custom = ModeWith(mode, "Set");
    std::size_t const start = custom.find("<ChannelNameSetAssignments>");
    std::size_t const end = custom.find("</CustomDeviceMode>");
    return StandardMode(mode, custom.substr(start, end - start) + NameSetWith("Set", {bank}));
  }

  /// An instrument with its names; without a maker it has the default ones.
  Destination MakeNamed(UString const& manufacturer = UString(), UString const& model = UString()) {
    Destination const destination = setup.MakeInstrument("Synth");
    destination.SetManufacturer(manufacturer);
    destination.SetModel(model);
    Renew(destination);
    return destination;
  }
  Destination MakeOne() { return MakeNamed("Acme", "One"); }
  /// True if the names changed.
  static bool Renew(Destination const& destination) {
    return Impl::ImplOf(destination)->GetNames()->Renew();
  }
  static Impl::NameConfiguration const& ConfigurationOf(Destination const& destination) {
    return Impl::DestinationNameManager::Of(destination)->GetConfiguration();
  }
  static int KindOf(Destination const& destination) { return ConfigurationOf(destination).kind; }
  static PatchBank BankOf(Destination const& destination, int index = 0) {
    return destination.GetNameSet(0).GetBank(index);
  }
  static Impl::PropertyDict DictOf(Destination const& destination) {
    Impl::PropertyDict dict;
    TestSetup::PeerOf(destination).GetDict(Impl::Keys::kNameConfiguration, dict);
    return dict;
  }
  static void SetDict(Destination const& destination, Impl::PropertyDict const& dict) {
    TestSetup::PeerOf(destination).SetDict(Impl::Keys::kNameConfiguration, dict);
  }
  /// Calls a note of a patch something.
  static void EditNote(PatchBank const& bank, UString const& name, int patch = 0) {
    bank.GetPatch(patch).GetNoteNames().SetNoteName(60, name);
  }
  /// What went out to a port since the last call.
  static void Sent(Destination const& port, std::vector<unsigned char> const& bytes) {
    Impl::ImplOf(port)->GetChannelState()->Track(
        DataPacket{bytes.data(), bytes.size(), kNoTimeStamp});
  }

  NameFolders folders;
};

}  // namespace Ostinet::Testing
