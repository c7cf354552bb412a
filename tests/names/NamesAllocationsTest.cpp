// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include "names/SmallTree.h"
#include "support/AllocationCounter.h"

namespace Ostinet::Testing {
namespace {

// What a buffer itself takes for these packets.
template <class Fill>
std::size_t Allocations(Fill const& fill) {
  AllocationCounter const allocations;
  DataBuffer buffer;
  fill(buffer);
  return allocations.Count();
}

std::size_t AllocationsOfTheBuffer(DataBuffer const& packets) {
  return Allocations([&packets](DataBuffer& buffer) {
    for (std::size_t i = 0; i < packets.size(); ++i) {
      buffer.Add(packets[i].stamp, packets[i].data, packets[i].length);
    }
  });
}

RCPtrMT<Impl::DestNameSetImpl> NewNameSet() { return new Impl::DestNameSetImpl(nullptr, "Set"); }

TEST(NamesAllocations, APatchChangeTakesWhatItsBufferTakes) {
  RCPtrMT<Impl::DestNameSetImpl> const nameSet = NewNameSet();
  RCPtrMT<Impl::PatchBankImpl> const bank = AddBank(*nameSet, "Bank", 1, 3);
  Patch const patch(AddPatch(*bank, 5));
  auto const generate = [&](DataBuffer& buffer) {
    bank->Commands().GenerateCommands(buffer, Clocks(1), 2, 0);
    Impl::ImplOf(patch)->Commands().GenerateCommands(buffer, Clocks(1), 2, 0);
  };
  DataBuffer expected;
  generate(expected);
  ASSERT_EQ(expected.size(), 3u);
  EXPECT_EQ(Allocations(generate), AllocationsOfTheBuffer(expected));
  AllocationCounter const allocations;
  patch.GetCommand(Clocks(1), 2, 0);
  EXPECT_EQ(allocations.Count(), 2u);  // the packet and its bytes
}

TEST(NamesAllocations, AScriptTakesNoMoreThanItsBytesOneByOne) {
  Impl::MIDICommandList list;
  list.AddThreeBytes(0xB0, 7, 1);
  list.AddDelay(5);
  list.BeginSysex();
  for (int i = 0; i < 8; ++i) {
    list.AddSysexMarker(Impl::SysexByte::kDeviceIDMarker, 0, 1);
  }
  DataBuffer expected;
  list.GenerateCommands(expected, Clocks(1), 0, 16);
  std::size_t const ofBuffer = Allocations([&expected](DataBuffer& buffer) {
    buffer.Add(expected[0].stamp, expected[0].data, expected[0].length);
    buffer.Add(expected[1].stamp, nullptr, 0);
    for (std::size_t i = 0; i < expected[1].length; ++i) {
      buffer.AppendByte(expected[1].data[i]);
    }
  });
  EXPECT_EQ(
      Allocations([&list](DataBuffer& buffer) { list.GenerateCommands(buffer, Clocks(1), 0, 16); }),
      ofBuffer);
}

TEST(NamesAllocations, LookingUpAPatchTakesNone) {
  RCPtrMT<Impl::DestNameSetImpl> const nameSet = NewNameSet();
  for (unsigned char bank = 0; bank < 4; ++bank) {
    RCPtrMT<Impl::PatchBankImpl> const added = AddBank(*nameSet, "Bank", bank, 0);
    AddPatch(*added, 1);
    AddPatch(*added, 5);
  }
  AllocationCounter const allocations;
  Impl::PatchImpl* const exact = nameSet->FindPatch(PatchNumbers(5, 3, 0));
  Impl::PatchImpl* const playing = nameSet->FindPlayingPatch(PatchNumbers(5, 3, 0));
  EXPECT_EQ(allocations.Count(), 0u);
  EXPECT_NE(exact, nullptr);
  EXPECT_EQ(exact, playing);
}

}  // namespace
}  // namespace Ostinet::Testing
