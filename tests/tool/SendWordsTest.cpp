// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>

#include "Errors.h"
#include "SendWords.h"
#include "support/TemporaryPath.h"

namespace Ostinet::Tool {
namespace {

// "TIME: BYTES" of each message.
std::vector<std::string> Read(std::vector<std::string> const& arguments) {
  SendWords words;
  for (std::string const& argument : arguments) {
    words.Add(argument);
  }
  std::vector<std::string> texts;
  for (ScheduledMessage const& message : words.Take()) {
    texts.push_back(std::to_string(static_cast<int>(message.afterMs)) + ": " +
                    ToHex(message.bytes));
  }
  return texts;
}

using Texts = std::vector<std::string>;

struct Case {
  std::vector<std::string> arguments;
  Texts messages;
};

class EachForm : public testing::TestWithParam<Case> {};

TEST_P(EachForm, MakesItsMessages) { EXPECT_EQ(Read(GetParam().arguments), GetParam().messages); }

INSTANTIATE_TEST_SUITE_P(
    SendWords, EachForm,
    testing::Values(
        Case{{"90 3C 40"}, {"0: 90 3C 40"}}, Case{{"903C40"}, {"0: 90 3C 40"}},
        Case{{"90", "3c", "40"}, {"0: 90 3C 40"}},
        Case{{"90 3C 40 3E 40 F8"}, {"0: 90 3C 40", "0: 90 3E 40", "0: F8"}},
        Case{{"on", "60", "100"}, {"0: 90 3C 64"}}, Case{{"on C4 100"}, {"0: 90 3C 64"}},
        Case{{"off 60"}, {"0: 80 3C 40"}}, Case{{"off 60 1"}, {"0: 80 3C 01"}},
        Case{{"off 60 on 61 2"}, {"0: 80 3C 40", "0: 90 3D 02"}},
        Case{{"cc 7 100"}, {"0: B0 07 64"}}, Case{{"CC 05"}, {"0: CC 05"}},
        Case{{"pc 5"}, {"0: C0 05"}}, Case{{"at 9"}, {"0: D0 09"}},
        Case{{"pp 60 9"}, {"0: A0 3C 09"}}, Case{{"pb 8192"}, {"0: E0 00 40"}},
        Case{{"pb 0"}, {"0: E0 00 00"}}, Case{{"pb", "-8192"}, {"0: E0 00 00"}},
        Case{{"pb +8191"}, {"0: E0 7F 7F"}}, Case{{"pb 16383"}, {"0: E0 7F 7F"}},
        Case{{"syx F0 41 F7"}, {"0: F0 41 F7"}}, Case{{"syx 41 10"}, {"0: F0 41 10 F7"}},
        Case{{"syx 41 on 60 1"}, {"0: F0 41 F7", "0: 90 3C 01"}},
        Case{{"start", "stop"}, {"0: FA", "0: FC"}},
        Case{{"clock continue reset"}, {"0: F8", "0: FB", "0: FF"}},
        Case{{"ch 16 pc 1 ch 1 pc 2"}, {"0: CF 01", "0: C0 02"}},
        Case{{"on 60 1 +500 off 60"}, {"0: 90 3C 01", "500: 80 3C 40"}},
        Case{{"+500 F8 +0 FA"}, {"0: FA", "500: F8"}},
        Case{{"syx 41 +10 F8"}, {"0: F0 41 F7", "10: F8"}}, Case{{}, {}}, Case{{" "}, {}}));

class EachFault : public testing::TestWithParam<std::vector<std::string>> {};

TEST_P(EachFault, IsWrongUsage) { EXPECT_THROW(Read(GetParam()), UsageError); }

INSTANTIATE_TEST_SUITE_P(SendWords, EachFault,
                         testing::Values(std::vector<std::string>{"on 60"}, Texts{"on"},
                                         Texts{"on 128 1"}, Texts{"on 60 128"}, Texts{"on H4 1"},
                                         Texts{"cc C4 1"}, Texts{"pc -1"}, Texts{"pb 16384"},
                                         Texts{"pb +8192"}, Texts{"ch 0"}, Texts{"ch 17"},
                                         Texts{"ch"}, Texts{"syx"}, Texts{"syx F0 90 F7"},
                                         Texts{"90 3C"}, Texts{"90 3"}, Texts{"nonsense"},
                                         Texts{"+x F8"}, Texts{"+ F8"}, Texts{"3C 40"},
                                         Texts{"90 3C on 60 1"}));

TEST(SendWords, KeepsTheChannelOfTheCommandLine) {
  SendWords words;
  words.SetChannel("10");
  words.Add("on 36 100");
  EXPECT_EQ(words.Take().at(0).bytes, (Bytes{0x99, 36, 100}));
}

TEST(SendWords, RefusesTimesThatAreNone) {
  for (char const* text : {"", "-1", "abc", "1x", "nan", "1e30"}) {
    SendWords words;
    EXPECT_THROW(words.SetTime(text), UsageError) << text;
  }
}

class SysexFiles : public testing::Test {
 protected:
  std::string Write(std::string const& name, std::string const& content) {
    std::filesystem::path const path = folder_.Path() / name;
    std::ofstream(path, std::ios::binary) << content;
    return path.string();
  }

 private:
  Testing::TemporaryPath folder_;
};

TEST_F(SysexFiles, AreSentMessageByMessage) {
  std::string const path = Write("two.SYX", "\xF0\x41\xF7\xF0\x42\xF7");
  EXPECT_EQ(Read({path, "F8"}), (Texts{"0: F0 41 F7", "0: F0 42 F7", "0: F8"}));
}

TEST_F(SysexFiles, FailWhereTheyCannotBeReadOrHoldNoMessages) {
  EXPECT_THROW(Read({"no/such/file.syx"}), Failure);
  EXPECT_THROW(Read({Write("cut.syx", "\xF0\x41")}), Failure);
  EXPECT_THROW(Read({Write("empty.syx", "")}), Failure);
  EXPECT_THROW(Read({Write("text.syx", "hello")}), Failure);
}

}  // namespace
}  // namespace Ostinet::Tool
