// Which points of a row lie inside a volume, against a look at every point; and which volumes are
// grids.
#include <vorl/Operators/IP/kernels/PlaneRows.h>

#include <gtest/gtest.h>

#include <algorithm>
#include <array>
#include <cstdint>
#include <limits>
#include <optional>
#include <random>
#include <string>

namespace {

using vorl_detail::FixedVector;
using vorl_detail::VolumeGrid;
using vorl_detail::VolumeView;

constexpr std::int64_t kLowest = std::numeric_limits<std::int32_t>::min();
constexpr std::int64_t kHighest = std::numeric_limits<std::int32_t>::max();

// ---- FindInside ------------------------------------------------------------------------------

struct Row {
  FixedVector limits, point, step;
  std::size_t width;
};

std::string Text(const FixedVector& vector) {
  return "(" + std::to_string(vector.x) + ", " + std::to_string(vector.y) + ", " +
         std::to_string(vector.z) + ")";
}

std::string Text(const Row& row) {
  return std::to_string(row.width) + " points from " + Text(row.point) + " by " + Text(row.step) +
         ", limits " + Text(row.limits);
}

// The true coordinates of point i, before any wrapping.
std::array<std::int64_t, 3> PointOf(const Row& row, std::int64_t i) {
  return {row.point.x + i * row.step.x, row.point.y + i * row.step.y, row.point.z + i * row.step.z};
}

bool Wraps(const Row& row, std::int64_t i) {
  const auto point = PointOf(row, i);
  return std::any_of(point.begin(), point.end(),
                     [](std::int64_t place) { return place < kLowest || place > kHighest; });
}

bool IsInside(const Row& row, std::int64_t i) {
  const auto [x, y, z] = PointOf(row, i);
  return x >= 0 && x < row.limits.x && y >= 0 && y < row.limits.y && z >= 0 && z < row.limits.z;
}

// What a row of few points comes to. Whether the place behind the last point wraps does not matter
// to anyone: it may go either way.
enum class Outcome { None, Empty, Some };

Outcome CheckAgainstEveryPoint(const Row& row) {
  const auto range = vorl_detail::FindInside(row.limits, row.point, row.step, row.width);
  const auto width = static_cast<std::int64_t>(row.width);
  bool pointsWrap = false;
  for (std::int64_t i = 0; i < width; ++i) {
    pointsWrap = pointsWrap || Wraps(row, i);
  }
  if (!range) {
    EXPECT_TRUE(Wraps(row, width)) << Text(row);
    return Outcome::None;
  }
  EXPECT_FALSE(pointsWrap) << Text(row);
  EXPECT_TRUE(range->begin >= 0 && range->begin <= range->end && range->end <= width) << Text(row);
  for (std::int64_t i = 0; i < width; ++i) {
    EXPECT_EQ(i >= range->begin && i < range->end, IsInside(row, i))
        << "point " << i << " of " << Text(row);
  }
  return range->begin < range->end ? Outcome::Some : Outcome::Empty;
}

std::int32_t RandomPlace(std::mt19937& random) {
  switch (random() % 8) {
    case 0:
      return static_cast<std::int32_t>(kLowest + random() % 3);
    case 1:
      return static_cast<std::int32_t>(kHighest - random() % 3);
    case 2:
      return static_cast<std::int32_t>(random());
    case 3:
      return static_cast<std::int32_t>(random() % 5) - 2;
    default:
      return static_cast<std::int32_t>(random() % (20 * 65536)) - 4 * 65536;
  }
}

std::int32_t RandomStep(std::mt19937& random) {
  switch (random() % 8) {
    case 0:
      return 0;
    case 1:
      return random() % 2 != 0 ? 65536 : -65536;
    case 2:
      return static_cast<std::int32_t>(random() % 7) - 3;
    case 3:
      return RandomPlace(random);
    case 4:
      return static_cast<std::int32_t>(random()) / 16;
    default:
      return static_cast<std::int32_t>(random() % (2 * 65536)) - 65536;
  }
}

std::int32_t RandomLimit(std::mt19937& random) {
  switch (random() % 8) {
    case 0:
      return RandomPlace(random);  // as wrapped sizes are
    case 1:
      return 32767 * 65536;
    case 2:
      return 0;
    default:
      return static_cast<std::int32_t>(random() % 16 + 1) * 65536;
  }
}

TEST(FindInside, FindsThePointsThatALookAtEachFinds) {
  constexpr unsigned kSeed = 11;
  SCOPED_TRACE("seed " + std::to_string(kSeed));
  std::mt19937 random(kSeed);
  std::array<int, 3> outcomes{};
  for (int i = 0; i < 40000 && !testing::Test::HasFailure(); ++i) {
    Row row;
    for (const auto axis : {&FixedVector::x, &FixedVector::y, &FixedVector::z}) {
      row.limits.*axis = RandomLimit(random);
      row.point.*axis = RandomPlace(random);
      row.step.*axis = RandomStep(random);
      if (random() % 2 != 0) {  // inside for the whole row, so that the other axes decide
        row.limits.*axis = 65536;
        row.point.*axis = static_cast<std::int32_t>(random() % 65536);
        row.step.*axis = 0;
      }
    }
    row.width = random() % 40;
    ++outcomes[static_cast<std::size_t>(CheckAgainstEveryPoint(row))];
  }
  for (const int count : outcomes) {
    EXPECT_GT(count, 2000) << "too few to tell";
  }
}

// The limits are met exactly: the last point before, on and behind each.
TEST(FindInside, CutsAtTheVoxelsOuterBorders) {
  for (const std::int32_t step : {1, 2, 3, 65535, 65536, 65537, 131072}) {
    for (const int points : {1, 2, 7}) {
      for (const int off : {-1, 0, 1}) {
        for (const int sign : {1, -1}) {
          Row row{{10 * 65536, 65536, 65536}, {}, {sign * step, 0, 0}, 12};
          const std::int32_t from = (sign > 0 ? 0 : row.limits.x - 1) + off;
          row.point.x = from - sign * points * step;  // point number `points` lies at `from`
          CheckAgainstEveryPoint(row);
          const std::int32_t to = (sign > 0 ? row.limits.x : -1) + off;
          row.point.x = to - sign * points * step;
          CheckAgainstEveryPoint(row);
        }
      }
    }
  }
}

void ExpectRange(const Row& row, std::int32_t begin, std::int32_t end) {
  const auto range = vorl_detail::FindInside(row.limits, row.point, row.step, row.width);
  ASSERT_TRUE(range) << Text(row);
  EXPECT_EQ(range->begin, begin) << Text(row);
  EXPECT_EQ(range->end, end) << Text(row);
}

TEST(FindInside, RowsWithoutPointsAreEmpty) {
  ExpectRange({{65536, 65536, 65536}, {0, 0, 0}, {65536, 0, 0}, 0}, 0, 0);
  ExpectRange({{65536, 65536, 65536}, {INT32_MAX, INT32_MIN, 0}, {INT32_MAX, INT32_MIN, 1}, 0}, 0,
              0);
}

TEST(FindInside, RowsAsLongAsTheyCanBe) {
  const FixedVector one{65536, 65536, 65536};
  const FixedVector all{INT32_MAX, INT32_MAX, INT32_MAX};
  constexpr std::size_t kMost = INT32_MAX;
  ExpectRange({one, {0, 0, 65535}, {0, 0, 0}, kMost}, 0, INT32_MAX);
  ExpectRange({one, {0, 0, 65536}, {0, 0, 0}, kMost}, 0, 0);
  ExpectRange({one, {-3, 0, 0}, {1, 0, 0}, kMost}, 3, 65539);
  ExpectRange({all, {INT32_MAX, 0, 0}, {-1, 0, 0}, kMost}, 1, INT32_MAX);
  ExpectRange({all, {0, INT32_MIN, 0}, {0, 2, 0}, kMost}, 1 << 30, INT32_MAX);
  EXPECT_FALSE(vorl_detail::FindInside(one, {}, {}, kMost + 1)) << "more than a range can hold";
  EXPECT_FALSE(vorl_detail::FindInside(one, {}, {}, std::numeric_limits<std::size_t>::max()));
}

TEST(FindInside, WrappingOnOneAxisIsEnough) {
  const FixedVector limits{65536, 65536, 65536};
  for (const auto axis : {&FixedVector::x, &FixedVector::y, &FixedVector::z}) {
    for (const std::int32_t sign : {1, -1}) {
      FixedVector step;
      step.*axis = sign * (1 << 28);
      EXPECT_TRUE(vorl_detail::FindInside(limits, {}, step, 7));
      EXPECT_FALSE(vorl_detail::FindInside(limits, {}, step, 9)) << sign;
    }
  }
}

TEST(FindInside, LimitsOfZeroAndLessHoldNothing) {
  for (const std::int32_t limit : {0, -1, -65536, INT32_MIN}) {
    for (const std::int32_t step : {-65536, -1, 0, 1, 65536}) {
      for (const std::int32_t start : {-65537, -2, -1, 0, 1, 65536}) {
        CheckAgainstEveryPoint({{limit, 65536, 65536}, {start, 0, 0}, {step, 0, 0}, 20});
        CheckAgainstEveryPoint({{65536, 65536, limit}, {0, 0, start}, {0, 0, step}, 20});
      }
    }
  }
}

// ---- VolumeGrid ------------------------------------------------------------------------------

// Slices at given addresses, which nobody reads.
class GridAt : public testing::Test {
 protected:
  void SetUp() override {
    if (sizeof(void*) < 8) {
      GTEST_SKIP() << "addresses of 32 bits are never too far apart";
    }
  }

