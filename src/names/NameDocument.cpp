// SPDX-License-Identifier: MIT
#include "ostinet/NameDocument.h"

#include "names/DocumentNames.h"
#include "names/NameDocumentReader.h"
#include "names/NameHandles.h"
#include "ostinet/core/Error.h"

namespace Ostinet {

using Impl::NameDocumentOwner;
using Impl::NameDocumentReader;

namespace {

using namespace Impl::DocumentNames;

// The first device of the first master, as far as it is named.
NameDocumentOwner FirstOwner(XMLLib::Parser& parser) {
  NameDocumentOwner owner;
  bool hasManufacturer = false;
  bool hasModel = false;
  if (!parser.DownToReqChildNounexp(kDocument) || !parser.DownToChildNounexp(kMasterDeviceNames)) {
    return owner;
  }
  for (; !(hasManufacturer && hasModel) && parser.DownToChild(); parser.UpToParent()) {
    if (parser.CurrentElement() == kManufacturer && !hasManufacturer) {
      hasManufacturer = true;
      owner.manufacturer = parser.ReadText();
    } else if (parser.CurrentElement() == kModel && !hasModel) {
      hasModel = true;
      owner.model = parser.ReadText();
    } else if (parser.CurrentElement() == kDevice) {
      UString uniqueID;
      parser.ReadAttribute(kUniqueID, uniqueID);
      if (Impl::ReadSigned(uniqueID, owner.uniqueID)) {
        return owner;
      }
    }
  }
  return owner;
}

NameDocumentOwner FirstOwner(FileSpecification const& file) {
  try {
    XMLLib::Parser parser{File(file)};
    return FirstOwner(parser);
  } catch (VantorError const&) {
    return {};
  }
}

}  // namespace

class NameDocument::Contents {
 public:
  explicit Contents(FileSpecification const& file) {
    NameDocumentReader reader(FirstOwner(file));
    isWhole = reader.LoadMaster(file);
    Impl::AssignLists(reader.tree, reader.uses);
    tree.Append(std::move(reader.tree));
    standardModeNames = std::move(reader.standardModeNames);
  }

  bool isWhole = false;
  Impl::NameTree tree;
  std::vector<UString> standardModeNames;
};

NameDocument::NameDocument(FileSpecification const& file) : contents_(new Contents(file)) {}
NameDocument::~NameDocument() = default;

bool NameDocument::IsWhole() const { return contents_->isWhole; }

int NameDocument::CountModes() const { return static_cast<int>(contents_->tree.modes.size()); }

DestinationMode NameDocument::GetMode(int index) const {
  return Impl::HandleAt<DestinationMode>(contents_->tree.modes, index);
}

int NameDocument::CountSupportedStandardModes() const {
  return static_cast<int>(contents_->standardModeNames.size());
}

UString NameDocument::GetSupportedStandardMode(int index) const {
  auto const& names = contents_->standardModeNames;
  bool const isThere = index >= 0 && static_cast<std::size_t>(index) < names.size();
  return isThere ? names[static_cast<std::size_t>(index)] : UString();
}

int NameDocument::CountNameSets() const {
  return static_cast<int>(contents_->tree.nameSets.size());
}

DestinationNameSet NameDocument::GetNameSet(int index) const {
  return Impl::HandleAt<DestinationNameSet>(contents_->tree.nameSets, index);
}

UString NameDocument::GetListName(PatchBank const& bank) {
  Impl::PatchBankImpl const* const impl = Impl::ImplOf(bank);
  return impl != nullptr ? impl->GetListName() : UString();
}

DefaultNoteNameList NameDocument::GetDefaultNotes(DestinationNameSet const& nameSet) {
  return DefaultNoteNameList(RCPtrMT<Impl::DestNameSetImpl>(Impl::ImplOf(nameSet)));
}

bool NameDocument::HasControls(ControlListBase const& list) {
  Impl::ObjectImpl const* const impl = Impl::ImplOf(static_cast<Object const&>(list));
  if (auto const* const patch = dynamic_cast<Impl::PatchImpl const*>(impl)) {
    return patch->GetControls().get() != nullptr;
  }
  auto const* const nameSet = dynamic_cast<Impl::DestNameSetImpl const*>(impl);
  return nameSet != nullptr && nameSet->GetDefaultControls().get() != nullptr;
}

DefaultControlList NameDocument::GetDefaultControls(DestinationNameSet const& nameSet) {
  return DefaultControlList(RCPtrMT<Impl::DestNameSetImpl>(Impl::ImplOf(nameSet)));
}

}  // namespace Ostinet
