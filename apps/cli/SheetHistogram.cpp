#include <cli/SheetHistogram.h>
#include <cli/Values.h>
#include <vorl/GUI/VGAxis.h>
#include <vorl/GUI/VGCurve.h>
#include <vorl/GUI/VGLine.h>
#include <vorl/GUI/VGRect.h>

#include <algorithm>
#include <cmath>
#include <numeric>
#include <vector>

namespace cli {
namespace {

constexpr double kTail = 1e-5;
constexpr double kMargin = 0.02;         ///< of the values, at both ends
constexpr double kLeastTicks = 5;        ///< of the axis
constexpr double kMostMargin = 0.15;     ///< of the axis
constexpr double kAir = 1.06;            ///< the upper end, in heights of the curve
constexpr int kRulerLength = 8 + 2 + 3;  ///< ticks and gaps
constexpr int kWidestLabels = 4;         ///< in lines, from label to label
constexpr COLORREF kBars = 0x5F5752;

/// The first and the last stored value that matter.
void FindEnds(const Histogram& counts, double& first, double& last) {
  const double all = std::accumulate(counts.begin(), counts.end(), 0.0);
  const auto pass = [&](auto begin, auto end) {
    double passed = 0;
    return static_cast<double>(std::find_if(begin, end,
                                            [&](std::uint64_t count) {
                                              passed += static_cast<double>(count);
                                              return passed > kTail * all;
                                            }) -
                               begin);
  };
  first = pass(counts.begin(), counts.end());
  last = static_cast<double>(kStoredValues) - pass(counts.rbegin(), counts.rend());
}

/// The curve's height for each column of pixels, 0 to 1: the share of the largest count, both as
/// logarithms. Values are put together where a column has more than one.
std::vector<float> Heights(const Histogram& counts, double first, double step, int columns) {
  const auto bin = static_cast<std::int64_t>(std::ceil(step));
  std::vector<double> heights;
  double largest = 0;
  for (int column = 0; column < columns; ++column) {
    const auto middle = static_cast<std::int64_t>(std::floor(first + (column + 0.5) * step));
    const std::int64_t begin = middle >= 0 ? middle / bin * bin : -bin;
    double count = 0;
    for (std::int64_t value = begin; value < begin + bin; ++value) {
      if (value >= 0 && value < static_cast<std::int64_t>(kStoredValues)) {
        count += static_cast<double>(counts[static_cast<std::size_t>(value)]);
      }
    }
    heights.push_back(std::log1p(count));
    largest = std::max(largest, heights.back());
  }
  std::vector<float> shares;
  for (const double height : heights) {
    shares.push_back(static_cast<float>(largest > 0 ? -height / largest : 0));
  }
  return shares;
}

}  // namespace

SheetHistogram::SheetHistogram(const study::Study& study, const RealWindow& window,
                               const SheetCanvas& canvas, const tagRECT& rect)
    : m_canvas(canvas),
      m_rect(rect),
      m_viewPort(canvas),
      m_title(canvas, {rect.left, rect.top, rect.right, rect.top + canvas.GetLineHeight() + 1}) {
  const Histogram counts = HistogramOf(study);
  FindEnds(counts, m_first, m_last);
  AddMargins(study);
  PlaceViewPort();
  AddCurve(counts);
  AddFrame();
  AddWindow(study.StoredValue(window.centre - 0.5 * window.width),
            study.StoredValue(window.centre + 0.5 * window.width));
  AddAxis(study);
  m_title.Write("Histogram", static_cast<int>(rect.left), static_cast<int>(rect.top),
                {colour::kStrong, true, false});
  m_title.WriteBefore("voxels, logarithmic", static_cast<int>(rect.right),
                      static_cast<int>(rect.top), {colour::kQuiet, false, false});
}

// The label of a value at either end must fit, too.
void SheetHistogram::AddMargins(const study::Study& study) {
  const double values = m_last - m_first;
  const int columns = std::max(1, static_cast<int>(m_rect.right - m_rect.left));
  const int decimals = DecimalsFor(values * study.scale / kLeastTicks);
  int label = 0;
  for (const double value : {m_first, m_last}) {
    const std::string text = FixedText(study.RealValue(value), decimals);
    label = std::max(label, m_canvas.SizeOf(text).width);
  }
  const double share = std::min(kMostMargin, 0.5 * (label + 4 * m_canvas.GetPenWidth()) / columns);
  const double margin = std::max({0.5, kMargin * values, values * share / (1 - 2 * share)});
  m_first -= margin;
  m_last += margin;
}

void SheetHistogram::PlaceViewPort() {
  const int line = m_canvas.GetLineHeight();
  const int frame = m_canvas.GetPenWidth();
  const Margins margins{frame, line + line / 3, frame, line + kRulerLength};
  m_picture = WithoutMargins(m_rect, margins);
  m_viewPort.Place(Rect2D(static_cast<float>(m_first), static_cast<float>(-kAir),
                          static_cast<float>(m_last), 0.0F),
                   m_rect, margins, false);
}

// One bar and one point of the outline for each column of pixels.
void SheetHistogram::AddCurve(const Histogram& counts) {
  const int columns = static_cast<int>(m_picture.right - m_picture.left);
  const double step = (m_last - m_first) / columns;
  std::vector<float> heights = Heights(counts, m_first, step, columns);
  for (const bool isOutline : {false, true}) {
    auto& curve = AddTo<VGCurveView>(m_viewPort.Inside(), isOutline ? colour::kText : kBars);
    curve.SetPenThickness(isOutline ? m_canvas.GetPenWidth() : 1);
    curve.SetDrawMode(isOutline ? CurveDrawMode_Polyline : CurveDrawMode_Bars);
    curve.SetData(static_cast<float>(m_first + 0.5 * step), static_cast<float>(step), columns,
                  heights.data(), CurveStorageMode_Copy);
  }
}

void SheetHistogram::AddFrame() {
  const double width = 0.5 * m_canvas.GetPenWidth();
  const double x =
      width * (m_last - m_first) / static_cast<double>(m_picture.right - m_picture.left);
  const double y = width * kAir / static_cast<double>(m_picture.bottom - m_picture.top);
  auto& frame = AddTo<VGRectView>(m_viewPort.Around(), colour::kFrame);
  frame.SetPenThickness(m_canvas.GetPenWidth());
  frame.Init(static_cast<float>(m_first - x), static_cast<float>(-kAir - y),
             static_cast<float>(m_last + x), static_cast<float>(y));
}

void SheetHistogram::AddWindow(double low, double high) {
  const auto add = [this](double x1, double y1, double x2, double y2, int style) {
    auto& line = AddTo<VGLineView>(m_viewPort.Inside(), colour::kMeasured);
    line.SetPenStyle(style);
    line.SetPenThickness(m_canvas.GetPenWidth());
    line.Init(dVect2D(static_cast<float>(x1), static_cast<float>(y1)),
              dVect2D(static_cast<float>(x2), static_cast<float>(y2)), TLine_Segment);
  };
  add(low, 0, low, -kAir, PS_DOT);
  add(high, 0, high, -kAir, PS_DOT);
  add(low, 0, high, -1, PS_SOLID);
}

void SheetHistogram::AddAxis(const study::Study& study) {
  m_unit.SetUnitTrafo(0, study.scale, study.offset);
  m_unit.SetUnitText(0, study.unit.c_str(), study.unit.c_str());
  const double below = 0.5 * kAir / static_cast<double>(m_picture.bottom - m_picture.top);
  auto& axis = AddTo<VGAxisView>(m_viewPort.Around(), colour::kText);
  axis.Init(dVect2D(static_cast<float>(m_first), static_cast<float>(below)), m_last - m_first,
            TAxis_X, "");
  axis.SetPenThickness(m_canvas.GetPenWidth());
  axis.SetAxisUnit(&m_unit);
  axis.SetAxisFonts(m_canvas.GetFont(), m_canvas.GetFont());
  axis.SetDisplayFlags(VGAxisDisplay_Line | VGAxisDisplay_Ticks | VGAxisDisplay_Labels |
                       VGAxisDisplay_UnitText);
  axis.DefineAxisScala(static_cast<float>(kWidestLabels * m_canvas.GetLineHeight()), 0);
  axis.SetGrayColor(static_cast<long>(colour::kQuiet));
  axis.SetUnitTextAttributes(dVect2D(0.0F, 10.0F), 4, static_cast<long>(colour::kQuiet));
}

void SheetHistogram::Draw() {
  m_viewPort.Draw();
  m_title.Draw();
}

}  // namespace cli
