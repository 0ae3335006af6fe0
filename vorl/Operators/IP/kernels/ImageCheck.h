#ifndef VORL_OPERATORS_IP_KERNELS_IMAGECHECK_H
#define VORL_OPERATORS_IP_KERNELS_IMAGECHECK_H

/// @file
/// Whether an image's buffer holds what its layout promises. It does, unless the application has
/// put another block under the image (see `dImage::GetDataBuffer`).

#include <vorl/Data/dImage.h>

#include <algorithm>
#include <cstdint>
#include <functional>

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

/// True when a byte of one image's pixels is one of the other's, too.
inline bool SharePixels(const dImage& a, const dImage& b) {
  const std::less<const unsigned char*> before;
  const auto* const firstOfA = static_cast<const unsigned char*>(a.GetDataPtr());
  const auto* const firstOfB = static_cast<const unsigned char*>(b.GetDataPtr());
  return before(firstOfA, firstOfB + b.GetImageSize()) &&
         before(firstOfB, firstOfA + a.GetImageSize());
}

}  // namespace vorl_detail
}  // namespace vorl

#endif
