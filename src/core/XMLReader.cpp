// SPDX-License-Identifier: MIT
#include "core/XMLReader.h"

#include <expat.h>

#include <algorithm>
#include <cstring>
#include <new>

#include "core/XMLEncodings.h"
#include "ostinet/core/Error.h"

// The parser below pushes, the cursor above pulls. A piece of the document is parsed into a batch
// of events, and the next piece when those are taken; a piece whose entities swell makes the
// parser pause in its middle, so a batch stays small whatever the document says. A fault waits
// behind the events in front of it. The batch's storage is used again and again: a document of
// any length costs a handful of allocations.

namespace Ostinet::Impl {

namespace {

constexpr std::size_t kFirstChunk = 16 * 1024;
constexpr std::size_t kLargestChunk = 16 * 1024 * 1024;
constexpr std::size_t kFullBatch = 256 * 1024;
constexpr std::size_t kManyEvents = 16 * 1024;
constexpr char kNamespaceSeparator = ' ';

std::exception_ptr XMLFault(int line, std::string const& text) {
  return std::make_exception_ptr(
      VantorError("XML", "XMLLib::Parser", 0, "line " + std::to_string(line) + ": " + text));
}

}  // namespace

// What the parser calls, in C. Nothing may be thrown through it, so a failure in here is kept
// and stops the parser.
struct XMLReader::Handlers {
  template <class Work>
  static void Guard(void* reader, Work work) {
    auto& self = *static_cast<XMLReader*>(reader);
    if (self.fault_ != nullptr) {
      return;  // the parser may still finish what it began
    }
    try {
      work(self);
      self.PauseIfFull();
    } catch (...) {
      self.Stop(std::current_exception());
    }
  }

  static void XMLCALL Start(void* reader, XML_Char const* name, XML_Char const** attributes) {
    Guard(reader, [&](XMLReader& self) {
      int const line = static_cast<int>(XML_GetCurrentLineNumber(self.parser_.get()));
      if (++self.depth_ > self.maxDepth_) {
        self.Stop(
            XMLFault(line, "elements are nested deeper than " + std::to_string(self.maxDepth_)));
        return;
      }
      self.Append(XMLEvent::Kind::kStart, self.Store(name), Span());
      self.raw_.back().line = line;
      for (; *attributes != nullptr; attributes += 2) {
        self.rawAttributes_.push_back(self.Store(attributes[0]));
        self.rawAttributes_.push_back(self.Store(attributes[1]));
        ++self.raw_.back().attributeCount;
      }
    });
  }

  static void XMLCALL End(void* reader, XML_Char const*) {
    Guard(reader, [](XMLReader& self) {
      --self.depth_;
      self.Append(XMLEvent::Kind::kEnd, Span(), Span());
    });
  }

  static void XMLCALL Text(void* reader, XML_Char const* text, int length) {
    Guard(reader, [&](XMLReader& self) {
      self.AppendText({text, static_cast<std::size_t>(length)});
    });
  }

  static void XMLCALL Instruction(void* reader, XML_Char const* target, XML_Char const* data) {
    Guard(reader, [&](XMLReader& self) {
      Span const targetSpan = self.Store(target);
      self.Append(XMLEvent::Kind::kInstruction, targetSpan, self.Store(data));
    });
  }

