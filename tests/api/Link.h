// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <cstring>
#include <type_traits>

namespace Ostinet::Testing {

/// The types of member functions.
template <class Class, class Result, class... Arguments>
using Const = Result (Class::*)(Arguments...) const;
template <class Class, class Result, class... Arguments>
using Mutable = Result (Class::*)(Arguments...);
template <class Result, class... Arguments>
using Static = Result (*)(Arguments...);

extern unsigned char gAddress[4 * sizeof(void*)];

/// Compiles if the function has this type, by itself or in a base class, and links if the library
/// has it.
template <class Function>
bool Link(Function function) {
  static_assert(sizeof function <= sizeof gAddress, "");
  std::memcpy(gAddress, &function, sizeof function);
  return true;
}

template <class From, class To>
constexpr bool kIsImplicit = std::is_convertible<From, To>::value;
template <class From, class To>
constexpr bool kIsExplicit =
    std::is_constructible<To, From>::value && !std::is_convertible<From, To>::value;

/// A handle is a table of virtual functions and one counted pointer.
constexpr std::size_t kHandleSize = 2 * sizeof(void*);

}  // namespace Ostinet::Testing
