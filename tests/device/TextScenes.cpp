// What holds whatever fonts there are: the scenes report relations, not lengths.

#include "Drawing.h"
#include "Groups.h"
#include "Pictures.h"

#include <string>

namespace {

struct Size {
  int width;
  int height;
  int result;
};

// The size of a text, in a rectangle of the given width where it matters.
Size Measure(HDC dc, const std::string& text, UINT format = 0, int limit = 0) {
  RECT rect{0, 0, limit, 0};
  const int result = DrawTextA(dc, text.c_str(), -1, &rect, format | DT_CALCRECT);
  return {static_cast<int>(rect.right), static_cast<int>(rect.bottom), result};
}

void ReportBool(const char* key, bool value) {
  Report(key, value ? 1 : 0);
}

// Text in the colour of its background: what is drawn is the box.
struct Box {
  explicit Box(Format format) : picture(160, 120, format) {
    SetBkMode(picture.dc, OPAQUE);
    SetBkColor(picture.dc, picture.Ink());
    SetTextColor(picture.dc, picture.Ink());
  }
  int Draw(const std::string& text, RECT rect, UINT format) {
    picture.Fill(0);
    const int result = DrawTextA(picture.dc, text.c_str(), -1, &rect, format);
    GdiFlush();
    return result;
  }
  // Is exactly this rectangle painted?
  bool IsPainted(int left, int top, int right, int bottom) const {
    for (int y = 0; y < picture.height; ++y) {
      for (int x = 0; x < picture.width; ++x) {
        const bool isInside = x >= left && x < right && y >= top && y < bottom;
        if ((picture.Get(x, y) != 0) != isInside) {
          return false;
        }
      }
    }
    return true;
  }
  Section picture;
};

void Measured() {
  Section p(20, 20, kFormats[0]);
  const Size a = Measure(p.dc, "Mg");
  const Size b = Measure(p.dc, "MgMg");
  const Size c = Measure(p.dc, "Mg\nMg");
  const Size d = Measure(p.dc, "");
  ReportBool("wider", b.width > a.width && a.width > 0);
  ReportBool("height", a.height == b.height && a.result == a.height && b.result == b.height);
  ReportBool("twice", c.height == 2 * a.height && c.width == a.width);
  ReportBool("empty", d.width == 0 && d.height == 0 && d.result == a.height);
  Show(p);
}

// How many lines a text has, as the measured height and as the result.
void Lines() {
  Section p(4, 4, {24, true});
  const int line = Measure(p.dc, "M").height;
  for (const char* const text : {"a", "a\n", "\n", "\n\n", "a\nb", "a\r\nb", "a\rb", "a\n\rb",
                                 "a\r", "a\r\n", "a\n\nb", "\na", "a\r\rb", "\r\n\r\n"}) {
    const Size size = Measure(p.dc, text);
    const Size single = Measure(p.dc, text, DT_SINGLELINE);
    Report("n", size.height / line * 100 + size.result / line * 10 + single.height / line);
  }
}

void OpaqueBox(Format format) {
  Box box(format);
  const Size size = Measure(box.picture.dc, "Axis");
  box.Draw("Axis", {7, 9, 7 + size.width, 9 + size.height}, 0);
  ReportBool("exact", box.IsPainted(7, 9, 7 + size.width, 9 + size.height));
}

// The box inside a rectangle that is larger than the text.
void Aligned(UINT format) {
  Box box({8, true});
  const Size size = Measure(box.picture.dc, "Mi");
  const RECT r{10, 8, 151, 111};
  const int result = box.Draw("Mi", r, format);
  int left = 10;
  if ((format & DT_CENTER) != 0) {
    left = 10 + (141 - size.width) / 2;
  } else if ((format & DT_RIGHT) != 0) {
    left = 151 - size.width;
  }
  int top = 8;
  if ((format & DT_SINGLELINE) != 0 && (format & DT_VCENTER) != 0) {
    top = 8 + 103 / 2 - size.height / 2;
  } else if ((format & DT_SINGLELINE) != 0 && (format & DT_BOTTOM) != 0) {
    top = 111 - size.height;
  }
  ReportBool("placed", box.IsPainted(left, top, left + size.width, top + size.height));
  ReportBool("result", result == top - 8 + size.height);
}

// Text that does not fit: cut at the rectangle, unless it may leave it.
void Overflowing() {
  Box box({24, true});
  const Size size = Measure(box.picture.dc, "Mgi");
  const RECT small{20, 20, 20 + size.width / 2, 20 + size.height / 2};
  box.Draw("Mgi", small, 0);
  ReportBool("cut", box.IsPainted(20, 20, small.right, small.bottom));
  box.Draw("Mgi", small, DT_NOCLIP);
  ReportBool("whole", box.IsPainted(20, 20, 20 + size.width, 20 + size.height));
  const int result = box.Draw("Mgi", {60, 60, 50, 40}, 0);
  ReportBool("nothing", box.IsPainted(0, 0, 0, 0));
  ReportBool("height", result == size.height);
  IntersectClipRect(box.picture.dc, 22, 18, 25, 24);
  box.Draw("Mgi", small, DT_NOCLIP);
  ReportBool("region", box.IsPainted(22, 20, 25, 24));
}

void Prefixes() {
  Section p(4, 4, {32, true});
  const auto width = [&p](const char* text, UINT format) {
    return Measure(p.dc, text, format).width;
  };
  ReportBool("one", width("&File", 0) == width("File", 0));
  ReportBool("two", width("a&&b", 0) == width("a&b", DT_NOPREFIX));
  ReportBool("three", width("a&&&b", 0) == width("a&b", DT_NOPREFIX));
  ReportBool("last", width("ab&", 0) == width("ab&", DT_NOPREFIX));
  ReportBool("kept", width("&a&b", DT_NOPREFIX) > width("&a&b", 0));
}

// The letter behind an ampersand is underlined, the last one of several.
void Underlined() {
  const auto ink = [](const char* text, UINT format) {
    Section p(80, 40, {8, true});
    SetBkMode(p.dc, TRANSPARENT);
    SetTextColor(p.dc, Grey(255));
    RECT r{0, 0, 80, 40};
    DrawTextA(p.dc, text, -1, &r, format);
    GdiFlush();
    int count = 0;
    for (int y = 0; y < 40; ++y) {
      for (int x = 0; x < 80; ++x) {
        count += p.Get(x, y) != 0 ? 1 : 0;
      }
    }
    return count;
  };
  ReportBool("more", ink("a&b", 0) > ink("ab", 0));
  ReportBool("once", ink("&a&b", 0) == ink("a&b", 0));
  ReportBool("blank", ink("   ", 0) == 0 && ink("& ", 0) > 0);
  ReportBool("none", ink("a&&b", 0) == ink("a&b", DT_NOPREFIX));
}

void Tabs() {
  Section p(4, 4, {24, true});
  const auto width = [&p](const char* text) { return Measure(p.dc, text, DT_EXPANDTABS).width; };
  const int tab = width("\t");
  ReportBool("stop", tab > 0 && width("\t\t") == 2 * tab);
  ReportBool("next", width("i\ti") == tab + width("i") && width("\ti") == width("i\ti"));
  ReportBool("lines", width("i\n\ti") == width("\ti"));
}

// Breaks between words. Limits are multiples of what the words measure.
void WordBreak() {
  Section p(4, 4, {24, true});
  const int line = Measure(p.dc, "M").height;
  const int word = Measure(p.dc, "word").width;
  const int two = Measure(p.dc, "word word").width;
  for (const char* const text : {"word", "word word", "word word word", "word\nword word word",
                                 "word-word", "word word\n"}) {
    for (const int limit : {word, two, 10 * word}) {
      const Size size = Measure(p.dc, text, DT_WORDBREAK, limit);
      Report("n", size.result / line);
      if (size.height != size.result) {
        ReportWord("height");
      }
    }
  }
  ReportBool("long", Measure(p.dc, "wordword", DT_WORDBREAK, word).width > word);
  ReportBool("space", Measure(p.dc, "word word", DT_WORDBREAK, word).width == word);
}

// What begins below the rectangle is not counted.
void Height() {
  Section p(60, 200, {24, true});
  const int line = Measure(p.dc, "M").height;
  for (int i = 0; i < 5; ++i) {
    RECT r{0, 0, 50, i * line + line / 2};
    Report("n", DrawTextA(p.dc, "a\nb\nc", -1, &r, 0) / line);
    Report("all", DrawTextA(p.dc, "a\nb\nc", -1, &r, DT_NOCLIP) / line);
  }
}

void Counts() {
  Section p(4, 4, {24, true});
  RECT r{0, 0, 100, 100};
  Report("none", DrawTextA(p.dc, "abc", 0, &r, 0));
  Report("right", r.right);
  DrawTextA(p.dc, "abc", 2, &r, DT_CALCRECT);
  ReportBool("two", r.right == Measure(p.dc, "ab").width);
  Report("null", DrawTextA(nullptr, "abc", -1, &r, 0));
}

// Heights follow what is asked for; a negative one is that of the characters alone.
void Fonts() {
  Section p(4, 4, {24, true});
  const auto height = [&p](int asked, int weight, DWORD italic) {
    const SelectedObject font(p.dc, CreateFontA(asked, 0, 0, 0, weight, italic, 0, 0, 1, 0, 0, 0, 0,
                                                "No font of this name"));
    return Measure(p.dc, "Mg").height;
  };
  ReportBool("grows", height(-40, 400, 0) > height(-20, 400, 0));
  ReportBool("smaller", height(20, 400, 0) <= 20 && height(-20, 400, 0) > 20);
  ReportBool("bold", height(-20, 700, 0) >= 20 && height(-20, 400, 1) >= 20);
  ReportBool("default", height(0, 400, 0) > 0);
}

// Lines under and through blanks: both run over the whole text, one below the other.
void Decorated() {
  const auto firstRow = [](DWORD underline, DWORD strikeOut) {
    Section p(60, 60, {8, true});
    SetBkMode(p.dc, TRANSPARENT);
    SetTextColor(p.dc, Grey(255));
    const SelectedObject font(
        p.dc, CreateFontA(-30, 0, 0, 0, 400, 0, underline, strikeOut, 1, 0, 0, 0, 0, ""));
    const int width = Measure(p.dc, "  ").width;
    RECT r{5, 0, 60, 60};
    DrawTextA(p.dc, "  ", -1, &r, 0);
    GdiFlush();
    for (int y = 0; y < 60; ++y) {
      if (p.Get(5, y) != 0) {
        ReportBool("whole",
                   p.Get(4, y) == 0 && p.Get(4 + width, y) != 0 && p.Get(5 + width, y) == 0);
        return y;
      }
    }
    return -1;
  };
  const int under = firstRow(1, 0);
  const int through = firstRow(0, 1);
  ReportBool("none", firstRow(0, 0) < 0);
  ReportBool("below", through > 0 && under > through);
}

// Text takes no notice of the raster operation.
void RasterOperation() {
  Box box({24, true});
  SetROP2(box.picture.dc, R2_NOP);
  const Size size = Measure(box.picture.dc, "Mg");
  box.Draw("Mg", {3, 4, 150, 110}, 0);
  ReportBool("drawn", box.IsPainted(3, 4, 3 + size.width, 4 + size.height));
}

}  // namespace

