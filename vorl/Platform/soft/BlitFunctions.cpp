#include <vorl/Platform/soft/Blit.h>
#include <vorl/Platform/soft/Rop3.h>

using vorl::vorl_detail::Axis;
using vorl::vorl_detail::Blit;
using vorl::vorl_detail::BlitSource;
using vorl::vorl_detail::DeviceContext;
using vorl::vorl_detail::FillByRop;
using vorl::vorl_detail::Find;
using vorl::vorl_detail::Guarded;
using vorl::vorl_detail::SetError;
using vorl::vorl_detail::UsesSource;

namespace {

// Stretched to a single column or row, a picture goes without its last one, as the system has it.
Axis StretchAxis(int target, int targetLength, int source, int sourceLength) {
  const bool toOne = targetLength == 1 && sourceLength > 1;
  return Axis{target, targetLength, source, toOne ? sourceLength - 1 : sourceLength};
}

BOOL BlitBetween(HDC dc, const Axis& x, const Axis& y, HDC source, DWORD rop) {
  return Guarded(FALSE, [&]() -> BOOL {
    const auto context = Find<DeviceContext>(dc);
    if (!context) {
      return FALSE;
    }
    if (!UsesSource(rop)) {
      FillByRop(*context, x, y, rop);
      return TRUE;
    }
    const auto from = Find<DeviceContext>(source);
    if (!from) {
      return FALSE;
    }
    Blit(*context, x, y, BlitSource{from->Target(), from->state.backgroundColour}, rop);
    return TRUE;
  });
}

}  // namespace

BOOL BitBlt(HDC dc, int x, int y, int width, int height, HDC source, int sourceX, int sourceY,
            DWORD rop) {
  return BlitBetween(dc, Axis{x, width, sourceX, width}, Axis{y, height, sourceY, height}, source,
                     rop);
}

BOOL PatBlt(HDC dc, int x, int y, int width, int height, DWORD rop) {
  if (UsesSource(rop)) {
    SetError(ERROR_INVALID_PARAMETER);
    return FALSE;
  }
  return BlitBetween(dc, Axis{x, width, 0, 0}, Axis{y, height, 0, 0}, nullptr, rop);
}

BOOL StretchBlt(HDC dc, int x, int y, int width, int height, HDC source, int sourceX, int sourceY,
                int sourceWidth, int sourceHeight, DWORD rop) {
  return BlitBetween(dc, StretchAxis(x, width, sourceX, sourceWidth),
                     StretchAxis(y, height, sourceY, sourceHeight), source, rop);
}
