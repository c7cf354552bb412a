// SPDX-License-Identifier: MIT
//
// A report is wanted when something is wrong, so each part is looked at for itself: what fails is
// told among the errors, and the rest goes on.
#include <CLI/CLI.hpp>
#include <map>

#include "Commands.h"
#include "DiagReport.h"
#include "Errors.h"
#include "Output.h"
#include "Studio.h"
#include "ostinet/DeviceTypeCatalog.h"
#include "ostinet/NameDocument.h"
#include "ostinet/core/XML.h"

namespace Ostinet::Tool {
namespace {

// Does one part of the work; a failure becomes an error of the report.
template <class Part>
void Try(DiagReport& report, Part const& part) {
  try {
    part();
  } catch (std::exception const& error) {
    report.errors.emplace_back(error.what());
  }
}

void TellSystem(DiagReport& report, GlobalOptions const& globals) {
  report.studioFile = StudioFileAskedFor(globals.studio);
  report.notice = WhyNoMIDI(globals.studio);
  Properties const backend;
  report.backend = backend.GetImplementationName().string();
  report.backendVersion = backend.GetImplementationVersion();
  report.systemKind = !report.studioFile.empty() ? "simulated"
                      : report.notice.empty()    ? "machine"
                                                 : "none";
}

void TellPorts(DiagReport& report) {
  report.ports = ListSystemPorts();
  for (SystemPort const& port : report.ports) {
    if (port.error != 0) {
      report.errors.push_back("the system does not describe one of its ports: error " +
                              std::to_string(port.error));
    }
  }
}

// A document may name the patches of many destinations and is read once.
class DocumentStates {
 public:
  std::string const& Of(FileSpecification const& file) {
    auto const [place, isNew] = states_.try_emplace(file.GetFullPath().string());
    if (isNew) {
      place->second = !file.IsFile() ? "missing" : NameDocument(file).IsWhole() ? "read" : "broken";
    }
    return place->second;
  }

 private:
  std::map<std::string, std::string> states_;
};

void TellDocument(DiagReport& report, Destination const& destination, DocumentStates& states) {
  Names const names = destination.GetNames();
  if (!names.Exists()) {
    return;
  }
  DocumentInUse document;
  document.destination = destination.GetName().string();
  document.type = names.GetType() == Names::kMasterNames ? "master" : "standard";
  document.name = names.GetName().string();
  document.file = names.GetFile().GetFullPath().string();
  document.state = states.Of(names.GetFile());
  if (document.state != "read") {
    report.errors.push_back("the name document \"" + document.file + "\" of \"" +
                            document.destination + "\" is " + document.state);
  }
  report.documents.push_back(document);
}

void TellStudio(DiagReport& report, Setup const& setup) {
  report.studio = ViewStudio(setup);
  Try(report, [&] { report.properties = ReadStoredProperties(setup); });
  DocumentStates states;
  for (int i = 0; i < setup.CountDestinations(); ++i) {
    TellDocument(report, setup.GetDestination(i), states);
  }
  for (int i = 0; i < setup.CountPrivateDestinations(); ++i) {
    TellDocument(report, setup.GetPrivateDestination(i), states);
  }
}

// Why an XML file breaks off; empty where it can be read to its end.
std::string XMLFault(File const& file) {
  try {
    XMLLib::Parser parser(file);
    while (parser.DownToChild()) {
      parser.UpToParent();
    }
    return {};
  } catch (std::exception const& error) {
    return error.what();
  }
}

void TellSettingsFile(DiagReport& report, File const& file) {
  SettingsFile state;
  state.name = file.GetName().string();
  state.bytes = file.Read().size();
  state.modified = UniversalTime(file.GetModDate().AsInt32());
  if (file.GetName().ends_with(".xml")) {
    state.fault = XMLFault(file);
  }
  if (!state.fault.empty()) {
    report.errors.push_back("\"" + file.GetFullPath().string() + "\" is broken: " + state.fault);
  }
  report.settingsFiles.push_back(state);
}

void TellSettings(DiagReport& report, GlobalOptions const& globals) {
  Folder const folder = SettingsFolder(globals);
  report.settingsFolder = folder.GetFullPath().string();
  for (FolderIterator entry(folder, FolderIterator::kFilesOnly); !entry.AtEnd(); ++entry) {
    Try(report, [&] { TellSettingsFile(report, File(*entry)); });
  }
}

class FileCounter : public Impl::XMLFilesVisitor {
 public:
  explicit FileCounter(char const* extension) { Impl::VisitXMLFiles(*this, extension); }
  void Visit(File const&, bool inUserFolder) override { ++(inUserFolder ? user : system); }

  int user = 0;
  int system = 0;
};

DataFolder StateOf(char const* kind, Folder const& folder) {
  DataFolder state;
  state.kind = kind;
  state.path = folder.GetFullPath().string();
  state.exists = folder.IsFolder();
  return state;
}

void TellDataFolders(DiagReport& report) {
  FileCounter const types("middev");
  FileCounter const documents("midnam");
  DataFolder user = StateOf("user", Folder::Find(Folder::kUserDeviceFiles, Folder::kDoNotCreate));
  user.deviceTypeFiles = types.user;
  user.nameDocuments = documents.user;
  DataFolder system =
      StateOf("system", Folder::Find(Folder::kSystemDeviceFiles, Folder::kDoNotCreate));
  system.deviceTypeFiles = types.system;
  system.nameDocuments = documents.system;
  File const resource = ResourceAccess::Instance().GetFile("AutoDetect", "xml");
  report.dataFolders = {user, system, StateOf("resources", resource.ParentFolder())};
}

void Diagnose(GlobalOptions const& globals) {
  ChooseStudio(globals.studio);
  DiagReport report;
  report.version = OSTINET_TOOL_VERSION;
  TellSystem(report, globals);
  try {
    Session const session(globals, nullptr, nullptr);
    Try(report, [&] { TellStudio(report, session.GetSetup()); });
    Try(report, [&] { TellPorts(report); });
    if (!session.SettingsFault().empty()) {
      report.errors.push_back("settings could not be read: " + session.SettingsFault());
    }
  } catch (Failure const& failure) {
    report.signIn = failure.what();
    report.errors.push_back(report.signIn);
    Try(report, [&] { TellPorts(report); });
  }
  Try(report, [&] { TellSettings(report, globals); });
  Try(report, [&] { TellDataFolders(report); });
  PrintOne(globals.json, DiagJSON(report), DiagLines(report));
}

}  // namespace

void AddDiagCommand(CLI::App& app, CommandLine& line) {
  CLI::App* const command =
      app.add_subcommand("diag", "Print a report of everything, to send to whoever gives support");
  command->footer("It holds the names of ports, devices and files, and saves nothing.");
  command->callback([&line] { line.run = [&line] { Diagnose(line.options); }; });
}

}  // namespace Ostinet::Tool
