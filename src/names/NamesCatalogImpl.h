// SPDX-License-Identifier: MIT
#pragma once

#include <optional>
#include <vector>

#include "names/NameDocumentDigest.h"

namespace Ostinet {
class PrefsHandler;
}

namespace Ostinet::Impl {

class PrefsBlockReader;
class PrefsBlockWriter;

/// The digests of the name documents of this machine.
///
/// Ownership    One object, which outlives everything else of the library.
/// Threads      The host's polling thread.
class NamesCatalogImpl {
 public:
  /// Is shown digests, one after the other.
  class Func {
   public:
    virtual ~Func() = default;
    /// True ends the search.
    virtual bool operator()(NameDocumentDigest const& digest) = 0;
  };
  /// What becomes of a document that breaks off while it is looked at for the first time.
  enum class Faults {
    kThrow,  ///< its VantorError ends the search
    kSkip,   ///< it counts for nothing; the next search tries it again
  };

  static NamesCatalogImpl& Instance();

  /// Shows every document in the order of the last scan; scans first if that is due.
  void Search(Func& look, Faults faults);

  /// Replaces the digests by those of the host's block, and has the next search scan.
  void LoadState(PrefsHandler& prefs);
  void SaveState(PrefsHandler& prefs) const;

  std::vector<NameDocumentDigest> const& GetDocuments() const { return documents_; }
  /// How many documents were opened since the start of the process.
  int CountParsed() const { return parsedCount_; }

 private:
  void ScanIfDue();
  void Scan();
  void LoadSection(PrefsBlockReader section, bool inUserFolder);
  void SaveSection(PrefsBlockWriter& writer, bool inUserFolder) const;

  std::vector<NameDocumentDigest> documents_;
  std::optional<long long> lastScan_;  // in ticks of 1/60 second
  int parsedCount_ = 0;
};

}  // namespace Ostinet::Impl
