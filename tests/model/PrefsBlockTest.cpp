// SPDX-License-Identifier: MIT
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "model/PrefsBlock.h"
#include "ostinet/core/Error.h"
#include "support/Printers.h"

namespace Ostinet::Testing {
namespace {

using Bytes = std::vector<unsigned char>;
using Impl::PrefsBlockReader;
using Impl::PrefsBlockWriter;
using ::testing::ElementsAre;

TEST(PrefsBlock, ALengthCoversItselfAndWhatFollows) {
  PrefsBlockWriter writer;
  std::size_t const part = writer.BeginPart();
  writer.WriteText(u"\u4e2d");
  writer.EndPart(part);
  writer.WriteNumber(0x01020304);
  EXPECT_THAT(writer.GetBytes(), ElementsAre(10, 0, 0, 0, 1, 0, 0, 0, 0x2d, 0x4e, 4, 3, 2, 1));
}

TEST(PrefsBlock, APartIsLeftByItsLengthWhateverWasReadOfIt) {
  PrefsBlockWriter writer;
  std::size_t const part = writer.BeginPart();
  writer.WriteNumber(1);
  writer.WriteNumber(2);
  writer.EndPart(part);
  writer.WriteText("behind");
  PrefsBlockReader reader(writer.GetBytes());
  PrefsBlockReader inner = reader.ReadPart();
  EXPECT_EQ(inner.ReadNumber(), 1u);
  EXPECT_EQ(reader.ReadText(), UString("behind"));
  EXPECT_TRUE(reader.AtEnd());
  EXPECT_FALSE(inner.AtEnd());
}

TEST(PrefsBlock, APartIsNotReadBeyondItsEnd) {
  Bytes const bytes = {6, 0, 0, 0, 1, 0, 0, 0};
  PrefsBlockReader reader(bytes);
  EXPECT_THROW(reader.ReadPart().ReadNumber(), VantorError);
}

// A walk over parts would never end.
TEST(PrefsBlock, ALengthThatDoesNotMoveOnFails) {
  for (unsigned char length = 0; length < 4; ++length) {
    Bytes const bytes = {length, 0, 0, 0, 0, 0, 0, 0};
    EXPECT_THROW(PrefsBlockReader(bytes).ReadPart(), VantorError) << int{length};
  }
  Bytes const bytes = {4, 0, 0, 0};
  EXPECT_TRUE(PrefsBlockReader(bytes).ReadPart().AtEnd());
}

TEST(PrefsBlock, LengthsBeyondTheBlockFail) {
  Bytes const bytes = {0xFF, 0xFF, 0xFF, 0xFF, 1, 2};
  EXPECT_THROW(PrefsBlockReader(bytes).ReadPart(), VantorError);
  EXPECT_THROW(PrefsBlockReader(bytes).ReadText(), VantorError);
  try {
    PrefsBlockReader(Bytes(3)).ReadNumber();
    FAIL();
  } catch (VantorError const& error) {
    EXPECT_EQ(error.Code(), -39);
  }
}

}  // namespace
}  // namespace Ostinet::Testing
