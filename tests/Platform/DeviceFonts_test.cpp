// Which font a description finds, how its characters are made, and what is kept of them. Where the
// installed fonts decide, relations are tested; a process of its own sees one font alone.

#include "../Support/TestFolder.h"
#include "DeviceTesting.h"

#include <vorl/Platform/soft/FontFace.h>

#include <fontconfig/fontconfig.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <memory>
#include <set>
#include <string>

using vorl_detail::FontFace;
using vorl_detail::Glyph;

namespace {

namespace fs = std::filesystem;

LOGFONTA Description(int height, int weight = FW_NORMAL, int italic = 0) {
  LOGFONTA description{};
  description.lfHeight = height;
  description.lfWeight = weight;
  description.lfItalic = static_cast<BYTE>(italic);
  return description;
}

LOGFONTA InFamily(DWORD pitchAndFamily) {
  LOGFONTA description = Description(-40);
  description.lfPitchAndFamily = static_cast<BYTE>(pitchAndFamily);
  return description;
}

int AdvanceOf(const LOGFONTA& description, char32_t character) {
  return FontFace::Find(description)->GlyphOf(character)->advance;
}

// All of a character's coverage.
long InkOf(const LOGFONTA& description, char32_t character) {
  const auto glyph = FontFace::Find(description)->GlyphOf(character);
  long ink = 0;
  for (const std::uint8_t coverage : glyph->coverage) {
    ink += coverage;
  }
  return ink;
}

// The middle of the ink in a row of a character's picture, from the origin.
double MiddleOfRow(const Glyph& glyph, int row) {
  double sum = 0;
  double ink = 0;
  for (int x = 0; x < glyph.width; ++x) {
    const double coverage = glyph.coverage[static_cast<std::size_t>(row * glyph.width + x)];
    sum += coverage * (glyph.left + x + 0.5);
    ink += coverage;
  }
  return sum / ink;
}

// How far an "I" leans to the right on its way up.
double LeanOf(const LOGFONTA& description) {
  const auto letter = FontFace::Find(description)->GlyphOf(U'I');
  return MiddleOfRow(*letter, 1) - MiddleOfRow(*letter, letter->height - 2);
}

TEST(DeviceFonts, WidthStretchesTheCharactersAcross) {
  const LOGFONTA normal = Description(-40);
  const auto font = FontFace::Find(normal);
  LOGFONTA description = normal;
  for (const int factor : {1, 2, 3}) {
    for (const int sign : {1, -1}) {
      description.lfWidth = sign * factor * font->Metrics().averageWidth;
      const auto stretched = FontFace::Find(description);
      EXPECT_EQ(stretched->Metrics().averageWidth, factor * font->Metrics().averageWidth);
      EXPECT_EQ(stretched->Metrics().Height(), font->Metrics().Height());
      for (const char32_t character : {U'm', U'H', U'x'}) {
        const auto glyph = font->GlyphOf(character);
        const auto wide = stretched->GlyphOf(character);
        EXPECT_NEAR(wide->advance, factor * glyph->advance, factor);
        EXPECT_NEAR(wide->height, glyph->height, 1);
        EXPECT_NEAR(wide->width, factor * glyph->width, 2 * factor);
      }
    }
  }
}

TEST(DeviceFonts, WidthReachesTheTextOfAContext) {
  const TestSection s(4, 4, 32);
  const auto width = [&s](int average) {
    const HFONT font = CreateFontA(-40, average, 0, 0, FW_NORMAL, 0, 0, 0, 1, 0, 0, 0, 0, "");
    const HGDIOBJ old = SelectObject(s.dc, font);
    RECT rect{0, 0, 0, 0};
    DrawTextA(s.dc, "mmmm", -1, &rect, DT_CALCRECT);
    SelectObject(s.dc, old);
    DeleteObject(font);
    return rect.right;
  };
  EXPECT_GT(width(60), 2 * width(20));
  EXPECT_LT(width(10), width(20));
}

TEST(DeviceFonts, PitchAndFamilyDecideWhereNoNameDoes) {
  for (const DWORD fixed : {FIXED_PITCH, FF_MODERN, FIXED_PITCH | FF_MODERN, FIXED_PITCH | FF_ROMAN,
                            VARIABLE_PITCH | FF_MODERN}) {
    EXPECT_EQ(AdvanceOf(InFamily(fixed), U'i'), AdvanceOf(InFamily(fixed), U'm')) << fixed;
  }
  for (const DWORD variable : {DEFAULT_PITCH, VARIABLE_PITCH, FF_SWISS, FF_ROMAN}) {
    EXPECT_LT(AdvanceOf(InFamily(variable), U'i'), AdvanceOf(InFamily(variable), U'm')) << variable;
  }
  const auto picture = [](DWORD family) {
    return FontFace::Find(InFamily(family))->GlyphOf(U'I')->coverage;
  };
  EXPECT_EQ(picture(FF_DONTCARE), picture(FF_SWISS));
  EXPECT_NE(picture(FF_ROMAN), picture(FF_SWISS));
}

TEST(DeviceFonts, NamesGoBeforeFamilies) {
  LOGFONTA description = InFamily(FF_SWISS);
  std::snprintf(description.lfFaceName, LF_FACESIZE, "monospace");
  EXPECT_EQ(AdvanceOf(description, U'i'), AdvanceOf(description, U'm'));
}

TEST(DeviceFonts, WeightMakesStrokesThicker) {
  EXPECT_GT(InkOf(Description(-40, FW_BOLD), U'I'), InkOf(Description(-40), U'I'));
  EXPECT_GT(InkOf(Description(-40, FW_SEMIBOLD), U'I'), InkOf(Description(-40), U'I'));
  EXPECT_EQ(InkOf(Description(-40, FW_DONTCARE), U'I'), InkOf(Description(-40), U'I'));
}

TEST(DeviceFonts, ItalicLeans) {
  EXPECT_NEAR(LeanOf(Description(-60)), 0.0, 0.6);
  EXPECT_GT(LeanOf(Description(-60, FW_NORMAL, 1)), 5.0);
  EXPECT_LT(LeanOf(Description(-60, FW_NORMAL, 1)), 13.0) << "it leans twice";
}

TEST(DeviceFonts, FontsThatNobodyUsesAreNotKeptForEver) {
  const std::weak_ptr<FontFace> font = FontFace::Find(Description(-31));
  EXPECT_FALSE(font.expired());
  for (int height = 100; height < 150; ++height) {
    FontFace::Find(Description(-31));
    FontFace::Find(Description(-height));
  }
  EXPECT_FALSE(font.expired()) << "it was used";
  for (int height = 100; height < 150; ++height) {
    FontFace::Find(Description(-height));
  }
  EXPECT_TRUE(font.expired());
}

TEST(DeviceFonts, StockFontsAreWhatTheirNamesSay) {
  const auto description = [](int index) {
    LOGFONTA font{};
    EXPECT_EQ(GetObjectA(GetStockObject(index), sizeof font, &font), int{sizeof font});
    return font;
  };
  for (const int fixed : {OEM_FIXED_FONT, ANSI_FIXED_FONT, SYSTEM_FIXED_FONT}) {
    EXPECT_EQ(AdvanceOf(description(fixed), U'i'), AdvanceOf(description(fixed), U'm')) << fixed;
  }
  for (const int variable : {ANSI_VAR_FONT, SYSTEM_FONT, DEVICE_DEFAULT_FONT, DEFAULT_GUI_FONT}) {
    EXPECT_LT(AdvanceOf(description(variable), U'i'), AdvanceOf(description(variable), U'm'))
        << variable;
  }
  LOGFONTA system = description(SYSTEM_FONT);
  system.lfHeight = -40;
  EXPECT_EQ(InkOf(system, U'I'), InkOf(Description(-40, FW_BOLD), U'I'));
}

// Draws an "O" and gives the different pixels.
std::set<std::uint32_t> ColoursOf(int bits, DWORD quality) {
  TestSection s(40, 40, bits);
  SetBkMode(s.dc, TRANSPARENT);
  SetTextColor(s.dc, RGB(255, 255, 255));
  const HFONT font = CreateFontA(-30, 0, 0, 0, FW_NORMAL, 0, 0, 0, 1, 0, 0, quality, 0, "");
  const HGDIOBJ old = SelectObject(s.dc, font);
  RECT rect{0, 0, 40, 40};
  DrawTextA(s.dc, "O", -1, &rect, 0);
  SelectObject(s.dc, old);
  DeleteObject(font);
  std::set<std::uint32_t> colours;
  for (std::size_t i = 0; i < s.Bytes(); ++i) {
    colours.insert(s.pixels[i]);
  }
  return colours;
}

TEST(DeviceFonts, SmoothOrNotIsAMatterOfQualityAndDepth) {
  EXPECT_GT(ColoursOf(32, DEFAULT_QUALITY).size(), 8U);
  EXPECT_GT(ColoursOf(24, ANTIALIASED_QUALITY).size(), 8U);
  EXPECT_EQ(ColoursOf(24, NONANTIALIASED_QUALITY), (std::set<std::uint32_t>{0, 255}));
  EXPECT_EQ(ColoursOf(8, ANTIALIASED_QUALITY), (std::set<std::uint32_t>{0, 255}));
}

TEST(DeviceFonts, KeptGlyphsAreBounded) {
  const auto font = FontFace::Find(Description(-200));
  const auto first = font->GlyphOf(U'A');
  EXPECT_EQ(font->GlyphOf(U'A'), first);
  EXPECT_GT(font->KeptBytes(), first->coverage.size());
  std::size_t most = 0;
  for (char32_t character = 0x100; character < 0x500; ++character) {
    font->GlyphOf(character);
    ASSERT_LE(font->KeptBytes(), FontFace::kMostBytes);
    most = std::max(most, font->KeptBytes());
  }
  EXPECT_GT(most, FontFace::kMostBytes / 2);
  EXPECT_NE(font->GlyphOf(U'A'), first) << "it has been dropped meanwhile";
  EXPECT_EQ(font->GlyphOf(U'A')->coverage, first->coverage);
}

TEST(DeviceFonts, GlyphThatIsTooLargeIsNotKept) {
  const auto font = FontFace::Find(Description(-4096));
  const auto glyph = font->GlyphOf(U'W');
  ASSERT_GT(glyph->coverage.size(), FontFace::kMostBytes);
  EXPECT_EQ(font->KeptBytes(), 0U);
  EXPECT_EQ(font->GlyphOf(U'W')->coverage, glyph->coverage);
}

constexpr int kLineGap = 512;  // font units, of 2048 or 1000 to the em

// Copies the machine's upright sans-serif font into an empty folder, with a gap between its lines,
// and tells fontconfig of nothing else. Returns the font's units to the em; 0 on failure.
int InstallOneFont(const fs::path& folder) {
  FcPattern* const wanted = FcNameParse(reinterpret_cast<const FcChar8*>("sans-serif:regular"));
  FcConfigSubstitute(nullptr, wanted, FcMatchPattern);
  FcDefaultSubstitute(wanted);
  FcResult result = FcResultMatch;
  FcPattern* const match = FcFontMatch(nullptr, wanted, &result);
  FcChar8* name = nullptr;
  if (match == nullptr || FcPatternGetString(match, FC_FILE, 0, &name) != FcResultMatch) {
    return 0;
  }
  std::ifstream source(reinterpret_cast<const char*>(name), std::ios::binary);
  std::string bytes{std::istreambuf_iterator<char>(source), std::istreambuf_iterator<char>()};
  FcPatternDestroy(match);
  FcPatternDestroy(wanted);
  FcFini();
  const auto byteAt = [&bytes](std::size_t i) { return std::size_t{static_cast<BYTE>(bytes[i])}; };
  const auto table = [&](const char* tag) {  // its place, of which files have few enough bytes
    const std::size_t entry = bytes.find(tag);
    return byteAt(entry + 9) << 16 | byteAt(entry + 10) << 8 | byteAt(entry + 11);
  };
  bytes[table("hhea") + 8] = static_cast<char>(kLineGap / 256);
  bytes[table("hhea") + 9] = static_cast<char>(kLineGap % 256);
  fs::create_directories(folder);
  std::ofstream(folder / "font.ttf", std::ios::binary) << bytes;
  const std::string file = (folder / "fonts.conf").string();
  std::ofstream(file) << "<fontconfig><dir>" << folder.string() << "</dir></fontconfig>\n";
  setenv("FONTCONFIG_FILE", file.c_str(), 1);
  return static_cast<int>(byteAt(table("head") + 18) << 8 | byteAt(table("head") + 19));
}

bool Holds(bool condition, const char* text) {
  if (!condition) {
    std::fprintf(stderr, "not so: %s\n", text);
  }
  return condition;
}

// What the font lacks is made of what it has.
bool UsesOneFont() {
  const TestFolder folder;
  const int unitsPerEm = InstallOneFont(folder.Path());
  bool isGood = Holds(unitsPerEm > 0, "a font is found");
  isGood &= Holds(InkOf(Description(-60, FW_BOLD), U'I') > InkOf(Description(-60), U'I') * 11 / 10,
                  "bold strokes are thicker");
  isGood &= Holds(InkOf(Description(-60, FW_MEDIUM), U'I') == InkOf(Description(-60), U'I'),
                  "medium ones are not");
  isGood &= Holds(LeanOf(Description(-60, FW_NORMAL, 1)) > 5.0, "italic letters lean");
  isGood &= Holds(LeanOf(Description(-60)) < 0.6, "upright ones do not");
  isGood &= Holds(InkOf(InFamily(FF_ROMAN), U'I') == InkOf(InFamily(FF_MODERN), U'I'),
                  "there is one font");

  const TestSection s(4, 4, 32);
  const HFONT font = CreateFontA(-60, 0, 0, 0, FW_NORMAL, 0, 0, 0, 1, 0, 0, 0, 0, "");
  const HGDIOBJ old = SelectObject(s.dc, font);
  const auto height = [&s](UINT format) {
    RECT rect{0, 0, 0, 0};
    const int result = DrawTextA(s.dc, "a\nb\nc", -1, &rect, format | DT_CALCRECT);
    return result == rect.bottom ? result : -1;
  };
  const int gap = (2 * kLineGap * 60 + unitsPerEm) / (2 * unitsPerEm);
  isGood &= Holds(gap > 0 && height(DT_EXTERNALLEADING) == height(0) + 3 * gap,
                  "lines have their gap when it is asked for");
  SelectObject(s.dc, old);
  DeleteObject(font);
  return isGood;
}

TEST(DeviceFonts, WhatAFontLacksIsMadeOfWhatItHas) {
  GTEST_FLAG_SET(death_test_style, "threadsafe");  // a new process, in which no font is open yet
  EXPECT_EXIT(std::exit(UsesOneFont() ? 0 : 1), testing::ExitedWithCode(0), "");
}

}  // namespace
