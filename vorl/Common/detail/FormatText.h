#ifndef VORL_COMMON_DETAIL_FORMATTEXT_H
#define VORL_COMMON_DETAIL_FORMATTEXT_H

/// @file
/// The texts that statuses and log records share: printf-style formatting and safe storing.

#include <array>
#include <cstdarg>
#include <string>
#include <string_view>

inline namespace vorl {
namespace vorl_detail {

/// The size of every formatted text, its terminator included; longer texts are cut.
inline constexpr int kFormatBufferSize = 1024;

using FormatBuffer = std::array<char, kFormatBufferSize>;

/// Formats into `buffer`; a null or empty format gives the empty text.
void FormatText(FormatBuffer& buffer, const char* format, std::va_list arguments);

/// Formats a text that has no arguments: "%%" becomes "%", any other conversion stays as written.
void FormatTextWithoutArguments(FormatBuffer& buffer, const char* format);

/// Replaces `text`. A value that finds no memory is dropped and leaves `text` empty: reporting a
/// failure must not fail itself. The calling thread is not ended by force meanwhile.
void StoreText(std::string& text, std::string_view value) noexcept;

/// Appends to `text`; an addition that finds no memory is dropped.
void AppendText(std::string& text, std::string_view addition) noexcept;

}  // namespace vorl_detail
}  // namespace vorl

#endif
