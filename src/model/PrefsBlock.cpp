// SPDX-License-Identifier: MIT
#include "model/PrefsBlock.h"

#include <string>

#include "ostinet/core/Error.h"

namespace Ostinet::Impl {

namespace {

constexpr int kEndOfFile = -39;
constexpr std::size_t kNumberSize = 4;
constexpr std::size_t kUnitSize = 2;

}  // namespace

void PrefsBlockReader::Demand(std::size_t count) const {
  if (static_cast<std::size_t>(end_ - position_) < count) {
    FailOSErr(kEndOfFile);
  }
}

std::uint32_t PrefsBlockReader::ReadNumber() {
  Demand(kNumberSize);
  std::uint32_t number = 0;
  for (unsigned shift = 0; shift < 32; shift += 8) {
    number |= static_cast<std::uint32_t>(*position_++) << shift;
  }
  return number;
}

UString PrefsBlockReader::ReadText() {
  std::size_t const length = ReadNumber();
  Demand(length * kUnitSize);
  std::u16string units;
  units.reserve(length);
  for (std::size_t i = 0; i < length; ++i, position_ += kUnitSize) {
    units.push_back(static_cast<char16_t>(position_[0] | position_[1] << 8));
  }
  return UString(std::move(units));
}

PrefsBlockReader PrefsBlockReader::ReadPart() {
  std::size_t const length = ReadNumber();
  // One that does not even cover itself would let a walk over the parts stand still.
  if (length < kNumberSize) {
    FailOSErr(kEndOfFile);
  }
  Demand(length - kNumberSize);
  unsigned char const* const start = position_;
  position_ += length - kNumberSize;
  return PrefsBlockReader(start, position_);
}

void PrefsBlockWriter::WriteNumber(std::uint32_t number) {
  for (unsigned shift = 0; shift < 32; shift += 8) {
    bytes_.push_back(static_cast<unsigned char>(number >> shift));
  }
}

void PrefsBlockWriter::WriteText(UString const& text) {
  WriteNumber(static_cast<std::uint32_t>(text.length()));
  for (char16_t const unit : text) {
    bytes_.push_back(static_cast<unsigned char>(unit));
    bytes_.push_back(static_cast<unsigned char>(unit >> 8));
  }
}

std::size_t PrefsBlockWriter::BeginPart() {
  std::size_t const place = bytes_.size();
  WriteNumber(0);
  return place;
}

void PrefsBlockWriter::EndPart(std::size_t place) {
  auto const length = static_cast<std::uint32_t>(bytes_.size() - place);
  for (std::size_t i = 0; i < kNumberSize; ++i) {
    bytes_[place + i] = static_cast<unsigned char>(length >> (8 * i));
  }
}

}  // namespace Ostinet::Impl
