// SPDX-License-Identifier: MIT
#pragma once

#include "names/DestNameSetImpl.h"

namespace Ostinet::Impl {

/// A mode that a destination can be in. It keeps its name sets alive; they do not keep it.
class DestModeImpl : public ObjectImpl {
 public:
  /// `destination` may be null.
  DestModeImpl(DestinationImpl* destination, UString name, bool isStandard)
      : destination_(destination), name_(std::move(name)), isStandard_(isStandard) {}
  ~DestModeImpl() override;

  UString GetName() const override { return name_; }
  /// Null once the destination has other names, or is gone.
  DestinationImpl* GetDestination() const { return destination_; }
  bool IsStandard() const { return isStandard_; }

  /// Sent when the mode is selected.
  MIDICommandList& EnableCommands() { return enableCommands_; }
  MIDICommandList const& EnableCommands() const { return enableCommands_; }
  /// Sent when the mode is left.
  MIDICommandList& DisableCommands() { return disableCommands_; }
  MIDICommandList const& DisableCommands() const { return disableCommands_; }

  ChannelNameSets const& GetNameSets() const { return nameSets_; }
  /// Channels are 0 to 15. Null for none, on every other channel too.
  DestNameSetImpl* GetNameSet(int channel) const;
  /// Tells the old and the new name set, so that both sides agree. Null empties the slot.
  void SetNameSet(int channel, RCPtrMT<DestNameSetImpl> const& nameSet);
  bool HasNameSets() const;

  /// The tree goes: ends the reference that leads out of it.
  void Detach() { destination_ = nullptr; }

 private:
  DestinationImpl* destination_;  // cleared by Detach
  UString const name_;
  bool const isStandard_;
  MIDICommandList enableCommands_;
  MIDICommandList disableCommands_;
  ChannelNameSets nameSets_;
};

}  // namespace Ostinet::Impl
