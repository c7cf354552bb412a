// SPDX-License-Identifier: MIT
#pragma once

#include <optional>
#include <string>
#include <vector>

#include "StoredProperties.h"
#include "StudioView.h"
#include "ostinet/SystemPorts.h"

namespace Ostinet::Tool {

/// A file of the settings folder.
struct SettingsFile {
  std::string name;
  std::size_t bytes = 0;
  std::string modified;  ///< "2026-01-31 12:00:00 UTC"
  std::string fault;     ///< why it cannot be read to its end; empty where it can, or is no XML
};

/// A folder of device type files and name documents.
struct DataFolder {
  std::string kind;  ///< "user", "system" or "resources"
  std::string path;  ///< empty where the system has none
  bool exists = false;
  int deviceTypeFiles = 0;
  int nameDocuments = 0;
};

/// The document that names the patches of a destination.
struct DocumentInUse {
  std::string destination;
  std::string type;  ///< "master" or "standard"
  std::string name;
  std::string file;
  std::string state;  ///< "read", "missing" or "broken"
};

/// What the author of a program asks a user for when something does not work.
struct DiagReport {
  std::string version;     ///< of this program
  std::string systemKind;  ///< "machine", "simulated" or "none"
  std::string studioFile;  ///< of a simulated studio
  std::string notice;      ///< why there is no MIDI; empty where there is
  std::string backend;     ///< the name of the library's backend
  unsigned backendVersion = 0;
  std::string signIn;  ///< why it failed; empty where it did not
  std::vector<SystemPort> ports;
  StudioView studio;
  StoredProperties properties;  ///< of the studio's objects
  std::vector<DocumentInUse> documents;
  std::string settingsFolder;  ///< empty where there is none
  std::vector<SettingsFile> settingsFiles;
  std::vector<DataFolder> dataFolders;
  std::vector<std::string> errors;  ///< whatever went wrong on the way, one sentence each
};

/// "2026-01-31 12:00:00 UTC" of seconds since 1970.
std::string UniversalTime(long long seconds);

/// The ports of the machine that the studio knows and that are not there.
std::vector<EndpointView> OfflinePorts(StudioView const& studio);

/// The report for people, and as one JSON object, indented.
std::vector<std::string> DiagLines(DiagReport const& report);
std::string DiagJSON(DiagReport const& report);

}  // namespace Ostinet::Tool
