// SPDX-License-Identifier: MIT
#pragma once

#include "model/ImplImpl.h"

namespace Ostinet::Impl {

// Properties as XML, as setup files keep them:
//
//   <Int key="uniqueID">4711</Int>
//   <String key="name">Synth</String>
//   <IntList key="connUniqueID"><IntItem>4711</IntItem></IntList>
//   <Dict key="nameConfiguration"> String, StringList, File and Dict, to any depth </Dict>
//   <File key="image"><Path type="UserMidiDevices">/Synth.png</Path></File>
//
// A path inside one of three known folders is written as the part behind that folder, so that a
// studio can be taken to another machine.

/// Writes one property as an element.
void WriteProperty(XMLLib::Writer& writer, UString const& key, PropertyValue const& value);

/// Reads the children of the current element into `peer`, through its setters. What cannot be
/// understood is passed over. With `skipIDs` the unique ID and the connections are left out, as
/// an imported object must not claim those of another studio.
void ReadProperties(XMLLib::Parser& parser, ImplImpl& peer, bool skipIDs);

}  // namespace Ostinet::Impl
