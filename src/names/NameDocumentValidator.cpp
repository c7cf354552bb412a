// SPDX-License-Identifier: MIT
#include "names/NameDocumentValidator.h"

#include <algorithm>

#include "names/DocumentNames.h"
#include "names/NameDocumentForm.h"

namespace Ostinet::Impl {

namespace {

std::string Quoted(std::string_view text) { return '"' + std::string(text) + '"'; }

bool IsBlank(UString const& text) {
  return std::all_of(text.begin(), text.end(),
                     [](char16_t unit) { return XMLLib::Parser::IsWhitespace(unit); });
}

class Validator {
 public:
  Validator(XMLLib::Parser& parser, ValidationLog& log) : parser_(parser), log_(log) {}

  void Document() {
    if (!parser_.DownToChild()) {
      return;
    }
    if (parser_.CurrentElement() != DocumentNames::kDocument) {
      log_.AddViolation(parser_.CurrentLine(), "the document is none of names: its root is " +
                                                   parser_.CurrentElement().Text());
    }
    Element();
    parser_.UpToParent();
  }

 private:
  // The current element with all that is in it. The parser bounds how deep elements are nested.
  void Element() {
    ElementForm const* const form = FindElementForm(parser_.CurrentElement().Text());
    if (form == nullptr) {
      return;  // its parent said so, and nothing is known of what it holds
    }
    Attributes(*form);
    Content(*form);
  }

  void Attributes(ElementForm const& form) {
    int const line = parser_.CurrentLine();
    for (XMLLib::Name const& name : parser_.AttributeNames()) {
      AttributeForm const* const attribute = form.FindAttribute(name.Text());
      UString value;
      parser_.ReadAttribute(name, value);
      std::string const what = Quoted(name.Text()) + " of " + std::string(form.name);
      if (attribute == nullptr) {
        log_.AddViolation(line, "the format has no " + what);
        continue;
      }
      if (!IsValueOf(*attribute, value)) {
        log_.AddViolation(line, what + " may not be " + Quoted(value.string()));
      }
      if (attribute->use == AttributeForm::kNotRead) {
        log_.AddNotRead(line, what + " is not read");
      }
    }
    for (AttributeForm const* const attribute : form.attributes) {
      UString value;
      if (attribute->need == AttributeForm::kRequired &&
          !parser_.ReadAttribute(XMLLib::Name(std::string(attribute->name)), value)) {
        log_.AddViolation(line, std::string(form.name) + " lacks " + Quoted(attribute->name));
      }
    }
  }

  void Content(ElementForm const& form) {
    int const line = parser_.CurrentLine();
    ContentModel::Walk walk(form.model);
    bool isInOrder = true;  // one violation of the order is told, not all that follow from it
    for (bool isFirst = true;; isFirst = false) {
      TextBeforeChild(form, isFirst);
      if (!parser_.DownToChild()) {
        break;
      }
      std::string const& child = parser_.CurrentElement().Text();
      if (isInOrder && !walk.Take(child)) {
        isInOrder = false;
        log_.AddViolation(parser_.CurrentLine(), Misplaced(form, walk, child));
      }
      Element();
      parser_.UpToParent();
    }
    if (isInOrder && !walk.IsComplete()) {
      log_.AddViolation(line, std::string(form.name) + " lacks " + walk.Expected());
    }
  }

  static std::string Misplaced(ElementForm const& form, ContentModel::Walk const& walk,
                               std::string const& child) {
    std::string const expected = walk.Expected();
    return child + " may not stand here in " + std::string(form.name) +
           (expected.empty() ? "" : ", but " + expected);
  }

  void TextBeforeChild(ElementForm const& form, bool isFirst) {
    UString const text = parser_.ReadText();
    bool const mayHoldText = form.content != ElementForm::kChildren;
    bool const isEmptyElement = !mayHoldText && ContentModel::Walk(form.model).Expected().empty();
    bool const isWrong = isEmptyElement ? isFirst && !text.empty() : !IsBlank(text);
    if (!mayHoldText && isWrong) {
      log_.AddViolation(parser_.CurrentLine(), std::string(form.name) + " may hold no text");
    }
  }

  XMLLib::Parser& parser_;
  ValidationLog& log_;
};

}  // namespace

void ValidateNameDocument(XMLLib::Parser& parser, ValidationLog& log) {
  Validator(parser, log).Document();
}

}  // namespace Ostinet::Impl
