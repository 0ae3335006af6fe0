#ifndef VORL_PLATFORM_DETAIL_SYSTEMERROR_H
#define VORL_PLATFORM_DETAIL_SYSTEMERROR_H

#include <string>

inline namespace vorl {
namespace vorl_detail {

/// Why the last call of the graphics device interface failed in this thread, in words: one line.
std::string LastErrorText();

}  // namespace vorl_detail
}  // namespace vorl

#endif
