#include <vorl/Platform/soft/DeviceContext.h>

#include <cstring>

inline namespace vorl {
namespace vorl_detail {
namespace {

template <class T>
Selected<T> SelectStock(int index) {
  auto object = std::static_pointer_cast<T>(StockObject(index));
  HandleTable::Instance().SelectAgain(*object);
  return Selected<T>(std::move(object));
}

Selected<Bitmap> SelectStockBitmap() {
  auto bitmap = StockBitmap();
  HandleTable::Instance().SelectAgain(*bitmap);
  return Selected<Bitmap>(std::move(bitmap));
}

}  // namespace

DeviceContext::DeviceContext(bool isScreen) : Object(kKind), screen(isScreen) {
  state.pen = SelectStock<Pen>(BLACK_PEN);
  state.brush = SelectStock<Brush>(WHITE_BRUSH);
  state.font = SelectStock<Font>(SYSTEM_FONT);
  state.bitmap = SelectStockBitmap();
  Update();
}

void DeviceContext::Update() {
  m_surface = state.bitmap->surface;
  if (screen) {
    m_surface = Surface{};
    m_surface.format = TrueColour();
  } else if (state.bitmap->stock) {
    m_surface.top = m_ownPixel;
  }
  Region visible(m_surface.Bounds());
  if (state.clip) {
    visible.Intersect(*state.clip);
  }
  m_visible = std::move(visible);
}

std::uint32_t DeviceContext::PixelOf(COLORREF colour) const {
  return NearestPixel(m_surface.format, colour);
}

}  // namespace vorl_detail
}  // namespace vorl
