// SPDX-License-Identifier: MIT
#pragma once

#include <string_view>
#include <vector>

#include "names/ContentModel.h"
#include "ostinet/core/UString.h"

namespace Ostinet::Impl {

/// What the MIDI Name Document format, version 1.0, says of an attribute.
struct AttributeForm {
  enum Type { kText, kToken, kWord };
  enum Need { kRequired, kOptional };
  enum Use { kRead, kNotRead };

  std::string_view element;
  std::string_view name;
  Type type;
  Need need;
  Use use;                      ///< whether the library reads it
  std::string_view words = {};  ///< of kWord: those that may stand, with "|" between
};

/// What the format says of an element.
struct ElementForm {
  enum Content { kChildren, kText, kMixed };

  std::string_view name;
  Content content;
  ContentModel model;  ///< of kMixed: which children may stand, in any order
  std::vector<AttributeForm const*> attributes;

  AttributeForm const* FindAttribute(std::string_view attribute) const;
};

/// Null for an element that the format has not.
ElementForm const* FindElementForm(std::string_view element);

/// Whether a value may stand for an attribute.
bool IsValueOf(AttributeForm const& attribute, UString const& value);

}  // namespace Ostinet::Impl
