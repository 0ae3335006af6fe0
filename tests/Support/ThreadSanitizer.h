#ifndef VORL_TESTS_SUPPORT_THREADSANITIZER_H
#define VORL_TESTS_SUPPORT_THREADSANITIZER_H

#include <gtest/gtest.h>

#if defined(__has_feature)  // Clang
#if __has_feature(thread_sanitizer) && !defined(__SANITIZE_THREAD__)
#define __SANITIZE_THREAD__ 1
#endif
#endif

/// Skips a test in builds with ThreadSanitizer and shows the reason.
#if defined(__SANITIZE_THREAD__)
#define SKIP_UNDER_THREAD_SANITIZER(reason) GTEST_SKIP() << "under ThreadSanitizer " reason
#else
#define SKIP_UNDER_THREAD_SANITIZER(reason) static_cast<void>(0)
#endif

#endif
