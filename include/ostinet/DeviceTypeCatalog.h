// SPDX-License-Identifier: MIT
#pragma once

#include <memory>
#include <utility>
#include <vector>

#include "ostinet/Common.h"
#include "ostinet/DeviceObject.h"
#include "ostinet/core/Files.h"
#include "ostinet/core/Noncopyable.h"
#include "ostinet/core/SortedVector.h"

namespace Ostinet {

namespace Autodetect {
class Request;
}

namespace Impl {
class DeviceTypeCatalogImpl;
}

/// The ports of one entity of an instrument, by name, seen from the instrument: what goes in is a
/// destination of the studio, what comes out a source. A name is empty where the type gives none.
struct DeviceTypePorts {
  UString name;
  std::vector<UString> ins;
  std::vector<UString> outs;
};

/// What a device type tells of its instruments, for hosts that show it. A host that wants a device
/// to be such an instrument calls Setup::ChangeDeviceType.
struct DeviceTypeFacts {
  UString image;              ///< a file name without its folder, or empty
  ModelInfo inquiryResponse;  ///< all 0xFF: not known
  bool hasDeviceID = false;   ///< whether the next three mean anything
  unsigned char defaultDeviceID = 0xFF;
  unsigned char minDeviceID = 0xFF;
  unsigned char maxDeviceID = 0xFF;
  unsigned short receiveMaxChannels = 16;   ///< 0 to 16
  unsigned short transmitMaxChannels = 16;  ///< 0 to 16
  /// What the type affirms or denies: the names of the device's properties ("is sampler"), in the
  /// order in which they are set. What is not here is not known.
  std::vector<std::pair<UString, bool>> flags;
  std::vector<DeviceTypePorts> ports;  ///< one for each entity; empty: not known
};

/// An instrument model of the catalog. Immutable.
///
/// Ownership    Counted. A handle is not to be used after the process began to exit.
/// Null handle  Default-constructed. Exists is false, the texts are empty.
/// Threads      [any thread], one handle on one thread at a time.
/// Errors       None are thrown.
class OSTINET_EXPORT DeviceTypeInfo {
 public:
  DeviceTypeInfo();
  DeviceTypeInfo(RCPtrMT<Impl::DeviceTypeInfoImpl> const& impl);
  DeviceTypeInfo(DeviceTypeInfo const& other);
  DeviceTypeInfo& operator=(DeviceTypeInfo const& other);
  /// True for two handles of one type of the catalog, and for two null handles.
  bool operator==(DeviceTypeInfo const& other) const;
  bool operator!=(DeviceTypeInfo const& other) const;

  bool Exists() const;
  UString GetMfrName() const;
  UString GetModelName() const;
  /// True if the device's manufacturer and model are exactly this type's. False for a null handle
  /// of a type.
  bool MatchesDevice(Device const& device) const;
  /// The defaults for a null handle.
  DeviceTypeFacts GetFacts() const;
  /// The object behind the handle, null for a null handle.
  Impl::DeviceTypeInfoImpl* GetImplPtr() const { return impl_.get(); }

 private:
  RCPtrMT<Impl::DeviceTypeInfoImpl> impl_;
};

/// The instrument models that the device type files describe, and the questions that find out
/// which of them hang on a port.
///
/// Device type files end in ".middev". They are looked for in the user's folder first, then in the
/// machine's (Folder::FindType), each with all folders below it. Of several types of one maker and
/// model the first counts, unless one comes from a file whose author is the maker.
///
/// Ownership    One object, read once and never again, which lives to the end of the process. It
///              needs no Setup.
/// Threads      [any thread]
/// Errors       None are thrown: what cannot be read is not in the catalog. CheckDeviceTypeFile
///              tells what that is.
class OSTINET_EXPORT DeviceTypeCatalog : private Noncopyable<DeviceTypeCatalog> {
 public:
  /// Reads all files at the first call.
  static DeviceTypeCatalog& Instance();

  /// The types, sorted by maker and model without regard to case and white space; behind them
  /// those that no file describes, but that autodetect can name.
  int CountDeviceTypes() const;
  /// A null handle out of range.
  DeviceTypeInfo GetDeviceType(int index) const;
  /// The type of exactly this maker and model, case and white space included, or a null handle.
  DeviceTypeInfo GetDeviceType(UString const& manufacturer, UString const& model) const;
  /// Adds the maker of each type to what the set holds already.
  template <class C>
  void CollectManufacturers(sorted_vector_set<UString, C>& manufacturers) const {
    for (int i = 0; i < CountDeviceTypes(); ++i) {
      manufacturers.insert(GetDeviceType(i).GetMfrName());
    }
  }
  /// Appends the types of exactly this maker, then sorts all of `models` by model, as people
  /// expect it: without regard to case, and numbers by their value.
  void CollectModels(UString const& manufacturer, std::vector<DeviceTypeInfo>& models) const;

  /// The requests, the universal inquiry first.
  int CountAutodetectRequests() const;
  /// A null handle out of range.
  Autodetect::Request GetAutodetectRequest(int index) const;

 private:
  DeviceTypeCatalog();
  ~DeviceTypeCatalog();

  std::unique_ptr<Impl::DeviceTypeCatalogImpl const> const impl_;
};

/// Something in a device type file that the catalog passes over.
struct DeviceTypeFileNote {
  int line;      ///< from 1; 0 for a file that cannot be read
  UString text;  ///< what, and why
};

/// What the catalog would make of a device type file.
struct DeviceTypeFileCheck {
  UString author;                         ///< empty if the file does not say
  std::vector<DeviceTypeInfo> types;      ///< those that it yields, in file order
  std::vector<DeviceTypeFileNote> notes;  ///< what is passed over, in file order
};

/// Reads a file as the catalog does and tells what of it is passed over: unknown elements and
/// attributes, values out of range, a second type of one model, names that new devices do not get,
/// pictures that are not installed, what stands behind a fault of the XML. Throws nothing, also for
/// a file that cannot be opened.
OSTINET_EXPORT DeviceTypeFileCheck CheckDeviceTypeFile(File const& file);

namespace Impl {

/// Is shown the data files of one kind.
class OSTINET_EXPORT XMLFilesVisitor {
 public:
  virtual ~XMLFilesVisitor();
  /// `inUserFolder` is false for a file of the machine's folder.
  virtual void Visit(File const& file, bool inUserFolder) = 0;
};

/// Shows the files whose names end in a dot and `extension`, in any case: first those of the user's
/// folder, then those of the machine's. Folders are walked in the order of their entries' names,
/// and one that is met is walked before what follows it.
OSTINET_EXPORT void VisitXMLFiles(XMLFilesVisitor& visitor, char const* extension);

}  // namespace Impl

}  // namespace Ostinet
