// Text: its encoding, its lines, its measures. Lengths are compared with each other, not with
// numbers, because fonts differ from machine to machine.

#include "../Support/TestFolder.h"
#include "DeviceTesting.h"

#include <vorl/Platform/soft/FontFace.h>
#include <vorl/Platform/soft/TextLayout.h>
#include <vorl/Platform/soft/Utf8.h>

#include <gtest/gtest.h>

#include <cstddef>
#include <cstdlib>
#include <fstream>
#include <limits>
#include <string>
#include <thread>
#include <vector>

using vorl_detail::DecodeUtf8;
using vorl_detail::FontFace;
using vorl_detail::LayOutText;
using vorl_detail::TextFormat;
using vorl_detail::TextLine;
using vorl_detail::TextRun;

namespace {

constexpr int kMin = std::numeric_limits<int>::min();
constexpr int kMax = std::numeric_limits<int>::max();

LOGFONTA Description(int height) {
  LOGFONTA description{};
  description.lfHeight = height;
  return description;
}

std::u32string TextOf(const TextLine& line) {
  std::u32string text;
  for (const TextRun& run : line.runs) {
    for (const vorl_detail::PlacedCharacter& character : run.characters) {
      text += character.code;
    }
  }
  return text;
}

// The texts of the lines; `limit` in widths of "m".
std::vector<std::u32string> Lines(const std::u32string& text, UINT format, int limit = 0) {
  const auto font = FontFace::Find(Description(-20));
  const std::int64_t width = std::int64_t{limit} * font->GlyphOf(U'm')->advance;
  std::vector<std::u32string> lines;
  for (const TextLine& line : LayOutText(text, *font, TextFormat(format), width)) {
    lines.push_back(TextOf(line));
  }
  return lines;
}

using Texts = std::vector<std::u32string>;

TEST(DeviceText, WellFormedUtf8) {
  EXPECT_EQ(DecodeUtf8("Az"), U"Az");
  EXPECT_EQ(DecodeUtf8("\xC2\x80\xDF\xBF"), U"\u0080\u07FF");
  EXPECT_EQ(DecodeUtf8("\xE0\xA0\x80\xEF\xBF\xBD"), U"\u0800\uFFFD");
  EXPECT_EQ(DecodeUtf8("\xF0\x90\x80\x80\xF4\x8F\xBF\xBF"), U"\U00010000\U0010FFFF");
  EXPECT_EQ(DecodeUtf8(""), U"");
}

TEST(DeviceText, EveryByteThatIsNoUtf8IsReplaced) {
  EXPECT_EQ(DecodeUtf8("a\x80z"), U"a\uFFFDz");                  // nothing to continue
  EXPECT_EQ(DecodeUtf8("\xC3"), U"\uFFFD");                      // cut off
  EXPECT_EQ(DecodeUtf8("\xE2\x82"), U"\uFFFD\uFFFD");            // cut off
  EXPECT_EQ(DecodeUtf8("\xC3z"), U"\uFFFDz");                    // broken off
  EXPECT_EQ(DecodeUtf8("\xC0\x80"), U"\uFFFD\uFFFD");            // longer than needed
  EXPECT_EQ(DecodeUtf8("\xE0\x9F\xBF"), U"\uFFFD\uFFFD\uFFFD");  // longer than needed
  EXPECT_EQ(DecodeUtf8("\xED\xA0\x80"), U"\uFFFD\uFFFD\uFFFD");  // a surrogate
  EXPECT_EQ(DecodeUtf8("\xF4\x90\x80\x80").size(), 4U);          // beyond the last character
  EXPECT_EQ(DecodeUtf8("\xFF\xFE"), U"\uFFFD\uFFFD");
}

TEST(DeviceText, LinesEndAtEveryKindOfBreak) {
  EXPECT_EQ(Lines(U"a\nb\rc\r\nd\n\re", 0), (Texts{U"a", U"b", U"c", U"d", U"e"}));
  EXPECT_EQ(Lines(U"a\n", 0), Texts{U"a"});
  EXPECT_EQ(Lines(U"\n\n", 0), (Texts{U"", U""}));
  EXPECT_EQ(Lines(U"a\nb", DT_SINGLELINE), Texts{U"a\nb"});
}

TEST(DeviceText, WordsAreKeptWhole) {
  EXPECT_EQ(Lines(U"mm mm mm", DT_WORDBREAK, 3), (Texts{U"mm ", U"mm ", U"mm"}));
  EXPECT_EQ(Lines(U"mm mm mm", DT_WORDBREAK, 2), (Texts{U"mm", U"mm", U"mm"}));
  EXPECT_EQ(Lines(U"mm mm mm", DT_WORDBREAK | DT_RIGHT, 3), (Texts{U"mm", U"mm", U"mm"}));
  EXPECT_EQ(Lines(U"mmmm m", DT_WORDBREAK, 2), (Texts{U"mmmm", U"m"}));
  EXPECT_EQ(Lines(U"mm-mm", DT_WORDBREAK, 4), (Texts{U"mm-", U"mm"}));
  EXPECT_EQ(Lines(U"mm mm\nmm", DT_WORDBREAK, 2), (Texts{U"mm", U"mm", U"mm"}));
  EXPECT_EQ(Lines(U"mm mm", DT_WORDBREAK, -1), Texts{U"mm mm"});
}

TEST(DeviceText, NoLimitIsTooNarrowToEnd) {
  for (const std::u32string text : {U"   ", U"\t\t", U" a ", U"\ta\tb", U"a\t\tb ", U"-", U"--a"}) {
    for (const UINT format :
         {DT_WORDBREAK, DT_WORDBREAK | DT_EXPANDTABS, DT_WORDBREAK | DT_RIGHT}) {
      EXPECT_LE(Lines(text, format, 0).size(), text.size() + 1);
    }
  }
}

TEST(DeviceText, AmpersandsUnderlineTheLastLetterMarked) {
  const auto font = FontFace::Find(Description(-20));
  const std::vector<TextLine> lines = LayOutText(U"&a&b&&c", *font, TextFormat(0), 0);
  ASSERT_EQ(lines.size(), 1U);
  ASSERT_EQ(TextOf(lines[0]), U"ab&c");
  const auto& characters = lines[0].runs[0].characters;
  EXPECT_FALSE(characters[0].isUnderlined);
  EXPECT_TRUE(characters[1].isUnderlined);
  EXPECT_FALSE(characters[2].isUnderlined);
  EXPECT_EQ(Lines(U"a&", 0), Texts{U"a&"});
  EXPECT_EQ(Lines(U"&a", DT_NOPREFIX), Texts{U"&a"});
}

TEST(DeviceText, UnderlinedLetterHasALineOneShorterThanItself) {
  TestSection s(60, -60, 32);
  SetBkMode(s.dc, TRANSPARENT);
  SetTextColor(s.dc, RGB(255, 255, 255));
  const HFONT selected = CreateFontA(-30, 0, 0, 0, FW_NORMAL, 0, 0, 0, 1, 0, 0, 0, 0, "");
  const HGDIOBJ old = SelectObject(s.dc, selected);
  RECT rect{5, 7, 60, 60};
  DrawTextA(s.dc, "& ", -1, &rect, 0);
  const auto font = FontFace::Find(Description(-30));
  const int row = 7 + font->Metrics().ascent + 1;
  const int end = 5 + font->GlyphOf(U' ')->advance - 1;
  for (int y = 0; y < 60; ++y) {
    for (int x = 0; x < 60; ++x) {
      EXPECT_EQ((s.At(x, y) & 0xFFFFFFU) != 0, y == row && x >= 5 && x < end) << x << ", " << y;
    }
  }
  SelectObject(s.dc, old);
  DeleteObject(selected);
}

TEST(DeviceText, TabStopsMayBeGiven) {
  const auto font = FontFace::Find(Description(-20));
  const int average = font->Metrics().averageWidth;
  const auto width = [&font](UINT format) {
    return LayOutText(U"\t", *font, TextFormat(format), 0)[0].width;
  };
  EXPECT_EQ(width(DT_EXPANDTABS), 8 * average);
  EXPECT_EQ(width(DT_EXPANDTABS | DT_TABSTOP | 3U << 8U), 3 * average);
  EXPECT_EQ(width(DT_EXPANDTABS | DT_TABSTOP), 1);  // stops at every pixel
}

TEST(DeviceText, UnusableArgumentsFail) {
  const TestSection s(8, 8, 32);
  RECT rect{0, 0, 8, 8};
  EXPECT_EQ(DrawTextA(nullptr, "a", -1, &rect, 0), 0);
  EXPECT_EQ(DrawTextA(s.dc, nullptr, -1, &rect, 0), 0);
  EXPECT_EQ(DrawTextA(s.dc, "a", -1, nullptr, 0), 0);
  EXPECT_EQ(DrawTextA(s.dc, "a", 0, &rect, DT_CALCRECT), 0);
  EXPECT_EQ(rect.right, 8);
}

TEST(DeviceText, TheCountIsInBytes) {
  const TestSection s(8, 8, 32);
  RECT one{0, 0, 0, 0};
  RECT two{0, 0, 0, 0};
  DrawTextA(s.dc, "\xC3\xA9xyz", 2, &one, DT_CALCRECT);
  DrawTextA(s.dc, "\xC3\xA9", -1, &two, DT_CALCRECT);
  EXPECT_EQ(one.right, two.right);
  EXPECT_GT(one.right, 0);
}

TEST(DeviceText, RectanglesAtTheEndsOfThePlane) {
  const TestSection s(16, 16, 32);
  const int ends[] = {kMin, -1, 0, 9, kMax};
  for (const int a : ends) {
    for (const int b : ends) {
      for (const UINT format : {0U, DT_CENTER | DT_VCENTER | DT_SINGLELINE, DT_RIGHT | DT_NOCLIP,
                                DT_BOTTOM | DT_SINGLELINE, DT_WORDBREAK, DT_CALCRECT}) {
        RECT rect{a, a, b, b};
        EXPECT_NE(DrawTextA(s.dc, "ab c", -1, &rect, format), 0);
      }
    }
  }
}

TEST(DeviceText, MissingCharactersAreShownAsSuch) {
  const auto font = FontFace::Find(Description(-30));
  const auto glyph = font->GlyphOf(0x10FFFD);  // for private use
  EXPECT_GT(glyph->advance, 0);
  EXPECT_EQ(glyph->coverage, font->GlyphOf(0x10FFFC)->coverage);
}

TEST(DeviceText, ALineOfPositiveHeightFits) {
  for (int height = 4; height < 60; ++height) {
    const int fitting = FontFace::Find(Description(height))->Metrics().Height();
    EXPECT_LE(fitting, height);
    EXPECT_GE(fitting, height - 3);
  }
  EXPECT_EQ(FontFace::Find(Description(0))->Metrics().Height(),
            FontFace::Find(Description(16))->Metrics().Height());
}

TEST(DeviceText, TheSameDescriptionFindsTheSameFont) {
  EXPECT_EQ(FontFace::Find(Description(-21)), FontFace::Find(Description(-21)));
  EXPECT_NE(FontFace::Find(Description(-21)), FontFace::Find(Description(-22)));
}

TEST(DeviceText, SmoothCharactersMixWithWhatIsBelow) {
  TestSection s(40, 40, 32);
  SetBkMode(s.dc, TRANSPARENT);
  SetTextColor(s.dc, RGB(255, 255, 255));
  const HFONT font = CreateFontA(-30, 0, 0, 0, FW_NORMAL, 0, 0, 0, 1, 0, 0, 0, 0, "");
  const HGDIOBJ old = SelectObject(s.dc, font);
  RECT rect{0, 0, 40, 40};
  DrawTextA(s.dc, "O", -1, &rect, 0);
  int between = 0;
  int full = 0;
  for (int y = 0; y < 40; ++y) {
    for (int x = 0; x < 40; ++x) {
      const std::uint32_t blue = s.At(x, y) & 0xFFU;
      EXPECT_EQ(s.At(x, y) & 0xFFFFFFU, blue * 0x010101U);  // grey: all channels alike
      between += blue > 0 && blue < 255 ? 1 : 0;
      full += blue == 255 ? 1 : 0;
    }
  }
  EXPECT_GT(between, 0);
  EXPECT_GT(full, 0);
  SelectObject(s.dc, old);
  DeleteObject(font);
}

TEST(DeviceText, ThreadsMeasureAtTheSameTime) {
  const auto measure = [](int height) {
    const TestSection s(4, 4, 32);
    const HFONT font = CreateFontA(height, 0, 0, 0, FW_NORMAL, 0, 0, 0, 1, 0, 0, 0, 0, "");
    const HGDIOBJ old = SelectObject(s.dc, font);
    RECT rect{0, 0, 0, 0};
    DrawTextA(s.dc, "The quick brown fox", -1, &rect, DT_CALCRECT);
    SelectObject(s.dc, old);
    DeleteObject(font);
    return rect.right;
  };
  std::vector<LONG> alone;
  for (int i = 0; i < 50; ++i) {
    alone.push_back(measure(-10 - i));
  }
  std::vector<LONG> together(alone.size());
  std::vector<std::thread> threads;
  for (std::size_t first = 0; first < 4; ++first) {
    threads.emplace_back([first, &together, &measure] {
      for (std::size_t i = first; i < together.size(); i += 4) {
        together[i] = measure(-10 - static_cast<int>(i));
      }
    });
  }
  for (std::thread& thread : threads) {
    thread.join();
  }
  EXPECT_EQ(together, alone);
}

// Fontconfig is told of no fonts; true when text then has no size and draws nothing.
bool DrawsNothingWithoutFonts() {
  const TestFolder folder;
  const std::string file = (folder / "no-fonts.conf").string();
  std::ofstream(file) << "<fontconfig></fontconfig>\n";
  setenv("FONTCONFIG_FILE", file.c_str(), 1);
  const TestSection s(8, 8, 32);
  SetBkColor(s.dc, RGB(255, 255, 255));
  RECT rect{2, 3, 8, 8};
  return DrawTextA(s.dc, "ab\ncd", -1, &rect, 0) == 0 && s.At(3, 4) == 0 &&
         DrawTextA(s.dc, "", -1, &rect, 0) == 0 &&
         DrawTextA(s.dc, "ab c", -1, &rect, DT_CALCRECT | DT_WORDBREAK) == 0 && rect.right == 2 &&
         rect.bottom == 3;
}

TEST(DeviceText, WithoutFontsNothingIsDrawn) {
  GTEST_FLAG_SET(death_test_style, "threadsafe");  // a new process, in which no font is open yet
  EXPECT_EXIT(std::exit(DrawsNothingWithoutFonts() ? 0 : 1), testing::ExitedWithCode(0), "");
}

}  // namespace
