// SPDX-License-Identifier: MIT
#include "names/DocumentCursor.h"

#include "names/DocumentNames.h"

namespace Ostinet::Impl {

bool DocumentCursor::Down(XMLLib::Name const& name) {
  if (log_ == nullptr) {
    return parser_.DownToChild(name);
  }
  for (; parser_.DownToChild(); parser_.UpToParent()) {
    if (IsAt(name)) {
      return true;
    }
    PassOver("is not read here");
  }
  return false;
}

bool DocumentCursor::ReadRequired(XMLLib::Name const& name, UString& value) const {
  bool const isThere = parser_.ReadReqAttribute(name, value);
  if (!isThere && log_ != nullptr) {
    NoteUnreadable(name);
  }
  return isThere;
}

bool DocumentCursor::ReadRequired(XMLLib::Name const& name, unsigned min, unsigned max,
                                  unsigned& value) const {
  UString text;
  unsigned number = 0;
  parser_.ReadReqAttribute(name, text);
  if (!ReadUnsigned(text, max, number) || number < min) {
    if (log_ != nullptr) {
      NoteUnreadable(name);
    }
    return false;
  }
  value = number;
  return true;
}

bool DocumentCursor::ReadRequired(XMLLib::Name const& name, double& value) const {
  UString text;
  parser_.ReadReqAttribute(name, text);
  bool const isNumber = ReadDouble(text, value);
  if (!isNumber && log_ != nullptr) {
    NoteUnreadable(name);
  }
  return isNumber;
}

bool DocumentCursor::ReadOptional(XMLLib::Name const& name, unsigned max, unsigned& value) const {
  UString text;
  bool const isRead = parser_.ReadAttribute(name, text) && ReadUnsigned(text, max, value);
  if (!isRead && log_ != nullptr) {
    NoteUnreadableIfPresent(name);
  }
  return isRead;
}

UString DocumentCursor::ReadText(XMLLib::Name const& name) const {
  UString text;
  parser_.ReadAttribute(name, text);
  return text;
}

void DocumentCursor::NoteElement(char const* why) const {
  log_->Add(parser_.CurrentLine(), Described() + why);
}

void DocumentCursor::NoteOthers() {
  for (; Down(); Up()) {
    NoteElement("is passed over: one stands before it");
  }
}

void DocumentCursor::NoteUnreadable(XMLLib::Name const& name) const {
  UString text;
  bool const isThere = parser_.ReadAttribute(name, text);
  std::string const what =
      isThere ? "the value \"" + text.string() + "\" of \"" + name.Text() + "\" cannot be used"
              : "\"" + name.Text() + "\" is missing";
  log_->Add(parser_.CurrentLine(), Described() + "is passed over: " + what);
}

void DocumentCursor::NoteUnreadableIfPresent(XMLLib::Name const& name) const {
  UString text;
  if (parser_.ReadAttribute(name, text)) {
    log_->Add(parser_.CurrentLine(), Described() + "loses \"" + name.Text() +
                                         "\", as the value \"" + text.string() +
                                         "\" cannot be used");
  }
}

// The element and, where it has one, its name: Patch "Grand Piano".
std::string DocumentCursor::Described() const {
  UString name;
  bool const hasName = parser_.ReadAttribute(DocumentNames::kName, name);
  return parser_.CurrentElement().Text() + (hasName ? " \"" + name.string() + "\" " : " ");
}

}  // namespace Ostinet::Impl
