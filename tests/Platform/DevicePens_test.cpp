// The shapes of wide pens, drawn by hand, and what a union of spans promises.

#include "DeviceTesting.h"

#include <vorl/Platform/soft/ExactMath.h>
#include <vorl/Platform/soft/Spans.h>
#include <vorl/Platform/soft/WidePen.h>

#include <gtest/gtest.h>

#include <algorithm>
#include <cstddef>
#include <limits>
#include <string>
#include <vector>

using vorl_detail::Difference;
using vorl_detail::GridPoint;
using vorl_detail::Normalise;
using vorl_detail::ShareOfDiagonal;
using vorl_detail::Span;
using vorl_detail::SquareRootFloor;
using vorl_detail::WideOutline;

namespace {

constexpr int kMin = std::numeric_limits<int>::min();
constexpr int kMax = std::numeric_limits<int>::max();

using Rows = std::vector<std::string>;

Rows Drawn(const std::vector<Span>& spans, const RECT& bounds) {
  Rows rows(static_cast<std::size_t>(bounds.bottom - bounds.top),
            std::string(static_cast<std::size_t>(bounds.right - bounds.left), '.'));
  for (const Span& span : spans) {
    for (int x = span.x0; x < span.x1; ++x) {
      char& pixel = rows.at(static_cast<std::size_t>(span.y - bounds.top))
                        .at(static_cast<std::size_t>(x - bounds.left));
      pixel = pixel == '.' ? '#' : '2';  // listed twice
    }
  }
  return rows;
}

Rows Dot(int width) {
  const std::vector<GridPoint> point{{0, 0}};
  const RECT bounds{-3, -3, 4, 4};
  return Drawn(WideOutline(point, false, width, bounds), bounds);
}

TEST(DevicePens, DotsAreRoundAndEvenOnesLeanToTheUpperLeft) {
  EXPECT_EQ(Dot(2),
            (Rows{".......", ".......", "..##...", "..##...", ".......", ".......", "......."}));
  EXPECT_EQ(Dot(3),
            (Rows{".......", ".......", "...#...", "..###..", "...#...", ".......", "......."}));
  EXPECT_EQ(Dot(4),
            (Rows{".......", "..##...", ".####..", ".####..", "..##...", ".......", "......."}));
  EXPECT_EQ(Dot(5),
            (Rows{".......", "..###..", ".#####.", ".#####.", ".#####.", "..###..", "......."}));
  EXPECT_EQ(Dot(6),
            (Rows{"..##...", ".####..", "######.", "######.", ".####..", "..##...", "......."}));
  EXPECT_EQ(Dot(7),
            (Rows{"..###..", ".#####.", "#######", "#######", "#######", ".#####.", "..###.."}));
}

TEST(DevicePens, DotsAreSymmetricAndAsWideAsThePen) {
  for (int width = 3; width < 80; ++width) {
    const int low = -(width / 2);
    const RECT bounds{low - 2, low - 2, low + width + 2, low + width + 2};
    const std::vector<Span> spans =
        WideOutline(std::vector<GridPoint>{{0, 0}}, false, width, bounds);
    ASSERT_EQ(spans.size(), static_cast<std::size_t>(width)) << width;
    int widest = 0;
    for (std::size_t i = 0; i < spans.size(); ++i) {
      ASSERT_EQ(spans[i].x0 - low, low + width - spans[i].x1) << width;
      ASSERT_EQ(spans[i].x0, spans[spans.size() - 1 - i].x0) << width;
      widest = std::max(widest, spans[i].x1 - spans[i].x0);
    }
    EXPECT_EQ(widest, width);
  }
}

TEST(DevicePens, LinesAlongTheAxes) {
  const RECT bounds{-2, -2, 8, 4};
  const std::vector<GridPoint> across{{0, 0}, {5, 0}};
  EXPECT_EQ(
      Drawn(WideOutline(across, false, 3, bounds), bounds),
      (Rows{"..........", "..######..", ".########.", "..######..", "..........", ".........."}));
  EXPECT_EQ(
      Drawn(WideOutline(across, false, 4, bounds), bounds),
      (Rows{".#######..", "#########.", "#########.", ".#######..", "..........", ".........."}));
}

TEST(DevicePens, EachPixelIsListedOnce) {
  const RECT bounds{0, 0, 40, 40};
  const std::vector<GridPoint> star{{5, 5}, {35, 12}, {6, 30}, {20, 2}, {33, 36}, {5, 5}};
  for (int width = 2; width < 15; ++width) {
    for (const std::string& row : Drawn(WideOutline(star, true, width, bounds), bounds)) {
      ASSERT_EQ(row.find('2'), std::string::npos) << width;
    }
  }
}

TEST(DevicePens, OnlyClosedWaysReturn) {
  const RECT bounds{0, 0, 30, 30};
  const std::vector<GridPoint> corner{{3, 3}, {25, 3}, {25, 25}};
  const Rows open = Drawn(WideOutline(corner, false, 3, bounds), bounds);
  const Rows closed = Drawn(WideOutline(corner, true, 3, bounds), bounds);
  EXPECT_EQ(open[14][14], '.');
  EXPECT_EQ(closed[14][14], '#');
}

TEST(DevicePens, WaysWithoutPointsAreEmpty) {
  EXPECT_TRUE(WideOutline({}, false, 5, {0, 0, 9, 9}).empty());
  EXPECT_TRUE(WideOutline({}, true, 5, {0, 0, 9, 9}).empty());
}

TEST(DevicePens, HugePensCoverEverything) {
  const RECT bounds{0, 0, 3, 2};
  const std::vector<Span> all{{0, 0, 3}, {1, 0, 3}};
  EXPECT_EQ(WideOutline(std::vector<GridPoint>{{kMin, kMin}, {kMax, kMax}}, false, kMax, bounds),
            all);
  EXPECT_EQ(WideOutline(std::vector<GridPoint>{{7, 9}}, false, std::int64_t{1} << 31, bounds), all);
}

TEST(DevicePens, SharesOfADiagonal) {
  EXPECT_EQ(ShareOfDiagonal(5, 3, 4), 3);   // 5 * 3 / 5
  EXPECT_EQ(ShareOfDiagonal(10, 1, 1), 7);  // 10 / sqrt(2) = 7.07...
  EXPECT_EQ(ShareOfDiagonal(10, 0, 8), 0);
  EXPECT_EQ(ShareOfDiagonal(std::uint64_t{1} << 31, (std::uint64_t{1} << 32) - 1, 0),
            std::int64_t{1} << 31);
}

TEST(DevicePens, SquareRoots) {
  for (const std::uint64_t root :
       {std::uint64_t{1}, std::uint64_t{2}, std::uint64_t{94906267}, std::uint64_t{4294967295}}) {
    EXPECT_EQ(SquareRootFloor(root * root), root);
    EXPECT_EQ(SquareRootFloor(root * root - 1), root - 1);
  }
  EXPECT_EQ(SquareRootFloor(0), 0U);
  EXPECT_EQ(SquareRootFloor(std::numeric_limits<std::uint64_t>::max()), 4294967295U);
}

TEST(DevicePens, NormalisedSpansAreOrderedAndJoined) {
  std::vector<Span> spans{{2, 5, 9}, {1, 4, 6}, {2, 0, 5}, {1, 8, 9}, {1, 1, 5}, {2, 20, 21}};
  Normalise(spans);
  EXPECT_EQ(spans, (std::vector<Span>{{1, 1, 6}, {1, 8, 9}, {2, 0, 9}, {2, 20, 21}}));
}

TEST(DevicePens, DifferencesLeaveWhatIsNotCovered) {
  const std::vector<Span> spans{{0, 0, 10}, {1, 0, 10}, {1, 12, 15}, {3, 2, 4}};
  const std::vector<Span> holes{{0, -5, 2}, {0, 4, 6}, {0, 9, 20},
                                {1, 5, 13}, {2, 0, 9}, {3, 2, 4}};
  EXPECT_EQ(Difference(spans, holes),
            (std::vector<Span>{{0, 2, 4}, {0, 6, 9}, {1, 0, 5}, {1, 13, 15}}));
  EXPECT_EQ(Difference(spans, {}), spans);
  EXPECT_TRUE(Difference({}, holes).empty());
}

TEST(DevicePens, AWidePenAndABrushMeetWithoutOverlapping) {
  const TestSection s(40, 40, 32);
  const HPEN pen = CreatePen(PS_SOLID, 7, RGB(255, 255, 255));
  const HBRUSH brush = CreateSolidBrush(RGB(255, 255, 255));
  SelectObject(s.dc, pen);
  SelectObject(s.dc, brush);
  SetROP2(s.dc, R2_XORPEN);
  const POINT corners[] = {{8, 8}, {32, 12}, {18, 33}};
  EXPECT_TRUE(Polygon(s.dc, corners, 3));
  // A pixel on the edge and one inside; both would be black again, had both touched them.
  EXPECT_EQ(s.At(20, 39 - 10) & 0xFFFFFFU, 0xFFFFFFU);
  EXPECT_EQ(s.At(20, 39 - 20) & 0xFFFFFFU, 0xFFFFFFU);
  SelectObject(s.dc, GetStockObject(BLACK_PEN));
  SelectObject(s.dc, GetStockObject(WHITE_BRUSH));
  DeleteObject(pen);
  DeleteObject(brush);
}

}  // namespace
