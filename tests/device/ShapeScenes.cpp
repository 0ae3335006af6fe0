#include "Drawing.h"
#include "Groups.h"
#include "Pictures.h"

#include <vector>

namespace {

const std::vector<std::vector<POINT>> kPolygons = {{{7, 2}, {28, 13}, {3, 27}},
                                                   {{2, 2}, {29, 5}, {14, 12}, {27, 28}, {5, 21}},
                                                   {{4, 4}, {27, 27}, {27, 4}, {4, 27}},
                                                   {{15, 2}, {28, 15}, {15, 28}, {2, 15}}};

enum Parts { kFill, kOutline, kBoth };

void DrawPolygon(int number, Parts parts) {
  Section p(32, 31, kFormats[(number * 3 + parts) % 8]);
  p.Fill(0x55);
  const bool hasPen = parts != kFill;
  const bool hasBrush = parts != kOutline;
  const SelectedObject pen(
      p.dc, hasPen ? HGDIOBJ(CreatePen(PS_SOLID, 1, p.Ink())) : GetStockObject(NULL_PEN), hasPen);
  const SelectedObject brush(
      p.dc, hasBrush ? HGDIOBJ(CreateSolidBrush(p.Paint(2))) : GetStockObject(NULL_BRUSH),
      hasBrush);
  const std::vector<POINT>& points = kPolygons[static_cast<std::size_t>(number)];
  Report("r", Polygon(p.dc, points.data(), static_cast<int>(points.size())) != 0 ? 1 : 0);
  Show(p);
}

void Rectangles(Format format, Random& random) {
  Section p(26, 24, format);
  p.Noise(random);
  for (int i = 0; i < 5; ++i) {
    const int left = random.In(-6, 20);
    const int top = random.In(-6, 20);
    const std::uint32_t colour = p.Paint(i);
    const int bottom = top + random.In(1, 12);
    const int right = left + random.In(1, 12);
    FillRectangle(p.dc, left, top, right, bottom, colour);
  }
  Show(p);
}

void Pixels() {
  Section p(12, 9, kFormats[1]);
  for (int i = 0; i < 14; ++i) {
    ReportHex("s", SetPixel(p.dc, i % 12, i % 9, p.Paint(i)));
  }
  ReportHex("g", GetPixel(p.dc, 3, 3));
  ReportHex("g", GetPixel(p.dc, 12, 3));
  Show(p);
}

// Every depth holds what is asked for, or the nearest that it has.
void PixelColours(Format format) {
  Section p(16, 4, format);
  for (int i = 0; i < 16; ++i) {
    ReportHex("s", SetPixel(p.dc, i, 1, p.Paint(i)));
    FillRectangle(p.dc, i, 2, i + 1, 4, p.Paint(i + 5));
    ReportHex("g", GetPixel(p.dc, i, 3));
  }
  Show(p);
}

// With exchanged corners, with another raster operation: which of the two heeds it.
void OddRectangles(int bits) {
  Section p(24, 20, {bits, true});
  FillRectangle(p.dc, 9, 8, 3, 1, p.Paint(1));
  FillRectangle(p.dc, 20, 2, 12, 7, p.Paint(3));
  FillRectangle(p.dc, 2, 18, 9, 11, p.Paint(5));
  FillRectangle(p.dc, 12, 12, 12, 18, p.Paint(7));
  SetROP2(p.dc, R2_XORPEN);
  FillRectangle(p.dc, 5, 5, 16, 15, p.Paint(9));
  for (int i = 0; i < 20; ++i) {
    ReportHex("s", SetPixel(p.dc, i, i, p.Paint(11)));
  }
  SetROP2(p.dc, R2_NOT);
  ReportHex("s", SetPixel(p.dc, 3, 4, p.Paint(13)));
  Show(p);
}

// Of one bit: what is neither of the two colours stands out from the background.
void OneBitColours(bool inverted, std::uint32_t background) {
  Section p(12, 3, {1, true}, inverted);
  SetBkColor(p.dc, background);
  const std::uint32_t colours[12] = {0,        0x101010, 0x404040, 0x7E7E7E, 0x7F7F7F, 0x808080,
                                     0x818181, 0xC0C0C0, 0xFEFEFE, 0xFFFFFF, 0x0000FF, 0x00FF00};
  for (int i = 0; i < 12; ++i) {
    ReportHex("s", SetPixel(p.dc, i, 0, colours[i]));
    FillRectangle(p.dc, i, 1, i + 1, 2, colours[i]);
    const SelectedPen pen(p.dc, PS_SOLID, 1, colours[i]);
    DrawLine(p.dc, i, 2, i + 1, 2);
  }
  Show(p);
}

}  // namespace

void ShapeScenes() {
  const char* const names[] = {"-fill", "-outline", "-both"};
  for (int i = 0; i < 4; ++i) {
    for (const Parts parts : {kFill, kOutline, kBoth}) {
      Scene("shape/polygon" + std::to_string(i) + names[parts],
            [i, parts](Random&) { DrawPolygon(i, parts); });
    }
  }
  for (int n = 0; n < 4; ++n) {
    Scene("shape/rectangles-" + NameOf(kFormats[n]),
          [n](Random& random) { Rectangles(kFormats[n], random); });
  }
  Scene("shape/pixels", [](Random&) { Pixels(); });
  for (const int bits : {1, 4, 8, 16, 24, 32}) {
    Scene("shape/pixel-colours-" + std::to_string(bits), [bits](Random&) {
      PixelColours({bits, bits % 3 != 0});
    });
    Scene("shape/odd-rectangles-" + std::to_string(bits), [bits](Random&) { OddRectangles(bits); });
  }
  for (const std::uint32_t background : {0xFFFFFFU, 0x404040U, 0x0000FFU}) {
    for (const bool inverted : {false, true}) {
      Scene("shape/one-bit-on-" + std::to_string(background) + (inverted ? "-inverted" : ""),
            [=](Random&) { OneBitColours(inverted, background); });
    }
  }
}
