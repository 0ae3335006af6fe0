#include <vorl/Data/detail/Block.h>

#include <atomic>
#include <cstdint>
#include <cstdlib>
#include <cstring>
#include <limits>

inline namespace vorl {
namespace vorl_detail {

namespace {

constexpr std::size_t kCacheLine = 64;
constexpr std::size_t kLinesPerPage = 64;
/// From here on a block is large: its head does not weigh.
constexpr std::size_t kLargeBlock = std::size_t{1} << 16;
constexpr std::size_t kSmallHead = alignof(std::max_align_t);

/// Blocks of such sizes are kept once they are freed.
constexpr std::size_t kSmallestKept = std::size_t{1} << 17;
constexpr std::size_t kLargestKept = std::size_t{1} << 26;

/// Stands in front of a block.
struct Head {
  std::uint64_t offset;  ///< how far the allocation begins before the block
  std::uint64_t size;    ///< what the block holds
};
static_assert(sizeof(Head) <= kSmallHead);

Head HeadOf(const void* block) {
  Head head;
  std::memcpy(&head, static_cast<const unsigned char*>(block) - sizeof(head), sizeof(head));
  return head;
}

void Release(void* block) {
  if (block != nullptr) {
    std::free(static_cast<unsigned char*>(block) - HeadOf(block).offset);
  }
}

#if defined(__SANITIZE_ADDRESS__)
// A block that is used after it was freed is to be noticed.
void* TakeKept(std::size_t) {
  return nullptr;
}
void Keep(void* block) {
  Release(block);
}
#else
/// The block that was freed last, if it is worth keeping.
std::atomic<void*> g_kept{nullptr};

void Keep(void* block) {
  Release(g_kept.exchange(block, std::memory_order_acq_rel));
}

/// The kept block, when it holds `size` bytes and not many more.
void* TakeKept(std::size_t size) {
  if (size < kSmallestKept || size > kLargestKept) {
    return nullptr;
  }
  void* const block = g_kept.exchange(nullptr, std::memory_order_acq_rel);
  if (block == nullptr) {
    return nullptr;
  }
  const std::uint64_t held = HeadOf(block).size;
  if (held >= size && held - size <= size / 8) {
    return block;
  }
  Keep(block);
  return nullptr;
}
#endif

std::size_t NextStagger() {
  static std::atomic<std::uint32_t> count{0};
  return count.fetch_add(1, std::memory_order_relaxed) % kLinesPerPage * kCacheLine;
}

}  // namespace

void* AllocateBlock(std::size_t size) {
  if (void* const kept = TakeKept(size)) {
    return kept;
  }
  const bool isLarge = size >= kLargeBlock;
  const std::size_t stagger = isLarge ? kCacheLine + NextStagger() : 0;
  const std::size_t room = isLarge ? stagger + kCacheLine : kSmallHead;
  if (size > std::numeric_limits<std::size_t>::max() - room) {
    return nullptr;
  }
  auto* const allocation = static_cast<unsigned char*>(std::malloc(size + room));
  if (allocation == nullptr) {
    return nullptr;
  }
  const auto address = reinterpret_cast<std::uintptr_t>(allocation);
  const std::size_t offset =
      isLarge ? stagger + (kCacheLine - address % kCacheLine) % kCacheLine : kSmallHead;
  const Head head{offset, size};
  std::memcpy(allocation + offset - sizeof(head), &head, sizeof(head));
  return allocation + offset;
}

void FreeBlock(void* block) {
  if (block == nullptr) {
    return;
  }
  const std::uint64_t size = HeadOf(block).size;
  if (size >= kSmallestKept && size <= kLargestKept) {
    Keep(block);
  } else {
    Release(block);
  }
}

}  // namespace vorl_detail
}  // namespace vorl
