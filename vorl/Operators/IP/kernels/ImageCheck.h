#ifndef VORL_OPERATORS_IP_KERNELS_IMAGECHECK_H
#define VORL_OPERATORS_IP_KERNELS_IMAGECHECK_H

/// @file
/// Whether an image's buffer holds what its layout promises. It does, unless the application has
/// put another block under the image (see `dImage::GetDataBuffer`).

#include <vorl/Data/dImage.h>

#include <algorithm>
#include <cstdint>

inline namespace vorl {
namespace vorl_detail {

/// True when there are at least `count` bytes, aligned for samples of `sampleBytes`.
inline bool HoldsBytes(const dImage& image, std::uint64_t count, std::uint64_t sampleBytes) {
  return image.IsValid() && image.GetImageSize() >= count &&
         reinterpret_cast<std::uintptr_t>(image.GetDataPtr()) % sampleBytes == 0;
}

/// True when every row of every plane is there.
inline bool HoldsRows(const dImage& image) {
  return HoldsBytes(image, std::uint64_t{image.GetBytesPerRow()} * image.GetNumRows(),
                    std::max(image.GetChannelDepth() / 8U, 1U));
}

}  // namespace vorl_detail
}  // namespace vorl

#endif
