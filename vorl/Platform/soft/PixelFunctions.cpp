#include <vorl/Platform/soft/Painter.h>

using vorl::vorl_detail::BitOperation;
using vorl::vorl_detail::Brush;
using vorl::vorl_detail::ColourOf;
using vorl::vorl_detail::DeviceContext;
using vorl::vorl_detail::Find;
using vorl::vorl_detail::Guarded;
using vorl::vorl_detail::NearestPixel;
using vorl::vorl_detail::Painter;
using vorl::vorl_detail::ReadPixel;
using vorl::vorl_detail::SetError;
using vorl::vorl_detail::Surface;
using vorl::vorl_detail::WritePixel;

COLORREF SetPixel(HDC dc, int x, int y, COLORREF colour) {
  return Guarded(CLR_INVALID, [&] {
    const auto context = Find<DeviceContext>(dc);
    if (!context || !context->Visible().Contains(x, y)) {
      return CLR_INVALID;
    }
    const Surface& target = context->Target();
    const std::uint32_t pixel = NearestPixel(target.format, colour);
    WritePixel(target.Row(y), x, target.format.depth, pixel);
    return ColourOf(target.format, pixel);
  });
}

COLORREF GetPixel(HDC dc, int x, int y) {
  return Guarded(CLR_INVALID, [&] {
    const auto context = Find<DeviceContext>(dc);
    if (!context || !context->Visible().Contains(x, y)) {
      return CLR_INVALID;
    }
    const Surface& target = context->Target();
    return ColourOf(target.format, ReadPixel(target.Row(y), x, target.format.depth));
  });
}

int FillRect(HDC dc, const RECT* rect, HBRUSH brush) {
  return Guarded(0, [&] {
    const auto context = Find<DeviceContext>(dc);
    if (!context) {
      return 0;
    }
    const auto chosen = Find<Brush>(brush);
    if (!chosen || rect == nullptr) {
      SetError(chosen ? ERROR_INVALID_PARAMETER : ERROR_INVALID_HANDLE);
      return 0;
    }
    if (chosen->style != BS_NULL) {
      // Always a copy: the raster operation of the context is for pens and shapes.
      Painter(*context, BitOperation{0, context->PixelOf(chosen->colour)}).Fill(*rect);
    }
    return 1;
  });
}
