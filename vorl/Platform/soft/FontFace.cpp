#include <vorl/Platform/soft/FontFace.h>

#include <fontconfig/fontconfig.h>

#include <ft2build.h>
#include FT_FREETYPE_H
#include FT_SYNTHESIS_H
#include FT_TRUETYPE_TABLES_H

#include <algorithm>
#include <cmath>
#include <cstdlib>
#include <cstring>
#include <list>
#include <mutex>
#include <new>
#include <string>
#include <utility>

#if defined(__SANITIZE_ADDRESS__)
#define VORL_LEAK_SANITIZER
#elif defined(__has_feature)
#if __has_feature(address_sanitizer)
#define VORL_LEAK_SANITIZER
#endif
#endif
#if defined(VORL_LEAK_SANITIZER)
#include <sanitizer/lsan_interface.h>
#endif

inline namespace vorl {
namespace vorl_detail {

namespace {

constexpr long kDefaultHeight = 16;      // of a line, where a description has no height
constexpr std::int64_t kLargest = 4096;  // pixels; larger fonts are drawn in this size
constexpr std::size_t kKeptFonts = 32;   // the most recently used

// Guards all of FreeType, fontconfig, the fonts in use and the list of them. Recursive, because a
// font that cannot be kept is destroyed inside.
std::recursive_mutex& FontMutex() {
  static std::recursive_mutex& mutex = *new std::recursive_mutex;
  return mutex;
}

// Null when FreeType cannot be started.
FT_Library Library() {
  static const FT_Library library = [] {
    FT_Library started = nullptr;
    return FT_Init_FreeType(&started) == 0 ? started : nullptr;
  }();
  return library;
}

// Fontconfig keeps addresses in forms in which the search for leaks does not find them.
struct LeaksIgnored {
#if defined(VORL_LEAK_SANITIZER)
  LeaksIgnored() {
    __lsan_disable();
  }
  ~LeaksIgnored() {
    __lsan_enable();
  }
#else
  LeaksIgnored() {}
#endif
  LeaksIgnored(const LeaksIgnored&) = delete;
  LeaksIgnored& operator=(const LeaksIgnored&) = delete;
};

// Fontconfig's configuration, made once for the process.
FcConfig* FontConfiguration() {
  static FcConfig* const configuration = [] {
    const LeaksIgnored ignored;
    return FcInitLoadConfigAndFonts();
  }();
  return configuration;
}

struct PatternDeleter {
  void operator()(FcPattern* pattern) const { FcPatternDestroy(pattern); }
};
using Pattern = std::unique_ptr<FcPattern, PatternDeleter>;

const char* GenericFamily(const LOGFONTA& description) {
  const int family = description.lfPitchAndFamily & 0xF0;
  if ((description.lfPitchAndFamily & 0x03) == static_cast<int>(FIXED_PITCH) ||
      family == static_cast<int>(FF_MODERN)) {
    return "monospace";
  }
  return family == static_cast<int>(FF_ROMAN) ? "serif" : "sans-serif";
}

long WeightOf(const LOGFONTA& description) {
  return description.lfWeight <= FW_DONTCARE ? FW_NORMAL
                                             : std::min<long>(description.lfWeight, 1000);
}

void AddString(FcPattern* pattern, const char* key, const char* text) {
  FcPatternAddString(pattern, key, reinterpret_cast<const FcChar8*>(text));
}

// Null when there are no fonts.
Pattern Match(const LOGFONTA& description) {
  FcConfig* const configuration = FontConfiguration();
  Pattern wanted(FcPatternCreate());
  if (configuration == nullptr || !wanted) {
    return nullptr;
  }
  // The name need not end with a zero.
  const std::string face(description.lfFaceName, strnlen(description.lfFaceName, LF_FACESIZE));
  if (!face.empty()) {
    AddString(wanted.get(), FC_FAMILY, face.c_str());
  }
  AddString(wanted.get(), FC_FAMILY, GenericFamily(description));
  FcPatternAddInteger(wanted.get(), FC_WEIGHT,
                      FcWeightFromOpenType(static_cast<int>(WeightOf(description))));
  FcPatternAddInteger(wanted.get(), FC_SLANT,
                      description.lfItalic != 0 ? FC_SLANT_ITALIC : FC_SLANT_ROMAN);
  FcPatternAddBool(wanted.get(), FC_SCALABLE, FcTrue);
  FcConfigSubstitute(configuration, wanted.get(), FcMatchPattern);
  FcDefaultSubstitute(wanted.get());
  FcResult result = FcResultMatch;
  return Pattern(FcFontMatch(configuration, wanted.get(), &result));
}

int IntegerOf(FcPattern* pattern, const char* key, int otherwise) {
  int value = otherwise;
  return FcPatternGetInteger(pattern, key, 0, &value) == FcResultMatch ? value : otherwise;
}

// A length in font units as pixels, halves rounded up.
int Scaled(std::int64_t units, std::int64_t pixelSize, std::int64_t unitsPerEm) {
  const std::int64_t doubled = 2 * units * pixelSize + unitsPerEm;
  const std::int64_t divisor = 2 * unitsPerEm;
  return static_cast<int>(doubled >= 0 ? doubled / divisor : -((divisor - 1 - doubled) / divisor));
}

// The heights of a line in font units. The system takes them from the table made for it.
struct LineUnits {
  std::int64_t ascent;
  std::int64_t descent;
  std::int64_t gap;
  std::int64_t averageWidth;
  std::int64_t strikeOut;  // the middle of the line, above the baseline
  std::int64_t strikeOutThickness;
};

LineUnits LineUnitsOf(FT_Face face) {
  LineUnits units{face->ascender,     -std::int64_t{face->descender}, 0, face->units_per_EM / 2,
                  face->ascender / 3, face->underline_thickness};
  const auto* os2 = static_cast<const TT_OS2*>(FT_Get_Sfnt_Table(face, FT_SFNT_OS2));
  if (os2 != nullptr && os2->usWinAscent + os2->usWinDescent > 0) {
    const std::int64_t height = std::int64_t{os2->usWinAscent} + os2->usWinDescent;
    units.gap = std::max<std::int64_t>(0, face->height - height);
    units.ascent = os2->usWinAscent;
    units.descent = os2->usWinDescent;
    units.averageWidth = os2->xAvgCharWidth;
    units.strikeOut = os2->yStrikeoutPosition;
    units.strikeOutThickness = os2->yStrikeoutSize;
  }
  return units;
}

// The size of the em in pixels. A negative height is that of the em; a positive one is that of a
// line, and the largest font whose lines fit is taken.
long PixelSize(FT_Face face, long height) {
  if (height < 0) {
    return static_cast<long>(std::min(-std::int64_t{height}, kLargest));
  }
  const std::int64_t wanted =
      height == 0 ? kDefaultHeight : std::min<std::int64_t>(height, kLargest);
  const LineUnits units = LineUnitsOf(face);
  const std::int64_t perEm = face->units_per_EM;
  std::int64_t size = wanted * perEm / std::max<std::int64_t>(1, units.ascent + units.descent) + 1;
  size = std::min(size, kLargest);
  while (size > 1 &&
         Scaled(units.ascent, size, perEm) + Scaled(units.descent, size, perEm) > wanted) {
    --size;
  }
  return static_cast<long>(size);
}

using Key = LOGFONTA;

// What matters for finding a font; lines under and through it are drawn by those who use it.
Key KeyOf(const LOGFONTA& description) {
  Key key{};
  key.lfHeight = description.lfHeight;
  key.lfWidth = description.lfWidth;
  key.lfWeight = static_cast<LONG>(WeightOf(description));
  key.lfItalic = description.lfItalic != 0 ? 1 : 0;
  key.lfPitchAndFamily = description.lfPitchAndFamily;
  std::strncpy(key.lfFaceName, description.lfFaceName, LF_FACESIZE);
  return key;
}

struct Kept {
  Key key;
  std::shared_ptr<FontFace> font;
};

std::list<Kept>& KeptFonts() {
  static std::list<Kept>& fonts = *new std::list<Kept>;
  return fonts;
}

}  // namespace

std::shared_ptr<FontFace> FontFace::Find(const LOGFONTA& description) {
  const Key key = KeyOf(description);
  std::shared_ptr<FontFace> dropped;  // destroyed after the lock, which its destructor takes
  const std::lock_guard lock(FontMutex());
  std::list<Kept>& fonts = KeptFonts();
  const auto found = std::find_if(fonts.begin(), fonts.end(), [&key](const Kept& kept) {
    return std::memcmp(&kept.key, &key, sizeof(Key)) == 0;
  });
  if (found != fonts.end()) {
    fonts.splice(fonts.begin(), fonts, found);
    return fonts.front().font;
  }
  fonts.push_front({key, Open(description)});
  if (fonts.size() > kKeptFonts) {
    dropped = std::move(fonts.back().font);
    fonts.pop_back();
  }
  return fonts.front().font;
}

std::shared_ptr<FontFace> FontFace::Open(const LOGFONTA& description) {
  std::shared_ptr<FontFace> font(new FontFace);
  const Pattern match = Match(description);
  FcChar8* file = nullptr;
  if (Library() == nullptr || !match ||
      FcPatternGetString(match.get(), FC_FILE, 0, &file) != FcResultMatch ||
      FT_New_Face(Library(), reinterpret_cast<const char*>(file),
                  IntegerOf(match.get(), FC_INDEX, 0), &font->m_face) != 0) {
    font->m_face = nullptr;
    return font;
  }
  // Where no scalable font is installed, the nearest one may be a set of bitmaps.
  if (!FT_IS_SCALABLE(font->m_face) || font->m_face->units_per_EM == 0) {
    FT_Done_Face(font->m_face);
    font->m_face = nullptr;
    return font;
  }
  const bool isBold = IntegerOf(match.get(), FC_WEIGHT, FC_WEIGHT_REGULAR) >= FC_WEIGHT_DEMIBOLD;
  font->m_isEmboldened = WeightOf(description) >= FW_SEMIBOLD && !isBold;
  font->m_isSlanted = description.lfItalic != 0 &&
                      IntegerOf(match.get(), FC_SLANT, FC_SLANT_ROMAN) == FC_SLANT_ROMAN;
  font->SetSize(description);
  return font;
}

void FontFace::SetSize(const LOGFONTA& description) {
  const long pixelSize = PixelSize(m_face, description.lfHeight);
  SetMetrics(pixelSize);
  std::int64_t across = pixelSize;
  if (description.lfWidth != 0 && m_metrics.averageWidth > 0) {
    const std::int64_t width =
        std::min(std::llabs(description.lfWidth), static_cast<long long>(kLargest));
    across = std::clamp<std::int64_t>(width * pixelSize / m_metrics.averageWidth, 1, kLargest);
    m_metrics.averageWidth = static_cast<int>(width);
  }
  FT_Set_Pixel_Sizes(m_face, static_cast<FT_UInt>(across), static_cast<FT_UInt>(pixelSize));
}

void FontFace::SetMetrics(long pixelSize) {
  const LineUnits units = LineUnitsOf(m_face);
  const std::int64_t perEm = m_face->units_per_EM;
  const auto scaled = [&](std::int64_t length) { return Scaled(length, pixelSize, perEm); };
  m_metrics.ascent = scaled(units.ascent);
  m_metrics.descent = scaled(units.descent);
  m_metrics.externalLeading = scaled(units.gap);
  m_metrics.averageWidth = scaled(units.averageWidth);
  // FreeType has moved the given position to the line's middle; the system takes it as that.
  const int position = m_face->underline_position + m_face->underline_thickness / 2;
  m_metrics.underlineThickness = std::max(1, scaled(m_face->underline_thickness));
  m_metrics.underlineTop = scaled(-position) - m_metrics.underlineThickness / 2;
  m_metrics.strikeOutThickness = std::max(1, scaled(units.strikeOutThickness));
  m_metrics.strikeOutTop = -scaled(units.strikeOut) - m_metrics.strikeOutThickness / 2;
}

FontFace::~FontFace() {
  if (m_face != nullptr) {
    const std::lock_guard lock(FontMutex());
    FT_Done_Face(m_face);
  }
}

// When the kept glyphs have grown too large, all are dropped: the text that is drawn next brings
// back those that are in use.
std::shared_ptr<const Glyph> FontFace::GlyphOf(char32_t character) {
  const std::lock_guard lock(FontMutex());
  const auto found = m_glyphs.find(character);
  if (found != m_glyphs.end()) {
    return found->second;
  }
  const auto glyph = std::make_shared<const Glyph>(Render(character));
  const std::size_t bytes = sizeof(Glyph) + glyph->coverage.capacity();
  if (bytes > kMostBytes) {
    return glyph;
  }
  if (bytes > kMostBytes - m_keptBytes) {
    m_glyphs.clear();
    m_keptBytes = 0;
  }
  m_glyphs.emplace(character, glyph);
  m_keptBytes += bytes;
  return glyph;
}

std::size_t FontFace::KeptBytes() const {
  const std::lock_guard lock(FontMutex());
  return m_keptBytes;
}

Glyph FontFace::Render(char32_t character) const {
  Glyph glyph;
  if (m_face == nullptr ||
      FT_Load_Glyph(m_face, FT_Get_Char_Index(m_face, character), FT_LOAD_DEFAULT) != 0) {
    return glyph;
  }
  const FT_GlyphSlot slot = m_face->glyph;
  if (m_isSlanted) {
    FT_GlyphSlot_Oblique(slot);
  }
  if (m_isEmboldened) {
    FT_GlyphSlot_Embolden(slot);
  }
  glyph.advance = static_cast<int>((slot->advance.x + 32) >> 6);
  if (FT_Render_Glyph(slot, FT_RENDER_MODE_NORMAL) != 0 ||
      slot->bitmap.pixel_mode != FT_PIXEL_MODE_GRAY || slot->bitmap.pitch < 0) {
    return glyph;
  }
  glyph.left = slot->bitmap_left;
  glyph.top = slot->bitmap_top;
  glyph.width = static_cast<int>(slot->bitmap.width);
  glyph.height = static_cast<int>(slot->bitmap.rows);
  glyph.coverage.reserve(std::size_t{slot->bitmap.width} * slot->bitmap.rows);
  for (unsigned y = 0; y < slot->bitmap.rows; ++y) {
    const std::uint8_t* row = slot->bitmap.buffer + std::ptrdiff_t{slot->bitmap.pitch} * y;
    glyph.coverage.insert(glyph.coverage.end(), row, row + slot->bitmap.width);
  }
  return glyph;
}

}  // namespace vorl_detail
}  // namespace vorl
