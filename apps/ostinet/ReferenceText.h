// SPDX-License-Identifier: MIT
#pragma once

#include <string>
#include <vector>

#include "NamePairs.h"
#include "ostinet/hostkit/ReferenceResolver.h"

namespace Ostinet::Tool {

/// A reference as people pass it on: its bytes, two hexadecimal digits each, in one word.
std::string ReferenceText(MatchData const& data);
/// The reference of such a text; blanks between bytes are allowed. Throws UsageError.
MatchData ParseReference(std::string const& text);

/// The tag of a word: device, entity, source, destination, mode, name-set, patch, bank, note-list,
/// control-list. Throws UsageError for any other.
MatchObjectID ParseObjectType(std::string const& word);
/// The first word of a tag, or its number.
std::string ObjectTypeText(MatchObjectID type);

/// The reference with all that it says, as one JSON object.
std::string ReferenceJSON(MatchData const& data);

/// What was found, a line for each candidate: the best, then the runners-up.
std::vector<std::string> AnswerLines(ReferenceResolver::Answer const& answer);
std::string AnswerJSON(ReferenceResolver::Answer const& answer);

std::string PairsJSON(std::vector<NamePair> const& pairs, std::vector<std::string> const& sources,
                      std::vector<std::string> const& destinations);

}  // namespace Ostinet::Tool
