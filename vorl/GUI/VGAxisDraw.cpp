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
#include <vorl/GUI/detail/AxisScale.h>
#include <vorl/GUI/detail/ShapePen.h>
#include <vorl/GUI/detail/ShapeText.h>

#include <algorithm>
#include <cmath>
#include <cstdio>

inline namespace vorl {

using vorl_detail::AxisScale;
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
        m_isInteger(view.m_unit != nullptr && view.m_unit->IsIntegerUnit()),
        m_length(view.m_viewVector.Length()),
        m_scale(ScaleOf(view, m_length, m_isInteger)) {
    GetClipBox(dc, &m_clip);
    const double margin = std::abs(static_cast<double>(view.GetPenThickness())) + 1.0;
    m_hasScale = m_scale.Step() > 0.0;
    if (m_hasScale) {
      // All the decimals that tell the labels apart.
      m_decimals = view.FormatOf(m_scale.Step()).decimals;
      m_decimals = m_isInteger ? m_decimals : std::max(m_decimals, -m_scale.Exponent());
      m_hasScale = m_scale.Show(view.m_viewPos, view.m_viewVector, m_clip, margin);
    }
    if (m_hasScale && Shows(VGAxisDisplay_Labels)) {
      PlanLabels();
    }
  }

  void DrawTicks() const {
    if (!Shows(VGAxisDisplay_Ticks) || !m_hasScale) {
      return;
    }
    const double mainStep = m_scale.Step();
    if (m_scale.Parts() > 1) {
      const ColoredPen pen(m_dc, m_view, m_view.m_gray);
      const double minorStep = mainStep / m_scale.Parts();
      m_scale.ForEachStep(minorStep, [&](double step) {
        if (std::fmod(step, m_scale.Parts()) != 0.0) {
          DrawTick(pen, step * minorStep, kMinorTick);
        }
      });
    }
    const ColoredPen pen(m_dc, m_view, static_cast<std::uint32_t>(m_view.GetPenColor()));
    m_scale.ForEachStep(mainStep, [&](double step) { DrawTick(pen, step * mainStep, kMainTick); });
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
      const double t = m_scale.PlaceOf(hl.value);
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
    if (!Shows(VGAxisDisplay_Labels) || !m_hasScale) {
      return;
    }
    const TextStyle style(m_dc, m_view.GetPenColor(), TRANSPARENT, 0, m_view.m_labelFont);
    m_isLabel = true;
    const double mainStep = m_scale.Step();
    m_scale.ForEachStep(mainStep, [&](double step) {
      if (std::fmod(step, m_stride) == 0.0) {
        char text[kLabelSize];
        Print(text, step * mainStep, m_decimals);
        Write(text,
              BoxBeside(text, At(m_scale.PlaceOf(step * mainStep)), m_side, kMainTick + kTextGap));
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

  static AxisScale ScaleOf(const VGAxisView& view, double length, bool isInteger) {
    double start = 0.0;
    double end = 0.0;
    view.GetValueRange(start, end);
    return {start, end, length, view.CalcScalaValueDistance(), isInteger};
  }

  /// Chooses the side of the labels, and how many main ticks lead from one to the next, by the
  /// sizes of the first and the last one.
  void PlanLabels() {
    int width = 0;
    int height = 0;
    const double step = m_scale.Step();
    for (const double value :
         {std::ceil(m_scale.First() / step) * step, std::floor(m_scale.Last() / step) * step}) {
      char text[kLabelSize];
      Print(text, value, m_decimals);
      const tagRECT box = BoxOf(text, dVect2D(), 0);
      width = std::max(width, static_cast<int>(box.right));
      height = std::max(height, static_cast<int>(box.bottom));
    }
    const double room = kMainTick + kTextGap + (m_isHorizontal ? height : width);
    m_side = !HasRoom(1, room) && HasRoom(-1, room) ? -1 : 1;
    const dVect2D& way = m_view.m_viewVector;
    const double distance = std::abs(m_scale.LengthOf(step) * (m_isHorizontal ? way.x : way.y));
    m_stride = m_scale.StrideFor((m_isHorizontal ? width : height) + kTextGap, distance);
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

  dVect2D At(double t) const {
    // A hair is added, so that a place that was meant to be whole is not cut down to the one
    // before.
    constexpr double kHair = 1e-3;
    dVect2D pos;
    pos.Set(m_view.m_viewPos.x + t * m_view.m_viewVector.x + kHair,
            m_view.m_viewPos.y + t * m_view.m_viewVector.y + kHair);
    return pos;
  }

  void DrawTick(const ColoredPen& pen, double value, int length) const {
    pen.Across(At(m_scale.PlaceOf(value)), m_isHorizontal, 0, m_side * (length + 1));
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
  double m_length;
  AxisScale m_scale;
  bool m_hasScale = false;
  double m_stride = 1.0;  ///< main ticks from one label to the next
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
