#ifndef VORL_PLATFORM_SOFT_UTF8_H
#define VORL_PLATFORM_SOFT_UTF8_H

#include <string>
#include <string_view>

inline namespace vorl {
namespace vorl_detail {

/// The characters of UTF-8 text. A byte that is not part of a well-formed sequence (too long a
/// form, a surrogate, beyond U+10FFFF, cut off) becomes U+FFFD, and reading goes on behind it.
std::u32string DecodeUtf8(std::string_view text);

}  // namespace vorl_detail
}  // namespace vorl

#endif
