#ifndef VORL_PLATFORM_DETAIL_SECTION_H
#define VORL_PLATFORM_DETAIL_SECTION_H

#include <vorl/Platform/Gdi.h>

inline namespace vorl {
namespace vorl_detail {

/// A section as `CreateDIBSection` makes it, for a caller who writes all of its bytes before
/// anybody reads them: they need not be zeros at first. Clearing them costs a fifth of loading a
/// bitmap file.
#if defined(_WIN32)
inline HBITMAP CreateSectionToFill(HDC dc, const BITMAPINFO* info, void** bits) {
  return CreateDIBSection(dc, info, DIB_RGB_COLORS, bits, nullptr, 0);
}
#else
HBITMAP CreateSectionToFill(HDC dc, const BITMAPINFO* info, void** bits);
#endif

}  // namespace vorl_detail
}  // namespace vorl

#endif
