// SPDX-License-Identifier: MIT
//
// Random documents, loaded, edited at random, written, and read back into a second load: what a
// host sees must be the same. What is lost is known: a list's groups are numbered anew, and a group
// with fewer than two named notes is none; a note or a control that is there but has neither name
// nor range is as one that is not there; patches have no commands but their program.
#include <gtest/gtest.h>

#include <map>
#include <random>
#include <set>

#include "ReadDocument.h"
#include "names/NameDocumentWriter.h"
#include "ostinet/NameDocument.h"
#include "support/TemporaryFolder.h"

namespace Ostinet::Testing {
namespace {

constexpr int kPitches = 12;  // few, so that edits meet

class Dice {
 public:
  explicit Dice(unsigned seed) : engine_(seed) {}
  int Roll(int sides) { return std::uniform_int_distribution<int>(0, sides - 1)(engine_); }
  bool OneIn(int sides) { return Roll(sides) == 0; }

 private:
  std::mt19937 engine_;
};

/// Makes documents. Names are drawn from few, and some of them are the same to a reader.
class DocumentMaker {
 public:
  explicit DocumentMaker(unsigned seed) : dice_(seed) {}

  std::string Make() {
    std::string content;
    for (int i = 1 + dice_.Roll(2); i > 0; --i) {
      content += NameSet("Set" + std::to_string(i));
    }
    for (std::string const name : {"N1", "n 1", "N2"}) {
      content += "<NoteNameList Name='" + name + "'>" + Notes() + "</NoteNameList>";
    }
    for (std::string const name : {"C1", "C2"}) {
      content += "<ControlNameList Name='" + name + "'>" + Controls() + "</ControlNameList>";
    }
    for (std::string const name : {"V1", "V2"}) {
      content += "<ValueNameList Name='" + name + "'>" + Values() + "</ValueNameList>";
    }
    for (std::string const name : {"L1", "L2"}) {
      content += "<PatchNameList Name='" + name + "'>" + Patches() + "</PatchNameList>";
    }
    return MasterText(content);
  }

 private:
  std::string Text() {
    constexpr char const* kTexts[] = {"Piano",   "Bass &amp; Lead", "",  "&#xE9;&#x1F3B9;",
                                      "a&#10;b", "&quot;x&quot;",   " ", "&lt;",
                                      "piano"};
    return kTexts[dice_.Roll(static_cast<int>(std::size(kTexts)))];
  }

  std::string Note() {
    return "<Note Number='" + std::to_string(dice_.Roll(kPitches)) + "' Name='" + Text() + "'/>";
  }

  std::string Notes() {
    std::string text;
    for (int i = dice_.Roll(8); i > 0; --i) {
      if (dice_.OneIn(3)) {
        text += "<NoteGroup Name='" + Text() + "'>" + Note() + Note() + Note() + "</NoteGroup>";
      } else {
        text += Note();
      }
    }
    return text;
  }

  std::string Values() {
    std::string text;
    for (int i = dice_.Roll(4); i > 0; --i) {
      text += "<Value Number='" + std::to_string(dice_.Roll(9)) + "' Name='" + Text() + "'/>";
    }
    return text;
  }

  std::string Range() {
    std::string text = "<Values Min='" + std::to_string(dice_.Roll(20) - 10) + ".125' Max='" +
                       std::to_string(dice_.Roll(20)) + "'";
    text += dice_.OneIn(2) ? " Default='0.1'" : "";
    text += dice_.OneIn(2) ? " Units='Hz'>" : ">";
    if (dice_.OneIn(3)) {
      text += "<ValueNameList>" + Values() + "</ValueNameList>";
    } else if (dice_.OneIn(2)) {
      text += "<UsesValueNameList Name='V" + std::to_string(1 + dice_.Roll(2)) + "'/>";
    }
    return text + "</Values>";
  }

  std::string Controls() {
    constexpr char const* kTypes[] = {"7bit", "14bit", "RPN", "NRPN"};
    std::string text;
    for (int i = dice_.Roll(6); i > 0; --i) {
      text += "<Control Type='" + std::string(kTypes[dice_.Roll(4)]) + "' Number='" +
              std::to_string(dice_.Roll(3)) + "' Name='" + Text() + "'>" +
              (dice_.OneIn(2) ? Range() : "") + "</Control>";
    }
    return text;
  }

  std::string ListsInPlace() {
    std::string text;
    if (dice_.OneIn(3)) {
      text += "<NoteNameList" + std::string(dice_.OneIn(2) ? " Name='In'>" : ">") + Notes() +
              "</NoteNameList>";
    } else if (dice_.OneIn(2)) {
      text += "<UsesNoteNameList Name='N" + std::to_string(1 + dice_.Roll(2)) + "'/>";
    }
    if (dice_.OneIn(3)) {
      text += "<ControlNameList>" + Controls() + "</ControlNameList>";
    } else if (dice_.OneIn(2)) {
      text += "<UsesControlNameList Name='C" + std::to_string(1 + dice_.Roll(2)) + "'/>";
    }
    return text;
  }

