#ifndef VORL_PLATFORM_GDICONSTANTS_H
#define VORL_PLATFORM_GDICONSTANTS_H

/// @file
/// The constants of the graphics device interface, with the system's names and values. Include
/// `vorl/Platform/Gdi.h`.

#if !defined(_WIN32)

#include <vorl/Platform/GdiTypes.h>

// Other headers define these as macros, with the same meaning.
#if !defined(FALSE)
inline constexpr BOOL FALSE = 0;
#endif
#if !defined(TRUE)
inline constexpr BOOL TRUE = 1;
#endif

/// A colour from its red, green and blue, each from 0 to 255.
constexpr COLORREF RGB(int red, int green, int blue) {
  return (static_cast<COLORREF>(red) & 0xFFU) | (static_cast<COLORREF>(green) & 0xFFU) << 8U |
         (static_cast<COLORREF>(blue) & 0xFFU) << 16U;
}
constexpr BYTE GetRValue(COLORREF colour) {
  return static_cast<BYTE>(colour);
}
constexpr BYTE GetGValue(COLORREF colour) {
  return static_cast<BYTE>(colour >> 8U);
}
constexpr BYTE GetBValue(COLORREF colour) {
  return static_cast<BYTE>(colour >> 16U);
}
/// Not a colour: what functions that return one return on failure.
inline constexpr COLORREF CLR_INVALID = 0xFFFFFFFF;

// Bitmap headers
inline constexpr DWORD BI_RGB = 0;         ///< plain, uncompressed pixels
inline constexpr DWORD BI_RLE8 = 1;        ///< run lengths of 8 bits: not supported
inline constexpr DWORD BI_RLE4 = 2;        ///< run lengths of 4 bits: not supported
inline constexpr DWORD BI_BITFIELDS = 3;   ///< 16 or 32 bits; three masks follow the header
inline constexpr UINT DIB_RGB_COLORS = 0;  ///< the palette holds colours
inline constexpr UINT DIB_PAL_COLORS = 1;  ///< the palette holds indices: not supported
inline constexpr DWORD CBM_INIT = 4;       ///< `CreateDIBitmap` copies the given pixels

// Stock objects
inline constexpr int WHITE_BRUSH = 0;
inline constexpr int LTGRAY_BRUSH = 1;
inline constexpr int GRAY_BRUSH = 2;
inline constexpr int DKGRAY_BRUSH = 3;
inline constexpr int BLACK_BRUSH = 4;
inline constexpr int NULL_BRUSH = 5;
inline constexpr int HOLLOW_BRUSH = NULL_BRUSH;
inline constexpr int WHITE_PEN = 6;
inline constexpr int BLACK_PEN = 7;
inline constexpr int NULL_PEN = 8;
inline constexpr int OEM_FIXED_FONT = 10;
inline constexpr int ANSI_FIXED_FONT = 11;
inline constexpr int ANSI_VAR_FONT = 12;
inline constexpr int SYSTEM_FONT = 13;
inline constexpr int DEVICE_DEFAULT_FONT = 14;
inline constexpr int SYSTEM_FIXED_FONT = 16;
inline constexpr int DEFAULT_GUI_FONT = 17;

// Kinds of objects, for GetCurrentObject
inline constexpr UINT OBJ_PEN = 1;
inline constexpr UINT OBJ_BRUSH = 2;
inline constexpr UINT OBJ_DC = 3;
inline constexpr UINT OBJ_FONT = 6;
inline constexpr UINT OBJ_BITMAP = 7;
inline constexpr UINT OBJ_REGION = 8;
inline constexpr UINT OBJ_MEMDC = 10;

// Ternary raster operations: source, destination and pattern
inline constexpr DWORD SRCCOPY = 0x00CC0020;      ///< source
inline constexpr DWORD SRCPAINT = 0x00EE0086;     ///< source or destination
inline constexpr DWORD SRCAND = 0x008800C6;       ///< source and destination
inline constexpr DWORD SRCINVERT = 0x00660046;    ///< source xor destination
inline constexpr DWORD SRCERASE = 0x00440328;     ///< source and not destination
inline constexpr DWORD NOTSRCCOPY = 0x00330008;   ///< not source
inline constexpr DWORD NOTSRCERASE = 0x001100A6;  ///< neither source nor destination
inline constexpr DWORD MERGECOPY = 0x00C000CA;    ///< source and pattern
inline constexpr DWORD MERGEPAINT = 0x00BB0226;   ///< not source, or destination
inline constexpr DWORD PATCOPY = 0x00F00021;      ///< pattern
inline constexpr DWORD PATPAINT = 0x00FB0A09;     ///< pattern, or not source, or destination
inline constexpr DWORD PATINVERT = 0x005A0049;    ///< pattern xor destination
inline constexpr DWORD DSTINVERT = 0x00550009;    ///< not destination
inline constexpr DWORD BLACKNESS = 0x00000042;    ///< zeros
inline constexpr DWORD WHITENESS = 0x00FF0062;    ///< ones

// Binary raster operations: pen and destination
inline constexpr int R2_BLACK = 1;
inline constexpr int R2_NOTMERGEPEN = 2;
inline constexpr int R2_MASKNOTPEN = 3;
inline constexpr int R2_NOTCOPYPEN = 4;
inline constexpr int R2_MASKPENNOT = 5;
inline constexpr int R2_NOT = 6;
inline constexpr int R2_XORPEN = 7;
inline constexpr int R2_NOTMASKPEN = 8;
inline constexpr int R2_MASKPEN = 9;
inline constexpr int R2_NOTXORPEN = 10;
inline constexpr int R2_NOP = 11;
inline constexpr int R2_MERGENOTPEN = 12;
inline constexpr int R2_COPYPEN = 13;
inline constexpr int R2_MERGEPENNOT = 14;
inline constexpr int R2_MERGEPEN = 15;
inline constexpr int R2_WHITE = 16;
inline constexpr int R2_LAST = 16;

