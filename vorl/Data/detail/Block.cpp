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

/// In front of a block stands how far the allocation begins before it.
using Head = std::uint64_t;
static_assert(sizeof(Head) <= kSmallHead);

std::size_t NextStagger() {
  static std::atomic<std::uint32_t> count{0};
  return count.fetch_add(1, std::memory_order_relaxed) % kLinesPerPage * kCacheLine;
}

}  // namespace

void* AllocateBlock(std::size_t size) {
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
  const Head head =
      isLarge ? stagger + (kCacheLine - address % kCacheLine) % kCacheLine : kSmallHead;
  std::memcpy(allocation + head - sizeof(head), &head, sizeof(head));
  return allocation + head;
}

void FreeBlock(void* block) {
  if (block == nullptr) {
    return;
  }
  Head head = 0;
  auto* const bytes = static_cast<unsigned char*>(block);
  std::memcpy(&head, bytes - sizeof(head), sizeof(head));
  std::free(bytes - head);
}

}  // namespace vorl_detail
}  // namespace vorl
