#include "Drawing.h"
#include "Groups.h"
#include "Pictures.h"

#include <string>
#include <vector>

namespace {

using Points = std::vector<POINT>;

void Draw(const Section& p, const Points& points) {
  Report("r", Polygon(p.dc, points.data(), static_cast<int>(points.size())) != 0 ? 1 : 0);
}

// Random corners, some of them outside and some of them in one row, with every operation.
void RandomCorners(int mode, int rop, Random& random) {
  Section p(48, 44, kFormats[(rop + mode) % 8]);
  p.Ramp();
  Report("old", SetPolyFillMode(p.dc, mode));
  SetROP2(p.dc, rop);
  const SelectedPen pen(p.dc, PS_SOLID, 1, p.Paint(rop));
  const SelectedBrush brush(p.dc, p.Paint(rop + 5));
  for (int i = 0; i < 3; ++i) {
    Points points;
    const int count = random.In(3, 9);
    for (int k = 0; k < count; ++k) {
      const int x = random.In(-10, 58);
      const int y = random.Flip() && k > 0 ? points.back().y : random.In(-10, 54);
      points.push_back({x, y});
    }
    Draw(p, points);
  }
  Show(p);
}

void Filled(const Points& points, int mode, bool hasPen) {
  Section p(40, 36, {8, true});
  SetPolyFillMode(p.dc, mode);
  SetROP2(p.dc, R2_XORPEN);
  const SelectedObject pen(
      p.dc, hasPen ? HGDIOBJ(CreatePen(PS_SOLID, 1, Grey(255))) : GetStockObject(NULL_PEN), hasPen);
  const SelectedBrush brush(p.dc, Grey(90));
  Draw(p, points);
  Show(p);
}

struct NamedPoints {
  const char* name;
  Points points;
};

// Polygons whose inside is empty, doubtful or partly turned over.
const std::vector<NamedPoints> kDegenerate = {
    {"no-point", {}},
    {"one-point", {{9, 9}}},
    {"two-points", {{5, 5}, {30, 20}}},
    {"two-equal-points", {{5, 5}, {5, 5}}},
    {"three-equal-points", {{5, 5}, {5, 5}, {5, 5}}},
    {"row", {{5, 5}, {30, 5}, {17, 5}}},
    {"column", {{5, 5}, {5, 30}, {5, 17}}},
    {"diagonal", {{5, 5}, {25, 25}, {15, 15}}},
    {"there-and-back", {{5, 5}, {30, 20}, {5, 5}, {30, 20}}},
    {"repeated-corner", {{5, 5}, {5, 5}, {30, 8}, {30, 8}, {12, 30}, {12, 30}}},
    {"closed-twice", {{5, 5}, {30, 8}, {12, 30}, {5, 5}}},
    {"clockwise-square", {{5, 5}, {30, 5}, {30, 30}, {5, 30}}},
    {"anticlockwise-square", {{5, 5}, {5, 30}, {30, 30}, {30, 5}}},
    {"bow-tie", {{5, 5}, {30, 30}, {30, 5}, {5, 30}}},
    {"pentagram", {{18, 2}, {28, 33}, {2, 14}, {34, 14}, {8, 33}}},
    {"ring",
     {{2, 2},
      {36, 2},
      {36, 33},
      {2, 33},
      {2, 2},
      {10, 10},
      {10, 25},
      {28, 25},
      {28, 10},
      {10, 10}}},
    {"same-way-ring",
     {{2, 2},
      {36, 2},
      {36, 33},
      {2, 33},
      {2, 2},
      {10, 10},
      {28, 10},
      {28, 25},
      {10, 25},
      {10, 10}}},
    {"comb", {{2, 30}, {2, 2}, {6, 28}, {10, 2}, {14, 28}, {18, 2}, {22, 28}, {26, 2}, {30, 30}}},
    {"sliver", {{2, 2}, {37, 4}, {37, 5}}},
    {"one-pixel", {{5, 5}, {6, 5}, {6, 6}, {5, 6}}},
    {"far-corners", {{-90000, -70000}, {80000, -30}, {25, 88000}}},
    {"around-everything", {{-100, -100}, {200, -100}, {200, 200}, {-100, 200}}},
    {"above", {{5, -20}, {30, -5}, {12, -1}}},
};

void Neighbours() {
  // Shapes that share edges neither overlap nor leave a gap: combined twice, they would show.
  Section p(40, 40, {8, true});
  SetROP2(p.dc, R2_XORPEN);
  const SelectedStock pen(p.dc, NULL_PEN);
  const SelectedBrush brush(p.dc, Grey(255));
  const POINT rim[] = {{1, 2}, {20, 0}, {38, 5}, {39, 22}, {33, 38}, {11, 39}, {0, 21}, {1, 2}};
  for (int i = 0; i < 7; ++i) {
    Draw(p, {{17, 19}, rim[i], rim[i + 1]});
  }
  Show(p);
}

void Clipped(Random& random) {
  Section p(44, 40, {24, false});
  IntersectClipRect(p.dc, 3, 5, 41, 36);
  ExcludeClipRect(p.dc, 15, 12, 22, 30);
  for (int i = 0; i < 4; ++i) {
    const SelectedPen pen(p.dc, PS_SOLID, i * 2, p.Paint(i));
    const SelectedBrush brush(p.dc, p.Paint(i + 7));
    Points points;
    for (int k = 0; k < 4; ++k) {
      const int x = random.In(-30, 70);
      const int y = random.In(-30, 70);
      points.push_back({x, y});
    }
    Draw(p, points);
  }
  Show(p);
}

}  // namespace

void PolygonScenes() {
  for (const int mode : {ALTERNATE, WINDING}) {
    const std::string name = mode == ALTERNATE ? "-alternate" : "-winding";
    for (int rop = R2_BLACK; rop <= R2_WHITE; ++rop) {
      Scene("polygon/random-rop" + std::to_string(rop) + name,
            [=](Random& random) { RandomCorners(mode, rop, random); });
    }
    for (const NamedPoints& shape : kDegenerate) {
      Scene("polygon/" + std::string(shape.name) + name,
            [&shape, mode](Random&) { Filled(shape.points, mode, false); });
    }
  }
  for (const NamedPoints& shape : kDegenerate) {
    Scene("polygon/" + std::string(shape.name) + "-outlined",
          [&shape](Random&) { Filled(shape.points, ALTERNATE, true); });
  }
  Scene("polygon/neighbours", [](Random&) { Neighbours(); });
  Scene("polygon/clipped", Clipped);
}
