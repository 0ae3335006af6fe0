// Every variant of the stretching loops that can run here gives the same bytes as the plain loops,
// for every length up to four registers and one unit more, enlarged, mirrored and reduced, and
// touches nothing beside its run.
#include <vorl/Platform/soft/StretchKernels.h>

#include <gtest/gtest.h>
#include <tests/Support/VariantTest.h>

#include <algorithm>
#include <memory>
#include <random>
#include <string>
#include <vector>

namespace {

using vorl_detail::CpuVariant;
using vorl_detail::GatherPlan;
using vorl_detail::PixelTable;

constexpr int kLongest = 4 * 64 + 1;  // four AVX-512 registers of bytes, and one byte
constexpr std::size_t kGuard = 64;

class StretchVariants : public VariantTest {
 protected:
  const vorl_detail::StretchKernels& Kernels() const {
    return vorl_detail::StretchKernelsOf(GetParam());
  }

  std::mt19937 m_random{2160};

  int Random(int end) { return static_cast<int>(m_random() % static_cast<unsigned>(end)); }

  // On the heap and of that size alone: memory checkers see what is read behind it.
  std::unique_ptr<std::uint8_t[]> RandomBytes(std::size_t count) {
    std::unique_ptr<std::uint8_t[]> bytes(new std::uint8_t[count]);
    std::generate_n(bytes.get(), count, [&] { return static_cast<std::uint8_t>(m_random()); });
    return bytes;
  }

  void ExpectGathered(const std::vector<int>& columns, int sourceCount, int bytes,
                      std::size_t misalignment) {
    const auto size = static_cast<std::size_t>(bytes);
    const auto source = RandomBytes(static_cast<std::size_t>(sourceCount) * size);
    std::vector<std::uint8_t> expected(kGuard + misalignment, 0xA5);
    for (const int column : columns) {
      const std::uint8_t* unit = source.get() + static_cast<std::size_t>(column) * size;
      expected.insert(expected.end(), unit, unit + size);
    }
    expected.insert(expected.end(), kGuard, 0xA5);
    std::vector<std::uint8_t> target(expected.size(), 0xA5);
    const GatherPlan plan(columns, sourceCount, bytes, Kernels());
    plan.Gather(source.get(), target.data() + kGuard + misalignment);
    ASSERT_EQ(target, expected) << columns.size() << " of " << sourceCount << " units of " << bytes
                                << " bytes, " << misalignment << " off";
    ExpectStreamed(plan, source.get(), bytes,
                   {expected.begin() + static_cast<std::ptrdiff_t>(kGuard + misalignment),
                    expected.end() - kGuard});
  }

  // Only to a cache line, and only where there is a loop for it.
  void ExpectStreamed(const GatherPlan& plan, const std::uint8_t* source, int bytes,
                      const std::vector<std::uint8_t>& expected) {
    std::vector<std::uint8_t> target(kGuard + expected.size() + 2 * kGuard, 0xA5);
    const auto address = reinterpret_cast<std::uintptr_t>(target.data());
    const std::size_t place = kGuard + (64 - address % 64) % 64;
    EXPECT_FALSE(plan.Stream(source, target.data() + place + 16));
    const bool canStream = GetParam() != CpuVariant::Reference && bytes == 4;
    ASSERT_EQ(plan.Stream(source, target.data() + place), canStream);
    Kernels().endStream();
    std::vector<std::uint8_t> whole(target.size(), 0xA5);
    if (canStream) {
      std::copy(expected.begin(), expected.end(),
                whole.begin() + static_cast<std::ptrdiff_t>(place));
    }
    ASSERT_EQ(target, whole) << expected.size() / 4 << " units";
  }
};

INSTANTIATE_TEST_SUITE_P(, StretchVariants, testing::ValuesIn(vorl_detail::kCpuVariants),
                         &VariantName);

// Of every count, from a few source units to more than are shown.
TEST_P(StretchVariants, StretchedRowsAreTheUnitsOfTheirColumns) {
  for (int bytes = 1; bytes <= 4; ++bytes) {
    for (int count = 1; count <= kLongest; ++count) {
      const int sourceCount = 1 + Random(2 * count);
      std::vector<int> columns;
      for (int i = 0; i < count; ++i) {
        columns.push_back(((2 * i + 1) * sourceCount - 1) / (2 * count));
      }
      if (count % 2 == 0) {
        std::reverse(columns.begin(), columns.end());
      }
      ExpectGathered(columns, sourceCount, bytes, static_cast<std::size_t>(count) % 67);
    }
  }
}

// No order, so that some blocks fit into a register and others do not.
TEST_P(StretchVariants, ColumnsNeedNoOrder) {
  for (const int bytes : {1, 4}) {
    for (int round = 0; round < 200; ++round) {
      const int sourceCount = 1 + Random(300);
      const int reach = 1 + Random(100);
      std::vector<int> columns(static_cast<std::size_t>(1 + Random(kLongest)));
      for (std::size_t i = 0; i < columns.size(); ++i) {
        columns[i] = (static_cast<int>(i) / 2 + Random(reach)) % sourceCount;
      }
      ExpectGathered(columns, sourceCount, bytes, 0);
    }
  }
}

TEST_P(StretchVariants, LastUnitsOfTheSourceAreReached) {
  for (const int bytes : {1, 4}) {
    for (int sourceCount = 1; sourceCount <= 130; ++sourceCount) {
      ExpectGathered(std::vector<int>(200, sourceCount - 1), sourceCount, bytes, 0);
    }
  }
}

TEST_P(StretchVariants, IndicesBecomeThePixelsOfTheTable) {
  enum { kGreys, kColours, kAllBytes, kTables };
  for (int kind = 0; kind < kTables; ++kind) {
    std::array<std::uint32_t, 256> pixels;
    for (std::uint32_t& pixel : pixels) {
      const auto random = static_cast<std::uint32_t>(m_random());
      pixel = kind == kGreys     ? (random & 0xFFU) * 0x010101U
              : kind == kColours ? random & 0xFFFFFFU
                                 : random;
    }
    const PixelTable table(pixels);
    for (std::size_t count = 0; count <= kLongest; ++count) {
      const auto source = RandomBytes(count);
      std::vector<std::uint8_t> expected(kGuard, 0xA5);
      for (std::size_t i = 0; i < count; ++i) {
        for (const unsigned shift : {0U, 8U, 16U, 24U}) {
          expected.push_back(static_cast<std::uint8_t>(pixels[source[i]] >> shift));
        }
      }
      expected.insert(expected.end(), kGuard, 0xA5);
      std::vector<std::uint8_t> target(expected.size(), 0xA5);
      Kernels().mapTo32(source.get(), target.data() + kGuard, count, table);
      ASSERT_EQ(target, expected) << "table " << kind << ", " << count << " samples";
    }
  }
}

TEST(PixelTable, OneColourAmongGreysIsNotGrey) {
  std::array<std::uint32_t, 256> pixels;
  for (std::uint32_t i = 0; i < 256; ++i) {
    pixels[i] = i * 0x010101U;
  }
  EXPECT_TRUE(PixelTable(pixels).isGrey);
  for (const std::uint32_t bit : {0x1U, 0x100U, 0x10000U}) {
    pixels[200] ^= bit;
    EXPECT_FALSE(PixelTable(pixels).isGrey) << bit;
    EXPECT_TRUE(PixelTable(pixels).topIsZero) << bit;
    pixels[200] ^= bit;
  }
  pixels[200] ^= 0x1000000U;
  EXPECT_FALSE(PixelTable(pixels).isGrey);
  EXPECT_FALSE(PixelTable(pixels).topIsZero);
}

}  // namespace
