#ifndef VORL_DATA_DETAIL_IMAGELAYOUT_H
#define VORL_DATA_DETAIL_IMAGELAYOUT_H

/// @file
/// The arithmetic of an image format: how many bytes a row, a plane and the whole image take.

#include <cstdint>

inline namespace vorl {
namespace vorl_detail {

/// What describes an image format, before any of it has been checked.
struct ImageFormat {
  std::uint64_t width;
  std::uint64_t height;
  std::uint16_t dataType;
  int numChannels;
  std::uint16_t dataOrder;
  std::uint16_t rowAlignment;
};

/// The first thing that is wrong with a format.
enum class ImageFormatError { None, ChannelSequence, DataType, DataOrder, RowAlignment };

/// Puts a single channel into pixel order, then checks everything but the sizes.
ImageFormatError CheckImageFormat(ImageFormat& format);

/// The layout of a checked format. All counts saturate at the largest 64-bit number.
struct ImageLayout {
  explicit ImageLayout(const ImageFormat& format);

  /// True when every count fits the 32 bits in which an image holds it.
  bool FitsImage() const;

  ImageFormat format;           ///< with the row alignment raised to the sample size
  std::uint64_t pixelBits;      ///< bits from one pixel of a row to the next
  std::uint64_t rowBytes;       ///< bytes from one row to the next
  std::uint64_t channelOffset;  ///< bits from one channel of a pixel to the next
  std::uint64_t totalBytes;     ///< bytes of the whole image
};

}  // namespace vorl_detail
}  // namespace vorl

#endif
