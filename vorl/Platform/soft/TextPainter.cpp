#include <vorl/Platform/soft/TextPainter.h>

#include <vorl/Platform/soft/Painter.h>

#include <algorithm>
#include <cstddef>
#include <utility>

inline namespace vorl {
namespace vorl_detail {

namespace {

constexpr unsigned kHalfCovered = 128;

// One channel of the colour between two, `coverage` 255ths of the way from `below` to `ink`.
unsigned MixedChannel(unsigned below, unsigned ink, unsigned coverage) {
  return (below * (255 - coverage) + ink * coverage + 127) / 255;
}

COLORREF Mixed(COLORREF below, COLORREF ink, unsigned coverage) {
  COLORREF colour = 0;
  for (unsigned shift = 0; shift < 24; shift += 8) {
    colour |= MixedChannel(below >> shift & 0xFFU, ink >> shift & 0xFFU, coverage) << shift;
  }
  return colour;
}

}  // namespace

TextPainter::TextPainter(const DeviceContext& dc, FontFace& font, Region clip)
    : m_dc(dc),
      m_font(font),
      m_clip(std::move(clip)),
      m_ink(dc.PixelOf(dc.state.textColour)),
      m_isSmooth(dc.Target().format.depth >= 16 &&
                 dc.state.font->description.lfQuality != NONANTIALIASED_QUALITY) {}

void TextPainter::Draw(const TextRun& run, std::int64_t x, std::int64_t top) const {
  const FontMetrics& metrics = m_font.Metrics();
  const LOGFONTA& description = m_dc.state.font->description;
  const COLORREF ink = m_dc.state.textColour;
  const std::int64_t baseline = top + metrics.ascent;
  const std::int64_t left = x + run.x;
  if (m_dc.state.backgroundMode == OPAQUE) {
    FillBox(left, top, left + run.width, top + metrics.Height(), m_dc.state.backgroundColour);
  }
  for (const PlacedCharacter& character : run.characters) {
    DrawGlyph(*m_font.GlyphOf(character.code), x + character.x, baseline);
    if (character.isUnderlined) {
      FillBox(x + character.x, baseline + 1, x + character.x + character.advance - 1, baseline + 2,
              ink);
    }
  }
  const auto line = [&](int offset, int thickness) {
    const std::int64_t lineTop = baseline + offset;
    FillBox(left, lineTop, left + run.width, lineTop + thickness, ink);
  };
  if (description.lfUnderline != 0) {
    line(metrics.underlineTop, metrics.underlineThickness);
  }
  if (description.lfStrikeOut != 0) {
    line(metrics.strikeOutTop, metrics.strikeOutThickness);
  }
}

void TextPainter::DrawGlyph(const Glyph& glyph, std::int64_t x, std::int64_t baseline) const {
  const std::int64_t left = x + glyph.left;
  const std::int64_t top = baseline - glyph.top;
  const RECT box = Ordered(left, top, left + glyph.width, top + glyph.height);
  for (const pixman_box32_t& visible : m_clip.Boxes()) {
    const RECT part = Intersection(box, RECT{visible.x1, visible.y1, visible.x2, visible.y2});
    for (LONG y = part.top; y < part.bottom; ++y) {
      DrawGlyphRow(glyph, static_cast<int>(y - top), y, left, part);
    }
  }
}

void TextPainter::DrawGlyphRow(const Glyph& glyph, int row, std::int64_t y, std::int64_t glyphX,
                               const RECT& part) const {
  const Surface& target = m_dc.Target();
  const int depth = target.format.depth;
  std::uint8_t* const pixels = target.Row(static_cast<int>(y));
  const std::uint8_t* const coverages =
      glyph.coverage.data() +
      std::size_t{static_cast<unsigned>(row)} * static_cast<unsigned>(glyph.width);
  for (LONG x = part.left; x < part.right; ++x) {
    const unsigned coverage = coverages[x - glyphX];
    if (coverage == 255 || (!m_isSmooth && coverage >= kHalfCovered)) {
      WritePixel(pixels, x, depth, m_ink);
    } else if (m_isSmooth && coverage > 0) {
      const COLORREF below = ColourOf(target.format, ReadPixel(pixels, x, depth));
      WritePixel(pixels, x, depth, m_dc.PixelOf(Mixed(below, m_dc.state.textColour, coverage)));
    }
  }
}

void TextPainter::FillBox(std::int64_t left, std::int64_t top, std::int64_t right,
                          std::int64_t bottom, COLORREF colour) const {
  if (left >= right || top >= bottom) {
    return;
  }
  Region box(m_clip);
  box.Intersect(Ordered(left, top, right, bottom));
  Painter(m_dc, BitOperation{0, m_dc.PixelOf(colour)}).Fill(box);
}

}  // namespace vorl_detail
}  // namespace vorl
