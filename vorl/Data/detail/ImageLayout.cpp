#include <vorl/Data/detail/ImageLayout.h>

#include <limits>

#include <vorl/Data/dImage.h>

inline namespace vorl {
namespace vorl_detail {

namespace {

constexpr std::uint64_t kSaturated = std::numeric_limits<std::uint64_t>::max();

std::uint64_t Multiply(std::uint64_t a, std::uint64_t b) {
  return b != 0 && a > kSaturated / b ? kSaturated : a * b;
}

std::uint64_t Add(std::uint64_t a, std::uint64_t b) {
  return a > kSaturated - b ? kSaturated : a + b;
}

bool IsDataType(std::uint16_t dataType) {
  switch (dataType) {
    case ImageDataType_U1:
    case ImageDataType_U8:
    case ImageDataType_U16:
    case ImageDataType_U32:
    case ImageDataType_U64:
    case ImageDataType_S8:
    case ImageDataType_S16:
    case ImageDataType_S32:
    case ImageDataType_S64:
    case ImageDataType_F32:
    case ImageDataType_F64:
      return true;
    default:
      return false;
  }
}

bool IsRowAlignment(std::uint16_t alignment) {
  return alignment >= 1 && alignment <= 32 && (alignment & (alignment - 1)) == 0;
}

// Bits to whole bytes, rounded up to the alignment.
std::uint64_t RowBytes(std::uint64_t rowBits, std::uint64_t alignment) {
  const std::uint64_t bytes = rowBits / 8 + (rowBits % 8 != 0 ? 1 : 0);
  const std::uint64_t raised = Add(bytes, alignment - 1);
  return raised == kSaturated ? kSaturated : raised / alignment * alignment;
}

bool FitsField(std::uint64_t value) {
  return value <= std::numeric_limits<std::uint32_t>::max();
}

}  // namespace

ImageFormatError CheckImageFormat(ImageFormat& format) {
  if (format.numChannels == 0) {
    return ImageFormatError::ChannelSequence;
  }
  if (format.numChannels == 1) {
    format.dataOrder = ImageDataOrder_Pixel;
  }
  if (!IsDataType(format.dataType)) {
    return ImageFormatError::DataType;
  }
  if (format.dataOrder > ImageDataOrder_Plane) {
    return ImageFormatError::DataOrder;
  }
  if (!IsRowAlignment(format.rowAlignment)) {
    return ImageFormatError::RowAlignment;
  }
  return ImageFormatError::None;
}

ImageLayout::ImageLayout(const ImageFormat& checkedFormat) : format(checkedFormat) {
  const std::uint64_t bits = format.dataType & 0xFFU;
  const auto channels = static_cast<std::uint64_t>(format.numChannels);
  const bool planes = format.dataOrder == ImageDataOrder_Plane;
  if (format.rowAlignment * 8U < bits) {
    format.rowAlignment = static_cast<std::uint16_t>(bits / 8);
  }
  pixelBits = planes ? bits : bits * channels;
  rowBytes = RowBytes(Multiply(pixelBits, format.width), format.rowAlignment);
  const std::uint64_t planeBytes = Multiply(rowBytes, format.height);
  channelOffset = planes ? Multiply(planeBytes, 8) : bits;
  totalBytes = planes ? Multiply(planeBytes, channels) : planeBytes;
}

bool ImageLayout::FitsImage() const {
  return format.numChannels <= std::numeric_limits<std::uint16_t>::max() &&
         FitsField(format.width) && FitsField(format.height) && FitsField(pixelBits) &&
         FitsField(rowBytes) && FitsField(channelOffset) && FitsField(totalBytes);
}

}  // namespace vorl_detail
}  // namespace vorl
