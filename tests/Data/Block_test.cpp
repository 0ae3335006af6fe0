// Where blocks of memory lie, and which of them are used again.
#include <vorl/Data/detail/Block.h>

#include <gtest/gtest.h>

#include <cstdint>
#include <cstring>
#include <limits>
#include <set>
#include <thread>
#include <vector>

namespace {

using vorl_detail::AllocateBlock;
using vorl_detail::FreeBlock;

constexpr std::size_t kPicture = std::size_t{1} << 20;

std::uintptr_t AddressOf(const void* block) {
  return reinterpret_cast<std::uintptr_t>(block);
}

TEST(Block, LargeOnesBeginAtEveryCacheLineOfAPageInTurn) {
  std::vector<void*> blocks;
  std::set<std::uintptr_t> places;
  for (int i = 0; i < 64; ++i) {
    blocks.push_back(AllocateBlock(kPicture));
    ASSERT_NE(blocks.back(), nullptr);
    EXPECT_EQ(AddressOf(blocks.back()) % 64, 0U);
    places.insert(AddressOf(blocks.back()) % 4096);
  }
  EXPECT_GE(places.size(), 32U);  // one of them may have been kept from before
  for (void* const block : blocks) {
    FreeBlock(block);
  }
}

TEST(Block, SmallOnesAreAlignedForEveryType) {
  for (const std::size_t size : {0U, 1U, 17U, 65535U}) {
    void* const block = AllocateBlock(size);
    ASSERT_NE(block, nullptr);
    EXPECT_EQ(AddressOf(block) % alignof(std::max_align_t), 0U);
    std::memset(block, 1, size);
    FreeBlock(block);
  }
}

TEST(Block, NullIsFreedAndSizesBeyondMemoryAreRefused) {
  FreeBlock(nullptr);
  EXPECT_EQ(AllocateBlock(std::numeric_limits<std::size_t>::max()), nullptr);
  EXPECT_EQ(AllocateBlock(std::numeric_limits<std::size_t>::max() - 64), nullptr);
}

#if !defined(__SANITIZE_ADDRESS__)  // under which nothing is kept, so that late uses are noticed
TEST(Block, TheOneFreedLastServesTheNextOfItsSize) {
  void* const first = AllocateBlock(kPicture);
  void* const second = AllocateBlock(kPicture);
  FreeBlock(first);
  FreeBlock(second);
  void* const next = AllocateBlock(kPicture - 1000);
  EXPECT_EQ(next, second);
  void* const another = AllocateBlock(kPicture);
  EXPECT_NE(another, second);
  FreeBlock(next);
  FreeBlock(another);
}

TEST(Block, AKeptOneIsGivenToNobodyWhoWantsMoreOrFarLess) {
  void* const kept = AllocateBlock(kPicture);
  FreeBlock(kept);
  void* const larger = AllocateBlock(kPicture + 1);
  EXPECT_NE(larger, kept);
  std::memset(larger, 1, kPicture + 1);
  void* const smaller = AllocateBlock(kPicture / 2);
  EXPECT_NE(smaller, kept);
  void* const fitting = AllocateBlock(kPicture - kPicture / 16);
  EXPECT_EQ(fitting, kept) << "it was still there";
  FreeBlock(larger);
  FreeBlock(smaller);
  FreeBlock(fitting);
}

TEST(Block, OnesOfOtherSizesAreNotKept) {
  void* const kept = AllocateBlock(kPicture);
  FreeBlock(kept);
  for (const std::size_t size : {std::size_t{100000}, (std::size_t{1} << 26) + 1}) {
    FreeBlock(AllocateBlock(size));
  }
  void* const next = AllocateBlock(kPicture);
  EXPECT_EQ(next, kept);
  FreeBlock(next);
}
#endif

TEST(Block, NoneIsGivenToTwoThreads) {
  std::vector<std::thread> threads;
  std::vector<int> faults(4);
  for (int id = 0; id < 4; ++id) {
    threads.emplace_back([id, &fault = faults[static_cast<std::size_t>(id)]] {
      for (int i = 0; i < 500; ++i) {
        auto* const block = static_cast<unsigned char*>(AllocateBlock(std::size_t{1} << 17));
        std::memset(block, id, std::size_t{1} << 17);
        std::this_thread::yield();
        for (std::size_t at = 0; at < std::size_t{1} << 17; at += 4000) {
          fault += block[at] != id ? 1 : 0;
        }
        FreeBlock(block);
      }
    });
  }
  for (std::thread& thread : threads) {
    thread.join();
  }
  EXPECT_EQ(faults, std::vector<int>(4));
}

}  // namespace
