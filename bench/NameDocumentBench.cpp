// SPDX-License-Identifier: MIT

// Name documents: each read into a tree of names, with its lists merged, beside bare expat with
// handlers that do nothing over the same bytes. The documents are those of OSTINET_NAME_CORPUS, or
// where there are none, those that ship.

#include <benchmark/benchmark.h>
#include <expat.h>

#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>
#include <vector>

#include "names/DocumentNames.h"
#include "names/NameDocumentReader.h"
#include "ostinet/core/Error.h"

namespace Ostinet::Bench {
namespace {

struct Document {
  std::string text;
  Impl::NameDocumentOwner owner;  // the first maker and model
};

Impl::NameDocumentOwner OwnerOf(std::string const& text) {
  using namespace Impl::DocumentNames;
  Impl::NameDocumentOwner owner;
  XMLLib::Parser parser(text.data(), text.size());
  if (parser.DownToChild(kDocument) && parser.DownToChild(kMasterDeviceNames)) {
    if (parser.DownToChild(kManufacturer)) {
      owner.manufacturer = parser.ReadText();
      parser.UpToParent();
    }
    if (parser.DownToChild(kModel)) {
      owner.model = parser.ReadText();
    }
  }
  return owner;
}

std::vector<Document> ReadFolder(std::filesystem::path const& folder) {
  std::vector<Document> documents;
  std::error_code error;
  for (auto const& entry : std::filesystem::directory_iterator(folder, error)) {
    if (entry.path().extension() == ".midnam") {
      std::ifstream stream(entry.path(), std::ios::binary);
      Document document;
      document.text.assign(std::istreambuf_iterator<char>(stream), {});
      document.owner = OwnerOf(document.text);
      documents.push_back(document);
    }
  }
  return documents;
}

std::vector<Document> const& Documents() {
  static std::vector<Document> const sDocuments = [] {
    auto documents = ReadFolder(OSTINET_NAME_CORPUS);
    return documents.empty() ? ReadFolder(OSTINET_SHIPPED_NAMES) : documents;
  }();
  return sDocuments;
}

void CountItems(benchmark::State& state) {
  state.SetItemsProcessed(state.iterations() * static_cast<std::int64_t>(Documents().size()));
}

void ReadDocuments(benchmark::State& state) {
  std::size_t nameSets = 0;
  for (auto _ : state) {
    for (Document const& document : Documents()) {
      XMLLib::Parser parser(document.text.data(), document.text.size());
      Impl::NameDocumentReader reader(document.owner);
      reader.ReadMaster(parser);
      reader.Resolve();
      Impl::AssignLists(reader.tree, reader.uses);
      nameSets += reader.tree.nameSets.size();
    }
  }
  benchmark::DoNotOptimize(nameSets);
  CountItems(state);
}

void ParseDocuments(benchmark::State& state) {
  for (auto _ : state) {
    for (Document const& document : Documents()) {
      XML_Parser const parser = XML_ParserCreate(nullptr);
      XML_SetElementHandler(
          parser, [](void*, XML_Char const*, XML_Char const**) {}, [](void*, XML_Char const*) {});
      XML_SetCharacterDataHandler(parser, [](void*, XML_Char const*, int) {});
      if (XML_Parse(parser, document.text.data(), static_cast<int>(document.text.size()), 1) !=
          XML_STATUS_OK) {
        state.SkipWithError("a document is malformed");
      }
      XML_ParserFree(parser);
    }
  }
  CountItems(state);
}

BENCHMARK(ReadDocuments)->Name("names, a document read/subject");
BENCHMARK(ParseDocuments)->Name("names, a document read/baseline: bare expat");

}  // namespace
}  // namespace Ostinet::Bench
