#include <vorl/Platform/soft/DeviceContext.h>

#include <algorithm>
#include <cstdlib>
#include <cstring>
#include <limits>
#include <utility>

using namespace vorl::vorl_detail;

namespace {

// Selects an object in the place of another of its kind, whose handle is returned.
template <class T>
HGDIOBJ Replace(DeviceContext& context, Selected<T> DrawState::*member,
                std::shared_ptr<Object> object) {
  if (!HandleTable::Instance().Select(*object, &context)) {
    return nullptr;
  }
  Selected<T> chosen(std::static_pointer_cast<T>(std::move(object)));
  void* before = (context.state.*member)->handle;
  context.state.*member = std::move(chosen);
  return before;
}

// Device bitmaps have to suit the screen, with which all contexts are compatible, or be monochrome.
bool SuitsScreen(const Bitmap& bitmap) {
  const int depth = bitmap.surface.format.depth;
  return bitmap.section || depth == 1 || depth == 32;
}

HGDIOBJ SelectBitmap(DeviceContext& context, std::shared_ptr<Object> object) {
  if (context.screen || !SuitsScreen(static_cast<const Bitmap&>(*object))) {
    SetError(ERROR_INVALID_PARAMETER);
    return nullptr;
  }
  HGDIOBJ before = Replace<Bitmap>(context, &DrawState::bitmap, std::move(object));
  if (before != nullptr) {
    context.Update();
  }
  return before;
}

// The result of SelectClipRgn, disguised as a handle.
HGDIOBJ SelectRegion(HDC dc, HGDIOBJ region) {
  const auto result = static_cast<std::uintptr_t>(SelectClipRgn(dc, static_cast<HRGN>(region)));
  return reinterpret_cast<HGDIOBJ>(result);
}

int Fill(void* buffer, int size, const void* description, std::size_t needed) {
  if (buffer == nullptr) {
    return static_cast<int>(needed);
  }
  const std::size_t count = std::min(needed, static_cast<std::size_t>(std::max(size, 0)));
  std::memcpy(buffer, description, count);
  return static_cast<int>(count);
}

int DescribeBitmap(const Bitmap& bitmap, int size, void* buffer) {
  DIBSECTION description{};
  BITMAP& facts = description.dsBm;
  facts.bmWidth = bitmap.surface.width;
  facts.bmHeight = bitmap.surface.height;
  facts.bmWidthBytes = bitmap.rowBytes;
  facts.bmPlanes = 1;
  facts.bmBitsPixel = static_cast<WORD>(bitmap.surface.format.depth);
  facts.bmBits = bitmap.section ? bitmap.pixels.get() : nullptr;
  if (!bitmap.section || buffer == nullptr || size < static_cast<int>(sizeof description)) {
    if (buffer != nullptr && size < static_cast<int>(sizeof facts)) {
      SetError(ERROR_INVALID_PARAMETER);
      return 0;
    }
    return Fill(buffer, size, &facts, sizeof facts);
  }
  description.dsBmih = bitmap.header;
  if (bitmap.header.biCompression == BI_BITFIELDS) {
    std::copy_n(bitmap.surface.format.masks.begin(), 3, description.dsBitfields);
  }
  return Fill(buffer, size, &description, sizeof description);
}

}  // namespace

HGDIOBJ SelectObject(HDC dc, HGDIOBJ handle) {
  return Guarded(HGDIOBJ{}, [&]() -> HGDIOBJ {
    const auto context = Find<DeviceContext>(dc);
    auto object = HandleTable::Instance().Find(handle);
    if (!context || !object) {
      SetError(ERROR_INVALID_HANDLE);
      return nullptr;
    }
    switch (object->kind) {
      case ObjectKind::kBitmap:
        return SelectBitmap(*context, std::move(object));
      case ObjectKind::kBrush:
        return Replace<Brush>(*context, &DrawState::brush, std::move(object));
      case ObjectKind::kPen:
        return Replace<Pen>(*context, &DrawState::pen, std::move(object));
      case ObjectKind::kFont:
        return Replace<Font>(*context, &DrawState::font, std::move(object));
      case ObjectKind::kRegion:
        return SelectRegion(dc, handle);
      case ObjectKind::kDeviceContext:
        break;
    }
    SetError(ERROR_INVALID_HANDLE);
    return nullptr;
  });
}

BOOL DeleteObject(HGDIOBJ object) {
  return Guarded(FALSE, [&]() -> BOOL { return HandleTable::Instance().Remove(object, false); });
}

HGDIOBJ GetStockObject(int index) {
  return Guarded(HGDIOBJ{}, [&]() -> HGDIOBJ {
    const auto object = StockObject(index);
    return object ? object->handle : nullptr;
  });
}

HGDIOBJ GetCurrentObject(HDC dc, UINT kind) {
  return Guarded(HGDIOBJ{}, [&]() -> HGDIOBJ {
    const auto context = Find<DeviceContext>(dc);
    if (!context) {
      return nullptr;
    }
    const DrawState& state = context->state;
    switch (kind) {
      case OBJ_PEN:
        return state.pen->handle;
      case OBJ_BRUSH:
        return state.brush->handle;
      case OBJ_FONT:
        return state.font->handle;
      case OBJ_BITMAP:
        return state.bitmap->handle;
      default:
        SetError(ERROR_INVALID_PARAMETER);
        return nullptr;
    }
  });
}

int GetObjectA(HGDIOBJ handle, int size, LPVOID buffer) {
  return Guarded(0, [&] {
    const auto object = HandleTable::Instance().Find(handle);
    if (object && object->kind == ObjectKind::kBitmap) {
      return DescribeBitmap(static_cast<const Bitmap&>(*object), size, buffer);
    }
    if (object && object->kind == ObjectKind::kPen) {
      const auto& pen = static_cast<const Pen&>(*object);
      const LOGPEN description{static_cast<UINT>(pen.style), POINT{pen.width, 0}, pen.colour};
      return Fill(buffer, size, &description, sizeof description);
    }
    if (object && object->kind == ObjectKind::kBrush) {
      const auto& brush = static_cast<const Brush&>(*object);
      const LOGBRUSH description{brush.style, brush.colour, 0};
      return Fill(buffer, size, &description, sizeof description);
    }
    if (object && object->kind == ObjectKind::kFont) {
      const auto& font = static_cast<const Font&>(*object);
      return Fill(buffer, size, &font.description, sizeof font.description);
    }
    SetError(ERROR_INVALID_HANDLE);
    return 0;
  });
}

HBRUSH CreateSolidBrush(COLORREF colour) {
  return Guarded(HBRUSH{},
                 [&] { return Enter<HBRUSH>(std::make_shared<Brush>(BS_SOLID, colour)); });
}

HPEN CreatePen(int style, int width, COLORREF colour) {
  return Guarded(HPEN{}, [&] {
    const int known = style >= PS_SOLID && style <= PS_INSIDEFRAME ? style : PS_SOLID;
    // The largest negative number has no positive counterpart.
    const int positive = width == std::numeric_limits<int>::min() ? std::numeric_limits<int>::max()
                                                                  : std::abs(width);
    return Enter<HPEN>(std::make_shared<Pen>(known, positive, colour));
  });
}

HRGN CreateRectRgn(int left, int top, int right, int bottom) {
  return Guarded(HRGN{}, [&] {
    return Enter<HRGN>(std::make_shared<RegionObject>(Region(Ordered(left, top, right, bottom))));
  });
}
