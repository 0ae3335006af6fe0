#include <vorl/Platform/Gdi.h>
#include <vorl/Platform/soft/DeviceContext.h>
#include <vorl/Platform/soft/ShapePainter.h>

#include <cstddef>
#include <memory>
#include <vector>

using vorl_detail::DeviceContext;
using vorl_detail::GridPoint;
using vorl_detail::Guarded;
using vorl_detail::ShapePainter;

BOOL LineTo(HDC dc, int x, int y) {
  return Guarded<BOOL>(FALSE, [&]() -> BOOL {
    const auto context = vorl_detail::Find<DeviceContext>(dc);
    if (!context) {
      return FALSE;
    }
    const POINT from = context->state.position;
    ShapePainter(*context).Line({from.x, from.y}, {x, y});
    context->state.position = {x, y};
    return TRUE;
  });
}

BOOL Polygon(HDC dc, const POINT* points, int count) {
  return Guarded<BOOL>(FALSE, [&]() -> BOOL {
    const auto context = vorl_detail::Find<DeviceContext>(dc);
    if (!context) {
      return FALSE;
    }
    if (points == nullptr || count < 2) {
      vorl_detail::SetError(ERROR_INVALID_PARAMETER);
      return FALSE;
    }
    std::vector<GridPoint> corners;
    corners.reserve(static_cast<std::size_t>(count));
    for (int i = 0; i < count; ++i) {
      corners.push_back({points[i].x, points[i].y});
    }
    ShapePainter(*context).Polygon(corners);
    return TRUE;
  });
}

BOOL Rectangle(HDC dc, int left, int top, int right, int bottom) {
  return Guarded<BOOL>(FALSE, [&]() -> BOOL {
    const auto context = vorl_detail::Find<DeviceContext>(dc);
    if (!context) {
      return FALSE;
    }
    ShapePainter(*context).Rectangle({left, top}, {right, bottom});
    return TRUE;
  });
}
