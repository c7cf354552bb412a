// SPDX-License-Identifier: MIT
#include <deque>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "core/Paths.h"
#include "core/Unicode.h"
#include "core/XMLReader.h"
#include "ostinet/core/XML.h"

// One invariant carries the cursor: the next event of the reader always lies in the content of
// the current element, at its own level. Going down takes a start, going up takes everything to
// the end of the element, and every search in between leaves that end where it is.

namespace Ostinet::XMLLib {

namespace {

using Impl::XMLEvent;
using Kind = XMLEvent::Kind;

// How many instructions of a prolog are kept without anyone having asked for them.
constexpr std::size_t kMostInstructionsOfProlog = 64;

UString FromUTF8(std::string_view bytes) {
  return UString(bytes.data(), bytes.size(), UString::kUTF8);
}

// An element that is open, with its attributes: the reader forgets them when it goes on.
class OpenElement {
 public:
  void Set(Impl::XMLReader const& reader, XMLEvent const& start) {
    name_ = Name(std::string(start.name));
    line_ = start.line;
    texts_.clear();
    ends_.clear();
    for (std::size_t i = 0; i < start.attributeCount; ++i) {
      auto const& attribute = reader.AttributeOf(start, i);
      Add(attribute.name);
      Add(attribute.value);
    }
  }

  Name const& GetName() const { return name_; }
  int Line() const { return line_; }

  std::vector<Name> AttributeNames() const {
    std::vector<Name> names;
    std::size_t start = 0;
    for (std::size_t i = 0; i + 1 < ends_.size(); i += 2) {
      names.emplace_back(std::string(View(start, ends_[i])));
      start = ends_[i + 1];
    }
    return names;
  }

  bool FindAttribute(Name const& name, UString& value) const {
    std::size_t start = 0;
    for (std::size_t i = 0; i + 1 < ends_.size(); i += 2) {
      if (View(start, ends_[i]) == name.Text()) {
        value = FromUTF8(View(ends_[i], ends_[i + 1]));
        return true;
      }
      start = ends_[i + 1];
    }
    return false;
  }

 private:
  void Add(std::string_view text) {
    texts_.append(text);
    ends_.push_back(texts_.size());
  }
  std::string_view View(std::size_t start, std::size_t end) const {
    return std::string_view(texts_).substr(start, end - start);
  }

  Name name_;
  int line_ = 0;
  std::string texts_;              // name, value, name, value... without anything between
  std::vector<std::size_t> ends_;  // where each of them ends
};

}  // namespace

class Parser::Cursor {
 public:
  explicit Cursor(std::filesystem::path const& file) : reader_(file, kMaxDepth) {}
  Cursor(void const* bytes, std::size_t count) : reader_(bytes, count, kMaxDepth) {}

  OpenElement const* Current() const { return depth_ == 0 ? nullptr : &open_[depth_ - 1]; }

  // To the next child, of a name if one is given.
  bool Down(Name const* name) {
    for (;;) {
      XMLEvent const& event = reader_.Peek();
      if (event.kind == Kind::kEnd || event.kind == Kind::kEndOfDocument) {
        return false;
      }
      if (event.kind == Kind::kStart) {
        sawRoot_ = true;
        if (name == nullptr || event.name == name->Text()) {
          Open(event);
          return true;
        }
        reader_.Pop();
        SkipToEnd();
      }
      PassOver();
    }
  }

  void Up() {
    if (depth_ > 0) {
      SkipToEnd();
      reader_.Pop();
      --depth_;
    }
  }

  // Up to the end of the element that is being read, or of the document.
  void SkipToEnd() {
    for (int level = 0;; PassOver()) {
      Kind const kind = reader_.Peek().kind;
      bool const isEnd = kind == Kind::kEnd || kind == Kind::kEndOfDocument;
      if (isEnd && level == 0) {
        return;
      }
      level += kind == Kind::kStart ? 1 : (isEnd ? -1 : 0);
    }
  }

