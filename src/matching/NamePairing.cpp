// SPDX-License-Identifier: MIT
//
// Which of a driver's inputs and outputs belong together, told from their names alone.
//
// The two directions of MatchOpposingNames are no mirrors of each other, and a front match of
// MatchRelatedNames ends in a blank: hosts keep texts that were built here, so both stay.
#include <algorithm>
#include <string_view>
#include <vector>

#include "ostinet/Endpoint.h"

namespace Ostinet {

namespace {

using Text = std::u16string_view;
using Tokens = std::vector<Text>;

constexpr Text kSeparators = u" \t:-";
constexpr Text kIn = u"In";
constexpr Text kOut = u"Out";
constexpr Text kInOut = u"In/Out";
constexpr Text kPort = u"Port";

UString Joined(Text front, Text back) {
  std::u16string text(front);
  return UString(text.append(kInOut).append(back));
}

// The first name has "In" where the second has "Out".
bool MatchInWithOut(Text in, Text out, UString& joined) {
  std::size_t const place = in.find(kIn);
  if (place == Text::npos || out.find(kOut) != place || out.size() != in.size() + 1) {
    return false;
  }
  Text const front = in.substr(0, place);
  Text const back = in.substr(place + kIn.size());
  if (out.substr(0, place) != front || out.substr(place + kOut.size()) != back) {
    return false;
  }
  joined = Joined(front, back);
  return true;
}

// The first name has "Out". Where the second has "In", or whether it has, is not asked: what
// follows there must be alike, or what follows its first character if it has none.
bool MatchOutWithIn(Text out, Text in, UString& joined) {
  std::size_t const place = out.find(kOut);
  if (place == Text::npos || out.size() != in.size() + 1) {
    return false;
  }
  Text const front = out.substr(0, place);
  Text const back = out.substr(place + kOut.size());
  std::size_t const inPlace = in.find(kIn);
  std::size_t const behind = inPlace == Text::npos ? 1 : inPlace + kIn.size();
  if (in.substr(0, place) != front || behind > in.size() ||
      in.substr(behind, back.size()) != back) {
    return false;
  }
  joined = Joined(front, back);
  return true;
}

bool IsSeparator(char16_t unit) { return kSeparators.find(unit) != Text::npos; }
bool IsSeparator(Text token) { return token.size() == 1 && IsSeparator(token[0]); }

// Separators one by one, and the runs between them.
Tokens Split(Text name) {
  Tokens tokens;
  while (!name.empty()) {
    std::size_t const end = name.find_first_of(kSeparators);
    std::size_t const length = end == 0 ? 1 : std::min(end, name.size());
    tokens.push_back(name.substr(0, length));
    name.remove_prefix(length);
  }
  return tokens;
}

// "(2)": what a system adds to keep two names apart.
bool IsNumberInBrackets(Text token) {
  return token.size() == 3 && token[0] == u'(' && token[1] >= u'0' && token[1] <= u'9' &&
         token[2] == u')';
}

bool HaveSameTail(Tokens const& a, Tokens const& b) {
  return a.size() > 1 && b.size() > 1 && a.back() == b.back() && IsNumberInBrackets(a.back());
}

// These words are in every driver's names and say nothing about whose port it is.
bool CarriesIdentity(Text token) {
  return token != kPort && token != kIn && token != kOut && token != kInOut;
}

bool AreAlike(Text a, Text b) { return a == b && CarriesIdentity(a); }

// Appends tokens without the separators around them. The blank comes even if nothing follows it.
void Join(std::u16string& target, Tokens const& tokens, std::size_t from, std::size_t to) {
  while (from < to && IsSeparator(tokens[from])) {
    ++from;
  }
  while (to > from && IsSeparator(tokens[to - 1])) {
    --to;
  }
  if (!target.empty()) {
    target += u' ';
  }
  for (; from < to; ++from) {
    target += tokens[from];
  }
}

UString Joined(Tokens const& tokens, std::size_t from, std::size_t to) {
  std::u16string text;
  Join(text, tokens, from, to);
  return UString(std::move(text));
}

}  // namespace

bool Endpoint::MatchOpposingNames(UString const& name1, UString const& name2, UString& joinedName) {
  if (name1 == name2) {
    return true;
  }
  Text const first = name1.utf16_str();
  Text const second = name2.utf16_str();
  return MatchInWithOut(first, second, joinedName) || MatchOutWithIn(first, second, joinedName);
}

bool Endpoint::MatchRelatedNames(UString const& name1, UString const& name2, UString& commonName,
                                 UString& rest1, UString& rest2) {
  // The outputs may be the names themselves.
  // NOLINTBEGIN(performance-unnecessary-copy-initialization)
  std::u16string const text1 = name1.utf16_str();
  std::u16string const text2 = name2.utf16_str();
  // NOLINTEND(performance-unnecessary-copy-initialization)
  commonName.clear();
  rest1.clear();
  rest2.clear();

  Tokens const tokens1 = Split(text1);
  Tokens const tokens2 = Split(text2);
  std::size_t const tail = HaveSameTail(tokens1, tokens2) ? 1 : 0;
  std::size_t const count1 = tokens1.size() - tail;
  std::size_t const count2 = tokens2.size() - tail;
  std::size_t const shorter = std::min(count1, count2);

  std::size_t front = 0;
  while (front < shorter && AreAlike(tokens1[front], tokens2[front])) {
    ++front;
  }
  std::size_t back = 0;
  while (back < shorter && AreAlike(tokens1[count1 - 1 - back], tokens2[count2 - 1 - back])) {
    ++back;
  }

  if (front > back && front < count1) {
    std::u16string common;
    Join(common, tokens1, 0, front);
    Join(common, tokens1, count1, tokens1.size());
    commonName = UString(std::move(common));
    rest1 = Joined(tokens1, front, count1);
    rest2 = Joined(tokens2, front, count2);
    return true;
  }
  if (back >= 1 && back < shorter) {
    commonName = Joined(tokens1, count1 - back, tokens1.size());
    rest1 = Joined(tokens1, 0, count1 - back);
    rest2 = Joined(tokens2, 0, count2 - back);
    return true;
  }
  return false;
}

}  // namespace Ostinet
