// SPDX-License-Identifier: MIT
#pragma once

#include "model/PropertyValue.h"
#include "names/NameConfiguration.h"
#include "names/NameTree.h"

namespace Ostinet::Impl {

/// Reads the documents that a configuration names. What is missing or broken means fewer names.
/// Nothing is selected in the result.
NameTree LoadNames(DestinationImpl& destination, NameConfiguration const& configuration);

/// Selects in `tree` what the Dict "nameConfiguration" says: the current mode, and the name set of
/// each channel. What the Dict names and the tree has not, stays as it was. True if anything
/// changed.
bool ApplySelection(PropertyDict const& dict, NameTree& tree);

}  // namespace Ostinet::Impl
