#ifndef VORL_PLATFORM_SOFT_TEXTLAYOUT_H
#define VORL_PLATFORM_SOFT_TEXTLAYOUT_H

#include <vorl/Platform/Gdi.h>
#include <vorl/Platform/soft/FontFace.h>

#include <cstddef>
#include <cstdint>
#include <string>
#include <vector>

inline namespace vorl {
namespace vorl_detail {

/// A character of a line and where it stands.
struct PlacedCharacter {
  char32_t code;
  std::int64_t x;  ///< from the line's start
  int advance;
  bool isUnderlined;  ///< by an ampersand before it
};

/// Characters side by side without a tab between them.
struct TextRun {
  std::int64_t x = 0;  ///< from the line's start
  std::int64_t width = 0;
  std::vector<PlacedCharacter> characters;
};

struct TextLine {
  std::int64_t width = 0;
  std::vector<TextRun> runs;
};

/// The format of `DrawTextA`.
struct TextFormat {
  /// With DT_TABSTOP bits 8 to 15 are the number of characters between tab stops and no flags.
  explicit TextFormat(UINT format)
      : flags((format & DT_TABSTOP) != 0 ? format & ~0xFF00U : format),
        tabCharacters((format & DT_TABSTOP) != 0 ? static_cast<int>(format >> 8U & 0xFFU) : 8) {}
  UINT flags;
  int tabCharacters;
};

/// Breaks text into lines and measures them, as `format` asks.
///
/// - CR, LF and pairs of both end a line; one at the end of the text starts no new one. With
///   DT_SINGLELINE they are characters like any other.
/// - With DT_WORDBREAK a line that is wider than `limit` ends behind the last space, tab or hyphen
///   that fits; a word that does not fit alone is not broken. A space at which a line ends is
///   dropped, in left-aligned text only when it does not fit.
/// - Tabs go to the next tab stop with DT_EXPANDTABS; else they are characters like any other. What
///   stands before an expanded tab is not broken.
/// - An ampersand underlines the character that follows, the last one of a line, and two stand for
///   one, unless DT_NOPREFIX.
std::vector<TextLine> LayOutText(const std::u32string& text, FontFace& font,
                                 const TextFormat& format, std::int64_t limit);

}  // namespace vorl_detail
}  // namespace vorl

#endif
