// SPDX-License-Identifier: MIT
#include "platform/system/native/PortNames.h"

#include <string_view>

#include "platform/system/native/Utf16.h"

namespace Ostinet::Impl {
namespace {

bool IsDigit(char c) { return c >= '0' && c <= '9'; }

std::size_t CountDigitsAtEnd(std::string_view text) {
  std::size_t count = 0;
  while (count < text.size() && IsDigit(text[text.size() - 1 - count])) ++count;
  return count;
}

std::string_view TrimBlanks(std::string_view text) {
  while (!text.empty() && text.front() == ' ') text.remove_prefix(1);
  while (!text.empty() && text.back() == ' ') text.remove_suffix(1);
  return text;
}

// " 20:0" at the end.
std::string_view WithoutAddress(std::string_view text) {
  std::size_t const port = CountDigitsAtEnd(text);
  std::string_view rest = text.substr(0, text.size() - port);
  if (port == 0 || rest.empty() || rest.back() != ':') return text;
  rest.remove_suffix(1);
  std::size_t const client = CountDigitsAtEnd(rest);
  rest.remove_suffix(client);
  if (client == 0 || rest.empty() || rest.back() != ' ') return text;
  return TrimBlanks(rest);
}

std::string JoinClientAndPort(std::string_view client, std::string_view port) {
  client = TrimBlanks(client);
  port = TrimBlanks(port);
  if (client.empty() || port.substr(0, client.size()) == client) return std::string(port);
  if (port.empty()) return std::string(client);
  return std::string(client) + ":" + std::string(port);
}

// "Synth [20] (capture)" is the client Synth.
std::string_view WithoutBridgeMarks(std::string_view client) {
  for (std::string_view mark : {" (capture)", " (playback)"}) {
    if (client.ends_with(mark)) client.remove_suffix(mark.size());
  }
  if (!client.ends_with("]")) return client;
  std::string_view const rest = client.substr(0, client.size() - 1);
  std::size_t const digits = CountDigitsAtEnd(rest);
  std::string_view const front = rest.substr(0, rest.size() - digits);
  if (digits == 0 || !front.ends_with(" [")) return client;
  return front.substr(0, front.size() - 2);
}

// A cut must not part the two halves of one character.
std::u16string CutAt(std::u16string text, std::size_t length) {
  if (text.size() <= length) return text;
  if (length > 0 && text[length - 1] >= 0xD800 && text[length - 1] <= 0xDBFF) --length;
  text.resize(length);
  return text;
}

}  // namespace

std::string AlsaPortName(std::string const& id) {
  std::string_view const name = WithoutAddress(id);
  std::size_t const colon = name.find(':');
  if (colon == std::string_view::npos) return std::string(TrimBlanks(name));
  return JoinClientAndPort(name.substr(0, colon), name.substr(colon + 1));
}

std::string JackPortName(std::string const& id) {
  std::string_view const name = id;
  std::size_t const colon = name.find(':');
  if (colon == std::string_view::npos) return std::string(TrimBlanks(name));
  std::string_view const port = name.substr(colon + 1);
  std::size_t const inner = port.rfind("): ");
  if (inner == std::string_view::npos) {
    return JoinClientAndPort(name.substr(0, colon), port);
  }
  std::string_view const marked = port.substr(0, inner + 1);
  std::string_view const bridged = WithoutBridgeMarks(marked);
  if (bridged.size() == marked.size()) return JoinClientAndPort(name.substr(0, colon), port);
  return JoinClientAndPort(bridged, port.substr(inner + 3));
}

std::u16string FitPortName(std::string const& name) {
  std::u16string const whole = Utf16FromUtf8(name);
  if (whole.size() <= kMaxPortName) return whole;
  std::size_t const colon = whole.find(u':');
  if (colon == std::u16string::npos) return CutAt(whole, kMaxPortName);
  std::u16string const port = whole.substr(colon + 1);
  if (port.size() + 2 > kMaxPortName) return CutAt(port, kMaxPortName);
  return CutAt(whole.substr(0, colon), kMaxPortName - 1 - port.size()) + u':' + port;
}

std::u16string MakePortNameUnique(std::u16string const& name,
                                  std::set<std::u16string> const& taken) {
  std::u16string candidate = name;
  for (unsigned number = 2; taken.contains(candidate); ++number) {
    std::u16string const suffix = u" " + Utf16FromUtf8(std::to_string(number));
    candidate = CutAt(name, kMaxPortName - suffix.size()) + suffix;
  }
  return candidate;
}

}  // namespace Ostinet::Impl
