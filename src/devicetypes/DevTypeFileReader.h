// SPDX-License-Identifier: MIT
#pragma once

#include <initializer_list>
#include <span>
#include <vector>

#include "devicetypes/DeviceTypeFlags.h"
#include "devicetypes/DeviceTypeInfoImpl.h"
#include "ostinet/DeviceTypeCatalog.h"
#include "ostinet/core/Files.h"
#include "ostinet/core/XML.h"

namespace Ostinet::Impl {

/// What one device type file yields.
///
/// Threads    One object on one thread at a time.
/// Errors     Read throws what the parser throws. The types and the author that were read before
///            stay; a type counts once its element has ended.
class DevTypeFileReader {
 public:
  /// `notes`, which may be null, gets each thing that the reader passes over, in file order.
  explicit DevTypeFileReader(File const& file, std::vector<DeviceTypeFileNote>* notes = nullptr)
      : file_(file), notes_(notes) {}

  void Read();
  /// The same of a document that lies elsewhere; `parser` stands above its root.
  void Read(XMLLib::Parser& parser);

  std::vector<RCPtrMT<DeviceTypeInfoImpl>> const& Types() const { return types_; }
  /// The lines on which these types start.
  std::vector<int> const& Lines() const { return lines_; }
  /// Who wrote the file; empty if it does not say.
  UString const& Author() const { return author_; }
  /// The full path of a picture beside the file or in "Images" beside it; empty if there is none.
  /// Hosts that show a type's picture before it is installed use this; applying a type does not.
  UString FindImage(UString const& name) const;

 private:
  using Type = DeviceTypeInfoImpl;

  void ReadType(XMLLib::Parser& parser);
  void ReadTypeChild(XMLLib::Parser& parser, Type& type);
  void ReadInquiryResponse(XMLLib::Parser const& parser, Type& type);
  void ReadDeviceID(XMLLib::Parser const& parser, Type& type);
  void ReadPortGroup(XMLLib::Parser& parser, Type& type);
  void ReadFlag(XMLLib::Parser const& parser, DeviceTypeFlag const& flag, TriBool& value);
  template <std::size_t N>
  void ReadTraffic(XMLLib::Parser const& parser, DeviceTypeFlag const (&flags)[N],
                   DeviceTypeTraffic<N>& traffic);

  // What is said to the author of a file; nothing while the catalog loads.
  void Note(XMLLib::Parser const& parser, UString const& text);
  void NoteElement(XMLLib::Parser const& parser, char const* place);
  void NoteAttributes(XMLLib::Parser const& parser,
                      std::initializer_list<XMLLib::Name const*> known,
                      std::span<DeviceTypeFlag const> flags = {});

  File const file_;
  std::vector<DeviceTypeFileNote>* const notes_;
  UString author_;
  std::vector<RCPtrMT<DeviceTypeInfoImpl>> types_;
  std::vector<int> lines_;
};

/// Whether two types are one to the catalog: their makers and models differ in nothing but case
/// and white space.
bool IsSameModel(DeviceTypeInfoImpl const& a, DeviceTypeInfoImpl const& b);
/// The order of the catalog.
bool ComesBefore(DeviceTypeInfoImpl const& a, DeviceTypeInfoImpl const& b);

}  // namespace Ostinet::Impl
