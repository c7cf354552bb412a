// SPDX-License-Identifier: MIT
#include "model/PropertyXML.h"

#include "model/PropertyKeys.h"
#include "model/PropertyPathXML.h"

namespace Ostinet::Impl {

namespace {

using XMLLib::Name;
using XMLLib::Parser;
using XMLLib::Writer;

Name const kKey("key");
Name const kInt("Int");
Name const kIntItem("IntItem");
Name const kIntList("IntList");
Name const kString("String");
Name const kStringItem("StringItem");
Name const kStringList("StringList");
Name const kDict("Dict");
Name const kFile("File");

UString NumberText(int number) {
  UString text;
  vantor::NumToUString(number, vantor::kDecimal, text);
  return text;
}

// A number that does not fit reads as 0, as every other text that is no number.
int ReadNumber(Parser& parser) {
  return vantor::UStringToInt32(parser.ReadText(), vantor::kDecimal);
}

// One overload for each kind of value, of properties and of the entries of a Dict alike.
class ElementWriter : public boost::static_visitor<void> {
 public:
  ElementWriter(Writer& writer, UString const& key) : writer_(writer), key_(key) {}

  void operator()(int value) const {
    Start(kInt);
    writer_.Write(NumberText(value));
    writer_.EndElement();
  }
  void operator()(UString const& value) const {
    Start(kString);
    writer_.Write(value);
    writer_.EndElement();
  }
  void operator()(std::vector<int> const& values) const {
    Start(kIntList);
    for (int const value : values) {
      writer_.Element(kIntItem, NumberText(value));
    }
    writer_.EndElement();
  }
  void operator()(std::vector<UString> const& values) const {
    Start(kStringList);
    for (UString const& value : values) {
      writer_.Element(kStringItem, value);
    }
    writer_.EndElement();
  }
  void operator()(PropertyDict const& dict) const {
    Start(kDict);
    for (auto const& [key, value] : dict.entries) {
      boost::apply_visitor(ElementWriter(writer_, key), value);
    }
    writer_.EndElement();
  }
  void operator()(PropertyPath const& value) const {
    Start(kFile);
    WritePath(writer_, value.path);
    writer_.EndElement();
  }

 private:
  void Start(Name const& element) const {
    writer_.StartElement(element);
    writer_.Attribute(kKey, key_);
  }

  Writer& writer_;
  UString const& key_;
};

std::vector<int> ReadIntList(Parser& parser) {
  std::vector<int> numbers;
  for (; parser.DownToChildNounexp(kIntItem); parser.UpToParent()) {
    numbers.push_back(ReadNumber(parser));
  }
  return numbers;
}

std::vector<UString> ReadStringList(Parser& parser) {
  std::vector<UString> texts;
  for (; parser.DownToChildNounexp(kStringItem); parser.UpToParent()) {
    texts.push_back(parser.ReadText());
  }
  return texts;
}

// A Dict holds no numbers, so an "Int" among its children is one more element that is unknown.
// The parser bounds the depth.
PropertyDict ReadDict(Parser& parser) {
  PropertyDict dict;
  for (; parser.DownToChild(); parser.UpToParent()) {
    UString key;
    if (!parser.ReadReqAttribute(kKey, key)) {
      continue;
    }
    Name const& element = parser.CurrentElement();
    if (element == kString) {
      dict.entries[key] = parser.ReadText();
    } else if (element == kStringList) {
      dict.entries[key] = ReadStringList(parser);
    } else if (element == kFile) {
      dict.entries[key] = PropertyPath{ReadPath(parser)};
    } else if (element == kDict) {
      dict.entries[key] = ReadDict(parser);
    }
  }
  return dict;
}

void ReadProperty(Parser& parser, ImplImpl& peer, UString const& key) {
  Name const& element = parser.CurrentElement();
  if (element == kInt) {
    peer.SetInt(key, ReadNumber(parser));
  } else if (element == kString) {
    peer.SetString(key, parser.ReadText());
  } else if (element == kIntList) {
    peer.SetIntList(key, ReadIntList(parser));
  } else if (element == kDict) {
    peer.SetDict(key, ReadDict(parser));
  } else if (element == kFile) {
    peer.SetFile(key, ReadPath(parser));
  }
}

}  // namespace

void WriteProperty(Writer& writer, UString const& key, PropertyValue const& value) {
  boost::apply_visitor(ElementWriter(writer, key), value);
}

void ReadProperties(Parser& parser, ImplImpl& peer, bool skipIDs) {
  for (; parser.DownToChild(); parser.UpToParent()) {
    UString key;
    bool const isWanted = parser.ReadReqAttribute(kKey, key) &&
                          !(skipIDs && (key == Keys::kUniqueID || key == Keys::kConnUniqueID));
    if (isWanted) {
      ReadProperty(parser, peer, key);
    }
  }
}

}  // namespace Ostinet::Impl
