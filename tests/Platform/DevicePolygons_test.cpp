// Filled polygons against a slow model that asks every pixel on its own.

#include "DeviceTesting.h"

#include <vorl/Platform/soft/PolygonScan.h>

#include <gtest/gtest.h>

#include <cstddef>
#include <limits>
#include <random>
#include <utility>
#include <vector>

using vorl_detail::AppendPolygon;
using vorl_detail::GridPoint;
using vorl_detail::Span;

namespace {

constexpr int kMin = std::numeric_limits<int>::min();
constexpr int kMax = std::numeric_limits<int>::max();
constexpr RECT kBounds{0, 0, 24, 20};

using Grid = std::vector<int>;

// How often each pixel of the bounds is listed.
Grid Counted(const std::vector<Span>& spans) {
  Grid grid(24 * 20);
  for (const Span& span : spans) {
    for (int x = span.x0; x < span.x1; ++x) {
      ++grid.at(static_cast<std::size_t>(span.y * 24 + x));
    }
  }
  return grid;
}

// The edges that cross the pixel's row at the pixel or to its left, and the sum of their
// directions.
std::pair<int, int> EdgesToTheLeft(const std::vector<GridPoint>& corners, int x, int y) {
  int count = 0;
  int winding = 0;
  for (std::size_t i = 0; i < corners.size(); ++i) {
    GridPoint a = corners[i];
    GridPoint b = corners[(i + 1) % corners.size()];
    const int direction = a.y < b.y ? 1 : -1;
    if (a.y > b.y) {
      std::swap(a, b);
    }
    if (y >= a.y && y < b.y && (x - a.x) * (b.y - a.y) >= (y - a.y) * (b.x - a.x)) {
      ++count;
      winding += direction;
    }
  }
  return {count, winding};
}

Grid SlowFill(const std::vector<GridPoint>& corners, int mode) {
  Grid grid;
  for (int y = 0; y < 20; ++y) {
    for (int x = 0; x < 24; ++x) {
      const auto [count, winding] = EdgesToTheLeft(corners, x, y);
      grid.push_back(mode == WINDING ? (winding != 0 ? 1 : 0) : count % 2);
    }
  }
  return grid;
}

Grid Filled(const std::vector<GridPoint>& corners, int mode) {
  std::vector<Span> spans;
  AppendPolygon(spans, corners, mode, kBounds);
  return Counted(spans);
}

TEST(DevicePolygons, RandomCornersFillWhatTheModeCallsInside) {
  std::mt19937 random(11);
  const auto in = [&random](int low, int high) {
    return std::uniform_int_distribution<int>(low, high)(random);
  };
  for (int i = 0; i < 2000; ++i) {
    std::vector<GridPoint> corners(static_cast<std::size_t>(in(0, 9)));
    for (GridPoint& corner : corners) {
      corner = {in(-8, 32), in(-8, 28)};
    }
    for (const int mode : {ALTERNATE, WINDING}) {
      ASSERT_EQ(Filled(corners, mode), SlowFill(corners, mode)) << "polygon " << i;
    }
  }
}

TEST(DevicePolygons, TheModesDifferWhereAShapeOverlapsItself) {
  const std::vector<GridPoint> twice{{2, 2}, {12, 2}, {12, 12}, {2, 12},
                                     {2, 2}, {12, 2}, {12, 12}, {2, 12}};
  EXPECT_EQ(Filled(twice, ALTERNATE), Grid(24 * 20, 0));
  const std::vector<GridPoint> once{{2, 2}, {12, 2}, {12, 12}, {2, 12}};
  EXPECT_EQ(Filled(twice, WINDING), Filled(once, WINDING));
}

TEST(DevicePolygons, RightAndLowerEdgesAreOutside) {
  std::vector<Span> spans;
  AppendPolygon(spans, std::vector<GridPoint>{{3, 4}, {6, 4}, {6, 6}, {3, 6}}, ALTERNATE, kBounds);
  EXPECT_EQ(spans, (std::vector<Span>{{4, 3, 6}, {5, 3, 6}}));
}

TEST(DevicePolygons, CornersAtTheEndsOfThePlane) {
  std::vector<Span> spans;
  AppendPolygon(spans,
                std::vector<GridPoint>{{kMin, kMin}, {kMax, kMin}, {kMax, kMax}, {kMin, kMax}},
                WINDING, kBounds);
  EXPECT_EQ(Counted(spans), Grid(24 * 20, 1));
  // Below the diagonal of the plane: y = x belongs to it, being a left edge of the upper triangle.
  spans.clear();
  AppendPolygon(spans, std::vector<GridPoint>{{kMin, kMin}, {kMax, kMin}, {kMax, kMax}}, WINDING,
                kBounds);
  const Grid grid = Counted(spans);
  for (int y = 0; y < 20; ++y) {
    for (int x = 0; x < 24; ++x) {
      ASSERT_EQ(grid[static_cast<std::size_t>(y * 24 + x)], x >= y ? 1 : 0) << x << ", " << y;
    }
  }
}

TEST(DevicePolygons, FewerThanTwoPointsFail) {
  const TestSection s(8, 8, 32);
  const POINT points[2] = {{1, 1}, {6, 6}};
  EXPECT_FALSE(Polygon(s.dc, points, -1));
  EXPECT_FALSE(Polygon(s.dc, points, 0));
  EXPECT_FALSE(Polygon(s.dc, points, 1));
  EXPECT_TRUE(Polygon(s.dc, points, 2));
  EXPECT_FALSE(Polygon(s.dc, nullptr, 2));
  EXPECT_FALSE(Polygon(s.dc, nullptr, kMax));
}

TEST(DevicePolygons, RectanglesFromEndToEndFillEverything) {
  const TestSection s(4, 3, 32);
  SelectObject(s.dc, GetStockObject(WHITE_BRUSH));
  EXPECT_TRUE(Rectangle(s.dc, kMin, kMin, kMax, kMax));
  EXPECT_TRUE(Rectangle(s.dc, kMax, kMax, kMin, kMin));
  for (int y = 0; y < 3; ++y) {
    for (int x = 0; x < 4; ++x) {
      EXPECT_EQ(s.At(x, y) & 0xFFFFFFU, 0xFFFFFFU);
    }
  }
}

}  // namespace
