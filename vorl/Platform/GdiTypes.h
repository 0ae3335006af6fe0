#ifndef VORL_PLATFORM_GDITYPES_H
#define VORL_PLATFORM_GDITYPES_H

/// @file
/// The types of the graphics device interface, at global scope, with the system's names and
/// layouts. On Windows the system header declares them; include `vorl/Platform/Gdi.h` there and
/// here.

#if !defined(_WIN32)

#include <cstddef>
#include <cstdint>

using BYTE = std::uint8_t;    ///< unsigned, 8 bits
using WORD = std::uint16_t;   ///< unsigned, 16 bits
using DWORD = std::uint32_t;  ///< unsigned, 32 bits
using LONG = std::int32_t;    ///< signed, 32 bits on every platform
using BOOL = int;             ///< 0 is false, everything else true
using UINT = unsigned int;
using COLORREF = DWORD;  ///< red in the lowest byte, then green, then blue; the highest byte is 0

using LPVOID = void*;
using LPSTR = char*;
using LPCSTR = const char*;

using HANDLE = void*;
/// Any object that `SelectObject` and `DeleteObject` take. The handles of the kinds convert to it.
using HGDIOBJ = void*;
using HDC = struct HDC__*;          ///< device context
using HBITMAP = struct HBITMAP__*;  ///< bitmap
using HBRUSH = struct HBRUSH__*;    ///< brush
using HPEN = struct HPEN__*;        ///< pen
using HFONT = struct HFONT__*;      ///< font
using HRGN = struct HRGN__*;        ///< region
using HWND = struct HWND__*;        ///< window

/// An integer point.
struct tagPOINT {
  LONG x;
  LONG y;
};
using POINT = tagPOINT;
using LPPOINT = tagPOINT*;

/// An integer rectangle; right and bottom stand one behind the last column and row.
struct tagRECT {
  LONG left;
  LONG top;
  LONG right;
  LONG bottom;
};
using RECT = tagRECT;
using LPRECT = tagRECT*;

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
using LPBITMAPINFO = tagBITMAPINFO*;

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

/// What `GetObjectA` tells of a bitmap.
struct tagBITMAP {
  LONG bmType;  ///< 0
  LONG bmWidth;
  LONG bmHeight;      ///< always positive
  LONG bmWidthBytes;  ///< of one row
  WORD bmPlanes;
  WORD bmBitsPixel;
  LPVOID bmBits;  ///< the pixels of a section; null for other bitmaps
};
using BITMAP = tagBITMAP;

/// What `GetObjectA` tells of a bitmap section when it is given room for this structure.
struct tagDIBSECTION {
  BITMAP dsBm;
  BITMAPINFOHEADER dsBmih;
  DWORD dsBitfields[3];  ///< masks of red, green and blue; 0 but for 16 and 32 bits with masks
  HANDLE dshSection;     ///< null: sections own their memory
  DWORD dsOffset;
};
using DIBSECTION = tagDIBSECTION;

/// What `GetObjectA` tells of a pen.
struct tagLOGPEN {
  UINT lopnStyle;
  POINT lopnWidth;  ///< x is the width, y is not used
  COLORREF lopnColor;
};
using LOGPEN = tagLOGPEN;

/// What `GetObjectA` tells of a brush.
struct tagLOGBRUSH {
  UINT lbStyle;  ///< `BS_SOLID` or `BS_NULL`
  COLORREF lbColor;
  std::uintptr_t lbHatch;  ///< 0
};
using LOGBRUSH = tagLOGBRUSH;

inline constexpr int LF_FACESIZE = 32;  ///< bytes of a font name, its final zero included

/// What `GetObjectA` tells of a font: the values that it was created with.
struct tagLOGFONTA {
  LONG lfHeight;
  LONG lfWidth;
  LONG lfEscapement;
  LONG lfOrientation;
  LONG lfWeight;
  BYTE lfItalic;
  BYTE lfUnderline;
  BYTE lfStrikeOut;
  BYTE lfCharSet;
  BYTE lfOutPrecision;
  BYTE lfClipPrecision;
  BYTE lfQuality;
  BYTE lfPitchAndFamily;
  char lfFaceName[LF_FACESIZE];
};
using LOGFONTA = tagLOGFONTA;

static_assert(sizeof(tagBITMAP) == 24 + sizeof(void*));
static_assert(sizeof(tagLOGPEN) == 16 && sizeof(tagLOGFONTA) == 60);

#endif

#endif
