// SPDX-License-Identifier: MIT
#pragma once

#include <boost/variant.hpp>
#include <map>
#include <vector>

#include "ostinet/core/UString.h"

namespace Ostinet::Impl {

/// A File value: a full path, which need not exist. A type of its own, so that a path and a plain
/// text stay different kinds of value.
struct PropertyPath {
  UString path;
  bool operator==(PropertyPath const& other) const { return path == other.path; }
};

struct PropertyDict;

/// The kinds of value that a Dict holds, in the order of their tags. There is no number among them.
using PropertyDictValue = boost::variant<UString, std::vector<UString>, PropertyPath,
                                         boost::recursive_wrapper<PropertyDict>>;

/// An ordered map from text to values, nested to any depth.
struct PropertyDict {
  std::map<UString, PropertyDictValue> entries;
  bool operator==(PropertyDict const& other) const { return entries == other.entries; }
};

/// One property, in the order of the tags: Int, String, IntList, Dict, File. Fresh, it is the Int
/// 0.
using PropertyValue = boost::variant<int, UString, std::vector<int>, PropertyDict, PropertyPath>;

}  // namespace Ostinet::Impl
