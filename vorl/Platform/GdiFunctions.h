#ifndef VORL_PLATFORM_GDIFUNCTIONS_H
#define VORL_PLATFORM_GDIFUNCTIONS_H

/// @file
/// The functions of the graphics device interface, with the system's names and signatures. Include
/// `vorl/Platform/Gdi.h`.
///
/// Handles are checked: a null, deleted or foreign handle makes a call fail, with the failure
/// result that each function names and ERROR_INVALID_HANDLE as `GetLastError`. Coordinates may be
/// any; what lies outside the bitmap or the clip region is left out. Different threads may use
/// different device contexts at the same time; one context belongs to one thread at a time.

#if !defined(_WIN32)

#include <vorl/Platform/GdiTypes.h>
#include <vorl/export.h>

// ---- Device contexts ----

/// Creates a memory device context. A null `dc` stands for the screen. Until a bitmap is selected
/// the context draws into a monochrome bitmap of one pixel. Ends with `DeleteDC`. Null on failure.
VORL_API HDC CreateCompatibleDC(HDC dc);
/// Deletes a memory device context; the objects selected into it are released, not deleted. False
/// for anything that is not a memory device context.
VORL_API BOOL DeleteDC(HDC dc);
/// The device context of the screen, for a null window: it has 32 bits per pixel and nothing that
/// could be drawn on. Ends with `ReleaseDC`. Null for any window: there are none.
VORL_API HDC GetDC(HWND window);
/// Ends the use of a context from `GetDC`. Returns 1, or 0 when `dc` is no such context.
VORL_API int ReleaseDC(HWND window, HDC dc);
/// Pushes a copy of the state (colours, modes, pen position, clip region, selected objects) onto
/// the context's stack. Returns its number there, counted from 1; 0 on failure.
VORL_API int SaveDC(HDC dc);
/// Restores a saved state: a positive `level` names one by its number, a negative one counts back
/// from the top. That state and those above it leave the stack. False when there is no such state.
VORL_API BOOL RestoreDC(HDC dc, int level);
/// Nothing is buffered: returns true.
VORL_API BOOL GdiFlush();
/// Why the last call failed in this thread: one of the `ERROR_` codes. Successful calls leave it.
VORL_API DWORD GetLastError();

// ---- Objects ----

/// Selects a bitmap, pen, brush or font and returns the one that it replaces. A region becomes the
/// clip region, as with `SelectClipRgn`, whose result is returned. Null on failure: a bitmap that
/// another context has selected, a bitmap for a context that is not a memory context.
VORL_API HGDIOBJ SelectObject(HDC dc, HGDIOBJ object);
/// Deletes a bitmap, pen, brush, font or region. Stock objects stay, which counts as success.
/// False for an invalid handle and for an object that is selected into a device context.
VORL_API BOOL DeleteObject(HGDIOBJ object);
/// The predefined object of the given number (`WHITE_BRUSH` ...). Null when there is none.
VORL_API HGDIOBJ GetStockObject(int index);
/// The selected object of a kind: OBJ_PEN, OBJ_BRUSH, OBJ_FONT or OBJ_BITMAP. Null on failure.
VORL_API HGDIOBJ GetCurrentObject(HDC dc, UINT kind);
/// Describes an object: fills `buffer` with a BITMAP, DIBSECTION, LOGPEN, LOGBRUSH or LOGFONTA, as
/// much of it as `size` bytes hold. Returns the bytes written; with a null `buffer` the bytes
/// needed; 0 on failure.
VORL_API int GetObjectA(HGDIOBJ object, int size, LPVOID buffer);
/// A brush of one colour. Null when memory or handles are exhausted.
VORL_API HBRUSH CreateSolidBrush(COLORREF colour);
/// A pen. Wider than one pixel it is solid whatever its style. Null for a style that does not exist
/// (those above PS_INSIDEFRAME become PS_SOLID) or when memory or handles are exhausted.
VORL_API HPEN CreatePen(int style, int width, COLORREF colour);
/// A font. A positive `height` is that of a line: the largest font that fits is taken; a negative
/// one is that of the characters; 0 takes a default of 16 for the line. Fonts above 4096 pixels are
/// drawn in that size. `width` is the average character's, 0 for the font's own. A null or unknown
/// `face` takes the font that comes nearest, in the family that `pitchAndFamily` names. Text always
/// runs from left to right: `escapement` and `orientation` are kept but have no effect. With
/// NONANTIALIASED_QUALITY, and on bitmaps of fewer than 16 bits, pixels are either set or not. Null
/// when memory is exhausted.
VORL_API HFONT CreateFontA(int height, int width, int escapement, int orientation, int weight,
                           DWORD italic, DWORD underline, DWORD strikeOut, DWORD charSet,
                           DWORD outPrecision, DWORD clipPrecision, DWORD quality,
                           DWORD pitchAndFamily, LPCSTR face);
