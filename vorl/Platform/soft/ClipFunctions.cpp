#include <vorl/Platform/soft/DeviceContext.h>

using vorl::vorl_detail::DeviceContext;
using vorl::vorl_detail::Find;
using vorl::vorl_detail::Guarded;
using vorl::vorl_detail::Ordered;
using vorl::vorl_detail::Region;
using vorl::vorl_detail::RegionObject;
using vorl::vorl_detail::SetError;

int IntersectClipRect(HDC dc, int left, int top, int right, int bottom) {
  return Guarded(RGN_ERROR, [&] {
    const auto context = Find<DeviceContext>(dc);
    if (!context) {
      return RGN_ERROR;
    }
    const Region rect(Ordered(left, top, right, bottom));
    if (context->state.clip) {
      context->state.clip->Intersect(rect);
    } else {
      context->state.clip = rect;
    }
    context->Update();
    return context->state.clip->Complexity();
  });
}

int ExcludeClipRect(HDC dc, int left, int top, int right, int bottom) {
  return Guarded(RGN_ERROR, [&] {
    const auto context = Find<DeviceContext>(dc);
    if (!context) {
      return RGN_ERROR;
    }
    if (!context->state.clip) {
      context->state.clip = Region(context->Target().Bounds());
    }
    context->state.clip->Subtract(Ordered(left, top, right, bottom));
    context->Update();
    return context->state.clip->Complexity();
  });
}

int SelectClipRgn(HDC dc, HRGN region) {
  return Guarded(RGN_ERROR, [&] {
    const auto context = Find<DeviceContext>(dc);
    if (!context) {
      return RGN_ERROR;
    }
    if (region == nullptr) {
      context->state.clip.reset();
      context->Update();
      return SIMPLEREGION;
    }
    const auto object = Find<RegionObject>(region);
    if (!object) {
      return RGN_ERROR;
    }
    context->state.clip = object->region;
    context->Update();
    return context->state.clip->Complexity();
  });
}

int GetClipBox(HDC dc, LPRECT rect) {
  return Guarded(RGN_ERROR, [&] {
    const auto context = Find<DeviceContext>(dc);
    if (!context || rect == nullptr) {
      SetError(context ? ERROR_INVALID_PARAMETER : ERROR_INVALID_HANDLE);
      return RGN_ERROR;
    }
    *rect = context->Visible().Extents();
    return context->Visible().Complexity();
  });
}
