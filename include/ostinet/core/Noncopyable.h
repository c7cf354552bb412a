// SPDX-License-Identifier: MIT
#pragma once

namespace Ostinet {

/// Mix-in base of classes that are not copied. `Tag` keeps two such bases of one class apart.
template <class Tag>
class Noncopyable {
 public:
  Noncopyable(Noncopyable const&) = delete;
  Noncopyable& operator=(Noncopyable const&) = delete;

 protected:
  Noncopyable() = default;
  ~Noncopyable() = default;
};

}  // namespace Ostinet
