// SPDX-License-Identifier: MIT
//
// Random sequences of edits and of recorded messages: what holds whatever a host or a document
// does.
#include <gmock/gmock.h>

#include <algorithm>
#include <map>
#include <random>
#include <set>

#include "names/SmallTree.h"

namespace Ostinet::Testing {
namespace {

using Impl::ControlTable;
using Impl::MIDICommandList;
using Impl::NoteNameData;
using Impl::NoteNameTable;

constexpr int kRounds = 300;
constexpr int kEdits = 60;

class Random {
 public:
  explicit Random(unsigned seed) : engine_(seed) {}
  int Below(int end) { return std::uniform_int_distribution<int>(0, end - 1)(engine_); }
  unsigned char Byte(int end) { return static_cast<unsigned char>(Below(end)); }
  UString Text() { return Below(6) == 0 ? UString() : UString(kTexts[Below(3)]); }

 private:
  static constexpr char const* kTexts[] = {"Kick", "Snare", "Tom"};
  std::mt19937 engine_;
};

// Few pitches, so that edits meet.
constexpr int kPitches = 12;
constexpr int kGroups = 4;

RCPtrMT<NoteNameData> RandomNotes(Random& random) {
  RCPtrMT<NoteNameData> const data(new NoteNameData("List", random.Below(2) == 0));
  data->groupNames = {"One", "Two", ""};
  for (int i = 0; i < 8; ++i) {
    data->SetNote(random.Byte(kPitches), random.Text(), random.Below(4));
  }
  return data;
}

void ExpectSortedAndUnique(std::vector<int> const& values, char const* what) {
  EXPECT_TRUE(std::is_sorted(values.begin(), values.end())) << what;
  EXPECT_EQ(std::adjacent_find(values.begin(), values.end()), values.end()) << what;
}

// Both sides of the relation of notes and groups agree, and everything can be found.
void ExpectWhole(NoteNameTable const& table) {
  std::vector<int> pitches;
  std::map<int, std::set<int>> notesOfGroups;
  for (Impl::NoteEntry const& note : table.GetNotes()) {
    pitches.push_back(note.pitch);
    EXPECT_EQ(table.FindNote(note.pitch), &note);
    if (note.group != 0) {
      notesOfGroups[note.group].insert(note.pitch);
    }
    EXPECT_TRUE(note.hasDefault || !note.inherited);
  }
  ExpectSortedAndUnique(pitches, "notes");
  std::vector<int> ids;
  std::map<int, std::set<int>> pitchesOfGroups;
  for (Impl::NoteGroupEntry const& group : table.GetGroups()) {
    ids.push_back(group.id);
    EXPECT_EQ(table.FindGroup(group.id), &group);
    std::set<int> const members(group.pitches.begin(), group.pitches.end());
    EXPECT_EQ(members.size(), group.pitches.size());
    EXPECT_FALSE(members.empty());
    pitchesOfGroups[group.id] = members;
    // What a group inherits, its notes inherit: it is written whole or not at all.
    for (unsigned char const pitch : group.pitches) {
      ASSERT_NE(table.FindNote(pitch), nullptr);
      EXPECT_EQ(table.FindNote(pitch)->inherited, group.inherited);
    }
  }
  ExpectSortedAndUnique(ids, "groups");
  EXPECT_EQ(notesOfGroups, pitchesOfGroups);
  ExpectSortedAndUnique({table.GetHiddenPitches().begin(), table.GetHiddenPitches().end()},
                        "hidden");
}

void EditNotes(NoteNameTable& table, Random& random) {
  unsigned char const pitch = random.Byte(kPitches);
  switch (random.Below(5)) {
    case 0:
    case 1:
      table.SetNoteName(pitch, random.Text());
      break;
    case 2:
      table.ClearNoteName(pitch);
      break;
    case 3:
      table.PutNoteInGroup(pitch, random.Below(kGroups), random.Text());
      break;
    default:
      table.RemoveGroup(random.Below(kGroups), random.Below(2) == 0);
  }
}

TEST(RandomEdits, KeepATableOfNotesWhole) {
  for (unsigned seed = 0; seed < kRounds; ++seed) {
    SCOPED_TRACE(seed);
    Random random(seed);
    RCPtrMT<NoteNameData> const defaults = RandomNotes(random);
    RCPtrMT<NoteNameData> const own = RandomNotes(random);
    RCPtrMT<NoteNameTable> const merged =
        NoteNameTable::Merge(random.Below(4) == 0 ? nullptr : defaults.get(),
                             random.Below(4) == 0 ? nullptr : own.get());
    for (Impl::NoteGroupEntry const& group : merged->GetGroups()) {
      EXPECT_GE(group.pitches.size(), 2u);
    }
    RCPtrMT<NoteNameTable> const table = merged->CopyForEditing();
    ExpectWhole(*table);
    for (int i = 0; i < kEdits && !::testing::Test::HasFailure(); ++i) {
      EditNotes(*table, random);
      ExpectWhole(*table);
    }
    ASSERT_FALSE(::testing::Test::HasFailure());
  }
}

// A pitch of the default list is never forgotten: it has its note, or it is hidden. So what a
// document says about it can always be told from what it does not say.
TEST(RandomEdits, RememberEveryDefaultNote) {
  for (unsigned seed = 0; seed < kRounds; ++seed) {
    SCOPED_TRACE(seed);
    Random random(seed);
    RCPtrMT<NoteNameData> const defaults = RandomNotes(random);
    RCPtrMT<NoteNameTable> const table =
        NoteNameTable::Merge(defaults.get(), nullptr)->CopyForEditing();
    std::set<int> expected;
    for (Impl::NoteEntry const& note : table->GetNotes()) {
      expected.insert(note.pitch);
    }
    for (int i = 0; i < kEdits; ++i) {
      EditNotes(*table, random);
    }
    std::set<int> known(table->GetHiddenPitches().begin(), table->GetHiddenPitches().end());
    for (Impl::NoteEntry const& note : table->GetNotes()) {
      if (note.hasDefault) {
        EXPECT_TRUE(known.insert(note.pitch).second);
      }
    }
    ASSERT_EQ(known, expected);
  }
}

TEST(RandomEdits, RememberEveryDefaultControl) {
  for (unsigned seed = 0; seed < kRounds; ++seed) {
    SCOPED_TRACE(seed);
    Random random(seed);
    auto const randomType = [&random] { return static_cast<ControlType>(random.Below(4)); };
    RCPtrMT<Impl::ControlNameData> const defaults(new Impl::ControlNameData("List"));
    std::set<std::pair<int, int>> expected;
    for (unsigned short number = 0; number < 6; ++number) {
      ControlType const type = randomType();
      defaults->controls.insert(Control(type, number, "Default"));
      expected.emplace(type, number);
    }
    RCPtrMT<ControlTable> const table =
        ControlTable::Merge(defaults.get(), nullptr)->CopyForEditing();
    std::set<std::pair<int, int>> present = expected;
    for (int i = 0; i < kEdits; ++i) {
      ControlType const type = randomType();
      unsigned short const number = random.Byte(8);
      if (random.Below(2) == 0) {
        table->Set(Control(type, number, "Mine"));
        present.emplace(type, number);
      } else {
        table->Clear({type, number});
        present.erase({type, number});
      }
    }
    std::set<std::pair<int, int>> known;
    for (Impl::ControlKey const& key : table->GetHidden()) {
      known.emplace(key.type, key.number);
    }
    std::set<std::pair<int, int>> found;
    for (Impl::ControlEntry const& entry : table->GetControls()) {
      Impl::ControlKey const key = Impl::ControlParts::KeyOf(entry.control);
      EXPECT_NE(table->Find(key), nullptr);
      found.emplace(key.type, key.number);
      if (entry.hasDefault) {
        EXPECT_TRUE(known.emplace(key.type, key.number).second);
      }
    }
    ASSERT_EQ(known, expected);
    ASSERT_EQ(found, present);
  }
}

/// What a list is expected to send: numbers while they can be, in their order, then the rest.
class Expectation {
 public:
  void Add(Bytes const& message) {
    Bytes* const slot = isPending_ ? SlotFor(message) : nullptr;
    if (slot != nullptr && slot->empty() && program_.empty()) {
      *slot = message;
    } else {
      isPending_ = false;
      script_.push_back(message);
    }
  }
  std::vector<Bytes> All() const {
    std::vector<Bytes> all;
    for (Bytes const* slot : {&msb_, &lsb_, &program_}) {
      if (!slot->empty()) {
        all.push_back(*slot);
      }
    }
    all.insert(all.end(), script_.begin(), script_.end());
    return all;
  }
  bool IsPending() const { return isPending_; }

