// SPDX-License-Identifier: MIT
#include "model/PropertyPathXML.h"

#include "ostinet/Setup.h"

namespace Ostinet::Impl {

namespace {

using XMLLib::Name;

Name const kPath("Path");
Name const kType("type");

/// What a stored path starts from.
enum class Base { kAbsolute, kUserMidiDevices, kSystemMidiDevices, kTempMidiDevices };

constexpr XMLLib::AttributeMap<Base>::Entry kBaseWords[] = {
    {"Absolute", Base::kAbsolute},
    {"UserMidiDevices", Base::kUserMidiDevices},
    {"SystemMidiDevices", Base::kSystemMidiDevices},
    {"TempMidiDevices", Base::kTempMidiDevices},
};
constexpr XMLLib::AttributeMap<Base> kBases{kBaseWords};

/// The full path of a base's folder; empty where there is none.
UString FolderPath(Base base) {
  Folder folder;
  switch (base) {
    case Base::kAbsolute:
      break;
    case Base::kUserMidiDevices:
      folder = Folder::Find(Folder::kUserDeviceFiles, Folder::kDoNotCreate);
      break;
    case Base::kSystemMidiDevices:
      folder = Folder::Find(Folder::kSystemDeviceFiles, Folder::kDoNotCreate);
      break;
    case Base::kTempMidiDevices:
      if (PrefsHandler* const prefs = Setup::Instance().GetPrefsHandler()) {
        prefs->GetFolder(folder);
      }
      break;
  }
  return folder.GetFullPath();
}

void WritePathElement(XMLLib::Writer& writer, Base base, UString const& text) {
  writer.StartElement(kPath);
  writer.Attribute(kType, kBases, base);
  writer.Write(text);
  writer.EndElement();
}

}  // namespace

void WritePath(XMLLib::Writer& writer, UString const& path) {
  FileSpecification const file(path);
  if (!file.IsFile()) {
    if (!path.empty()) {
      WritePathElement(writer, Base::kAbsolute, path);
    }
    return;
  }
  UString const full = file.GetFullPath();
  for (Base const base :
       {Base::kUserMidiDevices, Base::kSystemMidiDevices, Base::kTempMidiDevices}) {
    UString const folder = FolderPath(base);
    // Anywhere in the path, not only at its front: studios written so are in use.
    UString::size_type const place = folder.empty() ? UString::npos : full.find(folder);
    if (place != UString::npos) {
      WritePathElement(writer, base, full.substr(place + folder.length()));
      return;
    }
  }
  WritePathElement(writer, Base::kAbsolute, full);
}

UString ReadPath(XMLLib::Parser& parser) {
  UString path;
  if (parser.DownToReqChildNounexp(kPath)) {
    Base base = Base::kAbsolute;
    if (parser.ReadReqAttribute(kType, kBases, base)) {
      UString const text = parser.ReadText();
      if (base == Base::kAbsolute) {
        path = text;
      } else {
        UString const folder = FolderPath(base);
        path = folder.empty() ? UString() : folder + text;
      }
    }
    parser.UpToParent();
  }
  return FileSpecification(path).GetFullPath();
}

}  // namespace Ostinet::Impl
