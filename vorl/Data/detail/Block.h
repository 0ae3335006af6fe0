#ifndef VORL_DATA_DETAIL_BLOCK_H
#define VORL_DATA_DETAIL_BLOCK_H

/// @file
/// Blocks of memory that do not all begin at the same place of a page, and do not come and go
/// needlessly.

#include <cstddef>

inline namespace vorl {
namespace vorl_detail {

/// A block of `size` bytes with undefined content, or null when there is no memory.
///
/// Allocators place every large block at the same offset of a page. Pixels above each other in the
/// slices of a volume then compete for the same few lines of a cache. Large blocks are therefore
/// staggered by cache lines, each by one more than the one before.
///
/// New memory costs a page fault for every page, more than most work on its pixels. The block that
/// was freed last is therefore kept, up to 64 MB, and given to the next who wants about as much: an
/// operator that makes a new image of every frame then works in the same two blocks.
void* AllocateBlock(std::size_t size);

/// Frees a block of `AllocateBlock`; null is ignored.
void FreeBlock(void* block);

}  // namespace vorl_detail
}  // namespace vorl

#endif
