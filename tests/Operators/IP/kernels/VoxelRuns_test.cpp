// Every variant of the loops of voxel classification that can run here gives the same bits as the
// definition, for every length up to four registers and one voxel more, and touches nothing beside
// its run; counting finds every value, however often it follows itself.
#include <vorl/Operators/IP/kernels/VoxelRuns.h>

#include <gtest/gtest.h>
#include <tests/Support/VariantTest.h>

#include <algorithm>
#include <cstring>
#include <map>
#include <memory>
#include <random>
#include <string>
#include <vector>

namespace {

using vorl_detail::ClassRange;
using vorl_detail::CpuVariant;
using vorl_detail::ValueCounter;

constexpr std::size_t kLongest = 4 * 32 + 1;  // four AVX-512 registers of 16-bit values, and one
constexpr std::size_t kGuard = 32;

class VoxelRuns : public VariantTest {
 protected:
  const vorl_detail::VoxelKernels& Kernels() const {
    return vorl_detail::VoxelKernelsOf(GetParam());
  }

  // On the heap and of that size alone: memory checkers see what is read behind it.
  std::unique_ptr<std::uint16_t[]> RandomValues(std::size_t count) {
    std::unique_ptr<std::uint16_t[]> values(new std::uint16_t[count]);
    std::generate_n(values.get(), count, [&] { return static_cast<std::uint16_t>(m_random()); });
    return values;
  }

  std::mt19937 m_random{401};
};

INSTANTIATE_TEST_SUITE_P(, VoxelRuns, testing::ValuesIn(vorl_detail::kCpuVariants), &VariantName);

TEST_P(VoxelRuns, EdgeClassesAreTheRiseAboveTheLowerNeighbour) {
  for (std::size_t count = 0; count <= kLongest; ++count) {
    const auto voxels = RandomValues(count + 1);
    const auto below = RandomValues(count);
    std::vector<std::uint16_t> expected(count + kGuard, 0xA5A5);
    for (std::size_t i = 0; i < count; ++i) {
      const int right = voxels[i + 1] % 4096;
      const int under = below[i] % 4096;
      const int rise = voxels[i] % 4096 - (right < under ? right : under);
      expected[i] = static_cast<std::uint16_t>(rise);
    }
    std::vector<std::uint16_t> classes(count + kGuard, 0xA5A5);
    Kernels().edgeClasses(voxels.get(), below.get(), count, classes.data());
    ASSERT_EQ(classes, expected) << count;
  }
}

// Ranges that hold none to all of the values, wrapped ones among them, and room for none, for some
// and for all of the entries.
TEST_P(VoxelRuns, SelectionListsTheColumnsInOrderAsFarAsThereIsRoom) {
  const std::uint16_t widths[] = {0, 600, 30000, 64000, 65535};
  for (std::size_t count = 0; count <= kLongest; ++count) {
    const auto classes = RandomValues(count);
    for (const std::uint16_t above : widths) {
      const ClassRange range{static_cast<std::uint16_t>(m_random()), above};
      const std::size_t room = m_random() % (count + 40);
      const std::uint32_t base = 77U << 22U | 1234U << 11U;
      const auto firstX = static_cast<std::uint32_t>(m_random() % 3000);
      std::vector<std::uint32_t> expected;
      for (std::size_t i = 0; i < count; ++i) {
        const int distance = classes[i] - range.first;
        if ((distance + 65536) % 65536 <= above && expected.size() < room) {
          expected.push_back(base | (firstX + static_cast<std::uint32_t>(i)));
        }
      }
      // One byte off: lists may lie anywhere.
      std::vector<unsigned char> bytes(1 + 4 * room + kGuard, 0xA5);
      const std::size_t written =
          Kernels().select(classes.get(), count, range, base, firstX, bytes.data() + 1, room);
      ASSERT_EQ(written, expected.size()) << count << " classes, room " << room;
      std::vector<std::uint32_t> entries(written);
      if (written != 0) {
        std::memcpy(entries.data(), bytes.data() + 1, 4 * written);
      }
      ASSERT_EQ(entries, expected) << count << " classes, room " << room;
      ASSERT_EQ(bytes[0], 0xA5);
      ASSERT_TRUE(std::all_of(bytes.begin() + 1 + static_cast<std::ptrdiff_t>(4 * room),
                              bytes.end(), [](unsigned char byte) { return byte == 0xA5; }));
    }
  }
}

void ExpectCounted(const std::vector<std::vector<std::uint16_t>>& runs) {
  ValueCounter counter(1000000);
  ASSERT_TRUE(counter.IsValid());
  std::map<int, std::uint32_t> expected;
  for (const auto& run : runs) {
    counter.Count(run.data(), run.size());
    for (const std::uint16_t value : run) {
      ++expected[value];
    }
  }
  std::map<int, std::uint32_t> counted;
  counter.ForEach([&](std::uint16_t value, std::uint32_t times) { counted[value] = times; });
  EXPECT_EQ(counted, expected);
}

TEST(ValueCounter, FewValuesAreNotWorthItsCounts) {
  EXPECT_FALSE(ValueCounter(0).IsValid());
  EXPECT_FALSE(ValueCounter(131071).IsValid());
  EXPECT_TRUE(ValueCounter(131072).IsValid());
}

TEST(ValueCounter, CountsRunsOfEveryLength) {
  std::mt19937 random(402);
  std::vector<std::vector<std::uint16_t>> runs;
  for (std::size_t count = 0; count <= 70; ++count) {
    auto& run = runs.emplace_back();
    std::generate_n(std::back_inserter(run), count,
                    [&] { return static_cast<std::uint16_t>(random() % 5 * 16383); });
  }
  ExpectCounted(runs);
}

// Sixteen that are equal are counted at once: one that differs, wherever it stands, is not missed.
TEST(ValueCounter, OneDifferentValueAmongEqualOnesIsSeen) {
  std::vector<std::vector<std::uint16_t>> runs;
  for (std::size_t place = 0; place < 48; ++place) {
    auto& run = runs.emplace_back(48, std::uint16_t{7});
    run[place] = static_cast<std::uint16_t>(100 + place);
  }
  ExpectCounted(runs);
  ExpectCounted({std::vector<std::uint16_t>(1000, 0), std::vector<std::uint16_t>(1000, 0xFFFF)});
}

// Four and four, or in turns, as no run of equal ones is.
TEST(ValueCounter, RepeatedGroupsAreNotRuns) {
  std::vector<std::uint16_t> inTurns;
  std::vector<std::uint16_t> fours;
  for (unsigned i = 0; i < 160; ++i) {
    inTurns.push_back(static_cast<std::uint16_t>(i % 2));
    fours.push_back(static_cast<std::uint16_t>(i / 4 % 3));
  }
  ExpectCounted({inTurns, fours});
}

}  // namespace
