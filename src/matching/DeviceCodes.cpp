// SPDX-License-Identifier: MIT
//
// The file of device codes:
//
//   <BVDevices>
//     <Manufacturer name="Acme" code="2A">      a maker's code has its low eight bits clear: 0x2A00
//       <Model name="Synth 1" code="1F"/>
//     </Manufacturer>
//   </BVDevices>
//
// A later element of the same key takes the place of the earlier one.
#include "matching/DeviceCodes.h"

#include <cstdint>
#include <string_view>

#include "ostinet/core/XML.h"

namespace Ostinet::Impl {

namespace {

constexpr unsigned kManufacturerShift = 8;
constexpr unsigned kModelShift = 0;

// 0 for what is no digit.
std::uint32_t DigitValue(char16_t unit) {
  constexpr std::u16string_view kDigits = u"0123456789ABCDEF";
  char16_t const upper = unit >= u'a' && unit <= u'f' ? static_cast<char16_t>(unit - 32) : unit;
  std::size_t const place = kDigits.find(upper);
  return place == kDigits.npos ? 0 : static_cast<std::uint32_t>(place);
}

// From the last digit on. Files in use hold codes with other characters in them, which take up a
// digit's place, and codes longer than a number, which wrap around.
int ParseCode(UString const& text, unsigned shift) {
  constexpr unsigned kBits = 32;
  std::uint32_t code = 0;
  for (std::size_t i = text.length(); i > 0; --i) {
    if (!XMLLib::Parser::IsWhitespace(text[i - 1])) {
      code |= DigitValue(text[i - 1]) << shift;
      shift = (shift + 4) % kBits;
    }
  }
  return static_cast<int>(code);
}

// The attributes of the parser's element; false if one is missing.
bool ReadNameAndCode(XMLLib::Parser const& parser, unsigned shift, UString& name, int& code) {
  UString codeText;
  if (!parser.ReadReqAttribute("name", name) || !parser.ReadReqAttribute("code", codeText)) {
    return false;
  }
  code = ParseCode(codeText, shift);
  return true;
}

// Calls `add`(name, code) for each maker, which gives the function to call for each of its models.
template <class AddManufacturer>
void Walk(XMLLib::Parser& parser, AddManufacturer const& add) {
  if (!parser.DownToReqChildNounexp("BVDevices")) {
    return;
  }
  UString name;
  int code = 0;
  while (parser.DownToChildNounexp("Manufacturer")) {
    if (ReadNameAndCode(parser, kManufacturerShift, name, code)) {
      auto const addModel = add(name, code);
      while (parser.DownToChildNounexp("Model")) {
        if (ReadNameAndCode(parser, kModelShift, name, code)) {
          addModel(name, code);
        }
        parser.UpToParent();
      }
    }
    parser.UpToParent();
  }
}

// What was read before a fault in the file serves: one bad line does not cost a user the rest.
template <class AddManufacturer>
void ReadAsFarAsPossible(File const& file, AddManufacturer const& add) {
  try {
    XMLLib::Parser parser(file);
    Walk(parser, add);
  } catch (...) {
  }
}

}  // namespace

File DeviceCodesFile() { return ResourceAccess::Instance().GetFile("BVDevices", "xml"); }

DeviceTextsByCode::DeviceTextsByCode(File const& file) {
  ReadAsFarAsPossible(file, [this](UString const& name, int code) {
    Manufacturer& manufacturer = manufacturers_[code] = Manufacturer{name, {}};
    return [&manufacturer](UString const& modelName, int modelCode) {
      manufacturer.models[modelCode] = modelName;
    };
  });
}

DeviceTexts DeviceTextsByCode::Find(DeviceNumbers const& numbers) const {
  DeviceTexts texts;
  auto const place = manufacturers_.find(numbers.manufacturer);
  if (numbers.manufacturer == 0 || place == manufacturers_.end()) {
    return texts;
  }
  texts.manufacturer = place->second.name;
  auto const& models = place->second.models;
  auto const model = models.find(numbers.model);
  if (numbers.model != 0 && model != models.end()) {
    texts.model = model->second;
  }
  return texts;
}

DeviceCodesByText::DeviceCodesByText(File const& file) {
  ReadAsFarAsPossible(file, [this](UString const& name, int code) {
    Manufacturer& manufacturer = manufacturers_[name] = Manufacturer{code, {}};
    return [&manufacturer](UString const& modelName, int modelCode) {
      manufacturer.models[modelName] = modelCode;
    };
  });
}

DeviceNumbers DeviceCodesByText::Find(DeviceTexts const& texts) const {
  DeviceNumbers numbers;
  auto const place = manufacturers_.find(texts.manufacturer);
  if (texts.manufacturer.empty() || place == manufacturers_.end()) {
    return numbers;
  }
  numbers.manufacturer = place->second.code;
  auto const& models = place->second.models;
  auto const model = models.find(texts.model);
  if (!texts.model.empty() && model != models.end()) {
    numbers.model = model->second;
  }
  return numbers;
}

}  // namespace Ostinet::Impl
