// What is measured in a view, and the labels of the results.
#include <cli/SheetView.h>
#include <vorl/GUI/VGLine.h>
#include <vorl/GUI/VGRect.h>

#include <algorithm>
#include <cmath>
#include <vector>

namespace cli {
namespace {

constexpr int kLabelGap = 4;

}  // namespace

tagRECT SheetView::PixelsOf(const PlaneRect& rect) const {
  Rect2D view(static_cast<float>(rect.left), static_cast<float>(rect.top),
              static_cast<float>(rect.right), static_cast<float>(rect.bottom));
  m_viewPort.GetViewPort().GraphicToView(view);
  const auto pixel = [](float position) { return static_cast<LONG>(std::floor(position)); };
  return {pixel(view.GetTL().x), pixel(view.GetTL().y), pixel(view.GetBR().x) + 1,
          pixel(view.GetBR().y) + 1};
}

void SheetView::Show(const Measured& measured) {
  const std::optional<tagRECT> line =
      measured.line ? std::optional(AddLine(*measured.line)) : std::nullopt;
  const std::optional<tagRECT> region =
      measured.region ? std::optional(AddRegion(*measured.region)) : std::nullopt;
  if (line) {
    WriteLabel(measured.lineText, *line);
  }
  if (region) {
    WriteLabel(measured.regionText, *region);
  }
}

tagRECT SheetView::AddLine(const PlaneLine& measured) {
  const auto& [start, end] = measured;
  auto& line = AddTo<VGLineView>(m_viewPort.Inside(), colour::kMeasured);
  line.Init(dVect2D(static_cast<float>(start.x), static_cast<float>(start.y)),
            dVect2D(static_cast<float>(end.x), static_cast<float>(end.y)), TLine_Segment);
  line.SetPenThickness(m_canvas.GetPenWidth());
  line.Select(true);
  const tagRECT place = PixelsOf({std::min(start.x, end.x), std::min(start.y, end.y),
                                  std::max(start.x, end.x), std::max(start.y, end.y)});
  m_texts.Take(place);
  return place;
}

tagRECT SheetView::AddRegion(const PlaneRect& region) {
  auto& rect = AddTo<VGRectView>(m_viewPort.Inside(), colour::kMeasured);
  rect.SetPenThickness(m_canvas.GetPenWidth());
  rect.Init(static_cast<float>(region.left), static_cast<float>(region.top),
            static_cast<float>(region.right), static_cast<float>(region.bottom));
  m_texts.Take(PixelsOf(region));
  return PixelsOf(region);
}

/// How bright the picture is below a rectangle of the sheet, 0 to 255.
double SheetView::Brightness(const tagRECT& rect) const {
  const int width = static_cast<int>(m_image.GetWidth());
  const int height = static_cast<int>(m_image.GetHeight());
  double sum = 0;
  for (LONG y = rect.top; y < rect.bottom; ++y) {
    for (LONG x = rect.left; x < rect.right; ++x) {
      const int i = static_cast<int>(x - m_picture.left) - m_imageLeft;
      const int j = static_cast<int>(y - m_picture.top) - m_imageTop;
      if (i >= 0 && i < width && j >= 0 && j < height) {
        sum += static_cast<const unsigned char*>(m_image.GetRowPtr(j))[i];
      }
    }
  }
  return sum / std::max(1.0, static_cast<double>(rect.right - rect.left) *
                                 static_cast<double>(rect.bottom - rect.top));
}

// Where it hides as little as possible: a dark part of the picture, and no line of the cursor.
void SheetView::WriteLabel(const std::string& text, const tagRECT& object) {
  constexpr double kHidesCursor = 256;
  const TextSize size = m_canvas.SizeOf(text);
  const int left = static_cast<int>(object.left);
  const int top = static_cast<int>(object.top);
  const int right = static_cast<int>(object.right);
  const int bottom = static_cast<int>(object.bottom);
  struct Place {
    double cost;
    int x, y;
  };
  std::vector<Place> places;
  for (const int x : {(left + right - size.width) / 2, left, right - size.width}) {
    places.push_back({0, x, top - kLabelGap - size.height});
    places.push_back({0, x, bottom + kLabelGap});
  }
  for (const int y : {(top + bottom - size.height) / 2, top, bottom - size.height}) {
    places.push_back({0, right + kLabelGap, y});
    places.push_back({0, left - kLabelGap - size.width, y});
  }
  const PlanePoint at{m_frame.X(m_content.cursor), m_frame.Y(m_content.cursor)};
  const tagRECT cursor = PixelsOf({at.x, at.y, at.x, at.y});
  for (Place& place : places) {
    const bool hides = (place.x <= cursor.left && cursor.left < place.x + size.width) ||
                       (place.y <= cursor.top && cursor.top < place.y + size.height);
    place.cost = Brightness({place.x, place.y, place.x + size.width, place.y + size.height}) +
                 (hides ? kHidesCursor : 0);
  }
  std::stable_sort(places.begin(), places.end(),
                   [](const Place& a, const Place& b) { return a.cost < b.cost; });
  for (const Place& place : places) {
    if (m_texts.Write(text, place.x, place.y, {colour::kMeasured, false, true})) {
      return;
    }
  }
}

}  // namespace cli
