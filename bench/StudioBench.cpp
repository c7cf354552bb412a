// SPDX-License-Identifier: MIT

// The studio as it is kept: loading and saving a setup file of a thousand devices beside bare expat
// over the same bytes, working connections out, and a sorted list.

#include <benchmark/benchmark.h>
#include <expat.h>

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <string>

#include "BenchHost.h"
#include "CacheFiller.h"
#include "platform/SetupFile.h"

namespace Ostinet::Bench {
namespace {

namespace fs = std::filesystem;

/// Files in a folder of its own; no blocks.
class BenchPrefs : public PrefsHandler {
 public:
  explicit BenchPrefs(std::string const& name)
      : folder(fs::temp_directory_path() / ("ostinet-bench-" + name)) {
    fs::remove_all(folder);
    fs::create_directories(folder);
  }
  ~BenchPrefs() {
    std::error_code ignored;
    fs::remove_all(folder, ignored);
  }
  void Save(int, std::vector<unsigned char> const&) override {}
  void Load(int, std::vector<unsigned char>& bytes) override { bytes.clear(); }
  void GetFolder(Folder& out) override {
    out = Folder(FileSpecification(UString(folder.u16string())));
  }
  std::string Content() const {
    std::ifstream stream(folder / "Ostinet.xml", std::ios::binary);
    return {std::istreambuf_iterator<char>(stream), std::istreambuf_iterator<char>()};
  }

  fs::path folder;
};

UString Numbered(char const* name, int number) {
  return UString((name + std::to_string(number)).c_str());
}

/// A host that keeps its studio in a folder.
class KeepingHost : public BenchHost {
 public:
  KeepingHost() : prefs("settings") {}
  ~KeepingHost() { SignOut(); }

  void SignIn() { setup.SignIn(UString("Bench"), &receiver, &prefs); }
  void SignOut() { setup.SignOut(false); }

  /// As users have them: a maker, a model, a few words about each, an input and an output.
  void MakeDevices(int count) {
    for (int i = 0; i < count; ++i) {
      Device const device = setup.CreateDevice(Numbered("Synthesizer ", i));
      device.SetManufacturer(Numbered("Maker ", i / 40));
      device.SetModel(Numbered("Model ", i / 4));
      device.SetReceivesClock(true);
      device.SetSysexDeviceID(static_cast<char>(i % 128));
      device.SetChannelName(0, UString("Lead"));
      device.SetChannelName(9, UString("Drums"));
    }
  }

