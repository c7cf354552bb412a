// SPDX-License-Identifier: MIT
#pragma once

#include <string>
#include <vector>

#include "ostinet/Setup.h"
#include "ostinet/core/Files.h"

namespace Ostinet::Tool {

/// Of the settings folder.
constexpr char kVirtualEndpointsFile[] = "virtual.json";

/// The user's virtual endpoints. The library makes them anew for each host and each sign-in, so
/// this program keeps a reference to each and makes them when it signs in, under the same IDs.
class VirtualEndpoints {
 public:
  /// One pair, by the end that shows.
  struct Kept {
    Setup::SrcOrDest publicEnd;
    MatchData reference;
  };

  /// A file that is not there keeps none. Throws Failure for one that cannot be understood.
  void Load(File const& file);
  /// Makes all that are kept.
  void Make(Setup& setup);
  /// Writes what is kept if it was edited. Throws Failure, and then the file is as it was.
  void Save(File const& file) const;

  /// Makes a new pair and keeps it; gives the end that shows.
  Endpoint Add(Setup& setup, UString const& name, Setup::SrcOrDest publicEnd);
  /// The end that shows of one of them, named as endpoints are; throws Failure.
  Endpoint Find(std::string const& name) const;
  /// Deletes the pair whose end that is, and forgets it.
  void Remove(Setup& setup, Endpoint const& shown);

 private:
  struct Pair {
    Kept kept;
    Endpoint shown;
  };

  std::vector<Kept> loaded_;
  std::vector<Pair> pairs_;
  bool isEdited_ = false;
};

}  // namespace Ostinet::Tool
