// SPDX-License-Identifier: MIT
#include <algorithm>
#include <cstdlib>
#include <string_view>

#include "devicetypes/DevTypeFileReader.h"
#include "ostinet/core/Error.h"

namespace Ostinet {

namespace {

using Types = std::vector<RCPtrMT<Impl::DeviceTypeInfoImpl>>;

// The first type of a model counts, also within a file.
bool IsRepeated(Types const& types, std::size_t index) {
  auto const end = types.begin() + static_cast<std::ptrdiff_t>(index);
  return std::any_of(types.begin(), end, [&](auto const& earlier) {
    return Impl::IsSameModel(*earlier, *types[index]);
  });
}

bool IsInstalled(UString const& image) {
  FileSpecification found;
  return Folder::Find(Folder::kSystemDeviceFiles, Folder::kDoNotCreate).SearchFolder(image, found);
}

// The parser's texts name the line where it gave up: "line 7: mismatched tag". A fault of another
// kind means that the file could not be read at all.
DeviceTypeFileNote NoteOfFault() {
  VantorError const fault = VantorError::GetCurrentError();
  constexpr std::string_view kBefore = "line ";
  std::size_t const end = fault.Text().find(": ");
  if (fault.Domain() != "XML" || !fault.Text().starts_with(kBefore) || end == std::string::npos) {
    return {0, "the file cannot be read: " + UString(fault.Text())};
  }
  return {std::atoi(fault.Text().c_str() + kBefore.size()),
          "nothing is read from here on: " + UString(fault.Text().substr(end + 2))};
}

UString Numbered(char const* thing, std::size_t index) {
  UString text;
  text.Stream() << thing << " " << static_cast<unsigned long>(index + 1);
  return text;
}

// A new device names all inputs of a group or none, as one of them says.
void CheckInputNames(Impl::DeviceTypeInfoImpl const& type, int line, DeviceTypeFileCheck& check) {
  for (std::size_t i = 0; i < type.portGroups.size(); ++i) {
    auto const& names = type.portGroups[i].ins;
    bool const isAnyNamed =
        std::any_of(names.begin(), names.end(), [](UString const& name) { return !name.empty(); });
    if (isAnyNamed && i < names.size() && names[i].empty()) {
      check.notes.push_back({line, Numbered("input", i) + " of " + Numbered("port group", i) +
                                       " has no name: new devices skip those of the others, too"});
    }
  }
}

// What only the whole file tells.
void CheckTypes(Impl::DevTypeFileReader const& reader, DeviceTypeFileCheck& check) {
  for (std::size_t i = 0; i < reader.Types().size(); ++i) {
    Impl::DeviceTypeInfoImpl const& type = *reader.Types()[i];
    if (IsRepeated(reader.Types(), i)) {
      check.notes.push_back(
          {reader.Lines()[i], "\"" + type.manufacturer + "\" \"" + type.model +
                                  "\" stands above already: this one is skipped"});
      continue;
    }
    check.types.push_back(DeviceTypeInfo(reader.Types()[i]));
    CheckInputNames(type, reader.Lines()[i], check);
    if (!type.image.empty() && !IsInstalled(type.image)) {
      check.notes.push_back({reader.Lines()[i], "the picture \"" + type.image +
                                                    "\" is not in the machine's folder of device "
                                                    "files: devices will have none"});
    }
  }
}

}  // namespace

DeviceTypeFileCheck CheckDeviceTypeFile(File const& file) {
  DeviceTypeFileCheck check;
  Impl::DevTypeFileReader reader(file, &check.notes);
  try {
    reader.Read();
  } catch (...) {
    check.notes.push_back(NoteOfFault());
  }
  check.author = reader.Author();
  CheckTypes(reader, check);
  std::stable_sort(check.notes.begin(), check.notes.end(),
                   [](auto const& a, auto const& b) { return a.line < b.line; });
  return check;
}

}  // namespace Ostinet
