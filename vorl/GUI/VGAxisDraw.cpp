// How an axis is drawn: its line, the highlighted values and the unit text, and then ticks and
// labels as far as the clip box shows them. A text that finds no room is left out, so what is drawn
// first is what matters most.
#include <vorl/GUI/VGAxis.h>

#include <vorl/GUI/Trafo1D.h>
#include <vorl/GUI/detail/ShapePen.h>
#include <vorl/GUI/detail/ShapeText.h>

#include <algorithm>
#include <cmath>
#include <cstdio>
#include <utility>

inline namespace vorl {

using vorl_detail::ShapePen;
using vorl_detail::ShapeROP;
using vorl_detail::TextBox;
using vorl_detail::TextStyle;
using vorl_detail::ToDevice;
using vorl_detail::Truncated;

namespace {

constexpr int kMainTick = 8;
constexpr int kMinorTick = 4;
constexpr int kHLMark = 10;  ///< to both sides
constexpr int kArrowLength = 8;
constexpr int kArrowWidth = 4;  ///< to both sides
constexpr int kTextGap = 2;
/// Ticks that are closer than this, in device units, cannot be told apart.
constexpr double kLeastDistance = 4.0;
/// From here on neighbouring multiples of a step are not exact any more.
constexpr double kMostSteps = 1e15;
/// The longest number: 309 digits, as many decimals as a format has, sign and point.
constexpr std::size_t kLabelSize = 700;

bool IsInside(const tagRECT& inner, const tagRECT& outer) {
  return inner.left >= outer.left && inner.right <= outer.right && inner.top >= outer.top &&
         inner.bottom <= outer.bottom;
}

/// The boxes are closer to each other than texts should be.
bool AreTooClose(const tagRECT& a, const tagRECT& b) {
  return a.left < std::int64_t{b.right} + kTextGap && b.left < std::int64_t{a.right} + kTextGap &&
         a.top < b.bottom && b.top < a.bottom;
}

}  // namespace

/// One drawing of an axis.
class VGAxisView::Painter {
 public:
  Painter(HDC dc, const VGAxisView& view) : m_dc(dc), m_view(view) {
    view.GetValueRange(m_start, m_end);
    m_step = view.CalcScalaValueDistance();
    m_length = view.m_viewVector.Length();
    GetClipBox(dc, &m_clip);
    ChooseSteps();
  }

  void DrawLine() const {
    const ShapePen pen(m_dc, m_view, m_view.GetPenThickness());
    if (Shows(VGAxisDisplay_Line)) {
      pen.Line(m_view.m_viewPos, m_view.m_viewPos + m_view.m_viewVector);
    }
    if (Shows(VGAxisDisplay_Arrow) && m_length > 0.0) {
      const dVect2D tip = m_view.m_viewPos + m_view.m_viewVector;
      const dVect2D along = m_view.m_viewVector * (1.0 / m_length);
      const dVect2D back = tip - along * kArrowLength;
      const dVect2D aside(-along.y * kArrowWidth, along.x * kArrowWidth);
      pen.Line(tip, back + aside);
      pen.Line(tip, back - aside);
    }
  }

  void DrawHLValues() {
    for (const HLValue& hl : m_view.m_hlValues) {
      const double t = PlaceOf(hl.value);
      if (!hl.isEnabled || !(t >= 0.0 && t <= 1.0)) {
        continue;
      }
      if (hl.type != VGAxisHLType_Value) {
        const ColoredPen pen(m_dc, m_view, hl.color);
        pen.Across(At(t), m_view.IsHorizontal(), -kHLMark, kHLMark + 1);
      }
      if (hl.type != VGAxisHLType_Mark) {
        // One decimal more than the scale has: they lie between its ticks.
        const bool isInteger = m_view.m_unit != nullptr && m_view.m_unit->IsIntegerUnit();
        char text[kLabelSize];
        Print(text, hl.value, m_decimals + (isInteger ? 0 : 1));
        const TextStyle style(m_dc, hl.color, OPAQUE, hl.bgColor, m_view.m_labelFont);
        Write(text, BesideAxis(At(t), -(kHLMark + kTextGap)), m_view.IsHorizontal() ? 13 : 3);
      }
    }
  }

  void DrawUnitText() {
    const char* text = m_view.GetUnitText();
    if (m_view.m_unit != nullptr && *m_view.m_unit->GetShortUnitText() != '\0') {
      text = m_view.m_unit->GetShortUnitText();
    }
    if (Shows(VGAxisDisplay_UnitText) && *text != '\0') {
      const TextStyle style(m_dc, m_view.m_unitTextColor, TRANSPARENT, 0, m_view.m_unitFont);
      Write(text, m_view.m_viewPos + m_view.m_viewVector + m_view.m_unitTextPos,
            m_view.m_unitTextAlignment);
    }
  }

  void DrawScala() {
    double first = 0.0;
    double last = 0.0;
    if (m_step <= 0.0 || !ShownRange(first, last)) {
      return;
    }
    if (Shows(VGAxisDisplay_Ticks) && m_parts > 1) {
      const ColoredPen pen(m_dc, m_view, m_view.m_gray);
      const double minorStep = m_step / m_parts;
      ForEachStep(first, last, minorStep, [&](double step) {
        if (std::fmod(step, m_parts) != 0.0) {
          DrawTick(pen, step * minorStep, kMinorTick);
        }
      });
    }
    if (Shows(VGAxisDisplay_Ticks)) {
      const ColoredPen pen(m_dc, m_view, static_cast<std::uint32_t>(m_view.GetPenColor()));
      ForEachStep(first, last, m_step,
                  [&](double step) { DrawTick(pen, step * m_step, kMainTick); });
    }
    if (Shows(VGAxisDisplay_Labels)) {
      const TextStyle style(m_dc, m_view.GetPenColor(), TRANSPARENT, 0, m_view.m_labelFont);
      m_isLabel = true;
      ForEachStep(first, last, m_step, [&](double step) { DrawLabel(step * m_step); });
    }
  }

 private:
  /// A pen of the axis in another colour.
  class ColoredPen {
   public:
    ColoredPen(HDC dc, const VGAxisView& view, std::uint32_t color)
        : m_dc(dc),
          m_pen(CreatePen(PS_SOLID, view.GetPenThickness(), static_cast<COLORREF>(color))),
          m_old(SelectObject(dc, m_pen)) {}
    ColoredPen(const ColoredPen&) = delete;
    ColoredPen& operator=(const ColoredPen&) = delete;
    ~ColoredPen() {
      if (m_old != nullptr) {
        SelectObject(m_dc, m_old);
      }
      DeleteObject(m_pen);
    }
    /// A line across a horizontal axis, downwards, or a vertical one, leftwards.
    void Across(const dVect2D& pos, bool isHorizontal, int from, int to) const {
      const int x = Truncated<int>(pos.x);
      const int y = Truncated<int>(pos.y);
      const auto moved = [](int place, int way) { return ToDevice(std::int64_t{place} + way); };
      MoveToEx(m_dc, isHorizontal ? x : moved(x, -from), isHorizontal ? moved(y, from) : y,
               nullptr);
      LineTo(m_dc, isHorizontal ? x : moved(x, -to), isHorizontal ? moved(y, to) : y);
    }

   private:
    HDC m_dc;
    HPEN m_pen;
    HGDIOBJ m_old;
  };

  bool Shows(int flag) const { return (m_view.m_displayFlags & flag) != 0; }

  /// Widens steps that are too narrow to be seen, and parts them by ticks at round values.
  void ChooseSteps() {
    const double perValue = m_length / std::abs(m_end - m_start);
    if (!(m_step > 0.0) || !std::isfinite(perValue) || !(perValue > 0.0)) {
      m_step = 0.0;
      return;
    }
    while (m_step * perValue < kLeastDistance) {
      m_step *= 10.0;
    }
    const double exponent = std::floor(std::log10(m_step * 1.001));
    const double mantissa = m_step / std::pow(10.0, exponent);
    const int parts = mantissa > 1.5 && mantissa < 3.0 ? 4 : 5;
    m_parts = m_step * perValue / parts >= kLeastDistance ? parts : 1;
    const bool isInteger = m_view.m_unit != nullptr && m_view.m_unit->IsIntegerUnit();
    // All the decimals that tell the labels apart.
    m_decimals = m_view.FormatOf(m_step).decimals;
    if (!isInteger && exponent < 0.0) {
      m_decimals = std::max(m_decimals, Truncated<int>(-exponent));
    }
  }

  /// Where a value stands, in lengths of the axis.
  double PlaceOf(double value) const { return (value - m_start) / (m_end - m_start); }

  dVect2D At(double t) const {
    // A hair is added, so that a place that was meant to be whole is not cut down to the one
    // before.
    constexpr double kHair = 1e-3;
    dVect2D pos;
    pos.Set(m_view.m_viewPos.x + t * m_view.m_viewVector.x + kHair,
            m_view.m_viewPos.y + t * m_view.m_viewVector.y + kHair);
    return pos;
  }

  dVect2D BesideAxis(dVect2D pos, int way) const {
    if (m_view.IsHorizontal()) {
      pos.Add(0.0, way);
    } else {
      pos.Add(-way, 0.0);
    }
    return pos;
  }

  /// The values, in order, between which ticks can be seen. False where there are none.
  bool ShownRange(double& first, double& last) const {
    const dVect2D& pos = m_view.m_viewPos;
    const dVect2D& way = m_view.m_viewVector;
    const bool alongX = std::abs(way.x) >= std::abs(way.y);
    const double margin = std::abs(static_cast<double>(m_view.GetPenThickness())) + 1.0;
    const double low = (alongX ? m_clip.left : m_clip.top) - margin;
    const double high = (alongX ? m_clip.right : m_clip.bottom) + margin;
    double from = (low - (alongX ? pos.x : pos.y)) / (alongX ? way.x : way.y);
    double to = (high - (alongX ? pos.x : pos.y)) / (alongX ? way.x : way.y);
    if (from > to) {
      std::swap(from, to);
    }
    from = std::max(from, 0.0);
    to = std::min(to, 1.0);
    first = m_start + from * (m_end - m_start);
    last = m_start + to * (m_end - m_start);
    if (first > last) {
      std::swap(first, last);
    }
    return from <= to;
  }

  /// Calls `visit` with the number of each multiple of a step from the first value to the last.
  template <class Visitor>
  static void ForEachStep(double first, double last, double step, Visitor&& visit) {
    constexpr double kHair = 1e-6;
    const double from = std::ceil(first / step - kHair);
    const double to = std::floor(last / step + kHair);
    if (std::abs(from) > kMostSteps || std::abs(to) > kMostSteps) {
      return;
    }
    for (double number = from; number <= to; number += 1.0) {
      visit(number + 0.0);  // never the negative zero
    }
  }

  void DrawTick(const ColoredPen& pen, double value, int length) const {
    pen.Across(At(PlaceOf(value)), m_view.IsHorizontal(), 0, length + 1);
  }

  void DrawLabel(double value) {
    const bool isInteger = m_view.m_unit != nullptr && m_view.m_unit->IsIntegerUnit();
    if (isInteger && std::abs(value - std::round(value)) > m_step * 1e-3) {
      return;
    }
    char text[kLabelSize];
    Print(text, value, m_decimals);
    Write(text, BesideAxis(At(PlaceOf(value)), kMainTick + kTextGap),
          m_view.IsHorizontal() ? 12 : 7);
  }

  static void Print(char (&text)[kLabelSize], double value, int decimals) {
    std::snprintf(text, kLabelSize, "%.*f", decimals, value);
  }

  /// Writes a text where there is room for it.
  void Write(const char* text, const dVect2D& anchor, int alignment) {
    tagRECT box = TextBox(m_dc, text, anchor, alignment);
    if (!IsInside(box, m_clip) ||
        std::any_of(m_taken, m_taken + m_numTaken,
                    [&box](const tagRECT& other) { return AreTooClose(box, other); })) {
      return;
    }
    DrawTextA(m_dc, text, -1, &box, DT_NOPREFIX);
    // Labels follow each other: only the last one can be in the way of the next.
    if (!m_isLabel || !m_hasLabel) {
      ++m_numTaken;
      m_hasLabel = m_isLabel;
    }
    m_taken[m_numTaken - 1] = box;
  }

  HDC m_dc;
  const VGAxisView& m_view;
  tagRECT m_clip{};
  double m_start = 0.0;
  double m_end = 0.0;
  double m_length = 0.0;
  double m_step = 0.0;  ///< of the main ticks; 0: there is no scale
  int m_parts = 1;      ///< into which the shorter ticks part it
  int m_decimals = 0;
  tagRECT m_taken[4] = {};  ///< by highlighted values, the unit text and the last label
  int m_numTaken = 0;
  bool m_isLabel = false;
  bool m_hasLabel = false;
};

void VGAxisView::DrawGraphic(HDC dc) {
  if (dc == nullptr || m_displayFlags == 0) {
    return;
  }
  const ShapeROP rop(dc, *this);
  // Also for the line, whose gaps, if it has any, are not filled.
  const TextStyle style(dc, GetPenColor(), TRANSPARENT, 0, m_labelFont);
  Painter painter(dc, *this);
  painter.DrawLine();
  painter.DrawHLValues();
  painter.DrawUnitText();
  painter.DrawScala();
}

}  // namespace vorl
