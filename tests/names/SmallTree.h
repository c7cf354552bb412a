// SPDX-License-Identifier: MIT
#pragma once

#include <memory>
#include <string>
#include <vector>

#include "names/DestinationTree.h"
#include "names/NameHandles.h"
#include "support/StudioTest.h"

namespace Ostinet::Testing {

/// The names of a destination that come from the test itself.
class PlainNames : public Impl::DestinationTree {
 public:
  /// Gives `destination` names of this kind.
  static PlainNames& For(Destination const& destination) {
    Impl::DestinationImpl& impl = *Impl::ImplOf(destination);
    auto names = std::make_unique<PlainNames>(impl);
    PlainNames& result = *names;
    impl.SetNames(std::move(names));
    return result;
  }

  using DestinationTree::DestinationTree;
  using DestinationTree::EditedBanks;
  using DestinationTree::Tree;

  bool Renew() override { return false; }
  void SaveEditedBanks() override { EditedBanks().clear(); }
  void WillRemove() override {}
};

using Impl::ImplOf;

constexpr unsigned char kNoNumber = 255;

/// Records the numbers that are not 255.
inline void Record(Impl::MIDICommandList& list, unsigned char msb, unsigned char lsb,
                   unsigned char program = kNoNumber) {
  if (msb != kNoNumber) {
    list.AddThreeBytes(0xB0, 0, msb);
  }
  if (lsb != kNoNumber) {
    list.AddThreeBytes(0xB0, 32, lsb);
  }
  if (program != kNoNumber) {
    list.AddTwoBytes(0xC0, program);
  }
}

inline RCPtrMT<Impl::PatchImpl> MakePatch(unsigned char program, unsigned char msb = kNoNumber,
                                          unsigned char lsb = kNoNumber) {
  std::string const name = "Patch " + std::to_string(program);
  RCPtrMT<Impl::PatchImpl> patch(new Impl::PatchImpl("A1", name.c_str()));
  Record(patch->Commands(), msb, lsb, program);
  return patch;
}

inline RCPtrMT<Impl::PatchImpl> AddPatch(Impl::PatchBankImpl& bank, unsigned char program,
                                         unsigned char msb = kNoNumber,
                                         unsigned char lsb = kNoNumber) {
  RCPtrMT<Impl::PatchImpl> const patch = MakePatch(program, msb, lsb);
  bank.AddPatch(patch);
  return patch;
}

inline RCPtrMT<Impl::PatchBankImpl> AddBank(Impl::DestNameSetImpl& nameSet, char const* name,
                                            unsigned char msb = kNoNumber,
                                            unsigned char lsb = kNoNumber) {
  RCPtrMT<Impl::PatchBankImpl> bank(new Impl::PatchBankImpl(name));
  Record(bank->Commands(), msb, lsb);
  nameSet.AddBank(bank);
  return bank;
}

using Bytes = std::vector<unsigned char>;

/// The packets of a buffer, without their stamps.
inline std::vector<Bytes> Packets(DataBuffer const& buffer) {
  std::vector<Bytes> packets;
  for (std::size_t i = 0; i < buffer.size(); ++i) {
    packets.emplace_back(buffer[i].data, buffer[i].data + buffer[i].length);
  }
  return packets;
}

/// Their stamps.
inline std::vector<unsigned long long> Times(DataBuffer const& buffer) {
  std::vector<unsigned long long> times;
  for (std::size_t i = 0; i < buffer.size(); ++i) {
    times.push_back(buffer[i].stamp.AsMIDITime().Value());
  }
  return times;
}

}  // namespace Ostinet::Testing
