// SPDX-License-Identifier: MIT
//
// Every operation of every handle of the names on a null handle, and of the lists on an object
// without a list.
#include <functional>
#include <ostream>

#include "names/SmallTree.h"

namespace Ostinet::Testing {
namespace {

struct NullCase {
  char const* name;
  std::function<bool()> holds;
};

void PrintTo(NullCase const& nullCase, std::ostream* out) { *out << nullCase.name; }

class NullNames : public ::testing::TestWithParam<NullCase> {};

TEST_P(NullNames, GiveTheDefinedValue) { EXPECT_TRUE(GetParam().holds()); }

#define CASE(expression)                   \
  NullCase {                               \
#expression, [] { return expression; } \
  }

UString const kNone;

bool IsNone(PatchNumbers const& numbers) {
  return numbers.program == 255 && numbers.msb == 255 && numbers.lsb == 255;
}
bool IsNone(NoteGroup const& group) {
  return group.id == 0 && group.name.empty() && group.pitches.empty();
}
bool IsNone(Control const& control) {
  return control.GetType() == 0 && control.GetNumber() == 0 && control.GetName().empty() &&
         !control.HasValueRange();
}
bool IsNone(std::pair<unsigned char, UString> const& note) {
  return note.first == 0 && note.second.empty();
}

bool FillsNothing(void (DestinationMode::*get)(DataBuffer&, TimeStamp, unsigned char) const) {
  DataBuffer buffer;
  (DestinationMode().*get)(buffer, Clocks(1), 0);
  return buffer.empty();
}

INSTANTIATE_TEST_SUITE_P(
    Tree, NullNames,
    ::testing::Values(
        CASE(!DestinationMode().Exists()), CASE(DestinationMode().GetName() == kNone),
        CASE(DestinationMode().GetDestination() == Destination()),
        CASE(DestinationMode().GetNameSet(0) == DestinationNameSet()),
        CASE(!DestinationMode().IsStandardMode()), CASE(!DestinationMode().SelectableWithMIDI()),
        CASE(FillsNothing(&DestinationMode::GetEnablingCommand)),
        CASE(FillsNothing(&DestinationMode::GetDisablingCommand)),
        CASE(!DestinationNameSet().Exists()), CASE(DestinationNameSet().GetName() == kNone),
        CASE(DestinationNameSet().GetDestination() == Destination()),
        CASE(DestinationNameSet().CountBanks() == 0),
        CASE(DestinationNameSet().GetBank(0) == PatchBank()),
        CASE(DestinationNameSet().GetBank(255, 255) == PatchBank()),
        CASE(DestinationNameSet().CountModes() == 0),
        CASE(DestinationNameSet().GetMode(0).first == DestinationMode()),
        CASE(DestinationNameSet().GetMode(0).second == 0),
        CASE(DestinationNameSet().GetChannels() == 0), CASE(!PatchBank().Exists()),
        CASE(PatchBank().GetName() == kNone),
        CASE(PatchBank().GetNameSet() == DestinationNameSet()),
        CASE(PatchBank().GetBankName() == kNone), CASE(PatchBank().CountPatches() == 0),
        CASE(PatchBank().GetPatch(0) == Patch()), CASE(PatchBank().GetController0Number() == 255),
        CASE(PatchBank().GetController32Number() == 255),
        CASE(PatchBank().GetCommand(Clocks(1), 0, 0).empty()), CASE(!Patch().Exists()),
        CASE(Patch().GetName() == kNone), CASE(Patch().GetBank() == PatchBank()),
        CASE(Patch().GetNumber() == kNone), CASE(Patch().GetNumberAndName() == kNone),
        CASE(Patch().GetProgramChange() == 255), CASE(IsNone(Patch().GetPatchNumbers())),
        CASE(Patch().GetCommand(Clocks(1), 0, 0).empty()), CASE(!Patch().GetNoteNames().Exists()),
        CASE(!Patch().GetControlNames().Exists()),
        CASE(DestinationMode() == DestinationMode::kNoDestinationMode),
        CASE(DestinationNameSet() == DestinationNameSet::kNoDestinationNameSet),
        CASE(PatchBank() == PatchBank::kNoPatchBank), CASE(Patch() == Patch::kNoPatch)));

// The same for a list over nothing and over an object that has no list.
template <class List>
bool HasNoNotes(List const& list) {
  return list.GetName() == kNone && !list.HasNames() && list.CountNoteNames() == 0 &&
         IsNone(list.GetNoteName(0)) && list.CountNoteGroups() == 0 &&
         IsNone(list.GetNoteGroup(0)) && IsNone(list.GetNoteGroupForID(1)) &&
         list.GetNoteNameForPitch(60) == kNone && list.GetNoteGroupForPitch(60) == 0;
}
template <class List>
bool HasNoControls(List const& list) {
  return list.GetName() == kNone && list.CountControls() == 0 && IsNone(list.GetControl(0)) &&
         IsNone(list.GetControl(kControl7Bit, 0)) && !list.HasControl(kControl7Bit, 0);
}
bool EditsNothing() {
  NoteNameList().SetNoteName(60, "x");
  NoteNameList().ClearNoteName(60);
  NoteNameList().PutNoteInGroup(60, 1, "x");
  NoteNameList().RemoveNoteGroup(1, true);
  ControlList().SetControl(Control());
  ControlList().ClearControl(kControl7Bit, 0);
  return HasNoNotes(NoteNameList()) && HasNoControls(ControlList());
}

INSTANTIATE_TEST_SUITE_P(
    Lists, NullNames,
    ::testing::Values(
        CASE(!NoteNameList().Exists()), CASE(HasNoNotes(NoteNameList())),
        CASE(HasNoNotes(NoteNameList(MakePatch(1)))), CASE(HasNoNotes(DefaultNoteNameList())),
        CASE(HasNoNotes(DefaultNoteNameList(new Impl::DestNameSetImpl(nullptr, "Set")))),
        CASE(NoteNameList().GetPatch() == Patch()),
        CASE(DefaultNoteNameList().GetNameSet() == DestinationNameSet()),
        CASE(NoteNameList().GetUnusedGroupID() == 0),
        CASE(NoteNameList(MakePatch(1)).GetUnusedGroupID() == 1), CASE(EditsNothing()),
        CASE(!ControlList().Exists()), CASE(HasNoControls(ControlList())),
        CASE(HasNoControls(ControlList(MakePatch(1)))), CASE(HasNoControls(DefaultControlList())),
        CASE(HasNoControls(DefaultControlList(new Impl::DestNameSetImpl(nullptr, "Set")))),
        CASE(ControlList().GetPatch() == Patch()),
        CASE(DefaultControlList().GetNameSet() == DestinationNameSet()),
        CASE(NoteNameList() == NoteNameList::kNoNoteNameList),
        CASE(DefaultNoteNameList() == DefaultNoteNameList::kNoDefaultNoteNameList),
        CASE(ControlList() == ControlList::kNoControlList),
        CASE(DefaultControlList() == DefaultControlList::kNoDefaultControlList)));

TEST(NullNames, SendNothing) {
  Destination().SendModeChange(DestinationMode());
  Destination().SendPatchChange(0, Patch());
  TestSetup& setup = TestSetup::Get();
  setup.Reset();
  RecordingListener listener;
  setup.SetListener(&listener);
  Destination const port = setup.MakePort("Without names");
  ImplOf(port)->SetNames(nullptr);
  port.SendModeChange(RCPtrMT<Impl::DestModeImpl>(new Impl::DestModeImpl(nullptr, "M", false)));
  port.SendPatchChange(0, MakePatch(5));
  EXPECT_TRUE(listener.patches.empty());
  EXPECT_TRUE(TestSetup::PeerOf(port).sent->packets.empty());
  setup.Reset();
}

}  // namespace
}  // namespace Ostinet::Testing
