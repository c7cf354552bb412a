// SPDX-License-Identifier: MIT
#pragma once

#include <functional>
#include <string>

#include "names/DocumentNumbers.h"
#include "ostinet/core/XML.h"

namespace Ostinet::Impl {

/// Hears what a reader of name documents passes over. Reading for a destination goes without one:
/// a document that is odd gives fewer names and no words.
class PassedOverLog {
 public:
  virtual ~PassedOverLog() = default;
  virtual void Add(int line, std::string const& sentence) = 0;
  /// A sentence that holds if `isMissing` is true once the whole document is read.
  virtual void AddIf(std::function<bool()> isMissing, int line, std::string const& sentence) = 0;
};

/// The parser as the readers of name documents use it: each read that fails is told to the log, if
/// there is one.
///
/// Threads      As the parser's.
/// Errors       The parser's, which end the reading.
class DocumentCursor {
 public:
  /// Both outlive the cursor; `log` may be null.
  DocumentCursor(XMLLib::Parser& parser, PassedOverLog* log) : parser_(parser), log_(log) {}

  XMLLib::Parser& GetParser() const { return parser_; }
  PassedOverLog* GetLog() const { return log_; }

  /// To the next child of any name.
  bool Down() { return parser_.DownToChild(); }
  /// To the next child of this name; others are passed over.
  bool Down(XMLLib::Name const& name);
  void Up() { parser_.UpToParent(); }
  bool IsAt(XMLLib::Name const& name) const { return parser_.CurrentElement() == name; }

  /// An attribute without which the element is of no use.
  bool ReadRequired(XMLLib::Name const& name, UString& value) const;
  /// The same for a number from `min` to `max`.
  bool ReadRequired(XMLLib::Name const& name, unsigned min, unsigned max, unsigned& value) const;
  bool ReadRequired(XMLLib::Name const& name, double& value) const;
  /// An attribute that may be absent, but if it stands there should be such a number.
  bool ReadOptional(XMLLib::Name const& name, unsigned max, unsigned& value) const;
  /// An attribute of one of the map's words; `value` stays as it was without one.
  template <class T>
  void ReadOptional(XMLLib::Name const& name, XMLLib::AttributeMap<T> const& map, T& value) const {
    if (!parser_.ReadAttribute(name, map, value) && log_ != nullptr) {
      NoteUnreadableIfPresent(name);
    }
  }
  /// The text of an optional attribute; empty without one.
  UString ReadText(XMLLib::Name const& name) const;

  /// The current element is passed over, as it stands.
  void PassOver(char const* why) const {
    if (log_ != nullptr) {
      NoteElement(why);
    }
  }
  /// So are all children behind the one that was read: of them one counts.
  void PassOverOthers() {
    if (log_ != nullptr) {
      NoteOthers();
    }
  }
  /// The same, if `isMissing` is true when the whole document is read. `isMissing` is asked only
  /// while what it looks at is there.
  template <class IsMissing>
  void PassOverIf(IsMissing const& isMissing, char const* why) const {
    if (log_ != nullptr) {
      log_->AddIf(isMissing, parser_.CurrentLine(), Described() + why);
    }
  }

 private:
  void NoteElement(char const* why) const;
  void NoteOthers();
  void NoteUnreadable(XMLLib::Name const& name) const;
  void NoteUnreadableIfPresent(XMLLib::Name const& name) const;
  std::string Described() const;

  XMLLib::Parser& parser_;
  PassedOverLog* const log_;
};

}  // namespace Ostinet::Impl
