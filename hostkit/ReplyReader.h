// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <vector>

#include "ostinet/Autodetect.h"

namespace Ostinet {

/// An answer that a port may give, with the question that it belongs to.
struct KnownAnswer {
  std::size_t question;
  Autodetect::Response response;
  Autodetect::Matcher matcher;
};

/// An answer that fits a reply, and what it read from it.
struct Hit {
  std::size_t answer = 0;  // its index
  unsigned char deviceID = 0xFF;
  Array<unsigned char, 7> captured = {{0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF}};
};

/// A sysex message as far as it is kept, and the answers that it fits.
struct Reply {
  std::vector<unsigned char> bytes;
  std::vector<Hit> hits;
};

/// Puts the packets of one source together to sysex messages, and matches them against all known
/// answers as they come.
class ReplyReader {
 public:
  /// `answers` outlives the reader. More may be added to it; they count from the next message on.
  explicit ReplyReader(std::vector<KnownAnswer> const& answers) : answers_(answers) {}

  /// Takes a packet. Gives each message that it ends.
  std::vector<Reply> Take(DataPacket const& packet);
  /// Gives the message that is under way, if it has begun, and ignores the rest of it.
  std::vector<Reply> Finish();

 private:
  struct Attempt {
    Hit hit;
    std::size_t position = 0;
    bool isAlive = true;
  };

  void Begin();
  void Feed(unsigned char const* begin, unsigned char const* end);
  void End(std::vector<Reply>& replies);
  bool FitsAnswer(Attempt const& attempt) const;

  std::vector<KnownAnswer> const& answers_;
  std::vector<Attempt> attempts_;
  std::vector<unsigned char> bytes_;
  bool isInMessage_ = false;
};

}  // namespace Ostinet
