#ifndef VORL_PLATFORM_GDI_H
#define VORL_PLATFORM_GDI_H

/// @file
/// The graphics device interface: device contexts, bitmaps, pens, brushes, raster operations. On
/// Windows it is the system's. Elsewhere the same types, constants and functions are declared at
/// global scope and implemented in software, giving the same pixels, so that applications and
/// bitmap files read the same on every platform.

#include <vorl/Platform/GdiFwd.h>

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

#include <vorl/Platform/GdiConstants.h>
#include <vorl/Platform/GdiFunctions.h>
#include <vorl/Platform/GdiTypes.h>

#endif

#include <cstddef>

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
