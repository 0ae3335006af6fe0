#include <vorl/Operators/IP/kernels/VoxelClasses.h>

inline namespace vorl {
namespace vorl_detail {

namespace {

struct Interval {
  std::uint32_t first;
  std::uint32_t end;
};

// The part of [first, first + size) inside [0, length), less `leftOut` at the far end of the
// length.
Interval Clip(std::uint32_t first, std::uint32_t size, std::uint32_t length,
              std::uint32_t leftOut) {
  const std::uint64_t end = std::uint64_t{first} + size;
  const std::uint32_t last = length > leftOut ? length - leftOut : 0;
  return {first, static_cast<std::uint32_t>(std::min<std::uint64_t>(end, last))};
}

}  // namespace

VoxelBox::VoxelBox(const dVolume& volume, const dVOI* region, std::uint32_t neighbours) {
  const auto width = static_cast<std::uint32_t>(volume.GetSizeX());
  const auto height = static_cast<std::uint32_t>(volume.GetSizeY());
  const auto depth = static_cast<std::uint32_t>(volume.GetSizeZ());
  const dVOI box = region != nullptr ? *region : dVOI{0, 0, 0, width, height, depth};
  const Interval x = Clip(box.firstX, box.sizeX, width, neighbours);
  const Interval y = Clip(box.firstY, box.sizeY, height, neighbours);
  const Interval z = Clip(box.firstZ, box.sizeZ, depth, 0);
  firstX = x.first;
  endX = x.end;
  firstY = y.first;
  endY = y.end;
  firstZ = z.first;
  endZ = z.end;
}

}  // namespace vorl_detail
}  // namespace vorl
