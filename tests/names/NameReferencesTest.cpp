// SPDX-License-Identifier: MIT
#include "names/SmallTree.h"
#include "ostinet/MatchData.h"

namespace Ostinet::Testing {
namespace {

template <class Handle>
void ExpectAReference(Handle const& handle, int type) {
  MatchTranslator translator;
  MatchData const reference = translator.TranslateFromNameOnly(Handle::kObjectID, handle.GetName());
  EXPECT_EQ(reference.GetObjectType(), type);
  EXPECT_EQ(reference.GetObjectName(), handle.GetName());
  EXPECT_FALSE(reference.ObjectIsSoftware());
  // 32 bytes, two empty texts and three flags, and two for each unit of the name.
  EXPECT_EQ(reference.size(), 43 + 2 * handle.GetName().length());
}

// Hosts keep these bytes in their documents, so the tags never change. Banks and patches have one.
TEST(NameReferences, SayWhatKindOfObjectTheyName) {
  RCPtrMT<Impl::DestNameSetImpl> const nameSet(new Impl::DestNameSetImpl(nullptr, "Set"));
  RCPtrMT<Impl::PatchBankImpl> const bank = AddBank(*nameSet, "Bank", 1, 2);
  RCPtrMT<Impl::PatchImpl> const patch = AddPatch(*bank, 5);
  Patch(patch).GetNoteNames().SetNoteName(60, "C");
  Patch(patch).GetControlNames().SetControl(Control(kControl7Bit, 7, "Volume"));
  ExpectAReference(DestinationMode(new Impl::DestModeImpl(nullptr, "Mode", true)), 5);
  ExpectAReference(DestinationNameSet(nameSet), 6);
  ExpectAReference(PatchBank(bank), 7);
  ExpectAReference(Patch(patch), 7);
  ExpectAReference(Patch(patch).GetNoteNames(), 9);
  ExpectAReference(DefaultNoteNameList(nameSet), 10);
  ExpectAReference(Patch(patch).GetControlNames(), 11);
  ExpectAReference(DefaultControlList(nameSet), 12);
}

}  // namespace
}  // namespace Ostinet::Testing
