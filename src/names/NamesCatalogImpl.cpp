// SPDX-License-Identifier: MIT
//
// Documents are many and reading XML is slow, so a digest is made on first need, kept while the
// file's date stays, and handed from one session to the next.
#include "names/NamesCatalogImpl.h"

#include <cmath>
#include <map>
#include <utility>

#include "core/Time.h"
#include "ostinet/DeviceTypeCatalog.h"
#include "ostinet/core/Error.h"

namespace Ostinet::Impl {

namespace {

constexpr double kTicksPerSecond = 60.0;
constexpr long long kTicksBetweenScans = 3600;

long long Now() { return std::llround(VantorSystemTime::GetCurrentEventTime() * kTicksPerSecond); }

/// Gathers the documents of a scan; what stands in `old` under the same date is taken over.
class Visitor : public XMLFilesVisitor {
 public:
  Visitor(std::vector<NameDocumentDigest>& old, std::vector<NameDocumentDigest>& found)
      : next_(old.begin()), end_(old.end()), found_(found) {
    found_.reserve(old.size());
  }

  void Visit(File const& file, bool inUserFolder) override {
    FileModDate date;
    try {
      date = file.GetModDate();
    } catch (VantorError const&) {
      return;  // gone since the folder was listed
    }
    NameDocumentDigest* const known = Claim(file, inUserFolder);
    if (known != nullptr && known->modDate == date) {
      found_.push_back(std::move(*known));
      return;
    }
    NameDocumentDigest& digest = found_.emplace_back();
    digest.file = file;
    digest.inUserFolder = inUserFolder;
    digest.modDate = date;
  }

 private:
  using Key = std::pair<bool, FileSpecification>;

  // Mostly the walk meets what it met the last time, in the same order. At the first difference
  // what is left is indexed.
  NameDocumentDigest* Claim(FileSpecification const& file, bool inUserFolder) {
    if (next_ != end_ && next_->inUserFolder == inUserFolder && next_->file == file) {
      return &*next_++;
    }
    for (; next_ != end_; ++next_) {
      unclaimed_.emplace(Key(next_->inUserFolder, next_->file), &*next_);
    }
    auto const place = unclaimed_.find(Key(inUserFolder, file));
    if (place == unclaimed_.end()) {
      return nullptr;
    }
    NameDocumentDigest* const known = place->second;
    unclaimed_.erase(place);
    return known;
  }

  std::vector<NameDocumentDigest>::iterator next_;  // up to here all are claimed or indexed
  std::vector<NameDocumentDigest>::iterator const end_;
  std::vector<NameDocumentDigest>& found_;
  std::map<Key, NameDocumentDigest*> unclaimed_;  // the first of each file
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
