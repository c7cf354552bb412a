// SPDX-License-Identifier: MIT
//
// Each name in the text of a model is a place. A walk stands on the place of the last child; the
// places that may follow it were worked out when the model was read. No two of them bear the same
// name in a model that the XML standard allows, so a walk never has to guess.
#include "names/ContentModel.h"

#include <algorithm>

namespace Ostinet::Impl {

namespace {

template <class List>
void Append(List& list, List const& more) {
  list.insert(list.end(), more.begin(), more.end());
}

bool TakeCharacter(std::string_view& rest, char character) {
  if (rest.empty() || rest.front() != character) {
    return false;
  }
  rest.remove_prefix(1);
  return true;
}

}  // namespace

ContentModel::ContentModel(std::string_view text) {
  if (!text.empty()) {
    whole_ = ReadGroup(text);
  }
}

ContentModel::Part ContentModel::ReadGroup(std::string_view& rest) {
  Part group = ReadItem(rest);
  for (;;) {
    if (TakeCharacter(rest, ',')) {
      Part const item = ReadItem(rest);
      Connect(group, item);
      if (group.mayBeEmpty) {
        Append(group.first, item.first);
      }
      if (item.mayBeEmpty) {
        Append(group.last, item.last);
      } else {
        group.last = item.last;
      }
      group.mayBeEmpty = group.mayBeEmpty && item.mayBeEmpty;
    } else if (TakeCharacter(rest, '|')) {
      Part const item = ReadItem(rest);
      Append(group.first, item.first);
      Append(group.last, item.last);
      group.mayBeEmpty = group.mayBeEmpty || item.mayBeEmpty;
    } else {
      return group;
    }
  }
}

ContentModel::Part ContentModel::ReadItem(std::string_view& rest) {
  Part part;
  if (TakeCharacter(rest, '(')) {
    part = ReadGroup(rest);
    TakeCharacter(rest, ')');
  } else {
    part = ReadName(rest);
  }
  if (TakeCharacter(rest, '?')) {
    part.mayBeEmpty = true;
  } else if (TakeCharacter(rest, '*')) {
    Connect(part, part);
    part.mayBeEmpty = true;
  } else if (TakeCharacter(rest, '+')) {
    Connect(part, part);
  }
  return part;
}

ContentModel::Part ContentModel::ReadName(std::string_view& rest) {
  std::string_view const name = rest.substr(0, rest.find_first_of(",|?*+()"));
  rest.remove_prefix(name.size());
  Part part;
  part.first = part.last = {names_.size()};
  part.mayBeEmpty = false;
  names_.push_back(name);
  next_.emplace_back();
  return part;
}

void ContentModel::Connect(Part const& before, Part const& after) {
  for (std::size_t const place : before.last) {
    Append(next_[place], after.first);
  }
}

std::vector<std::size_t> const& ContentModel::Walk::Next() const {
  return place_ == kStart ? model_->whole_.first : model_->next_[place_];
}

bool ContentModel::Walk::Take(std::string_view child) {
  Places const& next = Next();
  auto const found = std::find_if(
      next.begin(), next.end(), [&](std::size_t place) { return model_->names_[place] == child; });
  if (found == next.end()) {
    return false;
  }
  place_ = *found;
  return true;
}

bool ContentModel::Walk::IsComplete() const {
  if (place_ == kStart) {
    return model_->whole_.mayBeEmpty;
  }
  Places const& last = model_->whole_.last;
  return std::find(last.begin(), last.end(), place_) != last.end();
}

std::string ContentModel::Walk::Expected() const {
  std::string list;
  Places const& next = Next();
  for (std::size_t i = 0; i < next.size(); ++i) {
    list += i == 0 ? "" : (i + 1 == next.size() ? " or " : ", ");
    list += model_->names_[next[i]];
  }
  return list;
}

}  // namespace Ostinet::Impl
