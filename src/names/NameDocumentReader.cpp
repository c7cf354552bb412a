// SPDX-License-Identifier: MIT
//
// Whether a reference to a list or its definition comes first in the document makes no difference:
// whoever comes first makes the object, and the definition fills it while it is empty. Banks wait
// for their patches until the end, when Resolve hands them out.
#include "names/NameDocumentReader.h"

#include <algorithm>

#include "model/DestinationImpl.h"
#include "model/PropertyKeys.h"
#include "names/DocumentNames.h"
#include "names/NamedLists.h"
#include "ostinet/core/Error.h"

namespace Ostinet::Impl {

using namespace DocumentNames;

namespace {

constexpr char kSecondDefinition[] = "is not read, as a list of this name stands before it";

// Reads a document from a file. What is wrong with it ends the reading and goes no further.
template <class Read>
bool ReadFile(FileSpecification const& file, Read const& read) {
  try {
    XMLLib::Parser parser(File(file), XMLLib::Parser::kDoNotValidate);
    read(parser);
    return true;
  } catch (VantorError const&) {
    return false;
  }
}

}  // namespace

NameDocumentOwner::NameDocumentOwner(DestinationImpl& of)
    : manufacturer(of.GetString(Keys::kManufacturer)),
      model(of.GetString(Keys::kModel)),
      uniqueID(of.GetInt(Keys::kUniqueID, 0)),
      destination(&of) {}

NameDocumentReader::NameDocumentReader(NameDocumentOwner owner, PassedOverLog* log)
    : owner_(std::move(owner)), log_(log) {}

void NameDocumentReader::ReadMaster(XMLLib::Parser& parser) {
  DocumentCursor cursor(parser, log_);
  if (!parser.DownToReqChildNounexp(kDocument)) {
    return;
  }
  for (; parser.DownToChildNounexp(kMasterDeviceNames); cursor.Up()) {
    if (Matches(cursor)) {
      ReadMasterContent(cursor);
      return;
    }
  }
}

void NameDocumentReader::ReadExtending(XMLLib::Parser& parser,
                                       std::vector<BankRequest> const& requests) {
  for (auto const& [bank, listName] : requests) {
    auto const list = DemandByName(patchLists_, listName,
                                   [&name = listName] { return new PatchNameListData(name); });
    list->banks.push_back(bank);
  }
  parser.CollectProcessingInstructions(true);
  DocumentCursor cursor(parser, log_);
  if (parser.DownToReqChildNounexp(kDocument)) {
    for (; parser.DownToChildNounexp(kExtendingDeviceNames); cursor.Up()) {
      if (Matches(cursor)) {
        ReadExtendingContent(cursor);
        break;
      }
    }
  }
  ReadTemporaryMark(parser);
}

void NameDocumentReader::ReadStandardMode(XMLLib::Parser& parser, UString const& modeName) {
  RCPtrMT<DestModeImpl> const mode(new DestModeImpl(owner_.destination, modeName, true));
  tree.modes.push_back(mode);
  DocumentCursor cursor(parser, log_);
  if (!parser.DownToReqChildNounexp(kDocument)) {
    return;
  }
  for (; parser.DownToChildNounexp(kStandardDeviceMode); cursor.Up()) {
    UString name;
    if (cursor.ReadRequired(kName, name) && !mode->HasNameSets() &&
        modeName.equal(name, UString::kLooselyEqual)) {
      ReadModeContent(cursor, *mode);
    }
  }
}

void NameDocumentReader::Resolve() {
  for (RCPtrMT<PatchNameListData> const& list : patchLists_) {
    list->Attach(isTemporary, uses);
  }
}

bool NameDocumentReader::LoadMaster(FileSpecification const& file) {
  bool const isWhole = ReadFile(file, [this](XMLLib::Parser& parser) { ReadMaster(parser); });
  Resolve();
  return isWhole;
}

bool NameDocumentReader::LoadExtending(FileSpecification const& file,
                                       std::vector<BankRequest> const& requests) {
  bool const isWhole =
      ReadFile(file, [&](XMLLib::Parser& parser) { ReadExtending(parser, requests); });
  Resolve();
  return isWhole;
}

bool NameDocumentReader::LoadStandardMode(FileSpecification const& file, UString const& modeName) {
  bool const isWhole =
      ReadFile(file, [&](XMLLib::Parser& parser) { ReadStandardMode(parser, modeName); });
  Resolve();
  return isWhole;
}

// Goes through the children of a device element until they say that it is this owner's. These
// children are behind the cursor then; so are those that stood between them.
bool NameDocumentReader::Matches(DocumentCursor& cursor) const {
  bool isManufacturer = false;
  bool isModel = false;
  for (bool matches = false; cursor.Down();) {
    XMLLib::Parser& parser = cursor.GetParser();
    if (cursor.IsAt(kManufacturer)) {
      isManufacturer =
          isManufacturer || parser.ReadText().equal(owner_.manufacturer, UString::kLooselyEqual);
    } else if (cursor.IsAt(kModel)) {
      isModel = isModel || parser.ReadText().equal(owner_.model, UString::kLooselyEqual);
    } else if (cursor.IsAt(kDevice)) {
      int uniqueID = 0;
      matches = ReadSigned(cursor.ReadText(kUniqueID), uniqueID) && uniqueID == owner_.uniqueID;
    }
    matches = matches || (isManufacturer && isModel);
    cursor.Up();
    if (matches) {
      return true;
    }
  }
  return false;
}

void NameDocumentReader::ReadMasterContent(DocumentCursor& cursor) {
  for (; cursor.Down(); cursor.Up()) {
    UString name;
    if (cursor.IsAt(kCustomDeviceMode)) {
      if (cursor.ReadRequired(kName, name)) {
        RCPtrMT<DestModeImpl> const mode(new DestModeImpl(owner_.destination, name, false));
        tree.modes.push_back(mode);
        ReadModeContent(cursor, *mode);
      }
    } else if (cursor.IsAt(kSupportsStandardDeviceMode)) {
      if (cursor.ReadRequired(kName, name)) {
        standardModeNames.push_back(name);
      }
    } else if (cursor.IsAt(kChannelNameSet)) {
      ReadNameSet(cursor);
    } else if (!cursor.IsAt(kModel)) {
      ReadDeviceList(cursor);
    }
  }
}

void NameDocumentReader::ReadExtendingContent(DocumentCursor& cursor) {
  for (; cursor.Down(); cursor.Up()) {
    if (cursor.IsAt(kPatchNameList)) {
      ReadExtendingPatchList(cursor);
    } else if (!cursor.IsAt(kModel)) {
      ReadDeviceList(cursor);
    }
  }
}

void NameDocumentReader::ReadStandardModeContent(DocumentCursor& cursor, UString const& modeName) {
  RCPtrMT<DestModeImpl> const mode(new DestModeImpl(owner_.destination, modeName, true));
  tree.modes.push_back(mode);
  ReadModeContent(cursor, *mode);
}

void NameDocumentReader::ReadTemporaryMark(XMLLib::Parser& parser) {
  UString target;
  UString data;
  while (!isTemporary && parser.GetProcessingInstruction(target, data)) {
    isTemporary = target.starts_with(kMarkTargetStart) && data == kMarkData;
  }
}

void NameDocumentReader::ReadDeviceList(DocumentCursor& cursor) {
  UString name;
  if (cursor.IsAt(kPatchNameList)) {
    ReadPatchListDefinition(cursor);
  } else if (cursor.IsAt(kNoteNameList)) {
    if (cursor.ReadRequired(kName, name)) {
      auto const list =
          DemandByName(noteLists_, name, [&] { return new NoteNameData(name, true); });
      list->notes.empty() ? ReadNotes(cursor, *list) : cursor.PassOver(kSecondDefinition);
    }
  } else if (cursor.IsAt(kControlNameList)) {
    if (cursor.ReadRequired(kName, name)) {
      auto const list =
          DemandByName(controlLists_, name, [&] { return new ControlNameData(name, true); });
      list->controls.empty() ? ReadControls(cursor, *list) : cursor.PassOver(kSecondDefinition);
    }
  } else if (cursor.IsAt(kValueNameList)) {
    if (cursor.ReadRequired(kName, name)) {
      auto const list =
          DemandByName(valueLists_, name, [&] { return new ValueListImpl(name, true); });
      list->GetValues().empty() ? ReadValues(cursor, *list) : cursor.PassOver(kSecondDefinition);
    }
  } else {
    cursor.PassOver("is not read here");
  }
}

void NameDocumentReader::ReadPatchListDefinition(DocumentCursor& cursor) {
  UString name;
  if (!cursor.ReadRequired(kName, name)) {
    return;
  }
  auto const list = DemandByName(patchLists_, name, [&] { return new PatchNameListData(name); });
  list->patches.empty() ? ReadPatches(cursor, *list) : cursor.PassOver(kSecondDefinition);
}

// A list that no bank asked for is not read.
void NameDocumentReader::ReadExtendingPatchList(DocumentCursor& cursor) {
  if (readAllPatchLists_) {
    ReadPatchListDefinition(cursor);
    return;
  }
  UString name;
  if (!cursor.ReadRequired(kName, name)) {
    return;
  }
  PatchNameListData* const list = FindByName(patchLists_, name);
  if (list != nullptr && list->patches.empty()) {
    ReadPatches(cursor, *list);
  }
}

}  // namespace Ostinet::Impl
