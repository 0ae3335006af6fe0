#ifndef VORL_APPS_STUDY_ERROR_H
#define VORL_APPS_STUDY_ERROR_H

/// @file
/// The exceptions of the applications' common code.

#include <stdexcept>
#include <string>

namespace study {

/// An operation failed. The text is one line without a final full stop, fit to be printed as it is;
/// it names the file concerned.
class Error : public std::runtime_error {
 public:
  using std::runtime_error::runtime_error;
};

/// The caller's progress function asked to stop.
class Cancelled : public Error {
 public:
  Cancelled() : Error("cancelled") {}
};

/// `text` between single quotes, as file names stand in messages.
inline std::string Quoted(const std::string& text) {
  return std::string(1, '\'').append(text).append(1, '\'');
}

}  // namespace study

#endif
