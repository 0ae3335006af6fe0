#include <vorl/Operators/IP/kernels/PlaneRows.h>

#include <algorithm>
#include <limits>

inline namespace vorl {
namespace vorl_detail {

namespace {

constexpr std::int64_t kLowest = std::numeric_limits<std::int32_t>::min();
constexpr std::int64_t kHighest = std::numeric_limits<std::int32_t>::max();

std::int64_t FloorDivide(std::int64_t dividend, std::int64_t divisor) {
  const std::int64_t quotient = dividend / divisor;
  return quotient - ((dividend % divisor != 0 && (dividend < 0) != (divisor < 0)) ? 1 : 0);
}

// Cuts [begin, end) to the points with 0 <= start + i * step < limit.
void Cut(std::int64_t start, std::int64_t step, std::int64_t limit, std::int64_t& begin,
         std::int64_t& end) {
  const std::int64_t first = start + begin * step;
  const std::int64_t last = start + (end - 1) * step;
  if (first >= 0 && first < limit && last >= 0 && last < limit) {
    return;  // the usual case, which needs no division
  }
  if (step < 0) {  // the same points with the axis turned round
    start = limit - 1 - start;
    step = -step;
  }
  if (step == 0) {
    if (start < 0 || start >= limit) {
      end = begin;
    }
    return;
  }
  begin = std::max(begin, -FloorDivide(start, step));
  end = std::min(end, FloorDivide(limit - 1 - start, step) + 1);
}

bool Wraps(std::int64_t start, std::int64_t step, std::int64_t width) {
  const std::int64_t last = start + step * width;
  return last < kLowest || last > kHighest;
}

}  // namespace

std::optional<PointRange> FindInside(const FixedVector& limits, const FixedVector& point,
                                     const FixedVector& step, std::size_t width) {
  const auto count = static_cast<std::int64_t>(width);
  if (width > std::size_t{kHighest} || Wraps(point.x, step.x, count) ||
      Wraps(point.y, step.y, count) || Wraps(point.z, step.z, count)) {
    return std::nullopt;
  }
  std::int64_t begin = 0;
  std::int64_t end = count;
  Cut(point.x, step.x, limits.x, begin, end);
  Cut(point.y, step.y, limits.y, begin, end);
  Cut(point.z, step.z, limits.z, begin, end);
  if (begin >= end) {
    return PointRange{0, 0};
  }
  return PointRange{static_cast<std::int32_t>(begin), static_cast<std::int32_t>(end)};
}

VolumeGrid::VolumeGrid(const VolumeView& view)
    : m_origin(view.Slice<std::uint16_t>(0)),
      m_width(view.Width()),
      m_height(view.Height()),
      m_pitch(view.Pitch()) {
  m_slices.reserve(static_cast<std::size_t>(view.Depth()) + 2);
}

std::optional<VolumeGrid> VolumeGrid::Of(const VolumeView& view) {
  VolumeGrid grid(view);
  if (view.Width() < 2) {
    return std::nullopt;
  }
  const auto origin = reinterpret_cast<std::intptr_t>(grid.m_origin);
  const std::int64_t samples = std::int64_t{std::max(view.Pitch(), view.Width())} * view.Height();
  for (std::int32_t z = -1; z <= view.Depth(); ++z) {
    const std::int64_t bytes =
        reinterpret_cast<std::intptr_t>(view.Slice<std::uint16_t>(z)) - origin;
    const std::int64_t place = bytes / 2;
    if (bytes % 2 != 0 || place < kLowest || place + samples > kHighest) {
      return std::nullopt;
    }
    grid.m_slices.push_back(static_cast<std::int32_t>(place));
  }
  return grid;
}

#if defined(VORL_X86_KERNELS)
extern const PlaneKernels kPlaneKernelsAvx2;
extern const PlaneKernels kPlaneKernelsAvx512;
#endif

const PlaneKernels* PlaneKernelsOf(CpuVariant variant) {
#if defined(VORL_X86_KERNELS)
  switch (variant) {
    case CpuVariant::Avx512:
      return &kPlaneKernelsAvx512;
    case CpuVariant::Avx2:
      return &kPlaneKernelsAvx2;
    case CpuVariant::Reference:
      break;
  }
#else
  static_cast<void>(variant);
#endif
  return nullptr;
}

}  // namespace vorl_detail
}  // namespace vorl
