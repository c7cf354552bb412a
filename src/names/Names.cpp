// SPDX-License-Identifier: MIT
#include "ostinet/NamesCatalog.h"

namespace Ostinet {

namespace {

constexpr unsigned char kNone = 255;

UString WithoutExtension(UString const& fileName) {
  // Of no dot, everything is in front.
  return fileName.substr(0, fileName.rfind(u'.'));
}

}  // namespace

PatchNumbers::PatchNumbers() : PatchNumbers(kNone, kNone, kNone) {}
PatchNumbers::PatchNumbers(unsigned char theProgram, unsigned char theMSB, unsigned char theLSB)
    : program(theProgram), msb(theMSB), lsb(theLSB) {}

NoteGroup::NoteGroup() : id(0) {}

Names::Names() : type_(kNoNames) {}
Names::Names(Type type, FileSpecification const& file)
    : Names(type, file, WithoutExtension(file.GetName())) {}
Names::Names(Type type, FileSpecification const& file, UString const& name)
    : type_(type), file_(file), name_(name) {}

bool Names::Exists() const { return type_ != kNoNames; }
Names::Type Names::GetType() const { return type_; }
FileSpecification const& Names::GetFile() const { return file_; }
UString const& Names::GetName() const { return name_; }

bool Names::operator==(Names const& other) const {
  return type_ == other.type_ && file_ == other.file_ && name_ == other.name_;
}
bool Names::operator!=(Names const& other) const { return !(*this == other); }

}  // namespace Ostinet
