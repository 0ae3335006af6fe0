#ifndef VORL_PLATFORM_SOFT_DIBLAYOUT_H
#define VORL_PLATFORM_SOFT_DIBLAYOUT_H

#include <vorl/Platform/soft/Object.h>

#include <cstdint>
#include <memory>
#include <optional>

inline namespace vorl {
namespace vorl_detail {

/// What a BITMAPINFO says, checked.
struct DibLayout {
  BITMAPINFOHEADER header{};
  PixelFormat format;
  int width = 0;
  int height = 0;
  bool bottomUp = false;
  std::uint64_t rowBytes = 0;
  std::uint64_t Bytes() const { return rowBytes * static_cast<std::uint64_t>(height); }

  /// The surface over pixels of this layout.
  Surface Over(std::uint8_t* pixels) const;
};

/// Reads a header and its colours. Nothing, with the error set, for null, unknown depths and
/// compressions, empty sizes and those beyond 2 GB.
std::optional<DibLayout> ReadLayout(const BITMAPINFO* info, UINT usage);

/// The layout of a header without colours: sizes, depth and orientation.
std::optional<DibLayout> ReadHeader(const BITMAPINFOHEADER& header);

/// What the bytes of a new section are: zeros, or whatever was in the memory.
enum class NewPixels { Zeros, Unset };

/// A section of a layout. Throws `std::bad_alloc`.
std::shared_ptr<Bitmap> MakeSection(const DibLayout& layout, NewPixels pixels = NewPixels::Zeros);

/// A device bitmap. Null, with the error set, beyond 2 GB; throws `std::bad_alloc`.
std::shared_ptr<Bitmap> MakeDeviceBitmap(std::int64_t width, std::int64_t height, int depth);

}  // namespace vorl_detail
}  // namespace vorl

#endif