/// A region of one rectangle, its corners in any order. Null when memory or handles are exhausted.
VORL_API HRGN CreateRectRgn(int left, int top, int right, int bottom);

// ---- Bitmaps ----

/// A bitmap of 1, 4, 8, 16, 24 or 32 bits whose pixels the application sees: `*bits` receives their
/// address, valid until the bitmap is deleted. Rows are padded to 4 bytes; the first is the bottom
/// one unless `biHeight` is negative. `usage` has to be DIB_RGB_COLORS, `section` null. Null, and a
/// null `*bits`, for headers that are no such bitmap and for sizes that memory does not hold.
VORL_API HBITMAP CreateDIBSection(HDC dc, const BITMAPINFO* info, UINT usage, void** bits,
                                  HANDLE section, DWORD offset);
/// A device bitmap that suits the context: as deep as the bitmap selected into it, 32 bits for the
/// screen. Its pixels are 0. Null on failure.
VORL_API HBITMAP CreateCompatibleBitmap(HDC dc, int width, int height);
/// A device bitmap of 1, 4, 8, 16, 24 or 32 bits; with one bit it is monochrome: colours become
/// white where they equal the background colour, and 0 and 1 become the text and the background
/// colour. `bits` holds rows padded to 2 bytes, top row first; null leaves the pixels 0. An empty
/// size gives the 1 by 1 stock bitmap. Contexts accept depths of 1 and 32. Null on failure.
VORL_API HBITMAP CreateBitmap(int width, int height, UINT planes, UINT bitCount, const void* bits);
/// A device bitmap that suits the context, of the size that `header` tells; with CBM_INIT in
/// `flags` it receives the picture of `bits` and `info`. Null on failure.
VORL_API HBITMAP CreateDIBitmap(HDC dc, const BITMAPINFOHEADER* header, DWORD flags,
                                const void* bits, const BITMAPINFO* info, UINT usage);
/// Copies `count` rows of a bitmap, from row `start` (counted from the bottom of the picture that
/// `info` describes) on, into `bits`, and fills in the colour table and the size behind the header.
/// The pictures share their upper left corner; what the bitmap lacks is 0. The bitmap that every
/// new context has shows what was drawn in `dc`. `usage` has to be DIB_RGB_COLORS, the format
/// without masks.
///
/// Returns
/// - the rows that the bitmap had a part of: fewer than were filled where the picture is higher;
/// - 1 where no row was asked for: null `bits`, a `count` of 0, a `start` beyond the picture;
/// - the bitmap's height where `biBitCount` is 0: then the header receives the bitmap's own format,
///   and nothing is copied;
/// - 0 on failure.
VORL_API int GetDIBits(HDC dc, HBITMAP bitmap, UINT start, UINT count, LPVOID bits,
                       LPBITMAPINFO info, UINT usage);

// ---- Blits ----

/// Combines a rectangle of the source context, the brush and the destination by one of the 256
/// ternary operations (bits 16 to 23 of `rop`). Source and destination may overlap. False on
/// failure; `source` may be null for operations that use none.
VORL_API BOOL BitBlt(HDC dc, int x, int y, int width, int height, HDC source, int sourceX,
                     int sourceY, DWORD rop);
/// As `BitBlt` without a source. False for operations that use one.
VORL_API BOOL PatBlt(HDC dc, int x, int y, int width, int height, DWORD rop);
/// As `BitBlt`, with a source of another size, stretched by the context's stretch mode. A negative
/// width or height mirrors.
VORL_API BOOL StretchBlt(HDC dc, int x, int y, int width, int height, HDC source, int sourceX,
                         int sourceY, int sourceWidth, int sourceHeight, DWORD rop);
