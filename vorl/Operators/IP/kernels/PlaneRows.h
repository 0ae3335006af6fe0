#ifndef VORL_OPERATORS_IP_KERNELS_PLANEROWS_H
#define VORL_OPERATORS_IP_KERNELS_PLANEROWS_H

/// @file
/// The rows of sampling points that reconstruction and projection are made of, without a test per
/// sample: a row is cut once to the points inside the volume, and a kernel samples those.
///
/// The results equal those of the plain loops (Mpr.h, Mip.h) bit for bit.

#include <vorl/Operators/IP/kernels/VolumeView.h>
#include <vorl/Platform/detail/Cpu.h>

#include <cstddef>
#include <cstdint>
#include <optional>
#include <vector>

inline namespace vorl {
namespace vorl_detail {

/// Points `begin` to, but not including, `end` of a row.
struct PointRange {
  std::int32_t begin;
  std::int32_t end;
};

/// The points point + i * step, 0 <= i < width, that lie inside the volume. None when a coordinate
/// wraps at 32 bits on the way, so that the points inside need not be neighbours.
std::optional<PointRange> FindInside(const FixedVector& limits, const FixedVector& point,
                                     const FixedVector& step, std::size_t width);

/// True when all start + i * step, 0 <= i < count, lie in [0, limit) and nothing wraps up to the
/// one behind them.
inline bool StaysInside(std::int64_t start, std::int64_t step, std::int64_t count,
                        std::int64_t limit) {
  const std::int64_t end = start + step * count;
  const std::int64_t last = end - step;
  return start >= 0 && start < limit && last >= 0 && last < limit &&
         static_cast<std::int32_t>(end) == end;
}

/// True for rows all of which `FindInside` finds inside, as it does for most: these are not worth a
/// call. False for some of them, too, that are long.
inline bool IsRowInside(const FixedVector& limits, const FixedVector& point,
                        const FixedVector& step, std::size_t width) {
  const auto count = static_cast<std::int64_t>(width & 0xFFFF);
  return width - 1 < 0xFFFF && StaysInside(point.x, step.x, count, limits.x) &&
         StaysInside(point.y, step.y, count, limits.y) &&
         StaysInside(point.z, step.z, count, limits.z);
}

/// A volume whose samples are addressed by 32-bit numbers of samples from its first slice.
class VolumeGrid {
 public:
  /// Such a grid; none when slices lie too far apart, or a slice has less than two columns.
  static std::optional<VolumeGrid> Of(const VolumeView& view);

  /// The first sample of slice 0.
  const void* Origin() const { return m_origin; }
  /// The place of each slice's first sample, from -1 to the number of slices; the outer two are
  /// those of the first and the last slice.
  const std::int32_t* Slices() const { return m_slices.data() + 1; }
  std::int32_t Width() const { return m_width; }
  std::int32_t Height() const { return m_height; }
  /// Samples from one row to the next.
  std::int32_t Pitch() const { return m_pitch; }

 private:
  explicit VolumeGrid(const VolumeView& view);

  const void* m_origin;
  std::vector<std::int32_t> m_slices;
  std::int32_t m_width;
  std::int32_t m_height;
  std::int32_t m_pitch;
};

/// What becomes of the samples of a row.
enum class RowSink {
  Store,    ///< the row's pixels, of the volume's type
  Maximum,  ///< raises numbers of 32 bits
  Sum       ///< is added to numbers of 32 bits, wrapping
};

/// Samples `count` points inside the volume and hands them to the sink's row.
using SampleRun = void(const VolumeGrid& grid, const FixedVector& point, const FixedVector& step,
                       std::size_t count, RowSink sink, void* row);

/// Four rows of voxels.
struct RowSources {
  const void* rows[4];
};

/// Raises a row of `count` samples to those of four rows, and fetches those that come next.
using RowRaise = void(void* row, const RowSources& sources, const RowSources& next,
                      std::size_t count);

/// For each of `count` points of one x inside the volume: the largest voxel of its row of voxels in
/// some ranges of columns, at least 0.
using RowLargest = void(const VolumeGrid& grid, const FixedVector& point, const FixedVector& step,
                        std::size_t count, const PointRange* columns, std::size_t ranges,
                        void* row);

/// One variant of each loop: for unsigned and for signed samples.
struct PlaneKernels {
  SampleRun* nearest[2];
  SampleRun* linear[2];
  RowRaise* raiseRow[2];
  RowLargest* largestInRows[2];
};

/// The loops of a variant that can run here (see `CanRun`). Null for the reference, which has none:
/// it tests every sample.
const PlaneKernels* PlaneKernelsOf(CpuVariant variant);

}  // namespace vorl_detail
}  // namespace vorl

#endif
