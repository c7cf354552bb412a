// SPDX-License-Identifier: MIT
//
// Documents are many and reading XML is slow, so a digest is made on first need, kept while the
// file's date stays, and handed from one session to the next.
#include "names/NamesCatalogImpl.h"

#include <map>
#include <utility>

#include "core/Time.h"
#include "ostinet/DeviceTypeCatalog.h"
#include "ostinet/core/Error.h"

namespace Ostinet::Impl {

namespace {

constexpr double kTicksPerSecond = 60.0;
constexpr long long kTicksBetweenScans = 3600;

long long Now() {
  return static_cast<long long>(VantorSystemTime::GetCurrentEventTime() * kTicksPerSecond + 0.5);
}

/// Gathers the documents of a scan; what stands in `old` under the same date is taken over.
class Visitor : public XMLFilesVisitor {
 public:
  Visitor(std::vector<NameDocumentDigest>& old, std::vector<NameDocumentDigest>& found)
      : found_(found) {
    for (NameDocumentDigest& digest : old) {
      unclaimed_.emplace(Key(digest.inUserFolder, digest.file), &digest);
    }
  }

  void Visit(File const& file, bool inUserFolder) override {
    NameDocumentDigest digest;
    try {
      digest.modDate = file.GetModDate();
    } catch (VantorError const&) {
      return;  // gone since the folder was listed
    }
    digest.file = file;
    digest.inUserFolder = inUserFolder;
    if (NameDocumentDigest* const known = Claim(digest)) {
      if (known->modDate == digest.modDate) {
        found_.push_back(std::move(*known));
        return;
      }
    }
    found_.push_back(std::move(digest));
  }

 private:
  using Key = std::pair<bool, FileSpecification>;

  NameDocumentDigest* Claim(NameDocumentDigest const& digest) {
    auto const place = unclaimed_.find(Key(digest.inUserFolder, digest.file));
    if (place == unclaimed_.end()) {
      return nullptr;
    }
    NameDocumentDigest* const known = place->second;
    unclaimed_.erase(place);
    return known;
  }

  std::vector<NameDocumentDigest>& found_;
  std::map<Key, NameDocumentDigest*> unclaimed_;  // into the old ones, the first of each file
};

}  // namespace

// Never destroyed: the studio may sign out while the process ends, and saves the catalog then.
NamesCatalogImpl& NamesCatalogImpl::Instance() {
  static NamesCatalogImpl& instance = *new NamesCatalogImpl;
  return instance;
}

void NamesCatalogImpl::Search(Func& look, Faults faults) {
  ScanIfDue();
  for (NameDocumentDigest& digest : documents_) {
    if (!digest.isParsed) {
      ++parsedCount_;
      try {
        ParseDigest(digest);
      } catch (VantorError const&) {
        if (faults == Faults::kThrow) {
          throw;
        }
        continue;
      }
    }
    if (look(digest)) {
      return;
    }
  }
}

void NamesCatalogImpl::ScanIfDue() {
  long long const now = Now();
  if (!lastScan_ || now >= *lastScan_ + kTicksBetweenScans) {
    Scan();
    lastScan_ = now;
  }
}

void NamesCatalogImpl::Scan() {
  std::vector<NameDocumentDigest> old = std::exchange(documents_, {});
  Visitor visitor(old, documents_);
  VisitXMLFiles(visitor, "midnam");
}

}  // namespace Ostinet::Impl