  UString Text() {
    std::u16string text;
    for (;; PassOver()) {
      XMLEvent const& event = reader_.Peek();
      if (event.kind == Kind::kText) {
        Impl::AppendUTF8(event.text, text);
      } else if (event.kind != Kind::kInstruction) {
        return text;
      }
    }
  }

  void Collect(bool collect) { collect_ = collect; }

  bool TakeInstruction(UString& target, UString& data) {
    if (instructions_.empty()) {
      return false;
    }
    std::tie(target, data) = std::move(instructions_.front());
    instructions_.pop_front();
    return true;
  }

 private:
  void Open(XMLEvent const& start) {
    if (depth_ == open_.size()) {
      open_.emplace_back();
    }
    open_[depth_].Set(reader_, start);
    ++depth_;
    reader_.Pop();
  }

  // Goes on behind the next event, keeping it if it is an instruction to keep.
  void PassOver() {
    XMLEvent const& event = reader_.Peek();
    if (event.kind == Kind::kInstruction) {
      bool const ofProlog = !sawRoot_ && instructions_.size() < kMostInstructionsOfProlog;
      if (collect_ || ofProlog) {
        instructions_.emplace_back(FromUTF8(event.name), FromUTF8(event.text));
      }
    }
    sawRoot_ = sawRoot_ || event.kind == Kind::kStart;
    reader_.Pop();
  }

  Impl::XMLReader reader_;
  std::vector<OpenElement> open_;  // kept when closed, so that their storage serves the next
  std::size_t depth_ = 0;
  bool sawRoot_ = false;
  bool collect_ = false;
  std::deque<std::pair<UString, UString>> instructions_;
};

Parser::Parser(File const& file, Validate) : cursor_(new Cursor(Impl::ToPath(file))) {}
Parser::Parser(void const* bytes, std::size_t count) : cursor_(new Cursor(bytes, count)) {}
Parser::~Parser() = default;

bool Parser::DownToChild() { return cursor_->Down(nullptr); }
bool Parser::DownToChild(Name const& name) { return cursor_->Down(&name); }
bool Parser::DownToChildNounexp(Name const& name) { return cursor_->Down(&name); }
bool Parser::DownToReqChildNounexp(Name const& name) { return cursor_->Down(&name); }

bool Parser::DownToReqChildrenNounexp(Name const& name, bool& found) {
  bool const isThere = cursor_->Down(&name);
  found = found || isThere;
  return isThere;
}

void Parser::UpToParent() { cursor_->Up(); }
void Parser::Nounexp() { cursor_->SkipToEnd(); }

Name const& Parser::CurrentElement() const {
  static Name const sNone;
  OpenElement const* const current = cursor_->Current();
  return current == nullptr ? sNone : current->GetName();
}

int Parser::CurrentLine() const {
  OpenElement const* const current = cursor_->Current();
  return current == nullptr ? 1 : current->Line();
}

std::vector<Name> Parser::AttributeNames() const {
  OpenElement const* const current = cursor_->Current();
  return current == nullptr ? std::vector<Name>() : current->AttributeNames();
}

bool Parser::ReadAttribute(Name const& name, UString& value) const {
  OpenElement const* const current = cursor_->Current();
  if (current != nullptr && current->FindAttribute(name, value)) {
    return true;
  }
  value.clear();
  return false;
}

bool Parser::ReadReqAttribute(Name const& name, UString& value) const {
  return ReadAttribute(name, value);
}

UString Parser::ReadText() { return cursor_->Text(); }

void Parser::CollectProcessingInstructions(bool collect) { cursor_->Collect(collect); }

bool Parser::GetProcessingInstruction(UString& target, UString& data) {
  return cursor_->TakeInstruction(target, data);
}

bool Parser::IsWhitespace(unsigned short unit) {
  return unit == ' ' || unit == '\t' || unit == '\n' || unit == '\r';
}

}  // namespace Ostinet::XMLLib
