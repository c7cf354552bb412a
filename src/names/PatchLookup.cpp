// SPDX-License-Identifier: MIT
//
// DestNameSetImpl: from numbers to banks and patches.
//
// A patch is asked for in two ways. A host that asks for certain numbers wants just those, in the
// bank that has them or in any other, since a patch may bring a bank select of its own. What was
// seen on the wire is often less than that: then the patch that fits best is the one that plays.
#include "names/DestNameSetImpl.h"
#include "ostinet/NamesCatalog.h"

namespace Ostinet::Impl {

namespace {

constexpr unsigned char kNone = MIDICommandList::kNone;

// What a number that fits is worth, of a bank and of a patch, and the bank that was selected last.
constexpr int kBankFits = 2;
constexpr int kPatchFits = 6;
constexpr int kIsCurrentBank = 1;
constexpr int kBestScore = 2 * kBankFits + 2 * kPatchFits + kIsCurrentBank;

int Fits(unsigned char seen, unsigned char number, int score) {
  return seen == kNone || seen == number ? score : 0;
}

}  // namespace

PatchBankImpl* DestNameSetImpl::FindBank(unsigned char msb, unsigned char lsb) const {
  if (currentBank_.get() != nullptr && currentBank_->HasNumbers(msb, lsb)) {
    return currentBank_.get();
  }
  // Without numbers nothing tells several banks apart.
  if (msb == kNone && lsb == kNone && banks_.size() != 1) {
    return nullptr;
  }
  for (RCPtrMT<PatchBankImpl> const& bank : banks_) {
    if (bank->HasNumbers(msb, lsb)) {
      return bank.get();
    }
  }
  return nullptr;
}

PatchImpl* DestNameSetImpl::FindPatch(PatchNumbers const& numbers) const {
  PatchBankImpl const* const bank = FindBank(numbers.msb, numbers.lsb);
  PatchImpl* patch = bank != nullptr ? bank->FindPatch(numbers) : nullptr;
  if (patch == nullptr && currentBank_.get() != nullptr) {
    patch = currentBank_->FindPatch(numbers);
  }
  for (auto i = banks_.begin(); patch == nullptr && i != banks_.end(); ++i) {
    patch = (*i)->FindPatch(numbers);
  }
  return patch;
}

int DestNameSetImpl::ScoreBank(PatchBankImpl const& bank, PatchNumbers const& seen) const {
  return Fits(seen.msb, bank.Commands().PendingMSB(), kBankFits) +
         Fits(seen.lsb, bank.Commands().PendingLSB(), kBankFits) +
         (&bank == currentBank_.get() ? kIsCurrentBank : 0);
}

PatchImpl* DestNameSetImpl::FindPlayingPatch(PatchNumbers const& seen) const {
  PatchImpl* best = nullptr;
  int bestScore = -1;
  for (RCPtrMT<PatchBankImpl> const& bank : banks_) {
    int const bankScore = ScoreBank(*bank, seen);
    for (RCPtrMT<PatchImpl> const& patch : bank->GetPatches()) {
      if (patch->Commands().PendingProgram() != seen.program) {
        continue;
      }
      PatchNumbers const numbers = patch->GetNumbers();
      int const score = bankScore + Fits(seen.msb, numbers.msb, kPatchFits) +
                        Fits(seen.lsb, numbers.lsb, kPatchFits);
      if (score == kBestScore) {
        return patch.get();
      }
      if (score > bestScore) {
        best = patch.get();
        bestScore = score;
      }
    }
  }
  return best;
}

}  // namespace Ostinet::Impl
