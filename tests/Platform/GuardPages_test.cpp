// What other tests rely on: memory between guard pages ends where it should.
#include <tests/Support/GuardPages.h>

#include <gtest/gtest.h>

#include <cstddef>
#include <cstring>

namespace {

// Bytes: within a page, exactly one, and more.
constexpr std::size_t kSizes[] = {1, 100, 4096, 20001};

TEST(GuardPages, BlocksAreOpenFromEndToEnd) {
  for (const std::size_t size : kSizes) {
    for (const GuardPages::Side side : GuardPages::kSides) {
      const GuardPages block(size, side);
      std::memset(block.Data(), 7, size);
      EXPECT_EQ(static_cast<unsigned char*>(block.Data())[size - 1], 7);
    }
  }
}

#if GTEST_HAS_DEATH_TEST

void Touch(const GuardPages& block, std::ptrdiff_t offset) {
  static_cast<volatile unsigned char*>(block.Data())[offset] = 1;
}

TEST(GuardPagesDeathTest, TheByteBehindABlockIsClosed) {
  GTEST_FLAG_SET(death_test_style, "threadsafe");
  for (const std::size_t size : kSizes) {
    const GuardPages block(size, GuardPages::Side::Behind);
    EXPECT_DEATH(Touch(block, static_cast<std::ptrdiff_t>(size)), "") << size;
  }
}

TEST(GuardPagesDeathTest, TheByteBeforeABlockIsClosed) {
  GTEST_FLAG_SET(death_test_style, "threadsafe");
  for (const std::size_t size : kSizes) {
    const GuardPages block(size, GuardPages::Side::Before);
    EXPECT_DEATH(Touch(block, -1), "") << size;
  }
}

#endif

}  // namespace
