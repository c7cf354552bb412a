// SPDX-License-Identifier: MIT
#pragma once

#include <vector>

#include "names/ControlParts.h"

namespace Ostinet::Impl {

/// The controls of a list as a document has them. Uses of one named list share the object.
struct ControlNameData : RCObjectMT<ControlNameData> {
  explicit ControlNameData(UString listName = UString(), bool listIsNamed = false)
      : name(std::move(listName)), isNamed(listIsNamed) {}

  UString const name;
  bool const isNamed;  ///< reached by its name, not written at its place of use
  sorted_vector_set<Control, ControlOrder> controls;
};

struct ControlEntry {
  Control control;
  bool hasDefault = false;  ///< the default list has this control
  bool inherited = false;   ///< it came from the default list unchanged
};

/// The controls of a patch, with the default list of its name set already in them. Patches with
/// equal sources share one table until one of them is edited.
class ControlTable : public RCObjectMT<ControlTable> {
 public:
  /// An empty table without a name.
  ControlTable() = default;
  /// The default list `defaults` beneath the list `own` of a patch; either may be null.
  static RCPtrMT<ControlTable> Merge(ControlNameData const* defaults, ControlNameData const* own);
  /// A table with the same entries that may be edited and that a document writes inline.
  RCPtrMT<ControlTable> CopyForEditing() const;

  UString const& GetName() const { return name_; }
  bool IsEditable() const { return isEditable_; }
  /// True if the table came from a named or merged list: documents refer to it by name.
  bool IsShared() const { return isShared_; }
  /// Sorted by key.
  std::vector<ControlEntry> const& GetControls() const { return controls_; }
  /// The controls of the default list that this table hides, sorted.
  std::vector<ControlKey> const& GetHidden() const { return hidden_; }
  /// Null if there is none.
  ControlEntry const* Find(ControlKey key) const;

  void Set(Control const& control);
  void Clear(ControlKey key);

 private:
  void Append(Control const& control, bool hasDefault, bool inherited);
  void Hide(ControlKey key);

  UString name_;
  bool isEditable_ = false;
  bool isShared_ = false;
  std::vector<ControlEntry> controls_;
  std::vector<ControlKey> hidden_;
};

}  // namespace Ostinet::Impl
