#ifndef VORL_PLATFORM_SOFT_FONTFACE_H
#define VORL_PLATFORM_SOFT_FONTFACE_H

#include <vorl/Platform/Gdi.h>

#include <cstddef>
#include <cstdint>
#include <memory>
#include <unordered_map>
#include <vector>

struct FT_FaceRec_;

inline namespace vorl {
namespace vorl_detail {

/// Lengths of a font in pixels.
struct FontMetrics {
  int ascent = 0;   ///< from the baseline to the top of a line
  int descent = 0;  ///< from the baseline to the bottom of a line
  int externalLeading = 0;
  int averageWidth = 0;
  int underlineTop = 0;  ///< from the baseline down
  int underlineThickness = 1;
  int strikeOutTop = 0;  ///< from the baseline down, negative above it
  int strikeOutThickness = 1;
  int Height() const { return ascent + descent; }
};

/// The picture of a character.
struct Glyph {
  int advance = 0;  ///< from its origin to that of the next character
  int left = 0;     ///< from the origin to the picture's left side
  int top = 0;      ///< from the baseline up to the picture's top
  int width = 0;
  int height = 0;
  std::vector<std::uint8_t> coverage;  ///< 0 to 255, row by row, `width` bytes each
};

/// A font of one size. All functions may be called from any thread.
class FontFace {
 public:
  /// The font that comes nearest to a description. Where no font is installed at all it is a font
  /// without height, whose characters are empty.
  static std::shared_ptr<FontFace> Find(const LOGFONTA& description);

  ~FontFace();
  FontFace(const FontFace&) = delete;
  FontFace& operator=(const FontFace&) = delete;

  const FontMetrics& Metrics() const { return m_metrics; }
  /// Characters that the font lacks have its "missing" picture. Never null.
  std::shared_ptr<const Glyph> GlyphOf(char32_t character);
  /// What the glyphs take that are kept for their next use: no more than `kMostBytes`.
  std::size_t KeptBytes() const;
  static constexpr std::size_t kMostBytes = std::size_t{4} << 20;

 private:
  FontFace() = default;
  static std::shared_ptr<FontFace> Open(const LOGFONTA& description);
  void SetSize(const LOGFONTA& description);
  void SetMetrics(long pixelSize);
  Glyph Render(char32_t character) const;

  FT_FaceRec_* m_face = nullptr;
  FontMetrics m_metrics;
  bool m_isEmboldened = false;
  bool m_isSlanted = false;
  std::unordered_map<char32_t, std::shared_ptr<const Glyph>> m_glyphs;
  std::size_t m_keptBytes = 0;
};

}  // namespace vorl_detail
}  // namespace vorl

#endif
