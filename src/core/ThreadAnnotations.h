// SPDX-License-Identifier: MIT
#pragma once

// Which mutex guards what, in words that clang checks while compiling (-Wthread-safety). Other
// compilers read nothing.
#if defined(__clang__)
#define OSTINET_THREAD_ATTRIBUTE(x) __attribute__((x))
#else
#define OSTINET_THREAD_ATTRIBUTE(x)
#endif

#define OSTINET_CAPABILITY(x) OSTINET_THREAD_ATTRIBUTE(capability(x))
#define OSTINET_SCOPED_CAPABILITY OSTINET_THREAD_ATTRIBUTE(scoped_lockable)
#define OSTINET_GUARDED_BY(x) OSTINET_THREAD_ATTRIBUTE(guarded_by(x))
#define OSTINET_PT_GUARDED_BY(x) OSTINET_THREAD_ATTRIBUTE(pt_guarded_by(x))
#define OSTINET_REQUIRES(...) OSTINET_THREAD_ATTRIBUTE(requires_capability(__VA_ARGS__))
#define OSTINET_EXCLUDES(...) OSTINET_THREAD_ATTRIBUTE(locks_excluded(__VA_ARGS__))
#define OSTINET_ACQUIRE(...) OSTINET_THREAD_ATTRIBUTE(acquire_capability(__VA_ARGS__))
#define OSTINET_TRY_ACQUIRE(...) OSTINET_THREAD_ATTRIBUTE(try_acquire_capability(__VA_ARGS__))
#define OSTINET_RELEASE(...) OSTINET_THREAD_ATTRIBUTE(release_capability(__VA_ARGS__))
#define OSTINET_NO_THREAD_SAFETY_ANALYSIS OSTINET_THREAD_ATTRIBUTE(no_thread_safety_analysis)