/// As `StretchBlt`, with a bitmap in memory as the source, whose rows count from the bottom.
/// Returns the rows of the source; 0 on failure.
VORL_API int StretchDIBits(HDC dc, int x, int y, int width, int height, int sourceX, int sourceY,
                           int sourceWidth, int sourceHeight, const void* bits,
                           const BITMAPINFO* info, UINT usage, DWORD rop);
/// Sets the stretch mode (BLACKONWHITE ... HALFTONE); returns the one before, 0 on failure.
/// HALFTONE is the one mode whose pixels are not the system's: it is drawn like COLORONCOLOR.
VORL_API int SetStretchBltMode(HDC dc, int mode);

// ---- Shapes ----

/// Fills a rectangle with a brush, whatever the binary raster operation. With exchanged corners the
/// first one is included. Returns 0 on failure.
VORL_API int FillRect(HDC dc, const RECT* rect, HBRUSH brush);
/// Draws a rectangle with the selected pen and fills it with the selected brush. False on failure.
VORL_API BOOL Rectangle(HDC dc, int left, int top, int right, int bottom);
/// Moves the pen; `*old`, unless null, receives where it was. False on failure.
VORL_API BOOL MoveToEx(HDC dc, int x, int y, LPPOINT old);
/// Draws a line from the pen's position up to, but without, the given point, and moves the pen
/// there. False on failure.
VORL_API BOOL LineTo(HDC dc, int x, int y);
/// Draws a closed polygon with the selected pen and fills it with the selected brush. False on
/// failure: fewer than two points.
VORL_API BOOL Polygon(HDC dc, const POINT* points, int count);
/// Sets how polygons are filled (ALTERNATE or WINDING); returns the mode before, 0 on failure.
VORL_API int SetPolyFillMode(HDC dc, int mode);
/// Sets the binary raster operation (R2_BLACK ... R2_WHITE) of pens, brushes and shapes; returns
/// the one before, 0 on failure.
VORL_API int SetROP2(HDC dc, int rop);
/// Sets one pixel to the nearest colour that the bitmap has, by the binary raster operation.
/// Returns that colour; CLR_INVALID outside the bitmap or the clip region, and on failure.
VORL_API COLORREF SetPixel(HDC dc, int x, int y, COLORREF colour);
/// The colour of one pixel. CLR_INVALID outside the bitmap or the clip region, and on failure.
VORL_API COLORREF GetPixel(HDC dc, int x, int y);

// ---- Text and colours ----

/// Draws, or with DT_CALCRECT measures, UTF-8 text inside a rectangle. `count` is its length in
/// bytes, negative for text that ends with a zero. Bytes that are no UTF-8 are shown as U+FFFD.
/// The text takes the text colour and, with the mode OPAQUE, the background colour; it takes no
/// notice of the raster operation. Measuring moves the right and lower sides of `rect` only.
/// Returns the height from the top of `rect` to the end of the text, 0 on failure; lines that begin
/// below `rect` count with DT_NOCLIP and DT_CALCRECT only. Where no font is installed text has no
/// size, nothing is drawn, and the result is 0.
VORL_API int DrawTextA(HDC dc, LPCSTR text, int count, LPRECT rect, UINT format);
/// Sets the text colour; returns the one before, CLR_INVALID on failure.
VORL_API COLORREF SetTextColor(HDC dc, COLORREF colour);
/// Sets the background colour; returns the one before, CLR_INVALID on failure.
VORL_API COLORREF SetBkColor(HDC dc, COLORREF colour);
/// Sets the background mode (TRANSPARENT or OPAQUE); returns the one before, 0 on failure.
VORL_API int SetBkMode(HDC dc, int mode);

// ---- Clipping ----

/// Cuts the clip region down to a rectangle. Returns NULLREGION, SIMPLEREGION or COMPLEXREGION for
/// the region that results, RGN_ERROR on failure.
VORL_API int IntersectClipRect(HDC dc, int left, int top, int right, int bottom);
/// Takes a rectangle out of the clip region. Results as for `IntersectClipRect`.
VORL_API int ExcludeClipRect(HDC dc, int left, int top, int right, int bottom);
/// Makes a copy of `region` the clip region; null removes it. Results as for `IntersectClipRect`.
VORL_API int SelectClipRgn(HDC dc, HRGN region);
/// The smallest rectangle around what can be drawn on: the clip region inside the bitmap. Results
/// as for `IntersectClipRect`.
VORL_API int GetClipBox(HDC dc, LPRECT rect);

#endif

#endif
