#ifndef VORL_COMMON_DETAIL_FORMATTEXT_H
#define VORL_COMMON_DETAIL_FORMATTEXT_H

/// @file
/// The printf-style formatting that statuses and log records share.

#include <array>
#include <cstdarg>

inline namespace vorl {
namespace vorl_detail {

/// The size of every formatted text, its terminator included; longer texts are cut.
inline constexpr int kFormatBufferSize = 1024;

using FormatBuffer = std::array<char, kFormatBufferSize>;

/// Formats into `buffer`; a null or empty format gives the empty text.
void FormatText(FormatBuffer& buffer, const char* format, std::va_list arguments);

/// Formats a text that has no arguments: "%%" becomes "%", any other conversion stays as written.
void FormatTextWithoutArguments(FormatBuffer& buffer, const char* format);

}  // namespace vorl_detail
}  // namespace vorl

#endif
