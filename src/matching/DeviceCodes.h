// SPDX-License-Identifier: MIT
#pragma once

#include <map>

#include "ostinet/core/Files.h"
#include "ostinet/core/SortedVector.h"
#include "ostinet/core/UString.h"

namespace Ostinet::Impl {

/// The file that relates the numbers of older references to texts.
File DeviceCodesFile();

/// A maker and a model as texts; either may be empty.
struct DeviceTexts {
  UString manufacturer;
  UString model;
};

/// The same as numbers; 0 is none.
struct DeviceNumbers {
  int manufacturer = 0;
  int model = 0;
};

/// From numbers to texts.
class DeviceTextsByCode {
 public:
  /// Reads the whole file. What cannot be read is missing, and nothing is thrown.
  explicit DeviceTextsByCode(File const& file);
  /// An unknown model leaves the maker alone; an unknown maker leaves both empty.
  DeviceTexts Find(DeviceNumbers const& numbers) const;

 private:
  struct Manufacturer {
    UString name;
    sorted_vector_map<int, UString> models;
  };
  std::map<int, Manufacturer> manufacturers_;
};

/// From texts to numbers.
class DeviceCodesByText {
 public:
  explicit DeviceCodesByText(File const& file);
  DeviceNumbers Find(DeviceTexts const& texts) const;

 private:
  struct Manufacturer {
    int code = 0;
    sorted_vector_map<UString, int> models;
  };
  std::map<UString, Manufacturer> manufacturers_;
};

}  // namespace Ostinet::Impl
