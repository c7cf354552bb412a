// SPDX-License-Identifier: MIT

#include "platform/SetupFile.h"

#include "model/DestinationImpl.h"
#include "model/DeviceImpl.h"
#include "model/XMLNames.h"
#include "platform/SetupFileReader.h"
#include "platform/WinMIDISetup.h"

namespace Ostinet::Impl {

namespace {

UString const kSetupFileName("Ostinet.xml");

Folder FolderOf(PrefsHandler& prefs) {
  Folder folder;
  prefs.GetFolder(folder);
  return folder;
}

template <class Object>
void WriteObject(XMLLib::Writer& writer, XMLLib::Name const& name, Object const& object) {
  writer.StartElement(name);
  object.WriteXML(writer);
  writer.EndElement();
}

/// Ports outside of any device. Software ports and virtual ends are found or made anew each time.
template <class Endpoints>
void WriteBarePorts(XMLLib::Writer& writer, XMLLib::Name const& name, Endpoints const& endpoints) {
  for (auto const& endpoint : endpoints) {
    if (endpoint->GetEntity() == nullptr && !endpoint->IsVirtual() && !endpoint->IsSoftware()) {
      WriteObject(writer, name, *endpoint);
    }
  }
}

}  // namespace

void LoadSetupFile(WinMIDISetup& setup) {
  PrefsHandler* const prefs = setup.GetPrefsHandler();
  if (prefs == nullptr) {
    return;
  }
  try {
    XMLLib::Parser parser(FolderOf(*prefs).GetFile(kSetupFileName));
    SetupFileReader(setup, parser, SetupFileReader::kLoad).ReadStudio();
  } catch (...) {
    // What was read by then stays.
  }
}

void SaveSetupFile(WinMIDISetup& setup) {
  PrefsHandler* const prefs = setup.GetPrefsHandler();
  if (prefs == nullptr) {
    return;
  }
  try {
    Studio const& studio = setup.Lists();
    // A host's first save makes the folder too.
    XMLLib::Writer writer(FolderOf(*prefs).DemandFileInFolder(kSetupFileName, 0, 0));
    writer.StartElement(kSetupFileRoot);
    WriteBarePorts(writer, XMLNames::kSource, studio.sources);
    WriteBarePorts(writer, XMLNames::kDestination, studio.destinations);
    for (auto const& device : studio.devices) {
      WriteObject(writer, XMLNames::kDevice, *device);
    }
    writer.EndElement();
    writer.Close();
  } catch (...) {
    // The old file stays.
  }
}

}  // namespace Ostinet::Impl
