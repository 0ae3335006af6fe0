#ifndef VORL_OPERATORS_IP_KERNELS_VOXELRUNS_H
#define VORL_OPERATORS_IP_KERNELS_VOXELRUNS_H

/// @file
/// The inner loops of voxel classification: one run of voxels each. VoxelClasses.h says what a
/// class is.
///
/// The functions named `...Ref` are the plain references that say what is true; the variants behind
/// `VoxelKernels` equal them bit for bit.

#include <vorl/Platform/detail/Cpu.h>

#include <cstddef>
#include <cstdint>
#include <memory>

inline namespace vorl {
namespace vorl_detail {

/// classes[i] = the edge class of voxels[i] (see `EdgeClass`), with voxels[i + 1] and below[i] its
/// neighbours: one voxel more than `count` is read. Signed voxels and classes are passed by their
/// bits.
using EdgeClassRun = void(const std::uint16_t* voxels, const std::uint16_t* below,
                          std::size_t count, std::uint16_t* classes);
void EdgeClassRunRef(const std::uint16_t* voxels, const std::uint16_t* below, std::size_t count,
                     std::uint16_t* classes);

/// A range of 16-bit values that may wrap: `first` and the `above` values that follow.
struct ClassRange {
  std::uint16_t first;
  std::uint16_t above;
};

/// Writes base | (firstX + i) for each i with a class in the range, as far as there is room for
/// entries; returns how many were written.
using SelectRun = std::size_t(const std::uint16_t* classes, std::size_t count, ClassRange range,
                              std::uint32_t base, std::uint32_t firstX, unsigned char* entries,
                              std::size_t room);
std::size_t SelectRunRef(const std::uint16_t* classes, std::size_t count, ClassRange range,
                         std::uint32_t base, std::uint32_t firstX, unsigned char* entries,
                         std::size_t room);

/// One variant of each loop.
struct VoxelKernels {
  EdgeClassRun* edgeClasses;
  SelectRun* select;
};

/// The loops of a variant that can run here (see `CanRun`).
const VoxelKernels& VoxelKernelsOf(CpuVariant variant);

/// The loops of the active variant.
const VoxelKernels& ActiveVoxelKernels();

/// Counts how often each 16-bit value occurs. Each count is kept in two parts, so that a value need
/// not wait for the count of an equal one before it; sixteen equal neighbours are counted at once.
class ValueCounter {
 public:
  /// For about so many values. For fewer than make up for clearing the counts and adding them up,
  /// and without memory for them, the counter is not valid and must not be used.
  explicit ValueCounter(std::uint64_t expected);
  bool IsValid() const { return m_counts != nullptr; }

  void Count(const std::uint16_t* values, std::size_t count);
  /// Calls `visit(value, times)` for each value that occurred; the number of times is up to 32
  /// bits, wrapping.
  template <class Visit>
  void ForEach(Visit&& visit) const {
    for (std::size_t i = 0; i < kValues; ++i) {
      const std::uint32_t times = m_counts[i] + m_counts[kValues + i];
      if (times != 0) {
        visit(static_cast<std::uint16_t>(i), times);
      }
    }
  }

 private:
  static constexpr std::size_t kValues = 65536;
  static constexpr std::uint64_t kWorthwhile = 131072;

  std::unique_ptr<std::uint32_t[]> m_counts;
};

}  // namespace vorl_detail
}  // namespace vorl

#endif
