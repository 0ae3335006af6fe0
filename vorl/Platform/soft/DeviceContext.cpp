#include <vorl/Platform/soft/DeviceContext.h>

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
  m_visible = Region();  // if memory runs out below, nothing can be drawn on
  m_surface = state.bitmap->surface;
  if (screen) {
    m_surface = Surface{};
    m_surface.format = DefaultFormat(32);
  } else if (state.bitmap->stock) {
    m_surface.top = m_ownPixel;
  }
  Region visible(m_surface.Bounds());
  if (state.clip) {
    visible.Intersect(*state.clip);
  }
  m_visible = std::move(visible);
}

// In bitmaps of one bit the two colours that there are, and the background colour, are drawn as
// what they are, or are nearest to; every other colour stands out from the background.
std::uint32_t DeviceContext::PixelOf(COLORREF colour) const {
  const PixelFormat& format = m_surface.format;
  if (format.depth != 1) {
    return NearestPixel(format, colour);
  }
  const COLORREF plain = colour & 0xFFFFFFU;
  for (std::uint32_t pixel = 0; pixel < 2; ++pixel) {
    if (plain == ColourOf(format, pixel)) {
      return pixel;
    }
  }
  const std::uint32_t background = NearestPixel(format, state.backgroundColour);
  return plain == (state.backgroundColour & 0xFFFFFFU) ? background : background ^ 1U;
}

}  // namespace vorl_detail
}  // namespace vorl
