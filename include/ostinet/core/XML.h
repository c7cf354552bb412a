// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <memory>
#include <string>
#include <vector>

#include "ostinet/Export.h"
#include "ostinet/core/Files.h"
#include "ostinet/core/UString.h"

namespace Ostinet {
namespace XMLLib {

/// The name of an element, an attribute or a processing instruction. A name in a namespace is
/// the namespace, a blank, and the local name, so it never equals a bare one.
///
/// Ownership    A value.
class OSTINET_EXPORT Name {
 public:
  Name() = default;
  Name(char const* text) : text_(text) {}
  explicit Name(std::string text) noexcept : text_(std::move(text)) {}

  bool empty() const noexcept { return text_.empty(); }
  /// In UTF-8.
  std::string const& Text() const noexcept { return text_; }

  friend bool operator==(Name const& a, Name const& b) noexcept { return a.text_ == b.text_; }
  friend bool operator!=(Name const& a, Name const& b) noexcept { return !(a == b); }
  friend bool operator<(Name const& a, Name const& b) noexcept { return a.text_ < b.text_; }

 private:
  std::string text_;
};

/// The words by which values of `T` are written in attributes.
template <class T>
class AttributeMap {
 public:
  struct Entry {
    char const* word;
    T value;
  };

  /// `entries` outlives the map.
  template <std::size_t N>
  constexpr explicit AttributeMap(Entry const (&entries)[N]) : entries_(entries), count_(N) {}

  /// The value of `word`; false, and `value` as it was, for a word of no entry.
  bool Find(UString const& word, T& value) const {
    for (std::size_t i = 0; i < count_; ++i) {
      if (word == entries_[i].word) {
        value = entries_[i].value;
        return true;
      }
    }
    return false;
  }
  /// The first word of `value`, or an empty text.
  UString WordOf(T const& value) const {
    for (std::size_t i = 0; i < count_; ++i) {
      if (entries_[i].value == value) {
        return entries_[i].word;
      }
    }
    return UString();
  }

 private:
  Entry const* entries_;
  std::size_t count_;
};

inline constexpr AttributeMap<bool>::Entry kBoolWords[] = {{"true", true}, {"false", false}};
/// "true" and "false".
inline constexpr AttributeMap<bool> kBoolAttribute{kBoolWords};

/// A cursor that walks down and up one XML document, reading as it goes.
///
/// Nothing beyond the document is ever fetched, entities that multiply are refused, and so is
/// nesting deeper than kMaxDepth elements.
///
/// Ownership    Not copied.
/// Threads      One object on one thread at a time.
/// Errors       A document that is malformed is read up to the fault; the operation that would
///              go beyond it throws a VantorError of the domain "XML", whose text names the
///              line, and so does each one after it. A file that cannot be read throws the
///              domain "OS".
class OSTINET_EXPORT Parser {
 public:
  enum Validate : int {
    kDoNotValidate = 0,
    kValidate = 1,  ///< taken for kDoNotValidate: no DTD is read
  };
  static constexpr int kMaxDepth = 256;

  /// Opens the file; the cursor stands above the root.
  explicit Parser(File const& file, Validate validate = kDoNotValidate);
  /// Reads a document in memory, which must outlive the parser.
  Parser(void const* bytes, std::size_t count);
  ~Parser();
  Parser(Parser const&) = delete;
  Parser& operator=(Parser const&) = delete;

  /// Moves to the next child of the current element. After UpToParent that is the one behind the
  /// child last left. False, with the cursor where it was, when there is none.
  bool DownToChild();
  /// The same for children of this name; those of other names are passed over.
  bool DownToChild(Name const& name);
  bool DownToChildNounexp(Name const& name);
  /// The same, for a child that the document's form requires. A missing one gives false too.
  bool DownToReqChildNounexp(Name const& name);
  /// The loop form: `found`, false at first, remembers that there was one.
  bool DownToReqChildrenNounexp(Name const& name, bool& found);
  /// Moves to the parent of the current element, passing over what remains in that element.
  /// Above the root it does nothing.
  void UpToParent();
  /// Passes over what remains unread in the current element.
  void Nounexp();