 private:
  Bytes* SlotFor(Bytes const& message) {
    if (message[0] == 0xC0) {
      return &program_;
    }
    bool const isControl = message[0] == 0xB0;
    return isControl && message[1] == 0 ? &msb_ : isControl && message[1] == 32 ? &lsb_ : nullptr;
  }

  bool isPending_ = true;
  Bytes msb_, lsb_, program_;
  std::vector<Bytes> script_;
};

TEST(RandomMessages, GoOutAsTheyWereRecorded) {
  for (unsigned seed = 0; seed < 20 * kRounds; ++seed) {
    SCOPED_TRACE(seed);
    Random random(seed);
    MIDICommandList list;
    Expectation expected;
    for (int count = random.Below(6); count > 0; --count) {
      unsigned char const value = random.Byte(128);
      constexpr unsigned char kControls[] = {0, 0, 32, 32, 7};
      if (random.Below(3) == 0) {
        list.AddTwoBytes(0xC0, value);
        expected.Add({0xC0, value});
      } else {
        unsigned char const control = kControls[random.Below(5)];
        list.AddThreeBytes(0xB0, control, value);
        expected.Add({0xB0, control, value});
      }
    }
    DataBuffer buffer;
    list.GenerateCommands(buffer, Clocks(1), 0, 0);
    ASSERT_EQ(Packets(buffer), expected.All());
    ASSERT_EQ(list.Items().empty(), expected.IsPending());
  }
}

}  // namespace
}  // namespace Ostinet::Testing
