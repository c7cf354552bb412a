// SPDX-License-Identifier: MIT
//
// The format as tables: what each element may hold and bear. The published definition carries no
// terms of use, so no copy of it ships; these rows say the same, and a test holds them against the
// definition where one is at hand.
#include "names/NameDocumentForm.h"

#include <algorithm>
#include <map>

#include "core/Unicode.h"

namespace Ostinet::Impl {

namespace {

using Attribute = AttributeForm;

struct ContentRow {
  std::string_view element;
  std::string_view model;
  ElementForm::Content content = ElementForm::kChildren;
};

constexpr char kChannelMessages[] =
    "(MIDIDelay|NoteOn|NoteOff|PolyKeyPressure|ControlChange|ProgramChange|ChannelKeyPressure"
    "|PitchBendChange|AllSoundOff|ResetAllControllers|LocalControl|AllNotesOff|OmniOff|OmniOn"
    "|MonoMode|PolyMode)+";
constexpr char kAllMessages[] =
    "(MIDIDelay|NoteOn|NoteOff|PolyKeyPressure|ControlChange|ProgramChange|ChannelKeyPressure"
    "|PitchBendChange|AllSoundOff|ResetAllControllers|LocalControl|AllNotesOff|OmniOff|OmniOn"
    "|MonoMode|PolyMode|SysEx)+";

// An empty model: the element is empty.
constexpr ContentRow kContents[] = {
    {"MIDINameDocument", "Author,(MasterDeviceNames+|ExtendingDeviceNames+|StandardDeviceMode+)"},
    {"Author", "", ElementForm::kText},
    {"MasterDeviceNames",
     "((Manufacturer,Model+)|Device),(CustomDeviceMode|SupportsStandardDeviceMode)+,"
     "ChannelNameSet*,(PatchNameList|NoteNameList|ControlNameList|ValueNameList)*"},
    {"ExtendingDeviceNames",
     "((Manufacturer,Model+)?|Device),(PatchNameList|NoteNameList|ControlNameList|ValueNameList)+"},
    {"Manufacturer", "", ElementForm::kText},
    {"Model", "", ElementForm::kText},
    {"Device", ""},
    {"StandardDeviceMode",
     "DeviceModeEnable?,DeviceModeDisable?,ChannelNameSetAssignments,ChannelNameSet+,"
     "(PatchNameList|NoteNameList|ControlNameList|ValueNameList)*"},
    {"CustomDeviceMode",
     "DeviceModeEnable?,DeviceModeDisable?,ChannelNameSetAssignments,"
     "(PatchNameList|NoteNameList|ControlNameList|ValueNameList)*"},
    {"DeviceModeEnable", "MIDICommands"},
    {"DeviceModeDisable", "MIDICommands"},
    {"SupportsStandardDeviceMode", ""},
    {"ChannelNameSetAssignments", "ChannelNameSetAssign+"},
    {"ChannelNameSetAssign", ""},
    {"ChannelNameSet",
     "AvailableForChannels,(NoteNameList|UsesNoteNameList)?,"
     "(ControlNameList|UsesControlNameList)?,PatchBank+"},
    {"AvailableForChannels", "AvailableChannel+"},
    {"AvailableChannel", ""},
    {"PatchBank", "MIDICommands?,(UsesPatchNameList|PatchNameList)"},
    {"UsesPatchNameList", ""},
    {"PatchNameList", "Patch*"},
    {"Patch",
     "PatchMIDICommands?,ChannelNameSetAssignments?,(NoteNameList|UsesNoteNameList)?,"
     "(ControlNameList|UsesControlNameList)?"},
    {"UsesNoteNameList", ""},
    {"NoteNameList", "(NoteGroup|Note)+"},
    {"NoteGroup", "Note*"},
    {"Note", ""},
    {"UsesControlNameList", ""},
    {"ControlNameList", "Control+"},
    {"Control", "Values?"},
    {"Values", "(ValueNameList|UsesValueNameList)?"},
    {"UsesValueNameList", ""},
    {"ValueNameList", "Value+"},
    {"Value", ""},
    {"MIDICommands", kAllMessages},
    {"PatchMIDICommands", kChannelMessages},
    {"MIDIDelay", ""},
    {"NoteOn", ""},
    {"NoteOff", ""},
    {"PolyKeyPressure", ""},
    {"ControlChange", ""},
    {"ProgramChange", ""},
    {"ChannelKeyPressure", ""},
    {"PitchBendChange", ""},
    {"AllSoundOff", ""},
    {"ResetAllControllers", ""},
    {"LocalControl", ""},
    {"AllNotesOff", ""},
    {"OmniOff", ""},
    {"OmniOn", ""},
    {"MonoMode", ""},
    {"PolyMode", ""},
    {"SysEx", "(SysExDeviceID|SysExChannel)*", ElementForm::kMixed},
    {"SysExDeviceID", ""},
    {"SysExChannel", ""},
};

constexpr char kChannelWords[] = "1|2|3|4|5|6|7|8|9|10|11|12|13|14|15|16";

constexpr Attribute Text(std::string_view element, std::string_view name,
                         Attribute::Need need = Attribute::kRequired) {
  return {element, name, Attribute::kText, need, Attribute::kRead};
}
constexpr Attribute Token(std::string_view element, std::string_view name,
                          Attribute::Need need = Attribute::kRequired,
                          Attribute::Use use = Attribute::kRead) {
  return {element, name, Attribute::kToken, need, use};
}
// Messages go out on the channel that the host says, so theirs is not read.
constexpr Attribute Channel(std::string_view element) {
  return {element,      "Channel", Attribute::kWord, Attribute::kOptional, Attribute::kNotRead,
          kChannelWords};
}

constexpr Attribute kAttributes[] = {
    Text("Device", "Name"),
    Token("Device", "UniqueID"),
    Text("StandardDeviceMode", "Name"),
    Text("CustomDeviceMode", "Name"),
    Text("SupportsStandardDeviceMode", "Name"),
    Token("ChannelNameSetAssign", "Channel"),
    Text("ChannelNameSetAssign", "NameSet"),
    Text("ChannelNameSet", "Name"),
    Token("AvailableChannel", "Channel"),
    {"AvailableChannel", "Available", Attribute::kWord, Attribute::kOptional, Attribute::kRead,
     "false|true"},
    Text("PatchBank", "Name", Attribute::kOptional),
    {"PatchBank", "ROM", Attribute::kWord, Attribute::kOptional, Attribute::kNotRead, "false|true"},
    Text("UsesPatchNameList", "Name"),
    Text("PatchNameList", "Name", Attribute::kOptional),
    Text("Patch", "Number"),
    Text("Patch", "Name"),
    Token("Patch", "ProgramChange", Attribute::kOptional),
    Text("UsesNoteNameList", "Name"),
    Text("NoteNameList", "Name", Attribute::kOptional),
    Text("NoteGroup", "Name", Attribute::kOptional),
    Token("Note", "Number"),
    Text("Note", "Name"),
    Text("UsesControlNameList", "Name"),
    Text("ControlNameList", "Name", Attribute::kOptional),
    {"Control", "Type", Attribute::kWord, Attribute::kOptional, Attribute::kRead,
     "7bit|14bit|RPN|NRPN"},
    Token("Control", "Number"),
    Text("Control", "Name"),
    Token("Values", "Min"),
    Token("Values", "Max"),
    Token("Values", "Default", Attribute::kOptional),
    Token("Values", "Units", Attribute::kOptional),
    Token("Values", "Mapping", Attribute::kOptional, Attribute::kNotRead),
    Text("UsesValueNameList", "Name"),
    Text("ValueNameList", "Name", Attribute::kOptional),
    Token("Value", "Number"),
    Text("Value", "Name"),
    Text("MIDIDelay", "Milliseconds"),
    Channel("NoteOn"),
    Token("NoteOn", "Note"),
    Token("NoteOn", "Velocity"),
    Channel("NoteOff"),
    Token("NoteOff", "Note"),
    Token("NoteOff", "Velocity"),
    Channel("PolyKeyPressure"),
    Token("PolyKeyPressure", "Note"),
    Token("PolyKeyPressure", "Pressure"),
    Channel("ControlChange"),
    Token("ControlChange", "Control"),
    Token("ControlChange", "Value"),
    Channel("ProgramChange"),
    Token("ProgramChange", "Number"),
    Channel("ChannelKeyPressure"),
    Token("ChannelKeyPressure", "Pressure"),
    Channel("PitchBendChange"),
    Token("PitchBendChange", "Value"),
    Channel("AllSoundOff"),
    Channel("ResetAllControllers"),
    Channel("LocalControl"),
    {"LocalControl", "Value", Attribute::kWord, Attribute::kRequired, Attribute::kRead, "off|on"},
    Channel("AllNotesOff"),
    Channel("OmniOff"),
    Channel("OmniOn"),
    Channel("MonoMode"),
    Token("MonoMode", "Value", Attribute::kRequired, Attribute::kNotRead),
    Channel("PolyMode"),
    Token("SysExDeviceID", "Multiplier", Attribute::kOptional),
    Token("SysExDeviceID", "Offset", Attribute::kOptional),
    Token("SysExChannel", "Multiplier", Attribute::kOptional),
    Token("SysExChannel", "Offset", Attribute::kOptional),
};

using Forms = std::map<std::string_view, ElementForm>;

Forms MakeForms() {
  Forms forms;
  for (ContentRow const& row : kContents) {
    forms.emplace(row.element, ElementForm{row.element, row.content, ContentModel(row.model), {}});
  }
  for (Attribute const& attribute : kAttributes) {
    forms.at(attribute.element).attributes.push_back(&attribute);
  }
  return forms;
}

struct Range {
  char32_t first, last;
};

// The characters of names in XML 1.0, fifth edition.
constexpr Range kNameCharacters[] = {
    {'-', '.'},       {'0', ':'},       {'A', 'Z'},         {'_', '_'},       {'a', 'z'},
    {0xB7, 0xB7},     {0xC0, 0xD6},     {0xD8, 0xF6},       {0xF8, 0x37D},    {0x37F, 0x1FFF},
    {0x200C, 0x200D}, {0x203F, 0x2040}, {0x2070, 0x218F},   {0x2C00, 0x2FEF}, {0x3001, 0xD7FF},
    {0xF900, 0xFDCF}, {0xFDF0, 0xFFFD}, {0x10000, 0xEFFFF},
};

bool IsNameCharacter(char32_t character) {
  return std::any_of(std::begin(kNameCharacters), std::end(kNameCharacters), [&](Range range) {
    return character >= range.first && character <= range.last;
  });
}

// Blanks around the value of a token or a word do not count.
std::u16string_view WithoutBlanks(UString const& value) {
  std::u16string_view text = value.utf16_str();
  while (!text.empty() && text.front() == ' ') {
    text.remove_prefix(1);
  }
  while (!text.empty() && text.back() == ' ') {
    text.remove_suffix(1);
  }
  return text;
}

bool IsToken(std::u16string_view text) {
  for (std::size_t position = 0; position < text.size();) {
    if (!IsNameCharacter(NextCharacter(text, position))) {
      return false;
    }
  }
  return !text.empty();
}

bool IsWordOf(std::string_view words, std::u16string_view text) {
  for (;;) {
    std::size_t const end = words.find('|');
    std::string_view const word = words.substr(0, end);
    if (std::equal(word.begin(), word.end(), text.begin(), text.end(),
                   [](char a, char16_t b) { return static_cast<unsigned char>(a) == b; })) {
      return true;
    }
    if (end == std::string_view::npos) {
      return false;
    }
    words.remove_prefix(end + 1);
  }
}

}  // namespace

AttributeForm const* ElementForm::FindAttribute(std::string_view attribute) const {
  auto const found =
      std::find_if(attributes.begin(), attributes.end(),
                   [&](AttributeForm const* each) { return each->name == attribute; });
  return found == attributes.end() ? nullptr : *found;
}

ElementForm const* FindElementForm(std::string_view element) {
  static Forms const sForms = MakeForms();
  auto const found = sForms.find(element);
  return found == sForms.end() ? nullptr : &found->second;
}

bool IsValueOf(AttributeForm const& attribute, UString const& value) {
  switch (attribute.type) {
    case AttributeForm::kText:
      return true;
    case AttributeForm::kToken:
      return IsToken(WithoutBlanks(value));
    case AttributeForm::kWord:
      return IsWordOf(attribute.words, WithoutBlanks(value));
  }
  return false;
}

}  // namespace Ostinet::Impl
