#include <vorl/Operators/IP/kernels/VolumeView.h>

#include <algorithm>

#include <vorl/Operators/IP/kernels/ImageCheck.h>

inline namespace vorl {
namespace vorl_detail {

namespace {

constexpr std::uint64_t kSampleBytes = 2;

// Size and format; rows may be padded otherwise.
bool IsLikeFirst(const dImage& image, const dImage& first) {
  return image.GetWidth() == first.GetWidth() && image.GetHeight() == first.GetHeight() &&
         image.GetFormatID() == first.GetFormatID();
}

// The bytes from the first pixel to the last one, of an image whose rows are that far apart.
std::uint64_t RasterBytes(const dImage& image, std::uint64_t bytesPerRow) {
  const std::uint64_t height = image.GetHeight();
  return (height > 0 ? bytesPerRow * (height - 1) : 0) + kSampleBytes * image.GetWidth();
}

}  // namespace

VolumeView::VolumeView(const dVolume& volume)
    : m_width(volume.GetSizeX()),
      m_height(volume.GetSizeY()),
      m_depth(volume.GetSizeZ()),
      m_pitch(0),
      m_limitX(FixedSize(volume.GetSizeX())),
      m_limitY(FixedSize(volume.GetSizeY())),
      m_limitZ(FixedSize(volume.GetSizeZ())) {
  const auto& slices = volume.GetSliceList();
  const dImage& first = slices.front().GetImage();
  m_pitch = static_cast<std::int32_t>(first.GetDataSamplesPerRow());

  m_slices.reserve(slices.size() + 2);
  m_slices.push_back(first.GetDataPtr());
  for (const dSlice& slice : slices) {
    const dImage& image = slice.GetImage();
    // Some kernels walk a slice's own rows, some those of the first slice.
    const std::uint64_t neededBytes =
        RasterBytes(image, std::max(image.GetBytesPerRow(), first.GetBytesPerRow()));
    if (!m_invalidSlice &&
        !(IsLikeFirst(image, first) && HoldsBytes(image, neededBytes, kSampleBytes))) {
      m_invalidSlice = static_cast<int>(m_slices.size()) - 1;
    }
    m_slices.push_back(image.GetDataPtr());
  }
  m_slices.push_back(m_slices.back());
}

bool CheckPixels(const VolumeView& view, dStatus& status) {
  const auto invalid = view.FindInvalidSlice();
  if (invalid) {
    status.Set(false, "invalid pixel data in slice %d of the Volume", *invalid);
  }
  return !invalid;
}

}  // namespace vorl_detail
}  // namespace vorl
