// SPDX-License-Identifier: MIT
#include <exception>
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "core/AtomicFile.h"
#include "core/Paths.h"
#include "core/Unicode.h"
#include "ostinet/core/Error.h"
#include "ostinet/core/XML.h"

namespace Ostinet::XMLLib {

namespace {

constexpr std::size_t kFullBuffer = 64 * 1024;
constexpr std::size_t kIndent = 2;

enum class Place { kText, kAttribute, kLiteral, kInstruction };

// XML has no way to hold these, not even by number.
bool CanStandInXML(char32_t character) {
  if (character < 0x20) {
    return character == '\t' || character == '\n' || character == '\r';
  }
  return character != 0xFFFE && character != 0xFFFF;
}

// What stands for a character where it cannot stand itself, or null. White space that a reader
// would change is written by number.
char const* EscapeOf(char32_t character, Place place) {
  if (place == Place::kInstruction) {
    return nullptr;
  }
  if (place == Place::kLiteral) {
    return character == '"' ? "%22" : nullptr;
  }
  switch (character) {
    case '&':
      return "&amp;";
    case '<':
      return "&lt;";
    case '>':
      return "&gt;";
    case '\r':
      return "&#13;";
    case '"':
      return place == Place::kAttribute ? "&quot;" : nullptr;
    case '\n':
      return place == Place::kAttribute ? "&#10;" : nullptr;
    case '\t':
      return place == Place::kAttribute ? "&#9;" : nullptr;
    default:
      return nullptr;
  }
}

void AppendEscaped(UString const& text, Place place, std::string& out) {
  for (std::size_t position = 0; position < text.length();) {
    char32_t const character = Impl::NextCharacter(text.utf16_str(), position);
    if (char const* const escape = EscapeOf(character, place)) {
      out += escape;
    } else if (character >= 0xD800 && character <= 0xDFFF) {
      Impl::AppendAsUTF8(Impl::kReplacementCharacter, out);
    } else if (CanStandInXML(character)) {
      Impl::AppendAsUTF8(character, out);
    }
  }
}

}  // namespace

class Writer::Output {
 public:
  explicit Output(std::filesystem::path const& target) { file_.emplace(target); }

  // True if the writer goes because of an exception that came after it.
  bool IsUnwinding() const { return std::uncaught_exceptions() > exceptionsAtStart_; }

  void Prolog(Name const& doctype, UString const& publicID, UString const& systemID) {
    buffer_ = "<?xml version=\"1.0\" encoding=\"UTF-8\"?>";
    if (doctype.empty() && publicID.empty() && systemID.empty()) {
      return;
    }
    buffer_ += "\n<!DOCTYPE " + doctype.Text();
    if (!publicID.empty()) {
      buffer_ += " PUBLIC ";
      Literal(publicID);
    } else if (!systemID.empty()) {
      buffer_ += " SYSTEM";
    }
    if (!publicID.empty() || !systemID.empty()) {
      buffer_ += ' ';
      Literal(systemID);
    }
    buffer_ += '>';
  }

  void Start(Name const& name) {
    if (open_.size() >= static_cast<std::size_t>(Parser::kMaxDepth)) {
      throw VantorError("XML", "XMLLib::Writer", 0,
                        "elements are nested deeper than " + std::to_string(Parser::kMaxDepth));
    }
    NewLineForContent();
    buffer_ += '<' + name.Text();
    open_.push_back({name, false, false});
    startIsOpen_ = true;
    FlushIfFull();
  }

  void End() {
    if (open_.empty()) {
      return;
    }
    Open const element = std::move(open_.back());
    open_.pop_back();
    if (startIsOpen_) {
      buffer_ += "/>";
      startIsOpen_ = false;
    } else {
      if (element.hasChildren && !element.isOnOneLine && Mode() == kIndented) {
        NewLine();
      }
      buffer_ += "</" + element.name.Text() + '>';
    }
    FlushIfFull();
  }

  void Attribute(Name const& name, UString const& value) {
    if (!startIsOpen_) {
      throw VantorError("XML", "XMLLib::Writer", 0,
                        "attribute " + name.Text() + " behind the start of its element");
    }
    buffer_ += ' ' + name.Text() + "=\"";
    AppendEscaped(value, Place::kAttribute, buffer_);
    buffer_ += '"';
    FlushIfFull();
  }

