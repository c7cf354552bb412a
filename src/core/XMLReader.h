// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <exception>
#include <filesystem>
#include <fstream>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "ostinet/core/Noncopyable.h"

struct XML_ParserStruct;

namespace Ostinet::Impl {

/// One thing that a document holds. Texts are UTF-8 and stay until the next Pop.
struct XMLEvent {
  enum class Kind { kStart, kEnd, kText, kInstruction, kEndOfDocument };
  struct Attribute {
    std::string_view name;
    std::string_view value;
  };

  Kind kind = Kind::kEndOfDocument;
  int line = 0;           ///< of a start
  std::string_view name;  ///< of a start; target of an instruction
  std::string_view text;  ///< of a text; data of an instruction
  std::size_t firstAttribute = 0;
  std::size_t attributeCount = 0;
};

/// The things of an XML document, one after the other.
///
/// Ownership    Owns the open file; a document in memory outlives it.
/// Threads      One object on one thread at a time.
/// Errors       What the constructor and Peek tell.
class XMLReader : private Noncopyable<XMLReader> {
 public:
  explicit XMLReader(std::filesystem::path const& file, int maxDepth);
  XMLReader(void const* bytes, std::size_t count, int maxDepth);
  ~XMLReader();

  /// The next thing. Throws the fault of the document once all before it has been taken.
  XMLEvent const& Peek();
  /// Goes on behind it. Not behind the end.
  void Pop() { ++next_; }
  XMLEvent::Attribute const& AttributeOf(XMLEvent const& start, std::size_t index) const {
    return attributes_[start.firstAttribute + index];
  }

 private:
  struct Handlers;
  // Where a text stands; the storage may still grow, so views are made when a batch is complete.
  struct Span {
    std::size_t start = 0;
    std::size_t length = 0;
  };
  struct RawEvent {
    XMLEvent::Kind kind;
    int line;
    Span name;
    Span text;
    std::size_t firstAttribute;
    std::size_t attributeCount;
  };
  struct ParserDeleter {
    void operator()(XML_ParserStruct* parser) const;
  };

  explicit XMLReader(int maxDepth);
  void Fill();
  void ParseMore();
  std::size_t ReadInput(void* buffer, std::size_t count);
  void MakeViews();
  void SetDocumentFault();
  void Stop(std::exception_ptr fault);
  Span Store(std::string_view text);
  void Append(XMLEvent::Kind kind, Span name, Span text);
  void AppendText(std::string_view text);
  void PauseIfFull();

  std::unique_ptr<XML_ParserStruct, ParserDeleter> parser_;
  std::ifstream file_;
  std::string_view memory_;
  bool isFile_ = false;
  std::size_t chunkSize_;
  int const maxDepth_;
  int depth_ = 0;
  bool paused_ = false;
  bool atEnd_ = false;
  std::exception_ptr fault_;

  // The batch: what came out of one run of the parser, and how far it has been taken.
  std::string storage_;
  std::vector<RawEvent> raw_;
  std::vector<Span> rawAttributes_;  // name, value, name, value...
  std::vector<XMLEvent> events_;
  std::vector<XMLEvent::Attribute> attributes_;
  std::size_t next_ = 0;
};

}  // namespace Ostinet::Impl