  static int XMLCALL UnknownEncoding(void*, XML_Char const* name, XML_Encoding* encoding) {
    encoding->data = nullptr;
    encoding->convert = nullptr;
    encoding->release = nullptr;
    return FindSingleByteEncoding(name, encoding->map) ? XML_STATUS_OK : XML_STATUS_ERROR;
  }
};

void XMLReader::ParserDeleter::operator()(XML_ParserStruct* parser) const {
  XML_ParserFree(parser);
}

XMLReader::XMLReader(int maxDepth)
    : parser_(XML_ParserCreateNS(nullptr, kNamespaceSeparator)),
      chunkSize_(kFirstChunk),
      maxDepth_(maxDepth) {
  if (parser_ == nullptr) {
    throw std::bad_alloc();
  }
  XML_Parser const parser = parser_.get();
  XML_SetUserData(parser, this);
  XML_SetElementHandler(parser, Handlers::Start, Handlers::End);
  XML_SetCharacterDataHandler(parser, Handlers::Text);
  XML_SetProcessingInstructionHandler(parser, Handlers::Instruction);
  XML_SetUnknownEncodingHandler(parser, Handlers::UnknownEncoding, nullptr);
  // No handler for external entities: what lies beyond the document is never asked for. Entities
  // that multiply are stopped by the parser itself, at a hundred times the document's size.
}

XMLReader::XMLReader(std::filesystem::path const& file, int maxDepth) : XMLReader(maxDepth) {
  std::error_code error;
  if (std::filesystem::is_regular_file(file, error)) {
    file_.open(file, std::ios::binary);
  }
  if (!file_.is_open()) {
    FailOSErr(static_cast<int>(std::filesystem::exists(file, error)
                                   ? std::errc::permission_denied
                                   : std::errc::no_such_file_or_directory));
  }
  isFile_ = true;
}

XMLReader::XMLReader(void const* bytes, std::size_t count, int maxDepth) : XMLReader(maxDepth) {
  memory_ = {static_cast<char const*>(bytes), count};
}

XMLReader::~XMLReader() = default;

XMLEvent const& XMLReader::Peek() {
  if (next_ == events_.size()) {
    Fill();
  }
  return events_[next_];
}

void XMLReader::Fill() {
  if (fault_ == nullptr) {
    next_ = 0;
    storage_.clear();
    raw_.clear();
    rawAttributes_.clear();
    events_.clear();
    attributes_.clear();
    while (raw_.empty() && fault_ == nullptr) {
      if (atEnd_) {
        Append(XMLEvent::Kind::kEndOfDocument, Span(), Span());
      } else {
        ParseMore();
      }
    }
    MakeViews();
  }
  if (next_ == events_.size()) {
    std::rethrow_exception(fault_);
  }
}

void XMLReader::ParseMore() {
  XML_Parser const parser = parser_.get();
  XML_Status status = XML_STATUS_OK;
  bool wasLast = false;
  if (paused_) {
    status = XML_ResumeParser(parser);
    XML_ParsingStatus parsing{};
    XML_GetParsingStatus(parser, &parsing);
    wasLast = parsing.finalBuffer != 0;
  } else {
    void* const buffer = XML_GetBuffer(parser, static_cast<int>(chunkSize_));
    if (buffer == nullptr) {
      throw std::bad_alloc();
    }
    std::size_t const count = ReadInput(buffer, chunkSize_);
    wasLast = count < chunkSize_;
    status = XML_ParseBuffer(parser, static_cast<int>(count), wasLast ? 1 : 0);
    // A token longer than a piece is looked at again with each piece that follows; growing
    // pieces keep that from adding up.
    chunkSize_ = raw_.empty() ? std::min(chunkSize_ * 2, kLargestChunk) : kFirstChunk;
  }
  paused_ = status == XML_STATUS_SUSPENDED;
  if (status == XML_STATUS_ERROR) {
    SetDocumentFault();
  }
  atEnd_ = status == XML_STATUS_OK && wasLast;
}

std::size_t XMLReader::ReadInput(void* buffer, std::size_t count) {
  if (!isFile_) {
    std::size_t const part = std::min(count, memory_.size());
    if (part > 0) {
      std::memcpy(buffer, memory_.data(), part);
    }
    memory_.remove_prefix(part);
    return part;
  }
  file_.read(static_cast<char*>(buffer), static_cast<std::streamsize>(count));
  if (file_.bad()) {
    FailOSErr(static_cast<int>(std::errc::io_error));
  }
  return static_cast<std::size_t>(file_.gcount());
}

void XMLReader::SetDocumentFault() {
  XML_Parser const parser = parser_.get();
  if (fault_ == nullptr) {
    fault_ = XMLFault(static_cast<int>(XML_GetCurrentLineNumber(parser)),
                      XML_ErrorString(XML_GetErrorCode(parser)));
  }
}

void XMLReader::Stop(std::exception_ptr fault) {
  fault_ = std::move(fault);
  XML_StopParser(parser_.get(), XML_FALSE);
}

void XMLReader::PauseIfFull() {
  if (storage_.size() >= kFullBatch || raw_.size() >= kManyEvents) {
    // Asked again before the parser has come to rest, it only says that it was asked already.
    XML_StopParser(parser_.get(), XML_TRUE);
  }
}

XMLReader::Span XMLReader::Store(std::string_view text) {
  Span const span{storage_.size(), text.size()};
  storage_.append(text);
  return span;
}

void XMLReader::Append(XMLEvent::Kind kind, Span name, Span text) {
  raw_.push_back({kind, 0, name, text, rawAttributes_.size() / 2, 0});
}

void XMLReader::AppendText(std::string_view text) {
  Span const span = Store(text);
  if (!raw_.empty() && raw_.back().kind == XMLEvent::Kind::kText) {
    raw_.back().text.length += span.length;  // it ends where this one starts
  } else {
    Append(XMLEvent::Kind::kText, Span(), span);
  }
}

void XMLReader::MakeViews() {
  auto const view = [this](Span span) {
    return std::string_view(storage_).substr(span.start, span.length);
  };
  for (std::size_t i = 0; i < rawAttributes_.size(); i += 2) {
    attributes_.push_back({view(rawAttributes_[i]), view(rawAttributes_[i + 1])});
  }
  for (RawEvent const& raw : raw_) {
    events_.push_back({raw.kind, raw.line, view(raw.name), view(raw.text), raw.firstAttribute,
                       raw.attributeCount});
  }
}

}  // namespace Ostinet::Impl