void TextScenes() {
  Scene("text/measure", [](Random&) { Measured(); });
  Scene("text/lines", [](Random&) { Lines(); });
  for (const int bits : kDepths) {
    Scene("text/opaque-box-" + std::to_string(bits), [bits](Random&) { OpaqueBox({bits, true}); });
  }
  const UINT horizontal[] = {DT_LEFT, DT_CENTER, DT_RIGHT};
  const UINT vertical[] = {DT_TOP, DT_VCENTER, DT_BOTTOM};
  for (const UINT h : horizontal) {
    for (const UINT v : vertical) {
      Scene("text/aligned" + std::to_string(h | v), [=](Random&) { Aligned(h | v); });
      Scene("text/single-line" + std::to_string(h | v),
            [=](Random&) { Aligned(h | v | DT_SINGLELINE); });
    }
  }
  Scene("text/overflowing", [](Random&) { Overflowing(); });
  Scene("text/prefixes", [](Random&) { Prefixes(); });
  Scene("text/underlined", [](Random&) { Underlined(); });
  Scene("text/tabs", [](Random&) { Tabs(); });
  Scene("text/word-break", [](Random&) { WordBreak(); });
  Scene("text/height", [](Random&) { Height(); });
  Scene("text/counts", [](Random&) { Counts(); });
  Scene("text/fonts", [](Random&) { Fonts(); });
  Scene("text/decorated", [](Random&) { Decorated(); });
  Scene("text/raster-operation", [](Random&) { RasterOperation(); });
}
