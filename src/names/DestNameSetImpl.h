// SPDX-License-Identifier: MIT
#pragma once

#include <utility>
#include <vector>

#include "names/PatchBankImpl.h"

namespace Ostinet::Impl {

/// The banks that one or more channels offer.
class DestNameSetImpl : public ObjectImpl {
 public:
  /// A mode that uses this name set, and on which channels: bit n for channel n of 0 to 15.
  using ModeUse = std::pair<DestModeImpl*, unsigned short>;

  /// `destination` may be null.
  DestNameSetImpl(DestinationImpl* destination, UString name)
      : destination_(destination), name_(std::move(name)) {}
  ~DestNameSetImpl() override;

  UString GetName() const override { return name_; }
  /// Null once the destination has other names, or is gone.
  DestinationImpl* GetDestination() const { return destination_; }
  /// In order of first use.
  std::vector<ModeUse> const& GetModes() const { return modes_; }

  /// The channels on which the name set is available; bit n for channel n of 0 to 15.
  unsigned short GetChannels() const { return channels_; }
  /// `channel` is 0 to 15.
  void SetChannelAvailable(int channel, bool isAvailable);

  std::vector<RCPtrMT<PatchBankImpl>> const& GetBanks() const { return banks_; }
  void AddBank(RCPtrMT<PatchBankImpl> const& bank);
  /// The bank that was selected last, which need not be one of this name set; null if none was.
  RCPtrMT<PatchBankImpl> const& GetCurrentBank() const { return currentBank_; }
  void SetCurrentBank(RCPtrMT<PatchBankImpl> const& bank) { currentBank_ = bank; }

  /// Null if there is none.
  RCPtrMT<NoteNameTable> const& GetDefaultNotes() const { return defaultNotes_; }
  void SetDefaultNotes(RCPtrMT<NoteNameTable> const& table) { defaultNotes_ = table; }
  RCPtrMT<ControlTable> const& GetDefaultControls() const { return defaultControls_; }
  void SetDefaultControls(RCPtrMT<ControlTable> const& table) { defaultControls_ = table; }

  // Lookups. Each gives null if there is nothing; 255 in a number means none.

  PatchBankImpl* FindBank(unsigned char msb, unsigned char lsb) const;
  /// The patch of just these numbers.
  PatchImpl* FindPatch(PatchNumbers const& numbers) const;
  /// The patch that fits best what was seen on the wire.
  PatchImpl* FindPlayingPatch(PatchNumbers const& seen) const;

  /// The tree goes: ends all references that lead out of it or round in it.
  void Detach();

 private:
  friend class DestModeImpl;
  void AddUse(DestModeImpl* mode, int channel);
  void RemoveUse(DestModeImpl* mode, int channel);
  void RemoveMode(DestModeImpl* mode);
  int ScoreBank(PatchBankImpl const& bank, PatchNumbers const& seen) const;

  DestinationImpl* destination_;  // cleared by Detach
  std::vector<ModeUse> modes_;    // the mode takes itself out when it goes
  UString const name_;
  unsigned short channels_ = 0;
  std::vector<RCPtrMT<PatchBankImpl>> banks_;
  RCPtrMT<PatchBankImpl> currentBank_;
  RCPtrMT<NoteNameTable> defaultNotes_;
  RCPtrMT<ControlTable> defaultControls_;
};

}  // namespace Ostinet::Impl
