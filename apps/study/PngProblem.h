#ifndef VORL_APPS_STUDY_PNGPROBLEM_H
#define VORL_APPS_STUDY_PNGPROBLEM_H

/// @file
/// How the PNG library's calls tell of their failure.
///
/// The library leaves a failing call by a jump to the `setjmp` of its caller. Where it may jump,
/// from that `setjmp` down to the callback, there are only objects without destructors, and no
/// callback throws: the library is no place for an exception to pass.

#include <cstdio>

#include <png.h>

namespace study {

/// The first thing that went wrong, in words. Kept where it needs no memory to be found.
struct PngProblem {
  char text[256] = {};

  void Set(const char* reason) noexcept {
    if (text[0] == '\0') {
      std::snprintf(text, sizeof text, "%s", reason);
    }
  }
  /// "no memory" where nothing was told.
  const char* Text() const noexcept { return text[0] != '\0' ? text : "no memory"; }
};

/// The error handler of reading and writing; its pointer is a `PngProblem`.
[[noreturn]] inline void OnPngError(png_structp png, png_const_charp message) {
  static_cast<PngProblem*>(png_get_error_ptr(png))->Set(message);
  png_longjmp(png, 1);
}

/// Warnings are for those who made the file.
inline void OnPngWarning(png_structp, png_const_charp) {}

}  // namespace study

#endif