// Stretch modes: what becomes of the pixels that have no place
inline constexpr int BLACKONWHITE = 1;  ///< they are combined by and
inline constexpr int WHITEONBLACK = 2;  ///< they are combined by or
inline constexpr int COLORONCOLOR = 3;  ///< they are left out
inline constexpr int HALFTONE = 4;      ///< accepted; works like `COLORONCOLOR`
inline constexpr int STRETCH_ANDSCANS = BLACKONWHITE;
inline constexpr int STRETCH_ORSCANS = WHITEONBLACK;
inline constexpr int STRETCH_DELETESCANS = COLORONCOLOR;
inline constexpr int STRETCH_HALFTONE = HALFTONE;

// Background modes
inline constexpr int TRANSPARENT = 1;  ///< gaps and text backgrounds stay as they are
inline constexpr int OPAQUE = 2;       ///< gaps and text backgrounds take the background colour

// Polygon fill modes
inline constexpr int ALTERNATE = 1;
inline constexpr int WINDING = 2;

// Pen and brush styles
inline constexpr int PS_SOLID = 0;
inline constexpr int PS_DASH = 1;
inline constexpr int PS_DOT = 2;
inline constexpr int PS_DASHDOT = 3;
inline constexpr int PS_DASHDOTDOT = 4;
inline constexpr int PS_NULL = 5;
inline constexpr int PS_INSIDEFRAME = 6;
inline constexpr UINT BS_SOLID = 0;
inline constexpr UINT BS_NULL = 1;

// Results of the region functions
#if !defined(ERROR)
inline constexpr int ERROR = 0;
#endif
inline constexpr int NULLREGION = 1;     ///< empty
inline constexpr int SIMPLEREGION = 2;   ///< one rectangle
inline constexpr int COMPLEXREGION = 3;  ///< more than one rectangle
inline constexpr int RGN_ERROR = 0;      ///< the call failed

// Text
inline constexpr UINT DT_TOP = 0x0;
inline constexpr UINT DT_LEFT = 0x0;
inline constexpr UINT DT_CENTER = 0x1;
inline constexpr UINT DT_RIGHT = 0x2;
inline constexpr UINT DT_VCENTER = 0x4;  ///< with `DT_SINGLELINE` only
inline constexpr UINT DT_BOTTOM = 0x8;   ///< with `DT_SINGLELINE` only
inline constexpr UINT DT_WORDBREAK = 0x10;
inline constexpr UINT DT_SINGLELINE = 0x20;
inline constexpr UINT DT_EXPANDTABS = 0x40;
inline constexpr UINT DT_TABSTOP = 0x80;
inline constexpr UINT DT_NOCLIP = 0x100;
inline constexpr UINT DT_EXTERNALLEADING = 0x200;
inline constexpr UINT DT_CALCRECT = 0x400;  ///< measure, draw nothing
inline constexpr UINT DT_NOPREFIX = 0x800;  ///< an ampersand is a character like any other

// Fonts
inline constexpr int FW_DONTCARE = 0;
inline constexpr int FW_THIN = 100;
inline constexpr int FW_EXTRALIGHT = 200;
inline constexpr int FW_LIGHT = 300;
inline constexpr int FW_NORMAL = 400;
inline constexpr int FW_MEDIUM = 500;
inline constexpr int FW_SEMIBOLD = 600;
inline constexpr int FW_BOLD = 700;
inline constexpr int FW_EXTRABOLD = 800;
inline constexpr int FW_HEAVY = 900;
inline constexpr DWORD ANSI_CHARSET = 0;
inline constexpr DWORD DEFAULT_CHARSET = 1;
inline constexpr DWORD OUT_DEFAULT_PRECIS = 0;
inline constexpr DWORD CLIP_DEFAULT_PRECIS = 0;
inline constexpr DWORD DEFAULT_QUALITY = 0;
inline constexpr DWORD NONANTIALIASED_QUALITY = 3;
inline constexpr DWORD ANTIALIASED_QUALITY = 4;
inline constexpr DWORD DEFAULT_PITCH = 0;
inline constexpr DWORD FIXED_PITCH = 1;
inline constexpr DWORD VARIABLE_PITCH = 2;
inline constexpr DWORD FF_DONTCARE = 0x00;
inline constexpr DWORD FF_ROMAN = 0x10;
inline constexpr DWORD FF_SWISS = 0x20;
inline constexpr DWORD FF_MODERN = 0x30;

// Results of GetLastError
inline constexpr DWORD ERROR_SUCCESS = 0;
inline constexpr DWORD ERROR_INVALID_HANDLE = 6;
inline constexpr DWORD ERROR_NOT_ENOUGH_MEMORY = 8;
inline constexpr DWORD ERROR_INVALID_PARAMETER = 87;
inline constexpr DWORD ERROR_BUSY = 170;  ///< the object is selected into a device context

// Keys and buttons that are down during a mouse event
inline constexpr int MK_LBUTTON = 1;
inline constexpr int MK_RBUTTON = 2;
inline constexpr int MK_SHIFT = 4;
inline constexpr int MK_CONTROL = 8;
inline constexpr int MK_MBUTTON = 16;

#endif

#endif
