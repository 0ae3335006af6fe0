#include <vorl/Operators/IP/kernels/VolumeView.h>

#include <vorl/Operators/IP/kernels/ImageCheck.h>

inline namespace vorl {
namespace vorl_detail {

namespace {

constexpr std::uint64_t kSampleBytes = 2;

// The size in 16.16. A size of 32,768 or more wraps as the positions do; the limit is then at most
// the size, so nothing outside is ever read.
std::int32_t LimitOf(std::int32_t size) {
  return WrapMultiply(size, 65536);
}

// Size and format; rows may be padded otherwise.
bool IsLikeFirst(const dImage& image, const dImage& first) {
  return image.GetWidth() == first.GetWidth() && image.GetHeight() == first.GetHeight() &&
         image.GetFormatID() == first.GetFormatID();
}

}  // namespace

VolumeView::VolumeView(const dVolume& volume)
    : m_width(volume.GetSizeX()),
      m_height(volume.GetSizeY()),
      m_depth(volume.GetSizeZ()),
      m_pitch(0),
      m_limitX(LimitOf(volume.GetSizeX())),
      m_limitY(LimitOf(volume.GetSizeY())),
      m_limitZ(LimitOf(volume.GetSizeZ())) {
  const auto& slices = volume.GetSliceList();
  const dImage& first = slices.front().GetImage();
  m_pitch = static_cast<std::int32_t>(first.GetDataSamplesPerRow());
  const std::uint64_t lastRow =
      m_height > 0 ? std::uint64_t{first.GetBytesPerRow()} * static_cast<unsigned>(m_height - 1)
                   : 0;
  const std::uint64_t neededBytes = lastRow + kSampleBytes * static_cast<unsigned>(m_width);

  m_slices.reserve(slices.size() + 2);
  m_slices.push_back(first.GetDataPtr());
  for (const dSlice& slice : slices) {
    const dImage& image = slice.GetImage();
    if (!m_invalidSlice &&
        !(IsLikeFirst(image, first) && HoldsBytes(image, neededBytes, kSampleBytes))) {
      m_invalidSlice = static_cast<int>(m_slices.size()) - 1;
    }
    m_slices.push_back(image.GetDataPtr());
  }
  m_slices.push_back(m_slices.back());
}

bool CheckPixels(const dVolume& volume, dStatus& status) {
  const auto invalid = VolumeView(volume).FindInvalidSlice();
  if (invalid) {
    status.Set(false, "invalid pixel data in slice %d of the Volume", *invalid);
  }
  return !invalid;
}

}  // namespace vorl_detail
}  // namespace vorl
