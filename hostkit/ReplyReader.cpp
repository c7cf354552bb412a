// SPDX-License-Identifier: MIT
#include "ReplyReader.h"

#include <algorithm>
#include <utility>

#include "ostinet/hostkit/DetectionRun.h"

namespace Ostinet {

namespace {

constexpr unsigned char kSysex = 0xF0;
constexpr unsigned char kEndOfExclusive = 0xF7;
constexpr unsigned char kFirstRealTime = 0xF8;
constexpr unsigned char kFirstStatus = 0x80;

// The end of the bytes from `begin` on that a sysex message goes on with: up to its last byte, to
// the next status, or to a real-time message that cuts in.
unsigned char const* EndOfRun(unsigned char const* begin, unsigned char const* end) {
  unsigned char const* const stop =
      std::find_if(begin, end, [](unsigned char byte) { return byte >= kFirstStatus; });
  return stop != end && *stop == kEndOfExclusive ? stop + 1 : stop;
}

}  // namespace

std::vector<Reply> ReplyReader::Take(DataPacket const& packet) {
  std::vector<Reply> replies;
  // Ports hand short messages over as three bytes, of which the last may mean nothing.
  if (!DetectionRun::IsSysex(packet)) {
    return replies;
  }
  unsigned char const* byte = packet.data;
  unsigned char const* const end = byte + packet.length;
  while (byte != end) {
    if (*byte >= kFirstRealTime) {
      ++byte;
      continue;
    }
    if (*byte >= kFirstStatus && *byte != kEndOfExclusive) {
      End(replies);  // cut off by what begins here
      isInMessage_ = *byte == kSysex;
      if (isInMessage_) {
        Begin();
        Feed(byte, byte + 1);
      }
      ++byte;
      continue;
    }
    unsigned char const* const stop = EndOfRun(byte, end);
    Feed(byte, stop);
    if (stop[-1] == kEndOfExclusive) {
      End(replies);
    }
    byte = stop;
  }
  return replies;
}

std::vector<Reply> ReplyReader::Finish() {
  std::vector<Reply> replies;
  End(replies);
  return replies;
}

void ReplyReader::Begin() {
  bytes_.clear();
  attempts_.assign(answers_.size(), Attempt());
  for (std::size_t i = 0; i < attempts_.size(); ++i) {
    attempts_[i].hit.answer = i;
    attempts_[i].position = answers_[i].matcher.Start();
  }
}

// A position of 0 behind the first byte means that the answer does not fit.
void ReplyReader::Feed(unsigned char const* begin, unsigned char const* end) {
  if (!isInMessage_) {
    return;
  }
  std::size_t const count = static_cast<std::size_t>(end - begin);
  for (Attempt& attempt : attempts_) {
    if (attempt.isAlive) {
      Autodetect::Matcher const& matcher = answers_[attempt.hit.answer].matcher;
      attempt.position = matcher.Match(Data(begin, count), attempt.position, attempt.hit.deviceID,
                                       attempt.hit.captured);
      attempt.isAlive = attempt.position != 0;
    }
  }
  std::size_t const room = DetectionRun::kMostReplyBytes - bytes_.size();
  bytes_.insert(bytes_.end(), begin, begin + std::min(count, room));
}

void ReplyReader::End(std::vector<Reply>& replies) {
  if (!std::exchange(isInMessage_, false)) {
    return;
  }
  Reply reply;
  reply.bytes = bytes_;
  for (Attempt const& attempt : attempts_) {
    if (FitsAnswer(attempt)) {
      reply.hits.push_back(attempt.hit);
    }
  }
  replies.push_back(std::move(reply));
}

bool ReplyReader::FitsAnswer(Attempt const& attempt) const {
  return attempt.isAlive && attempt.position == answers_[attempt.hit.answer].matcher.Success();
}

}  // namespace Ostinet
