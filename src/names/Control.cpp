// SPDX-License-Identifier: MIT
#include "names/ControlParts.h"

namespace Ostinet {

Control::Control() = default;

Control::Control(ControlType type, unsigned short number, UString const& name)
    : type_(type), number_(number), name_(name) {}

Control::Control(ControlType type, unsigned short number, UString const& name, double min,
                 double max)
    : Control(type, number, name) {
  hasValueRange_ = true;
  min_ = min;
  max_ = max;
}

Control::Control(ControlType type, unsigned short number, UString const& name, double min,
                 double max, UString const& units)
    : Control(type, number, name, min, max) {
  units_ = units;
}

Control::Control(ControlType type, unsigned short number, UString const& name, double min,
                 double max, double dflt)
    : Control(type, number, name, min, max) {
  hasDefaultValue_ = true;
  defaultValue_ = dflt;
}

Control::Control(ControlType type, unsigned short number, UString const& name, double min,
                 double max, double dflt, UString const& units)
    : Control(type, number, name, min, max, dflt) {
  units_ = units;
}

Control::Control(ControlType type, unsigned short number, UString const& name,
                 ValueMap const& values)
    : Control(type, number, name) {
  if (values.empty()) {
    return;
  }
  hasValueRange_ = true;
  min_ = values.begin()->first;
  max_ = values.rbegin()->first;
  valueNames_ = new Impl::ValueListImpl;
  for (ValueMap::value_type const& value : values) {
    valueNames_->Add(value.first, value.second);
  }
}

Control::Control(ControlType type, unsigned short number, UString const& name,
                 ValueMap const& values, unsigned short dflt)
    : Control(type, number, name, values) {
  // Without a range there is nothing for the default to lie in.
  if (hasValueRange_) {
    hasDefaultValue_ = true;
    defaultValue_ = dflt;
  }
}

ControlType Control::GetType() const { return type_; }
unsigned short Control::GetNumber() const { return number_; }
UString Control::GetName() const { return name_; }
double Control::GetMinValue() const { return min_; }
double Control::GetMaxValue() const { return max_; }
double Control::GetDefaultValue() const { return defaultValue_; }
UString Control::GetUnits() const { return units_; }
bool Control::HasValueRange() const { return hasValueRange_; }
bool Control::HasDefaultValue() const { return hasDefaultValue_; }
bool Control::HasUnits() const { return !units_.empty(); }

int Control::CountValueNames() const {
  return valueNames_.get() != nullptr ? static_cast<int>(valueNames_->GetValues().size()) : 0;
}

std::pair<unsigned short, UString> Control::GetValueName(int index) const {
  bool const isThere = index >= 0 && index < CountValueNames();
  return isThere ? valueNames_->GetValues().nth(static_cast<std::size_t>(index))
                 : std::pair<unsigned short, UString>();
}

UString Control::GetNameForValue(unsigned short value) const {
  if (valueNames_.get() == nullptr) {
    return UString();
  }
  Impl::ValueListImpl::Values const& values = valueNames_->GetValues();
  auto const place = values.find(value);
  return place != values.end() ? place->second : UString();
}

}  // namespace Ostinet
