// SPDX-License-Identifier: MIT

// Name documents: a catalog of a thousand of them, seen for the first time and known from an
// earlier session; and a destination that looks whether its names are still the same.

#include <benchmark/benchmark.h>

#include <memory>
#include <string>

#include "BenchHost.h"
#include "core/SystemServices.h"
#include "model/DestinationImpl.h"
#include "model/Handles.h"
#include "names/NamesCatalogImpl.h"
#include "ostinet/NamesCatalog.h"
#include "support/TemporaryFolder.h"

namespace Ostinet::Bench {
namespace {

constexpr int kDocuments = 1000;

/// A document of the usual size: eight banks of 32 patches, and names of the drums.
std::string DocumentText(int number) {
  std::string content =
      "<?xml version=\"1.0\"?><MIDINameDocument><Author>Somebody</Author><MasterDeviceNames>"
      "<Manufacturer>Maker</Manufacturer><Model>Model " +
      std::to_string(number) +
      "</Model><CustomDeviceMode Name=\"Default\"><ChannelNameSetAssignments>"
      "<ChannelNameSetAssign Channel=\"1\" NameSet=\"Names\"/></ChannelNameSetAssignments>"
      "</CustomDeviceMode><ChannelNameSet Name=\"Names\">";
  for (int bank = 0; bank < 8; ++bank) {
    content += "<PatchBank Name=\"Bank " + std::to_string(bank) + "\"><PatchNameList>";
    for (int patch = 0; patch < 32; ++patch) {
      std::string const text = std::to_string(patch);
      content += "<Patch Number=\"" + text + "\" Name=\"Grand Piano " + text +
                 "\" ProgramChange=\"" + text + "\"/>";
    }
    content += "</PatchNameList></PatchBank>";
  }
  content += "</ChannelNameSet><NoteNameList Name=\"Drums\">";
  for (int note = 35; note < 82; ++note) {
    content += "<Note Number=\"" + std::to_string(note) + "\" Name=\"Acoustic Drum\"/>";
  }
  return content + "</NoteNameList></MasterDeviceNames></MIDINameDocument>";
}

/// Keeps the blocks of a host in memory.
class BlocksInMemory : public PrefsHandler {
 public:
  void Save(int, std::vector<unsigned char> const& bytes) override { bytes_ = bytes; }
  void Load(int, std::vector<unsigned char>& bytes) override { bytes = bytes_; }
  void GetFolder(Folder&) override {}

 private:
  std::vector<unsigned char> bytes_;
};

class NamesCatalogBench : public benchmark::Fixture {
 public:
  void SetUp(benchmark::State&) override {
    folder_ = std::make_unique<Testing::TemporaryFolder>();
    for (int i = 0; i < kDocuments; ++i) {
      folder_->Write("Maker " + std::to_string(i % 50) + "/" + std::to_string(i) + ".midnam",
                     DocumentText(i));
    }
    SystemServices::SetEnvironment("OSTINET_USER_FOLDER", UString(folder_->Path().c_str()));
    SystemServices::SetEnvironment("OSTINET_SYSTEM_FOLDER", UString("/nowhere"));
  }
  void TearDown(benchmark::State&) override {
    SystemServices::SetEnvironment("OSTINET_USER_FOLDER", UString());
    SystemServices::SetEnvironment("OSTINET_SYSTEM_FOLDER", UString());
    folder_.reset();
  }

 protected:
  /// Looks at every document.
  static void SearchAll(Impl::NamesCatalogImpl& catalog) {
    class Nothing : public Impl::NamesCatalogImpl::Func {
      bool operator()(Impl::NameDocumentDigest const&) override { return false; }
    } nothing;
    catalog.Search(nothing, Impl::NamesCatalogImpl::Faults::kThrow);
  }

 private:
  std::unique_ptr<Testing::TemporaryFolder> folder_;
};

BENCHMARK_DEFINE_F(NamesCatalogBench, FirstScan)(benchmark::State& state) {
  for (auto _ : state) {
    Impl::NamesCatalogImpl catalog;
    SearchAll(catalog);
    benchmark::DoNotOptimize(catalog.GetDocuments().data());
  }
}

BENCHMARK_REGISTER_F(NamesCatalogBench, FirstScan)
    ->Name("names catalog of 1,000, start/baseline: first scan");

BENCHMARK_DEFINE_F(NamesCatalogBench, StartFromTheSavedBlock)(benchmark::State& state) {
  BlocksInMemory blocks;
  Impl::NamesCatalogImpl first;
  SearchAll(first);
  first.SaveState(blocks);
  for (auto _ : state) {
    Impl::NamesCatalogImpl catalog;
    catalog.LoadState(blocks);
    SearchAll(catalog);
    benchmark::DoNotOptimize(catalog.GetDocuments().data());
  }
}

BENCHMARK_REGISTER_F(NamesCatalogBench, StartFromTheSavedBlock)
    ->Name("names catalog of 1,000, start/subject");

// The baseline is what a renewal must look at in any case: the date of the document.
void LookAtADate(benchmark::State& state) {
  Testing::TemporaryFolder const folder;
  File const file = folder.Write("One.midnam", DocumentText(1));
  for (auto _ : state) {
    benchmark::DoNotOptimize(file.GetModDate());
  }
}
BENCHMARK(LookAtADate)->Name("names, unchanged renewal/baseline: one file's date");

void RenewUnchangedNames(benchmark::State& state) {
  BenchHost host;
  host.AddPort("Port", SimulatedPort::Kind::kDirectMusicOut);
  host.SignIn();
  Testing::TemporaryFolder const folder;
  Destination const destination = host.Dest("Port");
  destination.SetNames(Names(Names::kMasterNames, folder.Write("One.midnam", DocumentText(1))));
  destination.CountModes();  // loads the names
  Impl::DestinationNames& names = *Impl::ImplOf(destination)->GetNames();
  for (auto _ : state) {
    benchmark::DoNotOptimize(names.Renew());
  }
}
BENCHMARK(RenewUnchangedNames)->Name("names, unchanged renewal/subject");

}  // namespace
}  // namespace Ostinet::Bench
