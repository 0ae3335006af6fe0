#include <vorl/Operators/IP/kernels/VolumeView.h>

#include <algorithm>
#include <cstdint>

inline namespace vorl {
namespace vorl_detail {

namespace {

constexpr std::uint64_t kSampleBytes = 2;

// What a slice must have in common with slice 0, and how far its pixels must reach. Slices are many
// and a plane through them is done in little time: each is asked nothing twice.
class SliceCheck {
 public:
  explicit SliceCheck(const dImage& first)
      : m_width(first.GetWidth()),
        m_height(first.GetHeight()),
        m_format(first.GetFormatID()),
        m_bytesPerRow(first.GetBytesPerRow()) {}

  // Size and format; rows may be padded otherwise. Some kernels walk a slice's own rows, some those
  // of the first slice: the pixels must suffice for both. `pixels` is where they begin.
  bool IsGood(const dImage& image, const void* pixels) const {
    const auto place = reinterpret_cast<std::uintptr_t>(pixels);
    return image.GetWidth() == m_width && image.GetHeight() == m_height &&
           image.GetFormatID() == m_format && place != 0 && place % kSampleBytes == 0 &&
           image.GetImageSize() >= RasterBytes(std::max(image.GetBytesPerRow(), m_bytesPerRow));
  }

 private:
  // The bytes from the first pixel to the last one when rows are that far apart.
  std::uint64_t RasterBytes(std::uint64_t bytesPerRow) const {
    return (m_height > 0 ? bytesPerRow * (m_height - 1) : 0) + kSampleBytes * m_width;
  }

  std::uint64_t m_width;
  std::uint64_t m_height;
  unsigned long m_format;
  unsigned long m_bytesPerRow;
};

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

  const SliceCheck check(first);
  m_slices.reserve(slices.size() + 2);
  m_slices.push_back(first.GetDataPtr());
  for (const dSlice& slice : slices) {
    const dImage& image = slice.GetImage();
    const void* const pixels = image.GetDataPtr();
    if (!m_invalidSlice && !check.IsGood(image, pixels)) {
      m_invalidSlice = static_cast<int>(m_slices.size()) - 1;
    }
    m_slices.push_back(pixels);
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
