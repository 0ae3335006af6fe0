// The pixels of thin lines against a slow model, and lines whose ends lie anywhere in the plane.

#include "DeviceTesting.h"

#include <vorl/Platform/soft/DashPattern.h>
#include <vorl/Platform/soft/ExactMath.h>
#include <vorl/Platform/soft/LineSteps.h>

#include <gtest/gtest.h>

#include <algorithm>
#include <cstdlib>
#include <limits>
#include <random>
#include <string>
#include <vector>

using vorl_detail::CeilingRamp;
using vorl_detail::DashPattern;
using vorl_detail::GridPoint;
using vorl_detail::LineSteps;

namespace {

constexpr int kMin = std::numeric_limits<int>::min();
constexpr int kMax = std::numeric_limits<int>::max();

struct Pixel {
  std::int64_t x;
  std::int64_t y;
  std::int64_t step;
  friend bool operator==(const Pixel&, const Pixel&) = default;
};

std::vector<Pixel> PixelsOf(GridPoint from, GridPoint to, const RECT& bounds) {
  std::vector<Pixel> pixels;
  for (LineSteps steps(from, to, bounds); steps.IsValid(); steps.Next()) {
    pixels.push_back({steps.X(), steps.Y(), steps.Step()});
  }
  return pixels;
}

// Tries every minor coordinate and keeps the nearest to the ideal line, the smallest of equals.
std::int64_t NearestMinor(std::int64_t start, std::int64_t delta, std::int64_t step,
                          std::int64_t steps) {
  std::int64_t best = 0;
  std::int64_t bestDistance = std::numeric_limits<std::int64_t>::max();
  for (std::int64_t v = start - std::llabs(delta); v <= start + std::llabs(delta); ++v) {
    const std::int64_t distance = std::llabs((v - start) * steps - delta * step);
    if (distance < bestDistance) {
      best = v;
      bestDistance = distance;
    }
  }
  return best;
}

std::vector<Pixel> SlowLine(GridPoint from, GridPoint to) {
  const std::int64_t dx = to.x - from.x;
  const std::int64_t dy = to.y - from.y;
  const std::int64_t steps = std::max(std::llabs(dx), std::llabs(dy));
  const bool isSteep = std::llabs(dy) > std::llabs(dx);
  std::vector<Pixel> pixels;
  for (std::int64_t k = 0; k < steps; ++k) {
    if (isSteep) {
      pixels.push_back({NearestMinor(from.x, dx, k, steps), from.y + (dy > 0 ? k : -k), k});
    } else {
      pixels.push_back({from.x + (dx > 0 ? k : -k), NearestMinor(from.y, dy, k, steps), k});
    }
  }
  return pixels;
}

TEST(DeviceLines, EveryDirectionTakesTheNearestPixels) {
  const RECT everything{kMin, kMin, kMax, kMax};
  for (int dx = -13; dx <= 13; ++dx) {
    for (int dy = -13; dy <= 13; ++dy) {
      const GridPoint from{3, -2};
      const GridPoint to{3 + dx, -2 + dy};
      ASSERT_EQ(PixelsOf(from, to, everything), SlowLine(from, to)) << dx << ", " << dy;
    }
  }
}

TEST(DeviceLines, BoundsCutOffWithoutMovingTheRest) {
  std::mt19937 random(7);
  const auto in = [&random](int low, int high) {
    return std::uniform_int_distribution<int>(low, high)(random);
  };
  const RECT bounds{-3, 2, 11, 9};
  for (int i = 0; i < 3000; ++i) {
    const GridPoint from{in(-25, 30), in(-25, 30)};
    const GridPoint to{in(-25, 30), in(-25, 30)};
    std::vector<Pixel> expected = SlowLine(from, to);
    std::erase_if(expected, [&bounds](const Pixel& p) {
      return p.x < bounds.left || p.x >= bounds.right || p.y < bounds.top || p.y >= bounds.bottom;
    });
    ASSERT_EQ(PixelsOf(from, to, bounds), expected)
        << from.x << ", " << from.y << " to " << to.x << ", " << to.y;
  }
}

TEST(DeviceLines, TheWholePlaneIsCrossedExactly) {
  // From corner to corner of the plane the line has y = x up to one step at the very end.
  const std::vector<Pixel> diagonal = PixelsOf({kMin, kMin}, {kMax, kMax}, {5, 0, 9, 20});
  const std::int64_t first = 5 - std::int64_t{kMin};
  EXPECT_EQ(diagonal, (std::vector<Pixel>{
                          {5, 5, first}, {6, 6, first + 1}, {7, 7, first + 2}, {8, 8, first + 3}}));
  // Half as high as wide, through the origin: x = -2^31 + k, y = -2^30 + k / 2, halves downwards.
  const std::vector<Pixel> gentle = PixelsOf({kMin, kMin / 2}, {kMax - 1, kMax / 2}, {0, -9, 5, 9});
  const std::int64_t origin = -std::int64_t{kMin};
  EXPECT_EQ(gentle, (std::vector<Pixel>{{0, 0, origin},
                                        {1, 0, origin + 1},
                                        {2, 1, origin + 2},
                                        {3, 1, origin + 3},
                                        {4, 2, origin + 4}}));
}

TEST(DeviceLines, AnEmptyRectangleShowsNothing) {
  EXPECT_TRUE(PixelsOf({0, 0}, {10, 5}, {3, 3, 3, 3}).empty());
  EXPECT_TRUE(PixelsOf({4, 4}, {4, 4}, {0, 0, 9, 9}).empty());
}

TEST(DeviceLines, RampsGoUpAndDown) {
  for (const int slope : {-7, -3, 0, 2, 9}) {
    for (const int shift : {-4, 0, 3}) {
      CeilingRamp ramp(-5, slope, shift, 4);
      for (int k = -5; k < 12; ++k) {
        int expected = -100;  // the smallest integer that is not below the quotient
        while (expected * 4 < k * slope + shift) {
          ++expected;
        }
        ASSERT_EQ(ramp.Value(), expected) << k << " * " << slope << " + " << shift;
        ramp.Next();
      }
    }
  }
}

TEST(DeviceLines, PatternsHaveTheirLengths) {
  const auto drawn = [](int style) {
    const DashPattern pattern(style);
    std::string row;
    for (int i = 0; i < 26; ++i) {
      row += pattern.IsInk(i) ? '#' : '.';
    }
    return row;
  };
  EXPECT_EQ(drawn(PS_SOLID), "##########################");
  EXPECT_EQ(drawn(PS_DASH), "##################......##");
  EXPECT_EQ(drawn(PS_DOT), "###...###...###...###...##");
  EXPECT_EQ(drawn(PS_DASHDOT), "#########......###......##");
  EXPECT_EQ(drawn(PS_DASHDOTDOT), "#########...###...###...##");
  EXPECT_EQ(drawn(PS_INSIDEFRAME), "##########################");
}

TEST(DeviceLines, PatternsCountBeyondThirtyTwoBits) {
  const DashPattern pattern(PS_DASH);
  const std::int64_t period = 24 * (std::int64_t{1} << 40);
  EXPECT_TRUE(pattern.IsInk(period + 17));
  EXPECT_FALSE(pattern.IsInk(period + 18));
}

TEST(DeviceLines, LineToMovesEvenWhereNothingIsDrawn) {
  const TestSection s(4, 4, 32);
  POINT position{0, 0};
  EXPECT_TRUE(LineTo(s.dc, kMin, kMax));
  EXPECT_TRUE(MoveToEx(s.dc, 1, 1, &position));
  EXPECT_EQ(position.x, kMin);
  EXPECT_EQ(position.y, kMax);
}

TEST(DeviceLines, WrongHandlesFail) {
  EXPECT_FALSE(LineTo(nullptr, 1, 1));
  EXPECT_FALSE(Rectangle(nullptr, 0, 0, 2, 2));
  const POINT points[3]{};
  EXPECT_FALSE(Polygon(nullptr, points, 3));
}

}  // namespace
