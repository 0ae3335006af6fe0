#include <vorl/Platform/soft/Painter.h>

using vorl::vorl_detail::BitOperation;
using vorl::vorl_detail::Brush;
using vorl::vorl_detail::ColourOf;
using vorl::vorl_detail::DeviceContext;
using vorl::vorl_detail::Find;
using vorl::vorl_detail::Guarded;
using vorl::vorl_detail::NearestPixel;
using vorl::vorl_detail::Ordered;
using vorl::vorl_detail::Painter;
using vorl::vorl_detail::ReadPixel;
using vorl::vorl_detail::Rop2Operation;
using vorl::vorl_detail::SetError;
using vorl::vorl_detail::Surface;

namespace {

// Rectangles with exchanged corners cover as many pixels, with the first corner included.
RECT Covered(const RECT& rect) {
  const std::int64_t dx = rect.right < rect.left ? 1 : 0;
  const std::int64_t dy = rect.bottom < rect.top ? 1 : 0;
  return Ordered(rect.left + dx, rect.top + dy, rect.right + dx, rect.bottom + dy);
}

}  // namespace

COLORREF SetPixel(HDC dc, int x, int y, COLORREF colour) {
  return Guarded(CLR_INVALID, [&] {
    const auto context = Find<DeviceContext>(dc);
    if (!context || !context->Visible().Contains(x, y)) {
      return CLR_INVALID;
    }
    const Surface& target = context->Target();
    const std::uint32_t pixel = NearestPixel(target.format, colour);
    Painter(*context, Rop2Operation(context->state.rop2, pixel)).Point(x, y);
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
      Painter(*context, BitOperation{0, context->PixelOf(chosen->colour)}).Fill(Covered(*rect));
    }
    return 1;
  });
}
