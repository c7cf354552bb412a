// SPDX-License-Identifier: MIT
#pragma once

#include "ostinet/Common.h"
#include "ostinet/core/SortedVector.h"

namespace Ostinet::Impl {

/// The named values of a control. Controls share it.
class ValueListImpl : public RCObjectMT<ValueListImpl> {
 public:
  using Values = sorted_vector_map<unsigned short, UString, std::less<unsigned short>>;

  explicit ValueListImpl(UString name = UString(), bool isNamed = false)
      : name_(std::move(name)), isNamed_(isNamed) {}

  UString const& GetName() const { return name_; }
  /// True if the list was reached by its name, which a written document then uses too.
  bool IsNamed() const { return isNamed_; }
  Values const& GetValues() const { return values_; }
  /// A second name for a number is dropped.
  void Add(unsigned short number, UString const& name) { values_.emplace(number, name); }

 private:
  UString const name_;
  bool const isNamed_;
  Values values_;
};

}  // namespace Ostinet::Impl
