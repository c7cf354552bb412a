// SPDX-License-Identifier: MIT
#pragma once

#include <array>
#include <memory>

#include "model/ObjectImpl.h"
#include "names/ControlTable.h"
#include "names/MIDICommandList.h"
#include "names/NoteNameTable.h"

namespace Ostinet::Impl {

/// A name set for each channel, or null.
using ChannelNameSets = std::array<RCPtrMT<DestNameSetImpl>, 16>;

/// One patch. It may outlive its bank in a host's handle, and has no bank then.
class PatchImpl : public ObjectImpl {
 public:
  /// `number` is text that people read, as A1 or 001; only the commands have the MIDI numbers.
  PatchImpl(UString const& number, UString const& name);
  /// A copy for a further bank: it shares the note and control lists, is in no bank yet, and takes
  /// the table of name sets away from `source`.
  explicit PatchImpl(PatchImpl& source);
  ~PatchImpl() override;

  UString GetName() const override;
  UString GetNumber() const;
  /// Number, one blank, name: as lists of patches are drawn.
  UString const& GetNumberAndName() const { return numberAndName_; }
  MIDICommandList& Commands() { return commands_; }
  MIDICommandList const& Commands() const { return commands_; }
  /// Its own numbers, completed by those of its bank.
  PatchNumbers GetNumbers() const;

  PatchBankImpl* GetBank() const { return bank_; }
  /// Called by the bank alone.
  void SetBank(PatchBankImpl* bank) { bank_ = bank; }

  /// Null if there is none.
  RCPtrMT<NoteNameTable> const& GetNoteNames() const { return noteNames_; }
  void SetNoteNames(RCPtrMT<NoteNameTable> const& table) { noteNames_ = table; }
  RCPtrMT<ControlTable> const& GetControls() const { return controls_; }
  void SetControls(RCPtrMT<ControlTable> const& table) { controls_ = table; }
  /// The patch's own table, made or split off where it is not yet; that marks the bank as edited.
  NoteNameTable& EditNoteNames();
  ControlTable& EditControls();

  /// The name sets that go with this patch: kept and written back, used for nothing else. Null
  /// until DemandChannelNameSets.
  ChannelNameSets const* GetChannelNameSets() const { return channelNameSets_.get(); }
  ChannelNameSets& DemandChannelNameSets();
  /// The table can lead back to this patch; without it there is no such ring of references.
  void DropChannelNameSets() { channelNameSets_.reset(); }

 private:
  void MarkEdited();

  PatchBankImpl* bank_ = nullptr;  // cleared by the bank
  UString numberAndName_;
  UString::size_type numberLength_;
  MIDICommandList commands_;
  RCPtrMT<NoteNameTable> noteNames_;
  RCPtrMT<ControlTable> controls_;
  std::unique_ptr<ChannelNameSets> channelNameSets_;
};

}  // namespace Ostinet::Impl
