#ifndef VORL_IO_FILE_DETAIL_BITMAPROWS_H
#define VORL_IO_FILE_DETAIL_BITMAPROWS_H

/// @file
/// From the packed pixels of a bitmap's row to the bytes of an image's.

#include <vorl/Platform/Gdi.h>

#include <cstddef>

inline namespace vorl {
namespace vorl_detail {

/// True when red, green and blue are equal in every entry. Null logs "invalid parameter(s)" and is
/// not grey.
bool IsGrayScalePalette(const tagRGBQUAD* palette, unsigned int entries);

/// Replaces indices of 1, 2, 4 or 8 bits, the leftmost in the highest bits, by grey levels (target
/// of 8 bits) or by blue, green and red (24 bits). The palette has an entry for every index that
/// the bits allow. False after logging "invalid parameter(s)" (a null pointer, or no width),
/// "unsupported source pixel depth: %d(must be 8)" or "unsupported target pixel depth: %d(must be 8
/// or 24)".
bool ExpandPalette(unsigned char* target, int sourceBits, int targetBits,
                   const unsigned char* source, std::size_t width, const tagRGBQUAD* palette);

/// Replaces 16-bit pixels, five bits each of red, green and blue from bit 14 downwards, by blue,
/// green and red bytes, each times 8. False after logging "invalid parameter(s)" (a null pointer).
bool ExpandRGB16(std::size_t width, unsigned char* target, const unsigned char* source);

}  // namespace vorl_detail
}  // namespace vorl

#endif
