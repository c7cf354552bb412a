// SPDX-License-Identifier: MIT
#pragma once

#include "names/ValueListImpl.h"
#include "ostinet/NamesCatalog.h"

namespace Ostinet::Impl {

/// Which control it is, whatever it is called: controls are found and sorted by this.
struct ControlKey {
  ControlType type = ControlType();
  unsigned short number = 0;

  friend bool operator==(ControlKey a, ControlKey b) {
    return a.type == b.type && a.number == b.number;
  }
  friend bool operator<(ControlKey a, ControlKey b) {
    return a.type != b.type ? a.type < b.type : a.number < b.number;
  }
};

/// What the library does with controls and hosts do not.
struct ControlParts {
  static ControlKey KeyOf(Control const& control) { return {control.type_, control.number_}; }
  /// Null for a control without named values.
  static RCPtrMT<ValueListImpl> const& ValueNames(Control const& control) {
    return control.valueNames_;
  }
  static void SetValueNames(Control& control, RCPtrMT<ValueListImpl> const& list) {
    control.valueNames_ = list;
  }
  /// A control that says nothing: it stands for hiding the default of its type and number.
  static bool IsEmpty(Control const& control) {
    return control.name_.empty() && !control.hasValueRange_;
  }
};

struct ControlOrder {
  bool operator()(Control const& a, Control const& b) const {
    return ControlParts::KeyOf(a) < ControlParts::KeyOf(b);
  }
};

}  // namespace Ostinet::Impl
