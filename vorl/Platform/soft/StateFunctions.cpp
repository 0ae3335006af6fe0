#include <vorl/Platform/soft/DeviceContext.h>

#include <utility>

using vorl::vorl_detail::DeviceContext;
using vorl::vorl_detail::DrawState;
using vorl::vorl_detail::Find;
using vorl::vorl_detail::Guarded;
using vorl::vorl_detail::SetError;

namespace {

// Replaces one value of a context's state and returns the one before.
template <class Value>
Value Exchange(HDC dc, Value DrawState::*member, Value value, Value failure) {
  return Guarded(failure, [&] {
    const auto context = Find<DeviceContext>(dc);
    return context ? std::exchange(context->state.*member, value) : failure;
  });
}

int ExchangeMode(HDC dc, int DrawState::*member, int mode, int last) {
  if (mode < 1 || mode > last) {
    SetError(ERROR_INVALID_PARAMETER);
    return 0;
  }
  return Exchange(dc, member, mode, 0);
}

}  // namespace

int SetStretchBltMode(HDC dc, int mode) {
  return ExchangeMode(dc, &DrawState::stretchMode, mode, HALFTONE);
}

int SetPolyFillMode(HDC dc, int mode) {
  return ExchangeMode(dc, &DrawState::polyFillMode, mode, WINDING);
}

int SetROP2(HDC dc, int rop) {
  return ExchangeMode(dc, &DrawState::rop2, rop, R2_LAST);
}

int SetBkMode(HDC dc, int mode) {
  return ExchangeMode(dc, &DrawState::backgroundMode, mode, OPAQUE);
}

COLORREF SetTextColor(HDC dc, COLORREF colour) {
  return Exchange(dc, &DrawState::textColour, colour, CLR_INVALID);
}

COLORREF SetBkColor(HDC dc, COLORREF colour) {
  return Exchange(dc, &DrawState::backgroundColour, colour, CLR_INVALID);
}

BOOL MoveToEx(HDC dc, int x, int y, LPPOINT old) {
  return Guarded(FALSE, [&]() -> BOOL {
    const auto context = Find<DeviceContext>(dc);
    if (!context) {
      return FALSE;
    }
    const POINT before = std::exchange(context->state.position, POINT{x, y});
    if (old != nullptr) {
      *old = before;
    }
    return TRUE;
  });
}
