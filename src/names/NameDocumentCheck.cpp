// SPDX-License-Identifier: MIT
//
// The document is read three times: by the validator, then part by part by the reader itself with
// a log of what it passes over. So what is told about reading is what reading does.
#include <algorithm>
#include <charconv>
#include <functional>
#include <string>

#include "names/DocumentNames.h"
#include "names/NameDocumentReader.h"
#include "names/NameDocumentValidator.h"
#include "ostinet/NameDocument.h"
#include "ostinet/core/Error.h"

namespace Ostinet {

using Impl::DocumentCursor;
using Impl::NameDocumentOwner;
using Impl::NameDocumentReader;

namespace {

using namespace Impl::DocumentNames;
using Finding = NameDocumentFinding;

class Findings : public Impl::ValidationLog, public Impl::PassedOverLog {
 public:
  void Add(Finding::Kind kind, int line, std::string const& sentence) {
    Finding finding;
    finding.kind = kind;
    finding.line = line;
    finding.text = sentence;
    all_.push_back(finding);
  }

  void AddViolation(int line, std::string const& sentence) override {
    Add(Finding::kNotStandard, line, sentence);
  }
  void AddNotRead(int line, std::string const& sentence) override {
    Add(Finding::kPassedOver, line, sentence);
  }
  void Add(int line, std::string const& sentence) override {
    Add(Finding::kPassedOver, line, sentence);
  }
  void AddIf(std::function<bool()> isMissing, int line, std::string const& sentence) override {
    open_.push_back({std::move(isMissing), line, sentence});
  }

  // The part of the document that the open ones are about has been read.
  void CloseOpenOnes() {
    for (OpenFinding const& each : open_) {
      if (each.isMissing()) {
        Add(each.line, each.sentence);
      }
    }
    open_.clear();
  }

  std::vector<Finding> TakeSorted() {
    std::stable_sort(all_.begin(), all_.end(),
                     [](Finding const& a, Finding const& b) { return a.line < b.line; });
    return std::move(all_);
  }

 private:
  struct OpenFinding {
    std::function<bool()> isMissing;
    int line;
    std::string sentence;
  };

  std::vector<Finding> all_;
  std::vector<OpenFinding> open_;
};

// The children that say for whom the names are. False if no destination can fit them.
bool ReadOwner(DocumentCursor& cursor) {
  bool hasManufacturer = false;
  bool hasModel = false;
  int const line = cursor.GetParser().CurrentLine();
  std::string const element = cursor.GetParser().CurrentElement().Text();
  for (bool isDone = false; cursor.Down();) {
    int uniqueID = 0;
    if (cursor.IsAt(kManufacturer)) {
      hasManufacturer = true;
    } else if (cursor.IsAt(kModel)) {
      hasModel = true;
    } else if (cursor.IsAt(kDevice) && Impl::ReadSigned(cursor.ReadText(kUniqueID), uniqueID)) {
      isDone = true;
    } else {
      cursor.PassOver("is not read, as it stands before maker and model");
    }
    cursor.Up();
    if (isDone || (hasManufacturer && hasModel)) {
      return true;
    }
  }
  cursor.GetLog()->Add(line, element +
                                 " fits no destination: it names neither maker and model nor "
                                 "a device with a number");
  return false;
}

void ReadPart(DocumentCursor& cursor, Findings& findings) {
  NameDocumentReader reader(NameDocumentOwner(), &findings);
  reader.ReadAllPatchLists();
  UString name;
  if (cursor.IsAt(kMasterDeviceNames)) {
    if (ReadOwner(cursor)) {
      reader.ReadMasterContent(cursor);
    }
  } else if (cursor.IsAt(kExtendingDeviceNames)) {
    if (ReadOwner(cursor)) {
      reader.ReadExtendingContent(cursor);
    }
  } else if (cursor.IsAt(kStandardDeviceMode)) {
    if (cursor.ReadRequired(kName, name)) {
      reader.ReadStandardModeContent(cursor, name);
    }
  } else if (!cursor.IsAt(kAuthor)) {
    cursor.PassOver("is not read here");
  }
  findings.CloseOpenOnes();
}

void ReadParts(XMLLib::Parser& parser, Findings& findings) {
  DocumentCursor cursor(parser, &findings);
  if (!parser.DownToReqChildNounexp(kDocument)) {
    findings.Add(1, "nothing is read: the root is not MIDINameDocument");
    return;
  }
  for (; cursor.Down(); cursor.Up()) {
    ReadPart(cursor, findings);
  }
}

// The parser tells the line at the start of its text: "line 7: ...".
int LineOf(VantorError const& error) {
  constexpr std::string_view kStart = "line ";
  std::string const& text = error.Text();
  int line = 0;
  if (text.compare(0, kStart.size(), kStart) == 0) {
    std::from_chars(text.data() + kStart.size(), text.data() + text.size(), line);
  }
  return line;
}

}  // namespace

NameDocumentCheck CheckNameDocument(FileSpecification const& file) {
  NameDocumentCheck check;
  Findings findings;
  try {
    XMLLib::Parser toValidate{File(file)};
    Impl::ValidateNameDocument(toValidate, findings);
    check.isWellFormed = true;
    XMLLib::Parser toRead{File(file)};
    ReadParts(toRead, findings);
  } catch (VantorError const& error) {
    // Without a line of the document, the file itself could not be read.
    findings.Add(Finding::kMalformed, LineOf(error), error.Text());
  }
  check.findings = findings.TakeSorted();
  check.isStandard =
      check.isWellFormed &&
      std::none_of(check.findings.begin(), check.findings.end(),
                   [](Finding const& each) { return each.kind != Finding::kPassedOver; });
  return check;
}

}  // namespace Ostinet