  std::string Patches() {
    std::string text;
    for (int i = 1 + dice_.Roll(3); i > 0; --i) {
      text += "<Patch Number='" + Text() + "' Name='" + Text() + "'";
      text += dice_.OneIn(4) ? "" : " ProgramChange='" + std::to_string(dice_.Roll(128)) + "'";
      text += ">" + ListsInPlace() + "</Patch>";
    }
    return text;
  }

  std::string NameSet(std::string const& name) {
    std::string text = "<ChannelNameSet Name='" + name + "'>" + ListsInPlace();
    for (int i = 1 + dice_.Roll(3); i > 0; --i) {
      text += "<PatchBank Name='" + name + "-" + std::to_string(i) + "'>";
      text += dice_.OneIn(2)
                  ? "<PatchNameList Name='" + Text() + "'>" + Patches() + "</PatchNameList>"
                  : "<UsesPatchNameList Name='L" + std::to_string(1 + dice_.Roll(2)) + "'/>";
      text += "</PatchBank>";
    }
    return text + "</ChannelNameSet>";
  }

  Dice dice_;
};

void EditNotes(NoteNameList const& notes, Dice& dice) {
  auto const pitch = static_cast<unsigned char>(dice.Roll(kPitches));
  switch (dice.Roll(4)) {
    case 0:
      notes.SetNoteName(pitch, dice.OneIn(4) ? UString() : UString("Edited"));
      break;
    case 1:
      notes.ClearNoteName(pitch);
      break;
    case 2:
      notes.PutNoteInGroup(pitch, dice.Roll(4), dice.OneIn(2) ? "Toms" : "Cymbals");
      break;
    default:
      notes.RemoveNoteGroup(1 + dice.Roll(3), dice.OneIn(2));
      break;
  }
}

void EditControls(ControlList const& controls, Dice& dice) {
  auto const type = ControlType(dice.Roll(4));
  auto const number = static_cast<unsigned short>(dice.Roll(3));
  Control::ValueMap values;
  values.emplace(static_cast<unsigned short>(dice.Roll(5)), UString("one"));
  values.emplace(static_cast<unsigned short>(dice.Roll(5)), UString("two"));
  switch (dice.Roll(4)) {
    case 0:
      controls.SetControl(Control(type, number, "Edited", -0.1, 1e6, UString("cent")));
      break;
    case 1:
      controls.ClearControl(type, number);
      break;
    case 2:
      controls.SetControl(Control(type, number, dice.OneIn(3) ? UString() : UString("plain")));
      break;
    default:
      controls.SetControl(Control(type, number, "named", values, 3));
      break;
  }
}

using Notes = std::map<int, std::string>;

Notes NamesOf(NoteNameList const& list) {
  Notes notes;
  for (int pitch = 0; pitch < 128; ++pitch) {
    UString const name = list.GetNoteNameForPitch(static_cast<unsigned char>(pitch));
    if (!name.empty()) {
      notes[pitch] = name.string();
    }
  }
  return notes;
}

/// The groups of two named notes and more: name and pitches.
std::multiset<std::pair<std::string, std::set<int>>> GroupsOf(NoteNameList const& list) {
  std::multiset<std::pair<std::string, std::set<int>>> groups;
  for (int i = 0; i < list.CountNoteGroups(); ++i) {
    NoteGroup const group = list.GetNoteGroup(i);
    std::set<int> named;
    for (unsigned char const pitch : group.pitches) {
      if (!list.GetNoteNameForPitch(pitch).empty()) {
        named.insert(pitch);
      }
    }
    if (named.size() >= 2) {
      groups.insert({group.name.string(), named});
    }
  }
  return groups;
}

std::string TextOf(Control const& control) {
  UString text;
  auto stream = text.Stream();
  stream << int{control.GetType()} << ":" << int{control.GetNumber()} << " " << control.GetName();
  if (control.HasValueRange()) {
    stream << " " << control.GetMinValue() << ".." << control.GetMaxValue() << control.GetUnits();
  }
  if (control.HasDefaultValue()) {
    stream << " =" << control.GetDefaultValue();
  }
  for (int i = 0; i < control.CountValueNames(); ++i) {
    stream << " " << int{control.GetValueName(i).first} << "=" << control.GetValueName(i).second;
  }
  return text.string();
}

std::vector<std::string> ControlsOf(ControlList const& list) {
  std::vector<std::string> controls;
  for (int i = 0; i < list.CountControls(); ++i) {
    Control const control = list.GetControl(i);
    if (!control.GetName().empty() || control.HasValueRange()) {
      controls.push_back(TextOf(control));
    }
  }
  return controls;
}

void ExpectSame(Patch const& before, Patch const& after) {
  EXPECT_EQ(before.GetNumber(), after.GetNumber());
  EXPECT_EQ(before.GetName(), after.GetName());
  EXPECT_EQ(before.GetProgramChange(), after.GetProgramChange());
  EXPECT_EQ(NamesOf(before.GetNoteNames()), NamesOf(after.GetNoteNames()));
  EXPECT_EQ(before.GetNoteNames().HasNames(), after.GetNoteNames().HasNames());
  EXPECT_EQ(GroupsOf(before.GetNoteNames()), GroupsOf(after.GetNoteNames()));
  EXPECT_EQ(ControlsOf(before.GetControlNames()), ControlsOf(after.GetControlNames()));
}

std::vector<RCPtrMT<Impl::PatchBankImpl>> BanksOf(Impl::NameTree const& tree) {
  std::vector<RCPtrMT<Impl::PatchBankImpl>> banks;
  for (auto const& nameSet : tree.nameSets) {
    banks.insert(banks.end(), nameSet->GetBanks().begin(), nameSet->GetBanks().end());
  }
  return banks;
}

class RoundTrip {
 public:
  explicit RoundTrip(unsigned seed) : dice_(seed), text_(DocumentMaker(seed + 1000).Make()) {}

