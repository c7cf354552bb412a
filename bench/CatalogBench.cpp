// SPDX-License-Identifier: MIT

// The catalog of device types: loading all that ships, beside bare expat over the same bytes.

#include <benchmark/benchmark.h>
#include <expat.h>

#include <vector>

#include "devicetypes/DeviceTypeCatalogImpl.h"
#include "ostinet/DeviceTypeCatalog.h"

namespace Ostinet::Bench {
namespace {

/// Notes what it is shown.
class FileList : public Impl::XMLFilesVisitor {
 public:
  void Visit(File const& file, bool) override { files.push_back(file); }
  std::vector<File> files;
};

void CountElement(void* count, char const*, char const**) { ++*static_cast<std::size_t*>(count); }

std::size_t CountElements(File const& file) {
  std::size_t count = 0;
  std::vector<unsigned char> const bytes = file.Read();
  XML_Parser const parser = XML_ParserCreate(nullptr);
  XML_SetUserData(parser, &count);
  XML_SetStartElementHandler(parser, CountElement);
  XML_Parse(parser, reinterpret_cast<char const*>(bytes.data()), static_cast<int>(bytes.size()), 1);
  XML_ParserFree(parser);
  return count;
}

void LoadTypes(benchmark::State& state) {
  std::size_t types = 0;
  for (auto _ : state) {
    types = Impl::ReadDeviceTypeFiles().size();
    benchmark::DoNotOptimize(types);
  }
  if (types == 0) {
    state.SkipWithError("no device types were found");
  }
}

// The least that meets every element: the same walk over the folders, and a handler that counts.
void WalkTypes(benchmark::State& state) {
  for (auto _ : state) {
    FileList list;
    Impl::VisitXMLFiles(list, "middev");
    std::size_t elements = 0;
    for (File const& file : list.files) {
      elements += CountElements(file);
    }
    benchmark::DoNotOptimize(elements);
  }
}

BENCHMARK(LoadTypes)->Name("device types, load/subject");
BENCHMARK(WalkTypes)->Name("device types, load/baseline: expat");

}  // namespace
}  // namespace Ostinet::Bench
