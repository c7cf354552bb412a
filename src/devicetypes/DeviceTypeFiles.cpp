// SPDX-License-Identifier: MIT
//
// From the files to the catalog's list. Where two files describe one model, a file whose author is
// the maker himself wins against all others, the first such file against later ones, and else the
// first file: the user's files come before the machine's. What loses is dropped whole.
#include <algorithm>
#include <utility>

#include "devicetypes/DevTypeFileReader.h"
#include "devicetypes/DeviceTypeCatalogImpl.h"
#include "ostinet/DeviceTypeCatalog.h"

namespace Ostinet::Impl {

namespace {

class DevTypeFileVisitor : public XMLFilesVisitor, private Noncopyable<DevTypeFileVisitor> {
 public:
  void Visit(File const& file, bool) override {
    DevTypeFileReader reader(file);
    try {
      reader.Read();
    } catch (...) {
      // One bad file costs nobody else's types, and what it gave before its fault is good.
    }
    for (RCPtrMT<DeviceTypeInfoImpl> const& type : reader.Types()) {
      Insert(type, type->manufacturer.equal(reader.Author(), UString::kCatalogKey));
    }
  }

  DeviceTypes Take() {
    DeviceTypes types;
    types.reserve(entries_.size());
    for (Entry& entry : entries_) {
      types.push_back(std::move(entry.type));
    }
    return types;
  }

 private:
  struct Entry {
    RCPtrMT<DeviceTypeInfoImpl> type;
    bool isAuthoritative;
  };

  void Insert(RCPtrMT<DeviceTypeInfoImpl> const& type, bool isAuthoritative) {
    auto const place = std::lower_bound(
        entries_.begin(), entries_.end(), *type,
        [](Entry const& entry, auto const& wanted) { return ComesBefore(*entry.type, wanted); });
    if (place == entries_.end() || !IsSameModel(*place->type, *type)) {
      entries_.insert(place, {type, isAuthoritative});
    } else if (isAuthoritative && !place->isAuthoritative) {
      *place = {type, true};
    }
  }

  std::vector<Entry> entries_;  // sorted
};

}  // namespace

DeviceTypes ReadDeviceTypeFiles() {
  DevTypeFileVisitor visitor;
  VisitXMLFiles(visitor, "middev");
  return visitor.Take();
}

}  // namespace Ostinet::Impl
