// SPDX-License-Identifier: MIT
#include "ostinet/MatchData.h"

#include <algorithm>
#include <stdexcept>

namespace Ostinet {

size_t const MatchData::kMaxSize;

SlotID::SlotID() : words{} {}

bool SlotID::operator==(SlotID const& other) const {
  return std::equal(std::begin(words), std::end(words), std::begin(other.words));
}

bool SlotID::operator!=(SlotID const& other) const { return !(*this == other); }

MatchData::MatchData() = default;
MatchData::MatchData(size_t size) : bytes_(size) {}
MatchData::MatchData(MatchData const& other) = default;
MatchData& MatchData::operator=(MatchData const& other) = default;
MatchData::~MatchData() = default;

bool MatchData::operator==(MatchData const& other) const { return bytes_ == other.bytes_; }
bool MatchData::operator!=(MatchData const& other) const { return !(*this == other); }

size_t MatchData::size() const { return bytes_.size(); }
bool MatchData::empty() const { return bytes_.empty(); }

char* MatchData::begin() { return bytes_.data(); }
char const* MatchData::begin() const { return bytes_.data(); }
char* MatchData::end() { return begin() + size(); }
char const* MatchData::end() const { return begin() + size(); }

std::reverse_iterator<char*> MatchData::rbegin() { return std::reverse_iterator<char*>(end()); }
std::reverse_iterator<char const*> MatchData::rbegin() const {
  return std::reverse_iterator<char const*>(end());
}
std::reverse_iterator<char*> MatchData::rend() { return std::reverse_iterator<char*>(begin()); }
std::reverse_iterator<char const*> MatchData::rend() const {
  return std::reverse_iterator<char const*>(begin());
}

char& MatchData::operator[](size_t index) { return bytes_[index]; }
char const& MatchData::operator[](size_t index) const { return bytes_[index]; }

char& MatchData::at(size_t index) {
  return const_cast<char&>(static_cast<MatchData const&>(*this).at(index));
}

char const& MatchData::at(size_t index) const {
  if (index >= size()) {
    throw std::out_of_range("Ostinet::MatchData");
  }
  return bytes_[index];
}

}  // namespace Ostinet
