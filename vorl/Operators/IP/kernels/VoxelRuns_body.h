// The loops of voxel classification for one set of vector instructions. A variant's source includes
// this once, having defined in its anonymous namespace `Classes`, a register of 16-bit values.
//
// They call nothing that is inline elsewhere: it might be compiled here for a machine that others
// do not have, and kept as the one copy for all.

#include <vorl/Operators/IP/kernels/VoxelRuns.h>

inline namespace vorl {
namespace vorl_detail {
namespace {

// What the loops read comes from memory, which they are fast enough to wait for. Past the end
// nothing is read.
void AskAhead(const std::uint16_t* values) {
  constexpr std::uintptr_t kAhead = 2048;
  __builtin_prefetch(
      reinterpret_cast<const void*>(reinterpret_cast<std::uintptr_t>(values) + kAhead));
}

void EdgeClasses(const std::uint16_t* voxels, const std::uint16_t* below, std::size_t count,
                 std::uint16_t* classes) {
  std::size_t i = 0;
  for (; i + Classes::kCount <= count; i += Classes::kCount) {
    AskAhead(below + i);
    const Classes lower = Classes::Load12(voxels + i + 1).Min(Classes::Load12(below + i));
    Classes::Load12(voxels + i).Subtract(lower).Store(classes + i);
  }
  EdgeClassRunRef(voxels + i, below + i, count - i, classes + i);
}

// A whole register's entries are only written where there is room for all of them.
std::size_t Select(const std::uint16_t* classes, std::size_t count, ClassRange range,
                   std::uint32_t base, std::uint32_t firstX, unsigned char* entries,
                   std::size_t room) {
  const Classes first = Classes::All(range.first);
  const Classes above = Classes::All(range.above);
  std::size_t written = 0;
  std::size_t i = 0;
  for (; i + Classes::kCount <= count && written + Classes::kCount <= room; i += Classes::kCount) {
    AskAhead(classes + i);
    const std::uint32_t chosen = Classes::Load(classes + i).Subtract(first).IsAtMost(above);
    if (chosen != 0) {
      written += Classes::WriteEntries(chosen, base, firstX + static_cast<std::uint32_t>(i),
                                       entries + 4 * written);
    }
  }
  return written + SelectRunRef(classes + i, count - i, range, base,
                                firstX + static_cast<std::uint32_t>(i), entries + 4 * written,
                                room - written);
}

constexpr VoxelKernels kKernels = {&EdgeClasses, &Select};

}  // namespace
}  // namespace vorl_detail
}  // namespace vorl