  void EditAndCompare() {
    Reader const first = ReadMaster(text_);
    Impl::AssignLists(first->tree, first->uses);
    auto const banks = BanksOf(first->tree);
    Edit(banks);
    std::vector<Impl::PatchBankImpl const*> toWrite;
    for (auto const& bank : banks) {
      toWrite.push_back(bank.get());
    }
    File const file = folder_.GetFolder().GetFile("a.midnam");
    Impl::WrittenFor owner;
    owner.uniqueID = TestOwner().uniqueID;
    auto const written = Impl::WriteBanks(file, owner, toWrite);
    NameDocumentCheck const check = CheckNameDocument(file);
    EXPECT_TRUE(check.isStandard);
    for (NameDocumentFinding const& finding : check.findings) {
      EXPECT_EQ(finding.kind, NameDocumentFinding::kPassedOver) << finding.text.string();
    }

    Reader const second = ReadMaster(text_);
    Override(*second, file, written);
    auto const again = BanksOf(second->tree);
    ASSERT_EQ(banks.size(), again.size());
    for (std::size_t i = 0; i < banks.size(); ++i) {
      EXPECT_TRUE(again[i]->IsTemporary());
      Compare(PatchBank(banks[i]), PatchBank(again[i]));
    }
  }

 private:
  void Edit(std::vector<RCPtrMT<Impl::PatchBankImpl>> const& banks) {
    for (int edits = dice_.Roll(20); edits > 0; --edits) {
      PatchBank const bank(
          banks[static_cast<std::size_t>(dice_.Roll(static_cast<int>(banks.size())))]);
      Patch const patch = bank.GetPatch(dice_.Roll(bank.CountPatches()));
      if (dice_.OneIn(3)) {
        EditControls(patch.GetControlNames(), dice_);
      } else {
        EditNotes(patch.GetNoteNames(), dice_);
      }
    }
  }

  // What a destination does with the overrides of its banks.
  static void Override(Impl::NameDocumentReader& master, File const& file,
                       std::vector<Impl::WrittenBank> const& written) {
    std::vector<Impl::NameDocumentReader::BankRequest> requests;
    for (auto const& bank : BanksOf(master.tree)) {
      for (Impl::WrittenBank const& names : written) {
        if (names.bankName == bank->GetBankName()) {
          requests.emplace_back(bank, names.listName);
        }
      }
    }
    Impl::NameDocumentReader extending(TestOwner());
    EXPECT_TRUE(extending.LoadExtending(file, requests));
    master.uses.Merge(extending.uses);
    Impl::AssignLists(master.tree, master.uses);
  }

  static void Compare(PatchBank const& before, PatchBank const& after) {
    ASSERT_EQ(before.CountPatches(), after.CountPatches());
    for (int i = 0; i < before.CountPatches(); ++i) {
      SCOPED_TRACE(before.GetBankName().string() + ", patch " + std::to_string(i));
      ExpectSame(before.GetPatch(i), after.GetPatch(i));
    }
  }

  TemporaryFolder const folder_;
  Dice dice_;
  std::string const text_;
};

TEST(WrittenBanks, ReadBackAsTheyWere) {
  for (unsigned seed = 0; seed < 150 && !::testing::Test::HasFailure(); ++seed) {
    SCOPED_TRACE("seed " + std::to_string(seed));
    RoundTrip(seed).EditAndCompare();
  }
}

}  // namespace
}  // namespace Ostinet::Testing
