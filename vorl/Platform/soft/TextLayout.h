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

/// Breaks text into lines and measures them, as the DT_ flags of `format` ask.
///
/// - CR, LF and pairs of both end a line; one at the end of the text starts no new one. With
///   DT_SINGLELINE they are characters like any other.
/// - With DT_WORDBREAK a line that is wider than `limit` ends behind the last space, tab or hyphen
///   that fits; a word that does not fit alone is not broken. A space at which a line ends is
///   dropped, in left-aligned text only when it does not fit.
/// - Tabs go to the next multiple of eight average characters with DT_EXPANDTABS, or of the number
///   in bits 8 to 15 with DT_TABSTOP; else they are characters like any other.
/// - An ampersand underlines the character that follows and two stand for one, unless DT_NOPREFIX.
std::vector<TextLine> LayOutText(const std::u32string& text, FontFace& font, UINT format,
                                 std::int64_t limit);

}  // namespace vorl_detail
}  // namespace vorl

#endif
