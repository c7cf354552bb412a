// SPDX-License-Identifier: MIT
#pragma once

#include <vector>

#include "names/PatchImpl.h"

namespace Ostinet::Impl {

/// A bank of patches.
class PatchBankImpl : public ObjectImpl {
 public:
  explicit PatchBankImpl(UString bankName) : bankName_(std::move(bankName)) {}
  ~PatchBankImpl() override;

  /// The name of the list of patches in use, or else the bank's.
  UString GetName() const override { return listName_.empty() ? bankName_ : listName_; }
  /// Under this name an override of the bank is stored: it is the bank's identity from one load of
  /// the document to the next.
  UString const& GetBankName() const { return bankName_; }
  UString const& GetListName() const { return listName_; }
  void SetListName(UString const& name) { listName_ = name; }

  /// The bank select. Its pending numbers are the bank's numbers.
  MIDICommandList& Commands() { return commands_; }
  MIDICommandList const& Commands() const { return commands_; }
  bool HasNumbers(unsigned char msb, unsigned char lsb) const {
    return commands_.PendingMSB() == msb && commands_.PendingLSB() == lsb;
  }

  DestNameSetImpl* GetNameSet() const { return nameSet_; }
  /// Called by the name set alone.
  void SetNameSet(DestNameSetImpl* nameSet) { nameSet_ = nameSet; }

  std::vector<RCPtrMT<PatchImpl>> const& GetPatches() const { return patches_; }
  void AddPatch(RCPtrMT<PatchImpl> const& patch);
  void ClearPatches();
  /// The first patch with just these numbers; null if there is none.
  PatchImpl* FindPatch(PatchNumbers const& numbers) const;

  /// True if the patches came from a document of the library's own.
  bool IsTemporary() const { return isTemporary_; }
  void SetTemporary(bool isTemporary) { isTemporary_ = isTemporary; }

 private:
  DestNameSetImpl* nameSet_ = nullptr;  // cleared by the name set
  UString const bankName_;
  UString listName_;
  MIDICommandList commands_;
  std::vector<RCPtrMT<PatchImpl>> patches_;
  bool isTemporary_ = false;
};

}  // namespace Ostinet::Impl
