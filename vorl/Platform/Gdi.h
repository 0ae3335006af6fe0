#ifndef VORL_PLATFORM_GDI_H
#define VORL_PLATFORM_GDI_H

/// @file
/// The types of the graphics device interface. On Windows they come from the system header;
/// elsewhere they are declared here, at global scope, with the same names and layouts, so that
/// bitmap files and applications read the same on every platform.

#include <vorl/Platform/GdiFwd.h>

#include <cstddef>

#if defined(_WIN32)

#if !defined(NOMINMAX)
#define NOMINMAX
#endif
#if !defined(WIN32_LEAN_AND_MEAN)
#define WIN32_LEAN_AND_MEAN
#endif
#include <windows.h>
// The system header renames these by macro, and would rename methods of the same name with them.
#undef GetClassInfo
#undef GetObject

#else

#include <cstdint>

using BYTE = std::uint8_t;    ///< unsigned, 8 bits
using WORD = std::uint16_t;   ///< unsigned, 16 bits
using DWORD = std::uint32_t;  ///< unsigned, 32 bits
using LONG = std::int32_t;    ///< signed, 32 bits on every platform

/// An integer point.
struct tagPOINT {
  LONG x;
  LONG y;
};
using POINT = tagPOINT;

/// An integer rectangle; right and bottom stand one behind the last column and row.
struct tagRECT {
  LONG left;
  LONG top;
  LONG right;
  LONG bottom;
};
using RECT = tagRECT;

/// A palette entry.
struct tagRGBQUAD {
  BYTE rgbBlue;
  BYTE rgbGreen;
  BYTE rgbRed;
  BYTE rgbReserved;
};
using RGBQUAD = tagRGBQUAD;

/// Size and format of a device-independent bitmap.
struct tagBITMAPINFOHEADER {
  DWORD biSize;  ///< of this structure, in bytes
  LONG biWidth;
  LONG biHeight;  ///< positive: bottom row first; negative: top row first
  WORD biPlanes;
  WORD biBitCount;      ///< bits per pixel
  DWORD biCompression;  ///< `BI_RGB` for plain pixels
  DWORD biSizeImage;    ///< in bytes; may be 0 for plain pixels
  LONG biXPelsPerMeter;
  LONG biYPelsPerMeter;
  DWORD biClrUsed;  ///< entries of the palette; 0 for as many as the bits per pixel allow
  DWORD biClrImportant;
};
using BITMAPINFOHEADER = tagBITMAPINFOHEADER;

/// A bitmap header and its palette, which goes on behind the one entry declared here.
struct tagBITMAPINFO {
  BITMAPINFOHEADER bmiHeader;
  RGBQUAD bmiColors[1];
};
using BITMAPINFO = tagBITMAPINFO;

/// The first bytes of a bitmap file. Packed: its 32-bit fields stand on even addresses only.
#pragma pack(push, 2)
struct tagBITMAPFILEHEADER {
  WORD bfType;   ///< the characters "BM"
  DWORD bfSize;  ///< of the file, in bytes
  WORD bfReserved1;
  WORD bfReserved2;
  DWORD bfOffBits;  ///< where the pixels begin, from the start of the file
};
#pragma pack(pop)
using BITMAPFILEHEADER = tagBITMAPFILEHEADER;

/// Compression code of plain, uncompressed pixels.
inline constexpr DWORD BI_RGB = 0;
/// The palette holds colours, not indices.
inline constexpr unsigned int DIB_RGB_COLORS = 0;

#endif

static_assert(sizeof(BYTE) == 1 && sizeof(WORD) == 2 && sizeof(DWORD) == 4 && sizeof(LONG) == 4);
static_assert(sizeof(tagPOINT) == 8 && offsetof(tagPOINT, y) == 4);
static_assert(sizeof(tagRECT) == 16 && offsetof(tagRECT, right) == 8);
static_assert(sizeof(tagRGBQUAD) == 4 && offsetof(tagRGBQUAD, rgbRed) == 2);
static_assert(sizeof(tagBITMAPINFOHEADER) == 40 && offsetof(tagBITMAPINFOHEADER, biBitCount) == 14);
static_assert(offsetof(tagBITMAPINFOHEADER, biCompression) == 16);
static_assert(offsetof(tagBITMAPINFOHEADER, biClrUsed) == 32);
static_assert(sizeof(tagBITMAPINFO) == 44 && offsetof(tagBITMAPINFO, bmiColors) == 40);
static_assert(sizeof(tagBITMAPFILEHEADER) == 14 && offsetof(tagBITMAPFILEHEADER, bfOffBits) == 10);

#endif
