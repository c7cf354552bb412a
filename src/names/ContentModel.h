// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

namespace Ostinet::Impl {

/// Which children an element may have, and in which order: names with "," for one after the other,
/// "|" for one of several, and "?", "*" and "+" behind a name or a group in parentheses. An empty
/// model allows no child.
///
/// Ownership    A value. The text of the model outlives it.
/// Threads      [any thread] It does not change.
class ContentModel {
 public:
  /// How far the children of one element have come.
  class Walk {
   public:
    explicit Walk(ContentModel const& model) : model_(&model) {}
    /// Goes on to the next child; false, and the walk as it was, if it may not stand here.
    bool Take(std::string_view child);
    /// Whether the element may end here.
    bool IsComplete() const;
    /// What may stand here, for people: "A, B or C".
    std::string Expected() const;

   private:
    std::vector<std::size_t> const& Next() const;

    ContentModel const* model_;
    std::size_t place_ = kStart;
  };

  explicit ContentModel(std::string_view text);

 private:
  friend class Walk;
  static constexpr std::size_t kStart = static_cast<std::size_t>(-1);
  using Places = std::vector<std::size_t>;

  // Where a part of the model may begin and end, and whether it may be left out.
  struct Part {
    Places first;
    Places last;
    bool mayBeEmpty = true;
  };

  Part ReadGroup(std::string_view& rest);
  Part ReadItem(std::string_view& rest);
  Part ReadName(std::string_view& rest);
  void Connect(Part const& before, Part const& after);

  std::vector<std::string_view> names_;  // of each place in the model
  std::vector<Places> next_;             // the places that may follow each
  Part whole_;
};

}  // namespace Ostinet::Impl
