#ifndef VORL_APPS_STUDY_PROGRESS_H
#define VORL_APPS_STUDY_PROGRESS_H

/// @file
/// How long operations tell their caller where they are.

#include <study/Error.h>

#include <functional>
#include <string>

namespace study {

/// Called in the thread that runs the operation with the fraction done (0 to 1, never falling
/// within one operation) and what is being done. Returning false cancels: the operation throws
/// `Cancelled` and leaves no output behind. An empty function means that nobody listens.
using Progress = std::function<bool(double fraction, const std::string& what)>;

/// Reports to `progress` when there is one; throws `Cancelled` when it returns false.
inline void Report(const Progress& progress, double fraction, const std::string& what) {
  if (progress && !progress(fraction, what)) {
    throw Cancelled();
  }
}

/// A progress that maps the whole of a step to the part from `begin` to `end` of the whole.
inline Progress PartOf(const Progress& progress, double begin, double end) {
  if (!progress) {
    return {};
  }
  return [progress, begin, end](double fraction, const std::string& what) {
    return progress(begin + (end - begin) * fraction, what);
  };
}

}  // namespace study

#endif
