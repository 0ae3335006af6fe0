// How an axis is drawn, as far as the clip box shows it:
//
// 1. the ticks, then the line and the arrow over them,
// 2. the highlighted values,
// 3. the unit text,
// 4. the labels, at as many main ticks as have room for one.
//
// A text that finds no room is left out, so what is written first is what matters most.
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
constexpr int kHLMark = 9;  ///< to both sides: labels begin where it ends
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

bool Holds(const tagRECT& rect, double x, double y) {
  return x >= rect.left && x < rect.right && y >= rect.top && y < rect.bottom;
}

/// How far a span has to be moved to lie between two limits.
int WayInto(int from, int to, int low, int high) {
  const std::int64_t way = std::int64_t{low} - from;
  return ToDevice(way > 0 ? way : std::min<std::int64_t>(0, std::int64_t{high} - to));
}

}  // namespace

/// One drawing of an axis. The label font is selected.
class VGAxisView::Painter {
 public:
  Painter(HDC dc, const VGAxisView& view)
      : m_dc(dc),
        m_view(view),
        m_isHorizontal(view.IsHorizontal()),
        m_isInteger(view.m_unit != nullptr && view.m_unit->IsIntegerUnit()) {
    view.GetValueRange(m_start, m_end);
    m_step = view.CalcScalaValueDistance();
    m_length = view.m_viewVector.Length();
    GetClipBox(dc, &m_clip);
    ChooseSteps();
    if (!(m_step > 0.0) || !FindShownRange()) {
      m_step = 0.0;
    } else if (Shows(VGAxisDisplay_Labels)) {
      PlanLabels();
    }
  }

  void DrawTicks() const {
    if (!Shows(VGAxisDisplay_Ticks) || m_step <= 0.0) {
      return;
    }
    if (m_parts > 1) {
      const ColoredPen pen(m_dc, m_view, m_view.m_gray);
      const double minorStep = m_step / m_parts;
      ForEachStep(minorStep, [&](double step) {
        if (std::fmod(step, m_parts) != 0.0) {
          DrawTick(pen, step * minorStep, kMinorTick);
        }
      });
    }
    const ColoredPen pen(m_dc, m_view, static_cast<std::uint32_t>(m_view.GetPenColor()));
    ForEachStep(m_step, [&](double step) { DrawTick(pen, step * m_step, kMainTick); });
  }

