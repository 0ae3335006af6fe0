#include <cli/Cuts.h>
#include <cli/Mip.h>
#include <cli/Resample.h>
#include <cli/SheetView.h>
#include <cli/Values.h>
#include <study/Error.h>
#include <vorl/GUI/VGAxis.h>
#include <vorl/GUI/VGBitmapView.h>
#include <vorl/GUI/VGCrossCursorView.h>
#include <vorl/GUI/VGRect.h>

#include <algorithm>
#include <cmath>
#include <cstdio>
#include <utility>

namespace cli {
namespace {

/// So much of a pixel the image is moved to the right and down: its edges are meant to lie on those
/// of pixels, and must not be cut down to the ones before.
constexpr double kHair = 0.02;
constexpr double kNarrowWindow = 5;  ///< in which tenths are not enough

study::PlaneGeometry OnePixel(const study::Study& study, study::Plane plane) {
  study::PlaneRequest request;
  request.plane = plane;
  request.width = request.height = 1;
  return MakePlane(study, request);
}

/// The patient's coordinate along a direction that is one of the axes, or against it.
double SignOf(const study::Vec3& direction) {
  return direction.x + direction.y + direction.z < 0 ? -1 : 1;
}

/// With tenths, or as many decimals as tell where a narrow window ends.
std::string WindowText(const RealWindow& window, const std::string& unit) {
  const int decimals = window.width < kNarrowWindow ? DecimalsFor(window.width) + 2 : 1;
  const double power = std::pow(10, decimals);
  const auto text = [power](double value) { return NumberText(std::round(value * power) / power); };
  std::string line = "C " + text(window.centre) + "  W " + text(window.width);
  return unit.empty() ? line : line.append("  ").append(unit);
}

}  // namespace

ViewExtent ExtentOf(const study::Study& study, study::Plane plane) {
  const PlaneFrame frame(OnePixel(study, plane).coordinates);
  const study::Extent x = study::ExtentAlong(study, frame.right);
  const study::Extent y = study::ExtentAlong(study, frame.down);
  return {x.maximum - x.minimum, y.maximum - y.minimum};
}

double MiddleDown(const study::Study& study, study::Plane plane) {
  const PlaneFrame frame(OnePixel(study, plane).coordinates);
  const study::Extent y = study::ExtentAlong(study, frame.down);
  return 0.5 * (y.minimum + y.maximum) * SignOf(frame.down);
}

SheetView::SheetView(study::Study& study, const SheetCanvas& canvas, const ViewContent& content,
                     const ViewPlace& place, const study::Progress& progress)
    : m_canvas(canvas),
      m_content(content),
      m_place(place),
      m_picture(WithoutMargins(place.rect, place.margins)),
      m_frame(OnePixel(study, content.plane).coordinates),
      m_viewPort(canvas),
      m_texts(canvas, m_picture),
      m_title(canvas, {m_picture.left, place.rect.top, m_picture.right,
                       m_picture.top - canvas.GetPenWidth()}) {
  const study::Extent x = study::ExtentAlong(study, m_frame.right);
  const study::Extent y = study::ExtentAlong(study, m_frame.down);
  const double halfWidth = 0.5 * static_cast<double>(m_picture.right - m_picture.left);
  const double halfHeight = 0.5 * static_cast<double>(m_picture.bottom - m_picture.top);
  const double middleX = 0.5 * (x.minimum + x.maximum);
  const double middleY = 0.5 * (y.minimum + y.maximum);
  m_shown = {middleX - halfWidth * place.mmPerPixel, middleY - halfHeight * place.mmPerPixel,
             middleX + halfWidth * place.mmPerPixel, middleY + halfHeight * place.mmPerPixel};
  m_viewPort.Place(Rect2D(static_cast<float>(m_shown.left), static_cast<float>(m_shown.top),
                          static_cast<float>(m_shown.right), static_cast<float>(m_shown.bottom)),
                   place.rect, place.margins, true);
  MakeImage(study, progress);
  AddFrame();
}

// Only the pixels that meet the volume: the rest is background. The plane is sampled at the voxels,
// and then interpolated for the pixels.
void SheetView::MakeImage(study::Study& study, const study::Progress& progress) {
  const double spacing = m_place.mmPerPixel;
  const auto range = [spacing](const study::Extent& extent, double first, int count) {
    const double low = std::floor((extent.minimum - first) / spacing + 1e-3);
    const double high = std::ceil((extent.maximum - first) / spacing - 1e-3);
    const int begin = static_cast<int>(std::clamp(low, 0.0, count - 1.0));
    return std::pair(begin, static_cast<int>(std::clamp(high, begin + 1.0, double(count))));
  };
  const int width = static_cast<int>(m_picture.right - m_picture.left);
  const int height = static_cast<int>(m_picture.bottom - m_picture.top);
  const auto [left, right] = range(study::ExtentAlong(study, m_frame.right), m_shown.left, width);
  const auto [top, bottom] = range(study::ExtentAlong(study, m_frame.down), m_shown.top, height);

  const study::PlaneRequest plane = VoxelPlane(study, m_content.plane, m_content.cursor);
  const study::Progress part = study::PartOf(progress, 0, 0.8);
  const auto cut = m_content.isProjection ? ProjectMaximum(study, {plane}, part)
                                          : CutPlane(study, {plane}, part);
  const auto picture = Resample(*cut,
                                {m_shown.left + left * spacing, m_shown.top + top * spacing,
                                 spacing, right - left, bottom - top},
                                study::PartOf(progress, 0.8, 1));
  dImage levels;
  MakePicture(*picture, m_content.display, levels);
  m_image = levels;
  m_imageLeft = left;
  m_imageTop = top;
  auto& view = AddTo<VGBitmapView>(m_viewPort.Inside(), colour::kPicture);
  const dVect2D from = GraphicAt(left + kHair, top + kHair);
  const dVect2D to = GraphicAt(right + kHair, bottom + kHair);
  if (!view.Init(&m_image, from, to)) {
    throw study::Error(std::string("can't show the picture: ") +
                       static_cast<const char*>(view.GetStatus()));
  }
}

/// The point of the plane at a position in the picture, in pixels from its corner.
dVect2D SheetView::GraphicAt(double pixelX, double pixelY) const {
  return {static_cast<float>(m_shown.left + pixelX * m_place.mmPerPixel),
          static_cast<float>(m_shown.top + pixelY * m_place.mmPerPixel)};
}

void SheetView::AddFrame() {
  auto& frame = AddTo<VGRectView>(m_viewPort.Around(), m_content.colour);
  const double width = static_cast<double>(m_picture.right - m_picture.left);
  const double height = static_cast<double>(m_picture.bottom - m_picture.top);
  const double aside = 0.5 * m_canvas.GetPenWidth();
  frame.SetPenThickness(m_canvas.GetPenWidth());
  frame.Init(GraphicAt(-aside, -aside), GraphicAt(width + aside, height + aside));
}

void SheetView::Annotate(const study::Study& study) {
  AddCursor();
  if (m_place.hasRulers) {
    AddRulers();
  }
  AddLetters();
  AddTitle(study);
}

void SheetView::AddCursor() {
  auto& cursor = AddTo<VGCrossCursorView>(m_viewPort.Inside(), colour::kStrong);
  cursor.Set(m_frame.X(m_content.cursor), m_frame.Y(m_content.cursor));
  cursor.SetPenThickness(m_canvas.GetPenWidth());
  cursor.SetCursorColors(static_cast<long>(m_content.acrossColour),
                         static_cast<long>(m_content.downColour));
}

// The plane's coordinates are the patient's, or run against them.
void SheetView::AddRulers() {
  m_unitX.SetUnitTrafo(0, SignOf(m_frame.right), 0);
  m_unitY.SetUnitTrafo(0, SignOf(m_frame.down), 0);
  m_unitX.SetUnitText(0, "mm", "millimetres");
  AddRuler(true, m_unitX);
  AddRuler(false, m_unitY);
}

// Beside the frame.
void SheetView::AddRuler(bool isHorizontal, UnitTrafo& unit) {
  auto& ruler = AddTo<VGAxisView>(m_viewPort.Around(), colour::kText);
  const double width = static_cast<double>(m_picture.right - m_picture.left);
  const double height = static_cast<double>(m_picture.bottom - m_picture.top);
  const double aside = m_canvas.GetPenWidth() + 0.5;
  const double length = (isHorizontal ? width : height) * m_place.mmPerPixel;
  ruler.Init(isHorizontal ? GraphicAt(0, height + aside) : GraphicAt(-aside, 0), length,
             isHorizontal ? TAxis_X : TAxis_Y, "");
  ruler.SetPenThickness(m_canvas.GetPenWidth());
  ruler.SetAxisUnit(&unit);
  ruler.SetAxisFonts(m_canvas.GetFont(), m_canvas.GetFont());
  ruler.SetDisplayFlags(VGAxisDisplay_Ticks | VGAxisDisplay_Labels | VGAxisDisplay_UnitText);
  ruler.DefineAxisScala(static_cast<float>(kLinesPerTick * m_canvas.GetLineHeight()), 0);
  ruler.SetGrayColor(static_cast<long>(colour::kQuiet));
  // The unit stands at the end of the row of labels.
  ruler.SetUnitTextAttributes(dVect2D(0.0F, 10.0F), 4, static_cast<long>(colour::kQuiet));
}

void SheetView::AddLetters() {
  constexpr int kInset = 4;
  constexpr int kLeastLines = 5;
  if (std::min(m_picture.right - m_picture.left, m_picture.bottom - m_picture.top) <
      kLeastLines * m_canvas.GetLineHeight()) {
    return;
  }
  const TextLook look{colour::kStrong, true, true};
  const auto write = [&](const study::Vec3& direction, double x, double y) {
    const std::string letter(1, study::DirectionLetter(direction));
    const TextSize size = m_canvas.SizeOf(letter, true);
    const auto at = [](LONG low, LONG high, double part, int length) {
      const double room = static_cast<double>(high - low) - 2 * kInset - length;
      return static_cast<int>(low) + kInset + static_cast<int>(std::lround(part * room));
    };
    m_texts.Write(letter, at(m_picture.left, m_picture.right, x, size.width),
                  at(m_picture.top, m_picture.bottom, y, size.height), look);
  };
  write(m_frame.right * -1, 0, 0.5);
  write(m_frame.right, 1, 0.5);
  write(m_frame.down * -1, 0.5, 0);
  write(m_frame.down, 0.5, 1);
}

// The window goes before a long name, and that before the position.
void SheetView::AddTitle(const study::Study& study) {
  const int y = static_cast<int>(m_place.rect.top);
  const TextLook nameLook{m_content.colour, true, false};
  const int left = static_cast<int>(m_picture.left);
  const std::string window = WindowText(m_content.display.window, study.unit);
  const int gap = m_canvas.GetLineHeight() / 2;
  const int room =
      static_cast<int>(m_picture.right - m_picture.left) - m_canvas.SizeOf(window).width - gap;
  const bool isShort = m_canvas.SizeOf(m_content.name, true).width > room;
  const std::string& name = isShort ? m_content.shortName : m_content.name;
  if (!m_title.Write(name, left, y, nameLook)) {
    return;
  }
  m_title.WriteBefore(window, static_cast<int>(m_picture.right), y, {});
  if (!m_content.isProjection) {
    const char axis = "zyx"[static_cast<int>(m_content.plane)];
    const double position = Dot(m_content.cursor, m_frame.normal) * SignOf(m_frame.normal);
    char text[96];
    std::snprintf(text, sizeof text, "%c = %s mm", axis, FixedText(position, 1).c_str());
    m_title.Write(text, left + m_canvas.SizeOf(name, true).width + gap, y, {});
  }
}

void SheetView::Draw() {
  m_viewPort.Draw();
  m_texts.Draw();
  m_title.Draw();
}

}  // namespace cli
