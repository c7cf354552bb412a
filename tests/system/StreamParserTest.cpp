// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "platform/system/simulated/StreamParser.h"

namespace Ostinet::Impl::Simulated {
namespace {

class Writer final : public StreamParser::Sink {
 public:
  std::string Parse(std::vector<std::uint8_t> const& bytes) {
    text_.clear();
    parser_.Parse(bytes.data(), bytes.size(), *this);
    return text_;
  }

 private:
  void Hex(std::uint8_t byte) {
    char const* const digits = "0123456789ABCDEF";
    text_ += digits[byte >> 4];
    text_ += digits[byte & 15];
  }
  void Short(std::uint8_t const (&bytes)[3], int length) override {
    text_ += '(';
    for (int i = 0; i < length; ++i) Hex(bytes[i]);
    text_ += ')';
  }
  void SysexByte(std::uint8_t byte) override { Hex(byte); }
  void SysexEnd(bool whole) override { text_ += whole ? '.' : '!'; }
  void Stray(std::uint8_t byte) override {
    text_ += '?';
    Hex(byte);
  }

  StreamParser parser_;
  std::string text_;
};

TEST(StreamParser, CompletesRunningStatus) {
  EXPECT_EQ(Writer().Parse({0x90, 0x3C, 0x40, 0x3E, 0x41, 0xC2, 5, 6}),
            "(903C40)(903E41)(C205)(C206)");
}

TEST(StreamParser, TakesRealtimeOutOfOtherMessages) {
  EXPECT_EQ(Writer().Parse({0x90, 0xF8, 0x3C, 0x40}), "(F8)(903C40)");
  EXPECT_EQ(Writer().Parse({0xF0, 1, 0xFE, 2, 0xF7}), "F001(FE)02F7.");
}

TEST(StreamParser, SystemMessagesEndRunningStatus) {
  EXPECT_EQ(Writer().Parse({0x90, 1, 2, 0xF2, 3, 4, 5}), "(900102)(F20304)?05");
  EXPECT_EQ(Writer().Parse({0x90, 1, 2, 0xF6, 3}), "(900102)(F6)?03");
}

TEST(StreamParser, AStatusCutsSysexShort) {
  EXPECT_EQ(Writer().Parse({0xF0, 1, 0x90, 2, 3}), "F001!(900203)");
  EXPECT_EQ(Writer().Parse({0xF0, 1, 0xF0, 2, 0xF7}), "F001!F002F7.");
}

TEST(StreamParser, KeepsItsPlaceFromOneCallToTheNext) {
  Writer writer;
  EXPECT_EQ(writer.Parse({0xF0, 1}), "F001");
  EXPECT_EQ(writer.Parse({0xF7, 0x90, 7}), "F7.");
  EXPECT_EQ(writer.Parse({8}), "(900708)");
}

TEST(StreamParser, TellsWhatBelongsToNothing) {
  EXPECT_EQ(Writer().Parse({1, 0xF7, 0xF4, 2}), "?01?F7?F4?02");
}

}  // namespace
}  // namespace Ostinet::Impl::Simulated
