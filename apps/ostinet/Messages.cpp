// SPDX-License-Identifier: MIT
#include "Messages.h"

#include "Errors.h"

namespace Ostinet::Tool {
namespace {

// By the high nibble from 8 to E, then by the low nibble of F0 to FF.
constexpr size_t kChannelLengths[] = {3, 3, 3, 3, 2, 2, 3};
constexpr size_t kSystemLengths[] = {0, 2, 3, 2, 1, 1, 1, 1, 1, 1, 1, 1, 1, 1, 1, 1};

class Splitter {
 public:
  std::vector<Bytes> Split(Bytes const& run) {
    for (unsigned char const byte : run) {
      Take(byte);
    }
    FailIfWithinMessage();
    return std::move(messages_);
  }

 private:
  void Take(unsigned char byte) {
    if (IsRealtime(byte)) {
      messages_.push_back({byte});
    } else if (byte == kSysexEnd && InSysex()) {
      open_.push_back(byte);
      Finish();
    } else if (IsStatus(byte)) {
      TakeStatus(byte);
    } else {
      TakeData(byte);
    }
  }

  void TakeStatus(unsigned char status) {
    FailIfWithinMessage();
    open_ = {status};
    runningStatus_ = status < kSysexStart ? status : static_cast<unsigned char>(0);
    FinishIfComplete();
  }

  void TakeData(unsigned char byte) {
    if (open_.empty()) {
      if (runningStatus_ == 0) {
        throw UsageError("data byte " + ToHex({byte}) + " follows no status byte (80 to FF)");
      }
      open_ = {runningStatus_};
    }
    open_.push_back(byte);
    FinishIfComplete();
  }

  bool InSysex() const { return !open_.empty() && open_.front() == kSysexStart; }

  void FinishIfComplete() {
    if (open_.size() == MessageLength(open_.front())) {
      Finish();
    }
  }

  void Finish() {
    messages_.push_back(open_);
    open_.clear();
  }

  void FailIfWithinMessage() const {
    if (InSysex()) {
      throw UsageError("a sysex of " + std::to_string(open_.size()) + " bytes is not ended by F7");
    }
    if (!open_.empty()) {
      throw UsageError("message " + ToHex(open_) + " is incomplete: it takes " +
                       std::to_string(MessageLength(open_.front())) + " bytes");
    }
  }

  std::vector<Bytes> messages_;
  Bytes open_;
  unsigned char runningStatus_ = 0;
};

}  // namespace

size_t MessageLength(unsigned char status) {
  if (!IsStatus(status)) {
    return 0;
  }
  return status < kSysexStart ? kChannelLengths[(status >> 4) - 8] : kSystemLengths[status & 0x0F];
}

std::vector<Bytes> SplitMessages(Bytes const& run) { return Splitter().Split(run); }

}  // namespace Ostinet::Tool
