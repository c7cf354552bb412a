// SPDX-License-Identifier: MIT
#include "names/PatchImpl.h"

#include <utility>

#include "names/DestinationTree.h"

namespace Ostinet::Impl {

PatchImpl::PatchImpl(UString const& number, UString const& name)
    : numberAndName_(number + " " + name), numberLength_(number.length()) {}

PatchImpl::PatchImpl(PatchImpl& source)
    : ObjectImpl(),
      numberAndName_(source.numberAndName_),
      numberLength_(source.numberLength_),
      commands_(source.commands_),
      noteNames_(source.noteNames_),
      controls_(source.controls_),
      channelNameSets_(std::move(source.channelNameSets_)) {}

PatchImpl::~PatchImpl() = default;

UString PatchImpl::GetName() const { return numberAndName_.substr(numberLength_ + 1); }

UString PatchImpl::GetNumber() const { return numberAndName_.substr(0, numberLength_); }

PatchNumbers PatchImpl::GetNumbers() const {
  PatchNumbers numbers(commands_.PendingProgram(), commands_.PendingMSB(), commands_.PendingLSB());
  if (bank_ != nullptr && numbers.msb == MIDICommandList::kNone) {
    numbers.msb = bank_->Commands().PendingMSB();
  }
  if (bank_ != nullptr && numbers.lsb == MIDICommandList::kNone) {
    numbers.lsb = bank_->Commands().PendingLSB();
  }
  return numbers;
}

// Only the step to a table of its own marks the bank. The table stays editable after the bank was
// saved, and edits from then on are not marked: hosts count on a saved bank staying saved.
NoteNameTable& PatchImpl::EditNoteNames() {
  if (noteNames_.get() == nullptr || !noteNames_->IsEditable()) {
    noteNames_ = noteNames_.get() != nullptr ? noteNames_->CopyForEditing()
                                             : NoteNameTable().CopyForEditing();
    MarkEdited();
  }
  return *noteNames_;
}

ControlTable& PatchImpl::EditControls() {
  if (controls_.get() == nullptr || !controls_->IsEditable()) {
    controls_ =
        controls_.get() != nullptr ? controls_->CopyForEditing() : ControlTable().CopyForEditing();
    MarkEdited();
  }
  return *controls_;
}

ChannelNameSets& PatchImpl::DemandChannelNameSets() {
  if (channelNameSets_ == nullptr) {
    channelNameSets_ = std::make_unique<ChannelNameSets>();
  }
  return *channelNameSets_;
}

void PatchImpl::MarkEdited() {
  DestNameSetImpl const* const nameSet = bank_ != nullptr ? bank_->GetNameSet() : nullptr;
  DestinationTree* const tree =
      nameSet != nullptr ? DestinationTree::Of(nameSet->GetDestination()) : nullptr;
  if (tree != nullptr) {
    tree->MarkEdited(*bank_);
  }
}

}  // namespace Ostinet::Impl