  void AddSlice(std::uint64_t address, unsigned long width = 3, unsigned short alignment = 8) {
    dSlice slice;
    ASSERT_TRUE(
        slice.GetImage().Init(width, 2, ImageDataType_U16, "G", ImageDataOrder_Pixel, alignment));
    const unsigned long size = slice.GetImage().GetImageSize();
    ASSERT_GE(m_volume.AddSlice(slice), 0);
    void* const place = reinterpret_cast<void*>(static_cast<std::uintptr_t>(address));
    m_volume.GetSliceList().back().GetImage().GetDataBuffer().Init(place, size, DTM_Reference);
  }
  std::optional<VolumeGrid> Grid() const { return VolumeGrid::Of(VolumeView(m_volume)); }

  static constexpr std::uint64_t kFirst = 0x200000000000;
  static constexpr std::uint64_t kFarthest = std::uint64_t{1} << 32;  // 2^31 samples
  // Two rows, four samples apart.
  static constexpr std::uint64_t kRasterBytes = 16;

  dVolume m_volume;
};

TEST_F(GridAt, NamesEachSliceByItsDistanceFromTheFirst) {
  AddSlice(kFirst);
  AddSlice(kFirst + 1000);
  AddSlice(kFirst - 64);
  const auto grid = Grid();
  ASSERT_TRUE(grid);
  EXPECT_EQ(grid->Origin(), reinterpret_cast<void*>(std::uintptr_t{kFirst}));
  const std::int32_t expected[] = {0, 0, 500, -32, -32};
  for (int z = -1; z <= 3; ++z) {
    EXPECT_EQ(grid->Slices()[z], expected[z + 1]) << z;
  }
  EXPECT_EQ(grid->Width(), 3);
  EXPECT_EQ(grid->Height(), 2);
  EXPECT_EQ(grid->Pitch(), 4);
}

TEST_F(GridAt, SlicesAsFarBehindAsNumbersReach) {
  AddSlice(kFirst);
  AddSlice(kFirst + kFarthest - 2 - kRasterBytes);
  const auto grid = Grid();
  ASSERT_TRUE(grid);
  EXPECT_EQ(grid->Slices()[1], INT32_MAX - 8);
}

TEST_F(GridAt, NoneWhereTheLastSampleIsTooFarBehind) {
  AddSlice(kFirst);
  AddSlice(kFirst + kFarthest - kRasterBytes);
  EXPECT_FALSE(Grid());
}

TEST_F(GridAt, SlicesAsFarBeforeAsNumbersReach) {
  AddSlice(kFirst);
  AddSlice(kFirst - kFarthest);
  const auto grid = Grid();
  ASSERT_TRUE(grid);
  EXPECT_EQ(grid->Slices()[1], INT32_MIN);
}

TEST_F(GridAt, NoneWhereASliceIsTooFarBefore) {
  AddSlice(kFirst);
  AddSlice(kFirst + 64);
  AddSlice(kFirst - kFarthest - 2);
  EXPECT_FALSE(Grid());
}

TEST_F(GridAt, NoneWhereSlicesAreAtTheEndsOfMemory) {
  AddSlice(0x10000);
  AddSlice(0x7FFFFFFF0000);
  EXPECT_FALSE(Grid());
}

TEST_F(GridAt, NoneWhereSamplesLieBetweenSamples) {
  AddSlice(kFirst);
  AddSlice(kFirst + 1001);
  EXPECT_FALSE(Grid());
}

TEST_F(GridAt, NoneWithASingleColumn) {
  AddSlice(kFirst, 1);
  EXPECT_FALSE(Grid());
}

TEST_F(GridAt, TwoColumnsAreEnough) {
  AddSlice(kFirst, 2);
  EXPECT_TRUE(Grid());
}

}  // namespace