  /// The name of the current element; empty above the root.
  Name const& CurrentElement() const;
  /// The line on which the current element starts, from 1.
  int CurrentLine() const;
  /// The names of the current element's attributes, in the order of the document.
  std::vector<Name> AttributeNames() const;
  /// The text of an attribute of the current element. False, and `value` empty, if it is absent.
  bool ReadAttribute(Name const& name, UString& value) const;
  bool ReadReqAttribute(Name const& name, UString& value) const;
  /// The value that an attribute's word stands for. False, and `value` as it was, if it is
  /// absent or no word of the map.
  template <class T>
  bool ReadAttribute(Name const& name, AttributeMap<T> const& map, T& value) const {
    UString word;
    return ReadAttribute(name, word) && map.Find(word, value);
  }
  template <class T>
  bool ReadReqAttribute(Name const& name, AttributeMap<T> const& map, T& value) const {
    return ReadAttribute(name, map, value);
  }
  /// The character content of the current element from where the cursor stands to its next
  /// child, or to its end. Behind a child, after UpToParent, it gives the text that follows.
  UString ReadText();

  /// Whether the instructions that the cursor meets from now on are kept. Those of the prolog
  /// are kept in any case.
  void CollectProcessingInstructions(bool collect);
  /// Takes the first of the instructions kept; false when none is left.
  bool GetProcessingInstruction(UString& target, UString& data);

  /// Blank, tab, line feed or carriage return.
  static bool IsWhitespace(unsigned short unit);

 private:
  class Cursor;
  std::unique_ptr<Cursor> cursor_;
};

/// Writes one XML document in UTF-8, from its start to its end.
///
/// The file is replaced as a whole when the writer closes: until then, and after any failure,
/// the old file stands as it was. Characters that XML cannot hold are left out.
///
/// Ownership    Not copied.
/// Threads      One object on one thread at a time.
/// Errors       A VantorError of the domain "OS" for what the disk refuses; nothing is written
///              after one.
class OSTINET_EXPORT Writer {
 public:
  /// How what follows is laid out.
  enum Mode : int {
    kIndented = 0,   ///< each element on a line of its own, unless text stands beside it
    kOnOneLine = 1,  ///< nothing is added between text and elements
  };

  /// Writes the prolog: with a DOCTYPE if `doctype` is not empty.
  explicit Writer(File const& file, Name const& doctype = Name(),
                  UString const& publicID = UString(), UString const& systemID = UString());
  /// Closes. A failure passes in silence; and if an exception is taking the writer down, the old
  /// file stays.
  ~Writer();
  Writer(Writer const&) = delete;
  Writer& operator=(Writer const&) = delete;

  void StartElement(Name const& name);
  /// Ends the element last started. Without one it does nothing.
  void EndElement();
  /// An element without content.
  void Element(Name const& name);
  /// An element with text.
  void Element(Name const& name, UString const& text);
  /// An element with one attribute.
  void Element(Name const& name, Name const& attribute, UString const& value);
  /// An attribute of the element just started: to be written before any content of it.
  void Attribute(Name const& name, UString const& value);
  template <class T>
  void Attribute(Name const& name, AttributeMap<T> const& map, T const& value) {
    Attribute(name, map.WordOf(value));
  }
  /// Text of the current element.
  void Write(UString const& text);
  void ProcessingInstruction(Name const& target, UString const& data);

  /// Changes the layout of what follows.
  void SetMode(Mode mode);
  /// Restores the layout before the last SetMode.
  void ResetMode();

  /// Ends all open elements and puts the document in the file's place. Throws on failure. Called
  /// again it does nothing.
  void Close();

 private:
  class Output;
  std::unique_ptr<Output> output_;
};

}  // namespace XMLLib
}  // namespace Ostinet
