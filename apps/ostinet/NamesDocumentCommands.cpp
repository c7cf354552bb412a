// SPDX-License-Identifier: MIT
//
// `names show` and `names check`: what can be told of name documents without a studio.
#include <CLI/CLI.hpp>
#include <algorithm>
#include <memory>

#include "Errors.h"
#include "NameDocumentText.h"
#include "NamesCommand.h"
#include "Output.h"

namespace Ostinet::Tool {
namespace {

using Paths = std::vector<std::string>;

void PrintLines(std::vector<std::string> const& lines) {
  for (std::string const& line : lines) {
    PrintLine(line);
  }
}

FileSpecification FileOf(std::string const& path) {
  FileSpecification const file{UString(path)};
  if (!file.IsFile()) {
    throw Failure("there is no file \"" + path + "\"");
  }
  return file;
}

void ShowDocument(bool asJSON, std::string const& path) {
  NameDocument const document(FileOf(path));
  if (asJSON) {
    PrintLine(NameDocumentJSON(document));
  } else {
    PrintLines(NameDocumentLines(document));
  }
  if (!document.IsWhole()) {
    throw Failure("the document is broken, and only what stands before the fault was read");
  }
}

void Check(bool asJSON, Paths const& paths) {
  std::vector<CheckedNameDocument> files;
  for (std::string const& path : paths) {
    files.push_back({path, CheckNameDocument(FileSpecification(UString(path)))});
  }
  if (asJSON) {
    PrintLine(NameChecksJSON(files));
  } else {
    for (CheckedNameDocument const& file : files) {
      PrintLines(NameCheckLines(file));
    }
  }
  bool const isClean = std::all_of(files.begin(), files.end(), [](CheckedNameDocument const& file) {
    return file.check.findings.empty();
  });
  if (!isClean) {
    throw Failure("not all is as the standard wants it, or would be read");
  }
}

}  // namespace

void AddNamesShow(CLI::App& names, CommandLine& line) {
  auto const path = std::make_shared<std::string>();
  CLI::App* const command =
      names.add_subcommand("show", "Show what a name document holds for its first maker and model");
  command->add_option("file", *path, "The name document")->type_name("FILE")->required();
  command->callback(
      [&line, path] { line.run = [&line, path] { ShowDocument(line.options.json, *path); }; });
}

void AddNamesCheck(CLI::App& names, CommandLine& line) {
  auto const paths = std::make_shared<Paths>();
  CLI::App* const command = names.add_subcommand(
      "check", "Tell whether name documents are as the standard wants them, and what is not read");
  command->add_option("files", *paths, "The name documents")->type_name("FILE")->required();
  command->callback(
      [&line, paths] { line.run = [&line, paths] { Check(line.options.json, *paths); }; });
}

}  // namespace Ostinet::Tool
