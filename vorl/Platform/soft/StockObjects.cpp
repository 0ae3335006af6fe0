#include <vorl/Platform/soft/DeviceContext.h>

#include <array>
#include <cstring>

inline namespace vorl {
namespace vorl_detail {
namespace {

constexpr int kStockCount = DEFAULT_GUI_FONT + 1;

template <class T, class... Arguments>
std::shared_ptr<T> MakeStock(Arguments... arguments) {
  auto object = std::make_shared<T>(arguments...);
  object->stock = true;
  HandleTable::Instance().Add(object);
  return object;
}

LOGFONTA FontOf(LONG height, LONG weight, DWORD pitchAndFamily, const char* face) {
  LOGFONTA font{};
  font.lfHeight = height;
  font.lfWeight = weight;
  font.lfPitchAndFamily = static_cast<BYTE>(pitchAndFamily);
  std::strncpy(font.lfFaceName, face, LF_FACESIZE - 1);
  return font;
}

using Stock = std::array<std::shared_ptr<Object>, kStockCount>;

Stock MakeStockObjects() {
  Stock stock;
  const auto at = [&stock](int index) -> std::shared_ptr<Object>& {
    return stock[static_cast<std::size_t>(index)];
  };
  at(WHITE_BRUSH) = MakeStock<Brush>(BS_SOLID, RGB(255, 255, 255));
  at(LTGRAY_BRUSH) = MakeStock<Brush>(BS_SOLID, RGB(192, 192, 192));
  at(GRAY_BRUSH) = MakeStock<Brush>(BS_SOLID, RGB(128, 128, 128));
  at(DKGRAY_BRUSH) = MakeStock<Brush>(BS_SOLID, RGB(64, 64, 64));
  at(BLACK_BRUSH) = MakeStock<Brush>(BS_SOLID, RGB(0, 0, 0));
  at(NULL_BRUSH) = MakeStock<Brush>(BS_NULL, RGB(0, 0, 0));
  at(WHITE_PEN) = MakeStock<Pen>(PS_SOLID, 0, RGB(255, 255, 255));
  at(BLACK_PEN) = MakeStock<Pen>(PS_SOLID, 0, RGB(0, 0, 0));
  at(NULL_PEN) = MakeStock<Pen>(PS_NULL, 0, RGB(0, 0, 0));
  at(OEM_FIXED_FONT) = MakeStock<Font>(FontOf(12, FW_NORMAL, FIXED_PITCH | FF_MODERN, ""));
  at(ANSI_FIXED_FONT) = MakeStock<Font>(FontOf(12, FW_NORMAL, FIXED_PITCH | FF_MODERN, "Courier"));
  at(ANSI_VAR_FONT) =
      MakeStock<Font>(FontOf(12, FW_NORMAL, VARIABLE_PITCH | FF_SWISS, "MS Sans Serif"));
  at(SYSTEM_FONT) = MakeStock<Font>(FontOf(16, FW_BOLD, VARIABLE_PITCH | FF_SWISS, "System"));
  at(DEVICE_DEFAULT_FONT) =
      MakeStock<Font>(FontOf(16, FW_BOLD, VARIABLE_PITCH | FF_SWISS, "System"));
  at(SYSTEM_FIXED_FONT) =
      MakeStock<Font>(FontOf(16, FW_NORMAL, FIXED_PITCH | FF_MODERN, "Courier"));
  at(DEFAULT_GUI_FONT) =
      MakeStock<Font>(FontOf(-11, FW_NORMAL, VARIABLE_PITCH | FF_SWISS, "MS Shell Dlg"));
  return stock;
}

}  // namespace

std::shared_ptr<Object> StockObject(int index) {
  // Never destroyed, as the table that knows them.
  static const Stock& stock = *new Stock(MakeStockObjects());
  return index >= 0 && index < kStockCount ? stock[static_cast<std::size_t>(index)] : nullptr;
}

std::shared_ptr<Bitmap> StockBitmap() {
  static const std::shared_ptr<Bitmap>& bitmap = *new std::shared_ptr<Bitmap>([] {
    auto made = MakeStock<Bitmap>();
    made->surface.width = 1;
    made->surface.height = 1;
    made->surface.format = DefaultFormat(1);
    made->rowBytes = 2;
    return made;
  }());
  return bitmap;
}

}  // namespace vorl_detail
}  // namespace vorl