  void Text(UString const& text) {
    if (open_.empty() || text.empty()) {
      return;
    }
    CloseStart();
    open_.back().isOnOneLine = true;
    AppendEscaped(text, Place::kText, buffer_);
    FlushIfFull();
  }

  void Instruction(Name const& target, UString const& data) {
    NewLineForContent();
    buffer_ += "<?" + target.Text() + ' ';
    std::size_t const start = buffer_.size();
    AppendEscaped(data, Place::kInstruction, buffer_);
    // "?>" would end the instruction too soon, so a blank comes between.
    for (auto end = buffer_.find("?>", start); end != std::string::npos;
         end = buffer_.find("?>", end)) {
      buffer_.insert(end + 1, 1, ' ');
    }
    buffer_ += "?>";
    FlushIfFull();
  }

  void PushMode(Writer::Mode mode) { modes_.push_back(mode); }
  void PopMode() {
    if (!modes_.empty()) {
      modes_.pop_back();
    }
  }

  void Close() {
    if (closed_) {
      return;
    }
    while (!open_.empty()) {
      End();
    }
    buffer_ += '\n';
    Flush();
    Try([this] { file_->Commit(); });
    closed_ = true;
  }

 private:
  struct Open {
    Name name;
    bool hasChildren;
    bool isOnOneLine;  // text stands in it, or something was written with that layout
  };

  Writer::Mode Mode() const { return modes_.empty() ? kIndented : modes_.back(); }

  void Literal(UString const& text) {
    buffer_ += '"';
    AppendEscaped(text, Place::kLiteral, buffer_);
    buffer_ += '"';
  }

  void CloseStart() {
    if (startIsOpen_) {
      buffer_ += '>';
      startIsOpen_ = false;
    }
  }

  void NewLine() { buffer_.append(1, '\n').append(open_.size() * kIndent, ' '); }

  // Before a child or an instruction.
  void NewLineForContent() {
    CloseStart();
    if (open_.empty()) {
      NewLine();
      return;
    }
    Open& parent = open_.back();
    parent.hasChildren = true;
    parent.isOnOneLine = parent.isOnOneLine || Mode() == kOnOneLine;
    if (!parent.isOnOneLine) {
      NewLine();
    }
  }

  void FlushIfFull() {
    if (buffer_.size() >= kFullBuffer) {
      Flush();
    }
  }

  void Flush() {
    Try([this] { file_->Write(buffer_.data(), buffer_.size()); });
    buffer_.clear();
  }

  // After a failure everything fails alike, and what was written goes.
  template <class Call>
  void Try(Call call) {
    if (failure_) {
      throw VantorError(*failure_);
    }
    try {
      call();
    } catch (VantorError const& error) {
      failure_ = error;
      file_.reset();
      throw;
    }
  }

  int const exceptionsAtStart_ = std::uncaught_exceptions();
  std::optional<Impl::AtomicFile> file_;
  std::string buffer_;
  std::vector<Open> open_;
  std::vector<Writer::Mode> modes_;
  bool startIsOpen_ = false;
  bool closed_ = false;
  std::optional<VantorError> failure_;
};

Writer::Writer(File const& file, Name const& doctype, UString const& publicID,
               UString const& systemID)
    : output_(new Output(Impl::ToPath(file))) {
  output_->Prolog(doctype, publicID, systemID);
}

Writer::~Writer() {
  if (output_->IsUnwinding()) {
    return;  // half a document is not to replace a whole one
  }
  try {
    output_->Close();
  } catch (...) {
    // Whoever needs to know calls Close.
  }
}

void Writer::StartElement(Name const& name) { output_->Start(name); }
void Writer::EndElement() { output_->End(); }

void Writer::Element(Name const& name) {
  output_->Start(name);
  output_->End();
}

void Writer::Element(Name const& name, UString const& text) {
  output_->Start(name);
  output_->Text(text);
  output_->End();
}

void Writer::Element(Name const& name, Name const& attribute, UString const& value) {
  output_->Start(name);
  output_->Attribute(attribute, value);
  output_->End();
}

void Writer::Attribute(Name const& name, UString const& value) { output_->Attribute(name, value); }

void Writer::Write(UString const& text) { output_->Text(text); }

void Writer::ProcessingInstruction(Name const& target, UString const& data) {
  output_->Instruction(target, data);
}

void Writer::SetMode(Mode mode) { output_->PushMode(mode); }
void Writer::ResetMode() { output_->PopMode(); }
void Writer::Close() { output_->Close(); }

}  // namespace Ostinet::XMLLib
