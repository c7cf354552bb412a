// SPDX-License-Identifier: MIT
//
// The document is read three times: by the validator, by the catalog's reader, which tells for whom
// its parts are, then part by part by the reader itself with a log of what it passes over. So what
// is told about reading is what reading does.
#include <algorithm>
#include <charconv>
#include <functional>
#include <string>

#include "names/DocumentNames.h"
#include "names/NameDocumentDigest.h"
#include "names/NameDocumentReader.h"
#include "names/NameDocumentValidator.h"
#include "ostinet/NameDocument.h"
#include "ostinet/core/Error.h"

namespace Ostinet {

using Impl::DocumentCursor;
using Impl::NameDocumentDigest;
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

bool IsSame(UString const& a, UString const& b) { return a.equal(b, UString::kLooselyEqual); }

bool HasModel(NameDocumentDigest::Master const& entry, UString const& model) {
  return std::any_of(entry.models.begin(), entry.models.end(),
                     [&](UString const& each) { return IsSame(each, model); });
}

// A destination takes the first entry that fits it. True if those before `entry` fit whatever it
// fits, as far as makers and models tell.
template <class Entry>
bool AreDevicesTaken(std::vector<Entry> const& entries, Entry const& entry) {
  auto const isTaken = [&](UString const& model) {
    return std::any_of(entries.data(), &entry, [&](Entry const& earlier) {
      return IsSame(earlier.manufacturer, entry.manufacturer) && HasModel(earlier, model);
    });
  };
  return !entry.models.empty() && std::all_of(entry.models.begin(), entry.models.end(), isTaken);
}

/// The parts of a document, each read as for a destination that it fits.
class Parts {
 public:
  Parts(XMLLib::Parser& parser, NameDocumentDigest const& digest, Findings& findings)
      : cursor_(parser, &findings), digest_(digest), findings_(findings) {}

  void Read() {
    if (!cursor_.GetParser().DownToReqChildNounexp(kDocument)) {
      findings_.Add(1, "nothing is read: the root is not MIDINameDocument");
      return;
    }
    for (; cursor_.Down(); cursor_.Up()) {
      ReadPart();
    }
  }

 private:
  void ReadPart() {
    NameDocumentReader reader(NameDocumentOwner(), &findings_);
    reader.ReadAllPatchLists();
    if (cursor_.IsAt(kMasterDeviceNames)) {
      if (IsForSomebody(digest_.masters, masters_++)) {
        reader.ReadMasterContent(cursor_);
      }
    } else if (cursor_.IsAt(kExtendingDeviceNames)) {
      if (IsForSomebody(digest_.extenders, extenders_++)) {
        reader.ReadExtendingContent(cursor_);
      }
    } else if (cursor_.IsAt(kStandardDeviceMode)) {
      ReadMode(reader);
    } else if (!cursor_.IsAt(kAuthor)) {
      cursor_.PassOver("is not read here");
    }
    findings_.CloseOpenOnes();
  }

  // If so, the cursor is behind the children that say for whom.
  template <class Entry>
  bool IsForSomebody(std::vector<Entry> const& entries, std::size_t index) {
    // The file may have changed since the digest was made.
    if (index < entries.size() && AreDevicesTaken(entries, entries[index])) {
      cursor_.PassOver("is not read, as one for its devices stands before it");
      return false;
    }
    return ReadOwner(cursor_);
  }

  // Elements of one name add up until one of them assigns name sets.
  void ReadMode(NameDocumentReader& reader) {
    UString name;
    if (!cursor_.ReadRequired(kName, name)) {
      return;
    }
    if (std::any_of(modes_.begin(), modes_.end(),
                    [&](UString const& each) { return IsSame(each, name); })) {
      cursor_.PassOver("is not read, as a mode of this name stands before it");
      return;
    }
    reader.ReadStandardModeContent(cursor_, name);
    if (reader.tree.modes.front()->HasNameSets()) {
      modes_.push_back(name);
    }
  }

  DocumentCursor cursor_;
  NameDocumentDigest const& digest_;
  Findings& findings_;
  std::size_t masters_ = 0;  // how many there were
  std::size_t extenders_ = 0;
  std::vector<UString> modes_;  // with name sets
};

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
    NameDocumentDigest digest;
    digest.file = file;
    Impl::ParseDigest(digest);
    XMLLib::Parser toRead{File(file)};
    Parts(toRead, digest, findings).Read();
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
