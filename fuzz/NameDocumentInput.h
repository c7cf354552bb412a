// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

#include "names/NameDocumentReader.h"
#include "names/NameDocumentValidator.h"
#include "ostinet/core/Error.h"

namespace Ostinet::Fuzz {

/// Hears all and keeps the count.
class CountingLog : public Impl::PassedOverLog, public Impl::ValidationLog {
 public:
  void Add(int, std::string const&) override { ++count; }
  void AddIf(std::function<bool()> isMissing, int, std::string const&) override {
    open.push_back(std::move(isMissing));
  }
  void AddViolation(int, std::string const&) override { ++count; }
  void AddNotRead(int, std::string const&) override { ++count; }

  std::size_t count = 0;
  std::vector<std::function<bool()>> open;
};

/// Whether what was read holds together.
inline bool IsWhole(Impl::NameDocumentReader& reader) {
  Impl::AssignLists(reader.tree, reader.uses);
  bool ok = true;
  for (auto const& nameSet : reader.tree.nameSets) {
    for (auto const& bank : nameSet->GetBanks()) {
      ok = ok && bank->GetNameSet() == nameSet.get();
      for (auto const& patch : bank->GetPatches()) {
        ok = ok && patch->GetBank() == bank.get();
        DataBuffer buffer;
        patch->Commands().GenerateCommands(buffer, TimeStamp(), 3, 16);
        auto const notes = patch->GetNoteNames();
        for (std::size_t i = 0; notes && i < notes->GetNotes().size(); ++i) {
          ok = ok && notes->GetNotes()[i].pitch < 128;
        }
      }
    }
  }
  for (auto const& mode : reader.tree.modes) {
    DataBuffer buffer;
    mode->EnableCommands().GenerateCommands(buffer, TimeStamp(), 0, 126);
    mode->DisableCommands().GenerateCommands(buffer, TimeStamp(), 0, 126);
  }
  return ok;
}

template <class Read>
bool TryRead(std::uint8_t const* bytes, std::size_t count, Impl::PassedOverLog* log, Read read) {
  Impl::NameDocumentOwner owner;
  owner.manufacturer = "Maker";
  owner.model = "Model";
  owner.uniqueID = 7;
  Impl::NameDocumentReader reader(owner, log);
  try {
    XMLLib::Parser parser(bytes, count);
    read(reader, parser);
  } catch (VantorError const&) {
  }
  reader.Resolve();
  return IsWhole(reader);
}

/// Reads a document of these bytes in every way. True if what came of it holds together.
inline bool TryNameDocument(std::uint8_t const* bytes, std::size_t count) {
  using Reader = Impl::NameDocumentReader;
  CountingLog log;
  RCPtrMT<Impl::PatchBankImpl> const bank(new Impl::PatchBankImpl("Bank"));
  bool ok = TryRead(bytes, count, nullptr,
                    [](Reader& reader, XMLLib::Parser& parser) { reader.ReadMaster(parser); });
  ok = TryRead(bytes, count, &log,
               [](Reader& reader, XMLLib::Parser& parser) { reader.ReadMaster(parser); }) &&
       ok;
  ok = TryRead(bytes, count, nullptr,
               [&](Reader& reader, XMLLib::Parser& parser) {
                 reader.ReadExtending(parser, {{bank, UString("List")}});
               }) &&
       ok;
  ok = TryRead(bytes, count, nullptr,
               [](Reader& reader, XMLLib::Parser& parser) {
                 reader.ReadStandardMode(parser, "Mode");
               }) &&
       ok;
  for (auto const& isMissing : log.open) {
    log.count += isMissing() ? 1U : 0U;
  }
  try {
    XMLLib::Parser parser(bytes, count);
    Impl::ValidateNameDocument(parser, log);
  } catch (VantorError const&) {
  }
  return ok;
}

}  // namespace Ostinet::Fuzz
