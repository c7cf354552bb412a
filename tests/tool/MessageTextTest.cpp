// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include "MessageText.h"

namespace Ostinet::Tool {
namespace {

struct Case {
  Bytes message;
  char const* text;
};

class EachMessage : public testing::TestWithParam<Case> {};

TEST_P(EachMessage, IsToldInWords) {
  EXPECT_EQ(DescribeMessage(GetParam().message), GetParam().text);
}

INSTANTIATE_TEST_SUITE_P(
    DescribeMessage, EachMessage,
    testing::Values(Case{{0x80, 60, 64}, "note off          ch 1   note 60 (C4) velocity 64"},
                    Case{{0x9F, 69, 100}, "note on           ch 16  note 69 (A4) velocity 100"},
                    Case{{0xA2, 0, 5}, "note pressure     ch 3   note 0 (C-1) value 5"},
                    Case{{0xB0, 7, 100}, "control change    ch 1   control 7 (volume) value 100"},
                    Case{{0xB0, 3, 1}, "control change    ch 1   control 3 value 1"},
                    Case{{0xC9, 12}, "program change    ch 10  program 12"},
                    Case{{0xD0, 127}, "channel pressure  ch 1   value 127"},
                    Case{{0xE0, 0, 0x40}, "pitch bend        ch 1   value 0"},
                    Case{{0xE0, 0, 0}, "pitch bend        ch 1   value -8192"},
                    Case{{0xF0, 0x7E, 0xF7}, "sysex             3 bytes  F0 7E F7"},
                    Case{{0xF1, 0x35}, "time code         piece 3 value 5"},
                    Case{{0xF2, 0x01, 0x01}, "song position     beat 129"},
                    Case{{0xF3, 0x04}, "song select       song 4"}, Case{{0xF8}, "clock"},
                    Case{{0xFF}, "reset"}, Case{{0x3C, 0x40}, "piece             2 bytes  3C 40"},
                    Case{{0x90, 0x3C}, "piece             2 bytes  90 3C"}, Case{{}, "nothing"}));

TEST(DescribeMessage, ShowsTheBeginningOfALongSysex) {
  Bytes sysex(300, 0x01);
  sysex.front() = 0xF0;
  sysex.back() = 0xF7;
  std::string const text = DescribeMessage(sysex);
  EXPECT_NE(text.find("300 bytes  F0 01"), std::string::npos);
  EXPECT_EQ(text.substr(text.size() - 4), " ...");
}

TEST(NoteNames, ReadBackAsTheSameNote) {
  for (int note = 0; note < 128; ++note) {
    EXPECT_EQ(ParseNote(NoteName(note)), note);
    EXPECT_EQ(ParseNote(std::to_string(note)), note);
  }
}

TEST(ParseNote, TakesFlatsAndSmallLetters) {
  EXPECT_EQ(ParseNote("Bb3"), ParseNote("A#3"));
  EXPECT_EQ(ParseNote("bb3"), ParseNote("A#3"));
  EXPECT_EQ(ParseNote("c4"), 60);
}

TEST(ParseNote, RefusesWhatIsNoNote) {
  for (char const* text :
       {"", "H4", "C", "C#", "C4x", "128", "-1", "G#9", "Cb-1", "C99", " ", "#4"}) {
    EXPECT_EQ(ParseNote(text), -1) << text;
  }
}

}  // namespace
}  // namespace Ostinet::Tool
