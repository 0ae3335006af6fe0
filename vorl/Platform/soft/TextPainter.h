#ifndef VORL_PLATFORM_SOFT_TEXTPAINTER_H
#define VORL_PLATFORM_SOFT_TEXTPAINTER_H

#include <vorl/Platform/soft/DeviceContext.h>
#include <vorl/Platform/soft/FontFace.h>
#include <vorl/Platform/soft/TextLayout.h>

#include <cstdint>

inline namespace vorl {
namespace vorl_detail {

/// Draws characters in a context's text colour, with the background colour behind them where its
/// mode is OPAQUE. The raster operation has no effect on text. Bitmaps of 16 and more bits get
/// smooth characters, those with few colours the pixels that are at least half covered.
class TextPainter {
 public:
  /// Draws inside `clip`, which is a part of what the context shows.
  TextPainter(const DeviceContext& dc, FontFace& font, Region clip);

  /// Draws a run of a line. `x` and `top` are the upper left corner of the line.
  void Draw(const TextRun& run, std::int64_t x, std::int64_t top) const;

 private:
  void DrawGlyph(const Glyph& glyph, std::int64_t x, std::int64_t baseline) const;
  void DrawGlyphRow(const Glyph& glyph, int row, std::int64_t y, std::int64_t glyphX,
                    const RECT& part) const;
  void FillBox(std::int64_t left, std::int64_t top, std::int64_t right, std::int64_t bottom,
               COLORREF colour) const;

  const DeviceContext& m_dc;
  FontFace& m_font;
  const Region m_clip;
  const std::uint32_t m_ink;
  const bool m_isSmooth;
};

}  // namespace vorl_detail
}  // namespace vorl

#endif
