#include <vorl/Platform/soft/DeviceContext.h>

#include <new>

using vorl::vorl_detail::DeviceContext;
using vorl::vorl_detail::Enter;
using vorl::vorl_detail::Find;
using vorl::vorl_detail::Guarded;
using vorl::vorl_detail::HandleTable;
using vorl::vorl_detail::SetError;

HDC CreateCompatibleDC(HDC dc) {
  return Guarded(HDC{}, [&]() -> HDC {
    if (dc != nullptr && !Find<DeviceContext>(dc)) {
      return nullptr;
    }
    return Enter<HDC>(std::make_shared<DeviceContext>(false));
  });
}

BOOL DeleteDC(HDC dc) {
  return Guarded(FALSE, [&]() -> BOOL {
    const auto context = Find<DeviceContext>(dc);
    if (!context || context->screen) {
      SetError(ERROR_INVALID_HANDLE);
      return FALSE;
    }
    return HandleTable::Instance().Remove(dc, true);
  });
}

HDC GetDC(HWND window) {
  return Guarded(HDC{}, [&]() -> HDC {
    if (window != nullptr) {
      SetError(ERROR_INVALID_HANDLE);
      return nullptr;
    }
    return Enter<HDC>(std::make_shared<DeviceContext>(true));
  });
}

int ReleaseDC(HWND window, HDC dc) {
  return Guarded(0, [&] {
    const auto context = Find<DeviceContext>(dc);
    if (window != nullptr || !context || !context->screen) {
      SetError(ERROR_INVALID_HANDLE);
      return 0;
    }
    return HandleTable::Instance().Remove(dc, true) ? 1 : 0;
  });
}

int SaveDC(HDC dc) {
  return Guarded(0, [&] {
    const auto context = Find<DeviceContext>(dc);
    if (!context) {
      return 0;
    }
    context->saved.push_back(context->state);
    return static_cast<int>(context->saved.size());
  });
}

BOOL RestoreDC(HDC dc, int level) {
  return Guarded(FALSE, [&]() -> BOOL {
    const auto context = Find<DeviceContext>(dc);
    if (!context) {
      return FALSE;
    }
    const auto count = static_cast<std::int64_t>(context->saved.size());
    const std::int64_t index = level < 0 ? count + level : std::int64_t{level} - 1;
    if (index < 0 || index >= count) {
      SetError(ERROR_INVALID_PARAMETER);
      return FALSE;
    }
    context->state = std::move(context->saved[static_cast<std::size_t>(index)]);
    context->saved.resize(static_cast<std::size_t>(index));
    context->Update();
    return TRUE;
  });
}

BOOL GdiFlush() {
  return TRUE;
}
