// SPDX-License-Identifier: MIT
#pragma once

/// OSTINET_EXPORT marks what the shared library offers to hosts.
///
/// OSTINET_BUILDING is defined while the library itself is compiled, OSTINET_STATIC where its
/// objects are linked straight into a program.
#if defined(OSTINET_STATIC)
#define OSTINET_EXPORT
#elif defined(__CYGWIN__) || defined(_MSC_VER) || defined(__MINGW32__)
#if defined(OSTINET_BUILDING)
#define OSTINET_EXPORT __declspec(dllexport)
#else
#define OSTINET_EXPORT __declspec(dllimport)
#endif
#else
#define OSTINET_EXPORT __attribute__((visibility("default")))
#endif
