// SPDX-License-Identifier: MIT
#pragma once

#include <memory>
#include <string>
#include <vector>

#include "names/NameDocumentReader.h"
#include "ostinet/core/Error.h"
#include "support/Printers.h"

namespace Ostinet::Testing {

/// For whom the tests' documents are: "Maker", "Model", number 7.
inline Impl::NameDocumentOwner TestOwner() {
  Impl::NameDocumentOwner owner;
  owner.manufacturer = "Maker";
  owner.model = "Model";
  owner.uniqueID = 7;
  return owner;
}

/// A document of this content below the root.
inline std::string DocumentText(std::string const& content) {
  return "<?xml version='1.0'?>\n<MIDINameDocument><Author>A</Author>" + content +
         "</MIDINameDocument>";
}

/// A master for the owner of the tests.
inline std::string MasterText(std::string const& content) {
  return DocumentText("<MasterDeviceNames><Manufacturer>Maker</Manufacturer><Model>Model</Model>" +
                      content + "</MasterDeviceNames>");
}

/// One name set with one bank, "Bank", that has the list with these patches inline.
inline std::string PatchesText(std::string const& patches) {
  return MasterText("<ChannelNameSet Name='Set'><PatchBank Name='Bank'><PatchNameList>" + patches +
                    "</PatchNameList></PatchBank></ChannelNameSet>");
}

using Reader = std::unique_ptr<Impl::NameDocumentReader>;

/// What was read before a fault stands, as for destinations.
template <class Read>
Reader ReadText(std::string const& text, Read read,
                Impl::NameDocumentOwner const& owner = TestOwner()) {
  Reader reader = std::make_unique<Impl::NameDocumentReader>(owner);
  try {
    XMLLib::Parser parser(text.data(), text.size());
    read(*reader, parser);
  } catch (VantorError const&) {
  }
  reader->Resolve();
  return reader;
}

inline Reader ReadMaster(std::string const& text,
                         Impl::NameDocumentOwner const& owner = TestOwner()) {
  return ReadText(
      text,
      [](Impl::NameDocumentReader& reader, XMLLib::Parser& parser) { reader.ReadMaster(parser); },
      owner);
}

inline Reader ReadStandardMode(std::string const& text, char const* name) {
  return ReadText(text, [&](Impl::NameDocumentReader& reader, XMLLib::Parser& parser) {
    reader.ReadStandardMode(parser, name);
  });
}

inline Impl::PatchBankImpl& BankOf(Reader const& reader, std::size_t nameSet = 0,
                                   std::size_t bank = 0) {
  return *reader->tree.nameSets.at(nameSet)->GetBanks().at(bank);
}

/// The names of a bank's patches, with ";" behind each.
inline std::string PatchNames(Impl::PatchBankImpl const& bank) {
  std::string names;
  for (auto const& patch : bank.GetPatches()) {
    names += patch->GetName().string() + ";";
  }
  return names;
}

/// "B0 00 05;C0 07;": what a list sends on channel 1 to device 16.
inline std::string Messages(Impl::MIDICommandList const& commands) {
  DataBuffer buffer;
  commands.GenerateCommands(buffer, TimeStamp(), 0, 16);
  std::string text;
  for (std::size_t i = 0; i < buffer.size(); ++i) {
    for (unsigned long long k = 0; k < buffer[i].length; ++k) {
      char digits[4];
      std::snprintf(digits, sizeof digits, k == 0 ? "%02X" : " %02X", buffer[i].data[k]);
      text += digits;
    }
    text += ";";
  }
  return text;
}

}  // namespace Ostinet::Testing
