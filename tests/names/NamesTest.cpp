// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include "ostinet/NamesCatalog.h"

namespace Ostinet::Testing {
namespace {

FileSpecification At(char const* path) { return FileSpecification(UString(path)); }

TEST(Names, AreCalledAfterTheirFile) {
  EXPECT_EQ(Names(Names::kMasterNames, At("/names/Synth.v2.midnam")).GetName(),
            UString("Synth.v2"));
  EXPECT_EQ(Names(Names::kMasterNames, At("/na.mes/Synth")).GetName(), UString("Synth"));
  EXPECT_EQ(Names(Names::kMasterNames, At("/names/.midnam")).GetName(), UString());
  EXPECT_EQ(Names(Names::kMasterNames, FileSpecification()).GetName(), UString());
}

TEST(Names, TakeTheNameThatTheyAreGiven) {
  Names const names(Names::kStandardModeNames, At("/names/Modes.midnam"), "General MIDI");
  EXPECT_EQ(names.GetName(), UString("General MIDI"));
  EXPECT_EQ(names.GetType(), Names::kStandardModeNames);
  EXPECT_EQ(names.GetFile(), At("/names/Modes.midnam"));
}

TEST(Names, ExistByTheirTypeAlone) {
  EXPECT_FALSE(Names().Exists());
  EXPECT_EQ(Names().GetType(), Names::kNoNames);
  EXPECT_FALSE(Names().GetFile().IsValid());
  EXPECT_TRUE(Names(Names::kMasterNames, FileSpecification()).Exists());
  EXPECT_FALSE(Names(Names::kNoNames, At("/names/Synth.midnam")).Exists());
}

TEST(Names, AreEqualIfAllIs) {
  Names const names(Names::kOverrideNames, At("/a"), "List");
  EXPECT_EQ(names, Names(Names::kOverrideNames, At("/a"), "List"));
  EXPECT_NE(names, Names(Names::kEditedOverrideNames, At("/a"), "List"));
  EXPECT_NE(names, Names(Names::kOverrideNames, At("/b"), "List"));
  EXPECT_NE(names, Names(Names::kOverrideNames, At("/a"), "list"));
  Names copy;
  copy = names;
  EXPECT_EQ(copy, names);
}

TEST(PatchNumbers, AreNoneAtFirst) {
  PatchNumbers const none;
  EXPECT_EQ(none.program, 255);
  EXPECT_EQ(none.msb, 255);
  EXPECT_EQ(none.lsb, 255);
  PatchNumbers const some(1, 2, 3);
  EXPECT_EQ(some.program, 1);
  EXPECT_EQ(some.msb, 2);
  EXPECT_EQ(some.lsb, 3);
}

}  // namespace
}  // namespace Ostinet::Testing