  void DrawLine() const {
    const ShapePen pen(m_dc, m_view, m_view.GetPenThickness());
    if (Shows(VGAxisDisplay_Line)) {
      pen.Line(m_view.m_viewPos, Tip());
    }
    if (Shows(VGAxisDisplay_Arrow) && m_length > 0.0) {
      const dVect2D along = m_view.m_viewVector * (1.0 / m_length);
      const dVect2D back = Tip() - along * kArrowLength;
      const dVect2D aside(-along.y * kArrowWidth, along.x * kArrowWidth);
      pen.Line(Tip(), back + aside);
      pen.Line(Tip(), back - aside);
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
        pen.Across(At(t), m_isHorizontal, -kHLMark, kHLMark + 1);
      }
      if (hl.type != VGAxisHLType_Mark) {
        // One decimal more than the scale has: they lie between its ticks.
        char text[kLabelSize];
        Print(text, hl.value, m_decimals + (m_isInteger ? 0 : 1));
        const TextStyle style(m_dc, hl.color, OPAQUE, hl.bgColor, m_view.m_labelFont);
        WriteHLValue(text, At(t));
      }
    }
  }

  void DrawUnitText() {
    const char* text = m_view.GetUnitText();
    if (m_view.m_unit != nullptr && *m_view.m_unit->GetShortUnitText() != '\0') {
      text = m_view.m_unit->GetShortUnitText();
    }
    if (!Shows(VGAxisDisplay_UnitText) || *text == '\0') {
      return;
    }
    const TextStyle style(m_dc, m_view.m_unitTextColor, TRANSPARENT, 0, m_view.m_unitFont);
    if (m_view.m_hasUnitTextPlace) {
      Write(text, BoxOf(text, Tip() + m_view.m_unitTextPos, m_view.m_unitTextAlignment));
    } else if (!Write(text, UnitTextBox(text, -m_side))) {
      Write(text, UnitTextBox(text, m_side));
    }
  }

  void DrawLabels() {
    if (!Shows(VGAxisDisplay_Labels) || m_step <= 0.0) {
      return;
    }
    const TextStyle style(m_dc, m_view.GetPenColor(), TRANSPARENT, 0, m_view.m_labelFont);
    m_isLabel = true;
    ForEachStep(m_step, [&](double step) {
      if (std::fmod(step, m_stride) == 0.0) {
        char text[kLabelSize];
        Print(text, step * m_step, m_decimals);
        Write(text, BoxBeside(text, At(PlaceOf(step * m_step)), m_side, kMainTick + kTextGap));
      }
    });
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

  dVect2D Tip() const { return m_view.m_viewPos + m_view.m_viewVector; }

  /// Widens steps that are too narrow to be seen, and parts them by ticks at round values. Values
  /// of an integer unit lie at whole numbers only.
  void ChooseSteps() {
    m_perValue = m_length / std::abs(m_end - m_start);
    if (!(m_step > 0.0) || !std::isfinite(m_perValue) || !(m_perValue > 0.0)) {
      m_step = 0.0;
      return;
    }
    if (m_isInteger) {
      m_step = std::max(m_step, 1.0);
    }
    while (m_step * m_perValue < kLeastDistance) {
      m_step *= 10.0;
    }
    const double exponent = std::floor(std::log10(m_step * 1.001));
    m_digit = Truncated<int>(m_step / std::pow(10.0, exponent) + 0.5);
    int parts = m_digit == 2 ? 4 : 5;
    while (m_isInteger && std::fmod(m_step, parts) != 0.0) {
      --parts;
    }
    m_parts = m_step * m_perValue / parts >= kLeastDistance ? parts : 1;
    // All the decimals that tell the labels apart.
    m_decimals = m_view.FormatOf(m_step).decimals;
    if (!m_isInteger && exponent < 0.0) {
      m_decimals = std::max(m_decimals, Truncated<int>(-exponent));
    }
  }

  /// Finds the values, in order, between which ticks can be seen. False where there are none.
  bool FindShownRange() {
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
    m_first = m_start + from * (m_end - m_start);
    m_last = m_start + to * (m_end - m_start);
    if (m_first > m_last) {
      std::swap(m_first, m_last);
    }
    return from <= to;
  }

  /// Chooses the side of the labels, and how many main ticks lead from one to the next, by the
  /// sizes of the first and the last one.
  void PlanLabels() {
    int width = 0;
    int height = 0;
    for (const double value :
         {std::ceil(m_first / m_step) * m_step, std::floor(m_last / m_step) * m_step}) {
      char text[kLabelSize];
      Print(text, value, m_decimals);
      const tagRECT box = BoxOf(text, dVect2D(), 0);
      width = std::max(width, static_cast<int>(box.right));
      height = std::max(height, static_cast<int>(box.bottom));
    }
    const double room = kMainTick + kTextGap + (m_isHorizontal ? height : width);
    m_side = !HasRoom(1, room) && HasRoom(-1, room) ? -1 : 1;
    const dVect2D& way = m_view.m_viewVector;
    const double share = std::abs(m_isHorizontal ? way.x : way.y) / m_length;
    m_stride = StrideFor((m_isHorizontal ? width : height) + kTextGap, m_step * m_perValue * share);
  }

  /// Whether there is room on a side of all the axis.
  bool HasRoom(int side, double room) const {
    const dVect2D& pos = m_view.m_viewPos;
    const dVect2D tip = Tip();
    if (m_isHorizontal) {
      return side > 0 ? std::max(pos.y, tip.y) + room <= m_clip.bottom
                      : std::min(pos.y, tip.y) - room >= m_clip.top;
    }
    return side > 0 ? std::min(pos.x, tip.x) - room >= m_clip.left
                    : std::max(pos.x, tip.x) + room <= m_clip.right;
  }

  /// How many steps make a round number, and are together at least as long as an extent.
  double StrideFor(double extent, double distance) const {
    for (double power = 1.0; power < kMostSteps; power *= 10.0) {
      for (const int digit : {1, 2, 5}) {
        const double stride = digit * power / m_digit;
        if (stride == std::floor(stride) && stride * distance >= extent) {
          return stride;
        }
      }
    }
    return 1.0;
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

  /// Calls `visit` with the number of each multiple of a step that can be seen.
  template <class Visitor>
  void ForEachStep(double step, Visitor&& visit) const {
    constexpr double kHair = 1e-6;
    const double from = std::ceil(m_first / step - kHair);
    const double to = std::floor(m_last / step + kHair);
    if (std::abs(from) > kMostSteps || std::abs(to) > kMostSteps) {
      return;
    }
    for (double number = from; number <= to; number += 1.0) {
      visit(number + 0.0);  // never the negative zero
    }
  }

  void DrawTick(const ColoredPen& pen, double value, int length) const {
    pen.Across(At(PlaceOf(value)), m_isHorizontal, 0, m_side * (length + 1));
  }

  static void Print(char (&text)[kLabelSize], double value, int decimals) {
    std::snprintf(text, kLabelSize, "%.*f", decimals, value);
  }

  /// Ampersands are letters here.
  tagRECT BoxOf(const char* text, const dVect2D& anchor, int alignment) const {
    return TextBox(m_dc, text, anchor, alignment, DT_NOPREFIX);
  }

  /// The box of a text at a distance from the axis: below or left of it on side 1, above or right
  /// of it on side -1.
  tagRECT BoxBeside(const char* text, dVect2D pos, int side, int distance) const {
    if (m_isHorizontal) {
      pos.Add(0.0, side * distance);
      return BoxOf(text, pos, side > 0 ? 12 : 13);
    }
    pos.Add(-side * distance, 0.0);
    return BoxOf(text, pos, side > 0 ? 7 : 3);
  }

  /// The box of the unit text beside the arrow.
  tagRECT UnitTextBox(const char* text, int side) const {
    const int distance = side == m_side ? kMainTick + kTextGap : kArrowWidth + kTextGap;
    const dVect2D& way = m_view.m_viewVector;
    dVect2D pos = Tip();
    if (m_isHorizontal) {
      pos.Add(0.0, side * distance);
      return BoxOf(text, pos, (side > 0 ? 0 : 1) | (way.x < 0.0F ? 0 : 4));
    }
    pos.Add(-side * distance, 0.0);
    return BoxOf(text, pos, (side > 0 ? 4 : 0) | (way.y < 0.0F ? 0 : 1));
  }

  /// Away from the labels, or else among them. The text of a value that is seen is moved along the
  /// axis to be seen, too.
  void WriteHLValue(const char* text, const dVect2D& pos) {
    for (const int side : {-m_side, m_side}) {
      tagRECT box = BoxBeside(text, pos, side, kHLMark + 1 + kTextGap);
      if (Holds(m_clip, pos.x, pos.y) && m_isHorizontal) {
        const int way = WayInto(box.left, box.right, m_clip.left, m_clip.right);
        box = {box.left + way, box.top, box.right + way, box.bottom};
      } else if (Holds(m_clip, pos.x, pos.y)) {
        const int way = WayInto(box.top, box.bottom, m_clip.top, m_clip.bottom);
        box = {box.left, box.top + way, box.right, box.bottom + way};
      }
      if (Write(text, box)) {
        return;
      }
    }
  }

  /// Writes a text where there is room for it.
  bool Write(const char* text, tagRECT box) {
    if (!IsInside(box, m_clip) ||
        std::any_of(m_taken, m_taken + m_numTaken,
                    [&box](const tagRECT& other) { return AreTooClose(box, other); })) {
      return false;
    }
    DrawTextA(m_dc, text, -1, &box, DT_NOPREFIX);
    // Labels follow each other: only the last one can be in the way of the next.
    if (!m_isLabel || !m_hasLabel) {
      ++m_numTaken;
      m_hasLabel = m_isLabel;
    }
    m_taken[m_numTaken - 1] = box;
    return true;
  }

  HDC m_dc;
  const VGAxisView& m_view;
  bool m_isHorizontal;
  bool m_isInteger;  ///< the unit
  tagRECT m_clip{};
  double m_start = 0.0;
  double m_end = 0.0;
  double m_first = 0.0;  ///< of the values that can be seen
  double m_last = 0.0;
  double m_length = 0.0;
  double m_perValue = 0.0;  ///< the length of 1 on the device
  double m_step = 0.0;      ///< of the main ticks; 0: there is no scale
  int m_digit = 1;          ///< its first one: 1, 2 or 5
  int m_parts = 1;          ///< into which the shorter ticks part it
  double m_stride = 1.0;    ///< main ticks from one label to the next
  int m_decimals = 0;
  int m_side = 1;           ///< of ticks and labels; -1: above or right of the axis
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
  painter.DrawTicks();
  painter.DrawLine();
  painter.DrawHLValues();
  painter.DrawUnitText();
  painter.DrawLabels();
}

}  // namespace vorl
