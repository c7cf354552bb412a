// SPDX-License-Identifier: MIT
#include "datapath/ChannelPatchState.h"

namespace Ostinet::Impl {
namespace {

constexpr unsigned char kControlChange = 0xB0;
constexpr unsigned char kProgramChange = 0xC0;
constexpr unsigned char kBankSelectMSB = 0;
constexpr unsigned char kBankSelectLSB = 32;

// What the next data byte means. Running status is not followed, as hosts write out each status:
// after its data bytes a message is over.
enum class Expect { kNothing, kProgram, kController, kBankMSB, kBankLSB };

Expect AfterStatus(unsigned char status) {
  switch (status & 0xF0) {
    case kProgramChange:
      return Expect::kProgram;
    case kControlChange:
      return Expect::kController;
    default:
      return Expect::kNothing;
  }
}

Expect AfterController(unsigned char controller) {
  switch (controller) {
    case kBankSelectMSB:
      return Expect::kBankMSB;
    case kBankSelectLSB:
      return Expect::kBankLSB;
    default:
      return Expect::kNothing;
  }
}

constexpr auto kRelaxed = std::memory_order_relaxed;

}  // namespace

void ChannelPatchState::Track(DataPacket const& packet) {
  Expect expect = Expect::kNothing;
  Record* record = nullptr;
  for (unsigned long long i = 0; i < packet.length; ++i) {
    unsigned char const byte = packet.data[i];
    if (byte > 127) {
      record = &records_[byte & 0x0F];
      expect = AfterStatus(byte);
      continue;
    }
    if (expect == Expect::kNothing) {
      continue;  // most bytes, in short
    }
    switch (expect) {
      case Expect::kNothing:
        break;
      case Expect::kProgram:
        record->Commit(byte);
        expect = Expect::kNothing;
        break;
      case Expect::kController:
        expect = AfterController(byte);
        break;
      case Expect::kBankMSB:
        record->pendingMSB.store(byte, kRelaxed);
        expect = Expect::kNothing;
        break;
      case Expect::kBankLSB:
        record->pendingLSB.store(byte, kRelaxed);
        expect = Expect::kNothing;
        break;
    }
  }
}

// A bank select counts from the next program change on, as on an instrument.
void ChannelPatchState::Record::Commit(unsigned char newProgram) {
  bankMSB.store(pendingMSB.load(kRelaxed), kRelaxed);
  bankLSB.store(pendingLSB.load(kRelaxed), kRelaxed);
  program.store(newProgram, kRelaxed);
  // Release: whoever takes the mark, sees the patch.
  changed.store(1, std::memory_order_release);
}

ChannelPatchState::Patch ChannelPatchState::GetPatch(int channel) const {
  if (channel < 0 || channel >= static_cast<int>(records_.size())) {
    return {255, 255, 255};
  }
  Record const& record = records_[static_cast<std::size_t>(channel)];
  return {record.program.load(kRelaxed), record.bankMSB.load(kRelaxed),
          record.bankLSB.load(kRelaxed)};
}

unsigned short ChannelPatchState::TakeChangedChannels() {
  unsigned channels = 0;
  for (std::size_t channel = 0; channel < records_.size(); ++channel) {
    std::atomic<unsigned>& changed = records_[channel].changed;
    // The plain look first: in most polls nothing changed, and an exchange costs a cache line.
    if (changed.load(kRelaxed) != 0 && changed.exchange(0, std::memory_order_acquire) != 0) {
      channels |= 1u << channel;
    }
  }
  return static_cast<unsigned short>(channels);
}

}  // namespace Ostinet::Impl
