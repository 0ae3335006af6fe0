#include <cli/Sheet.h>
#include <cli/SheetHistogram.h>
#include <cli/SheetView.h>
#include <cli/TextLayer.h>
#include <cli/Values.h>
#include <study/Planes.h>

#include <algorithm>
#include <cmath>

namespace cli {
namespace {

constexpr int kTicks = 8 + 2 + 4;        ///< of a ruler, and gaps
constexpr double kHistogramShape = 1.6;  ///< height by width, at most
constexpr double kTableShare = 0.3;      ///< of a panel that lies below
constexpr int kTableLine = 4;            ///< thirds of the text's height

using Contents = std::array<ViewContent, kViewCount>;

Contents ContentsOf(const SheetContent& sheet) {
  using study::Plane;
  Display projection = sheet.display;
  projection.window = sheet.projectionWindow;
  return {{{"Axial", "Axial", Plane::Axial, false, sheet.display, sheet.cursor, colour::kAxial,
            colour::kCoronal, colour::kSagittal},
           {"Maximum intensity", "MIP", Plane::Coronal, true, projection, sheet.cursor,
            colour::kQuiet, colour::kAxial, colour::kSagittal},
           {"Coronal", "Coronal", Plane::Coronal, false, sheet.display, sheet.cursor,
            colour::kCoronal, colour::kAxial, colour::kSagittal},
           {"Sagittal", "Sagittal", Plane::Sagittal, false, sheet.display, sheet.cursor,
            colour::kSagittal, colour::kAxial, colour::kCoronal}}};
}

/// What the labels of the vertical rulers of a plan take. Between the ends of a ruler none is wider
/// than there.
int LabelWidth(const study::Study& study, const Contents& views, const SheetPlan& plan,
               const SheetCanvas& canvas) {
  int width = 0;
  for (std::size_t i = 0; i < kViewCount; ++i) {
    const double scale = plan.mmPerPixel[i];
    const tagRECT picture = WithoutMargins(plan.views[i], plan.margins);
    const double half = 0.5 * static_cast<double>(picture.bottom - picture.top) * scale;
    // The ticks are at least so far from each other.
    const double step = kLinesPerTick * canvas.GetLineHeight() * scale;
    const double middle = MiddleDown(study, views[i].plane);
    // Labels of one digit get a decimal.
    const int decimals = DecimalsFor(step) + (std::abs(middle) + half < 10 ? 1 : 0);
    for (const double value : {middle - half, middle + half}) {
      width = std::max(width, canvas.SizeOf(FixedText(value, decimals)).width);
    }
  }
  return width;
}

/// Labels depend on the scale, and the scale on the room that labels take: a plan whose labels turn
/// out wider is made again.
SheetPlan MakePlan(const study::Study& study, const SheetContent& content, const Contents& views,
                   const SheetCanvas& canvas) {
  constexpr int kTrials = 5;
  const int ticks = kTicks + canvas.GetPenWidth();
  SheetRequest request;
  request.width = content.width;
  request.height = content.height;
  request.layout = content.layout;
  request.isAnnotated = content.isAnnotated;
  request.lineHeight = canvas.GetLineHeight();
  request.penWidth = canvas.GetPenWidth();
  request.rulerWidth = ticks;
  request.rulerHeight = canvas.GetLineHeight() + ticks;
  for (std::size_t i = 0; i < kViewCount; ++i) {
    request.extents[i] = ExtentOf(study, views[i].plane);
  }
  SheetPlan plan = PlanSheet(request);
  for (int trial = 0; trial < kTrials && plan.hasRulers; ++trial) {
    const int needed = LabelWidth(study, views, plan, canvas) + ticks;
    if (needed <= request.rulerWidth) {
      break;
    }
    request.rulerWidth = needed;
    plan = PlanSheet(request);
  }
  return plan;
}

void DrawBackground(const SheetContent& content, const SheetCanvas& canvas) {
  const Rect2D all(0, 0, static_cast<float>(content.width), static_cast<float>(content.height));
  GraphicViewPort sheet(all, all, all);
  sheet.SetBgColor(static_cast<long>(colour::kSheet));
  sheet.UpdateTransformation();
  const SavedState state(canvas.GetDC());
  sheet.EraseBkgnd(canvas.GetDC(), nullptr, false);
}

void DrawHeader(const study::Study& study, const SheetCanvas& canvas, const tagRECT& rect) {
  TextLayer texts(canvas, rect);
  const dCoordSys3D& place = study.volume.GetCoordinates();
  const auto spacing = [](const dVect3D& axis) {
    return NumberText(std::round(Length(study::ToVec3(axis)) * 1e3) / 1e3);
  };
  const std::string title = study.description.empty() ? "Volume" : study.description;
  const int y = static_cast<int>(rect.top) + canvas.GetLineHeight() / 4;
  texts.Write(title, static_cast<int>(rect.left), y, {colour::kStrong, true, false});
  texts.WriteBefore(
      std::to_string(study.volume.GetSizeX()) + " x " + std::to_string(study.volume.GetSizeY()) +
          " x " + std::to_string(study.volume.GetSizeZ()) + " voxels of " + spacing(place.axisX) +
          " x " + spacing(place.axisY) + " x " + spacing(place.axisZ) + " mm",
      static_cast<int>(rect.right), y, {});
  texts.Draw();
}

/// Rows as far as they fit, names at the left, values at the right, or below where both together
/// are too wide.
void DrawTable(const ResultTable& results, const SheetCanvas& canvas, const tagRECT& rect) {
  TextLayer texts(canvas, rect);
  const int left = static_cast<int>(rect.left);
  const int right = static_cast<int>(rect.right);
  int y = static_cast<int>(rect.top);
  texts.Write("Measurements", left, y, {colour::kStrong, true, false});
  for (const auto& [name, value] : results) {
    y += canvas.GetLineHeight() * kTableLine / 3;
    if (!texts.Write(name, left, y, {colour::kQuiet, false, false})) {
      break;
    }
    if (!texts.WriteBefore(value, right, y, {})) {
      y += canvas.GetLineHeight();
      texts.WriteBefore(value, right, y, {});
    }
  }
  texts.Draw();
}

void DrawPanel(const study::Study& study, const SheetContent& content, const SheetCanvas& canvas,
               const tagRECT& panel) {
  tagRECT histogram = panel;
  tagRECT table = panel;
  const LONG width = panel.right - panel.left;
  const LONG height = panel.bottom - panel.top;
  const int line = canvas.GetLineHeight();
  const LONG tableHeight = static_cast<LONG>(content.results.size() + 2) * line * kTableLine / 3;
  if (height > width) {
    histogram.bottom =
        std::min({panel.top + static_cast<LONG>(std::lround(kHistogramShape * double(width))),
                  std::max(panel.bottom - tableHeight, panel.top + height / 2)});
    table.top = histogram.bottom + line;
  } else {
    table.left = panel.right - static_cast<LONG>(std::lround(kTableShare * double(width)));
    histogram.right = table.left - 2 * line;
  }
  SheetHistogram(study, content.display.window, canvas, histogram).Draw();
  DrawTable(content.results, canvas, table);
}

}  // namespace

void DrawSheet(study::Study& study, const SheetContent& content, const SheetCanvas& canvas,
               const study::Progress& progress) {
  const Contents views = ContentsOf(content);
  const SheetPlan plan = MakePlan(study, content, views, canvas);
  DrawBackground(content, canvas);
  for (std::size_t i = 0; i < kViewCount; ++i) {
    const auto share = [](std::size_t done) { return static_cast<double>(done) / kViewCount; };
    SheetView view(study, canvas, views[i],
                   {plan.views[i], plan.margins, plan.mmPerPixel[i], plan.hasRulers},
                   study::PartOf(progress, share(i), share(i + 1)));
    if (content.isAnnotated) {
      view.Annotate(study);
      if (i == 0) {
        view.Show(content.measured);
      }
    }
    view.Draw();
  }
  if (!IsEmptyRect(plan.header)) {
    DrawHeader(study, canvas, plan.header);
  }
  if (!IsEmptyRect(plan.panel)) {
    DrawPanel(study, content, canvas, plan.panel);
  }
}

}  // namespace cli