  BenchPrefs prefs;
};

constexpr int kDevices = 1000;

void LoadSetup(benchmark::State& state) {
  KeepingHost host;
  host.SignIn();
  host.MakeDevices(kDevices);
  Impl::SaveSetupFile(host.setup);
  host.SignOut();
  fs::path const file = host.prefs.folder / "Ostinet.xml";
  fs::path const aside = host.prefs.folder / "aside.xml";
  for (auto _ : state) {
    state.PauseTiming();
    fs::rename(file, aside);  // so that signing in loads nothing
    host.SignIn();
    fs::rename(aside, file);
    state.ResumeTiming();
    Impl::LoadSetupFile(host.setup);
    state.PauseTiming();
    if (host.setup.CountDevices() != kDevices) {
      state.SkipWithError("not all devices were loaded");
    }
    host.SignOut();
    state.ResumeTiming();
  }
}
BENCHMARK(LoadSetup)->Name("setup file, load/subject")->Unit(benchmark::kMillisecond);

void SaveSetup(benchmark::State& state) {
  KeepingHost host;
  host.SignIn();
  host.MakeDevices(kDevices);
  for (auto _ : state) {
    Impl::SaveSetupFile(host.setup);
  }
}
BENCHMARK(SaveSetup)->Name("setup file, save/subject")->Unit(benchmark::kMillisecond);

// The handlers look at what they are given and keep nothing.
struct Seen {
  std::size_t elements = 0;
  std::size_t letters = 0;
};

void XMLCALL OnStart(void* user, XML_Char const*, XML_Char const** attributes) {
  auto& seen = *static_cast<Seen*>(user);
  ++seen.elements;
  for (; *attributes != nullptr; attributes += 2) {
    ++seen.letters;
  }
}
void XMLCALL OnEnd(void*, XML_Char const*) {}
void XMLCALL OnText(void* user, XML_Char const*, int length) {
  static_cast<Seen*>(user)->letters += static_cast<std::size_t>(length);
}

void BareExpat(benchmark::State& state) {
  KeepingHost host;
  host.SignIn();
  host.MakeDevices(kDevices);
  Impl::SaveSetupFile(host.setup);
  std::string const bytes = host.prefs.Content();
  Seen seen;
  for (auto _ : state) {
    XML_Parser const parser = XML_ParserCreate(nullptr);
    XML_SetUserData(parser, &seen);
    XML_SetElementHandler(parser, OnStart, OnEnd);
    XML_SetCharacterDataHandler(parser, OnText);
    if (XML_Parse(parser, bytes.data(), static_cast<int>(bytes.size()), 1) != XML_STATUS_OK) {
      state.SkipWithError("the file was not read");
    }
    XML_ParserFree(parser);
  }
  benchmark::DoNotOptimize(seen);
}
BENCHMARK(BareExpat)
    ->Name("setup file, load/baseline: expat over the same bytes")
    ->Unit(benchmark::kMillisecond);
BENCHMARK(BareExpat)
    ->Name("setup file, save/against: expat reading the same bytes")
    ->Unit(benchmark::kMillisecond);

// Half of them are ports that are offline, half instruments of which each hangs on one.
std::string ConnectedStudio(int endpoints) {
  std::string text = "<Ostinet>";
  int const half = endpoints / 2;
  for (int i = 0; i < half; ++i) {
    std::string const instrument = std::to_string(100000 + (i * 7919) % half);
    text +=
        "<Destination direct=\"true\" software=\"false\"><Properties><String key=\"name\">Port " +
        std::to_string(i) + "</String><Int key=\"uniqueID\">" + std::to_string(i + 1) +
        "</Int><IntList key=\"connUniqueID\"><IntItem>" + instrument +
        "</IntItem></IntList></Properties></Destination>";
  }
  text += "<Device direct=\"false\"><Properties/><Entity direct=\"false\"><Properties/>";
  for (int i = 0; i < half; ++i) {
    text += "<Destination direct=\"false\" software=\"false\"><Properties><Int key=\"uniqueID\">" +
            std::to_string(100000 + i) + "</Int></Properties></Destination>";
  }
  return text + "</Entity></Device></Ostinet>";
}

// A poll that was told of a change works the connections out, and does next to nothing else.
// Studios change seldom, so the caches hold other things.
void Connections(benchmark::State& state) {
  KeepingHost host;
  std::ofstream(host.prefs.folder / "Ostinet.xml")
      << ConnectedStudio(static_cast<int>(state.range(0)));
  host.SignIn();
  host.setup.PollSetupChanges();
  if (host.setup.GetDestination(0).CountConnectedDestinations() != 1) {
    state.SkipWithError("nothing is connected");
  }
  CacheFiller filler;
  for (auto _ : state) {
    state.PauseTiming();
    host.setup.MarkChanged();
    filler.Fill();
    state.ResumeTiming();
    host.setup.PollSetupChanges();
  }
}
BENCHMARK(Connections)
    ->Name("connections/ports")
    ->Arg(1000)
    ->Arg(10000)
    ->Unit(benchmark::kMillisecond);

void FillWithEndpoints(KeepingHost& host) {
  host.SignIn();
  host.MakeDevices(kDevices);
  if (host.setup.CountDestinations() != kDevices) {
    std::abort();
  }
}

void FilterAndSort(benchmark::State& state) {
  KeepingHost host;
  FillWithEndpoints(host);
  ObjectFilter<Endpoint> const filter = PublicEndpoint() & !SoftwareEndpoint();
  for (auto _ : state) {
    DestinationList list(filter);
    list.Sort(DestinationList::sDefaultSortFilters);
    benchmark::DoNotOptimize(list.data());
  }
}
BENCHMARK(FilterAndSort)
    ->Name("filter and sort, 1,000 endpoints/subject")
    ->Unit(benchmark::kMillisecond);

// The names alone, made once each.
void SortNames(benchmark::State& state) {
  KeepingHost host;
  FillWithEndpoints(host);
  for (auto _ : state) {
    std::vector<UString> names;
    for (int i = 0; i < host.setup.CountDestinations(); ++i) {
      names.push_back(host.setup.GetDestination(i).GetName());
    }
    std::sort(names.begin(), names.end(),
              [](UString const& a, UString const& b) { return a.less(b, UString::kIgnoreCase); });
    benchmark::DoNotOptimize(names.data());
  }
}
BENCHMARK(SortNames)
    ->Name("filter and sort, 1,000 endpoints/against: sorting as many names")
    ->Unit(benchmark::kMillisecond);

}  // namespace
}  // namespace Ostinet::Bench
