#include <vorl/GUI/VGAxis.h>

#include <vorl/GUI/Geom2D.h>
#include <vorl/GUI/Trafo1D.h>
#include <vorl/GUI/detail/OwnedText.h>
#include <vorl/GUI/detail/Truncated.h>

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <cstdio>
#include <iterator>

inline namespace vorl {

using vorl_detail::TextOf;
using vorl_detail::Truncated;

namespace {

constexpr int kColor = 0x00E0E0;
constexpr std::uint32_t kGray = 0x808080;
constexpr std::size_t kFormatSize = 16;
// Beyond the exponent of every number.
constexpr int kMostDigits = 325;

/// The integer part of the logarithm; the lowest one for 0.
int DigitsOf(double value) {
  return std::clamp(Truncated<int>(std::log10(std::abs(value))), -kMostDigits, kMostDigits);
}

/// 10 to the power e.
double PowerOf10(int e) {
  double power = 1.0;
  double square = 10.0;
  for (int rest = std::abs(e); rest > 0; rest /= 2) {
    if (rest % 2 != 0) {
      power *= square;
    }
    square *= square;
  }
  return e < 0 ? 1.0 / power : power;
}

}  // namespace

VGAxis::VGAxis() = default;

VGAxis::VGAxis(const VGAxis& source)
    : VGObject(source),
      m_type(source.m_type),
      m_pos(source.m_pos),
      m_vector(source.m_vector),
      m_unitText(TextOf(source.GetUnitText())) {}

VGAxis& VGAxis::operator=(const VGAxis& source) {
  m_type = source.m_type;
  m_pos = source.m_pos;
  m_vector = source.m_vector;
  m_unitText = TextOf(source.GetUnitText());
  return *this;
}

VGAxis::~VGAxis() = default;

void VGAxis::Init(const dVect2D& pos, double length, TAxis type, const char* unitText) {
  m_type = type;
  m_pos = pos;
  m_vector.Set(IsHorizontal() ? length : 0.0, IsHorizontal() ? 0.0 : length);
  SetUnitText(unitText);
}

bool VGAxis::IsHorizontal() const {
  return m_type == TAxis_X;
}

TAxis VGAxis::GetType() const {
  return m_type;
}

void VGAxis::SetType(TAxis type) {
  m_type = type;
}

const dVect2D& VGAxis::GetPos() const {
  return m_pos;
}

void VGAxis::SetPos(const dVect2D& pos) {
  m_pos = pos;
}

const dVect2D& VGAxis::GetVector() const {
  return m_vector;
}

void VGAxis::SetVector(const dVect2D& vector) {
  m_vector = vector;
}

double VGAxis::GetLength() const {
  return m_vector.Length();
}

void VGAxis::SetLength(double length) {
  const double old = GetLength();
  if (old > 0.0) {
    m_vector.Set(m_vector.x / old * length, m_vector.y / old * length);
  } else {
    m_vector.Set(IsHorizontal() ? length : 0.0, IsHorizontal() ? 0.0 : length);
  }
}

const char* VGAxis::GetUnitText() const {
  return m_unitText.c_str();
}

void VGAxis::SetUnitText(const char* text) {
  m_unitText = TextOf(text);
}

void VGAxis::Transform(Trafo2DBase* trafo, bool toGraphic) {
  if (trafo == nullptr) {
    return;
  }
  if (toGraphic) {
    trafo->pB2A(m_pos);
    trafo->vB2A(m_vector);
  } else {
    trafo->pA2B(m_pos);
    trafo->vA2B(m_vector);
  }
}

VGAxisView::VGAxisView() : m_unitTextColor(kColor), m_gray(kGray) {
  SetPenColor(kColor);
}

VGAxisView::VGAxisView(const VGAxis& axis)
    : VGAxis(axis),
      m_viewPos(axis.GetPos()),
      m_viewVector(axis.GetVector()),
      m_unitTextColor(kColor),
      m_gray(kGray) {
  SetPenColor(kColor);
}

VGAxisView::VGAxisView(const VGAxisView& source) = default;

VGAxisView& VGAxisView::operator=(const VGAxis& axis) {
  SetData(axis);
  return *this;
}

VGAxisView& VGAxisView::operator=(const VGAxisView& source) {
  if (this == &source) {
    return *this;
  }
  VGObjectView::operator=(source);
  m_displayFlags = source.m_displayFlags;
  m_tickDistance = source.m_tickDistance;
  m_minValueStep = source.m_minValueStep;
  m_unit = source.m_unit;
  m_labelFont = source.m_labelFont;
  m_unitFont = source.m_unitFont;
  m_hasUnitTextPlace = source.m_hasUnitTextPlace;
  m_unitTextPos = source.m_unitTextPos;
  m_unitTextAlignment = source.m_unitTextAlignment;
  m_unitTextColor = source.m_unitTextColor;
  m_gray = source.m_gray;
  std::copy_n(source.m_hlValues, std::size(m_hlValues), m_hlValues);
  SetData(source);
  return *this;
}

VGAxisView::~VGAxisView() = default;

VGType VGAxisView::GetObjType() {
  return VGType_Axis;
}

void VGAxisView::Transform(bool toGraphic) {
  if (toGraphic) {
    SetPos(m_viewPos);
    SetVector(m_viewVector);
    Transform(GetTransformation(), true);
    return;
  }
  m_viewPos = GetPos();
  m_viewVector = GetVector();
  GetTransformation()->pA2B(m_viewPos);
  GetTransformation()->vA2B(m_viewVector);
}

bool VGAxisView::IsPointOnGraphic(dVect2D& point, int tolerance) {
  return Geom2D::IsPointOnLineSegment(point, m_viewPos, m_viewPos + m_viewVector, tolerance);
}

void VGAxisView::CalcBoundingBox(HDC /*dc*/, dVect2D& min, dVect2D& max) {
  min = m_viewPos;
  max = m_viewPos;
  UpdateBoundingBox(m_viewPos + m_viewVector, min, max);
}

void VGAxisView::SetData(const VGAxis& axis) {
  VGAxis::operator=(axis);
  Transform(false);
}

void VGAxisView::SetDisplayFlags(unsigned char flags) {
  m_displayFlags = flags;
}

unsigned char VGAxisView::GetDisplayFlags() const {
  return m_displayFlags;
}

void VGAxisView::DefineAxisScala(float tickDistance, float minValueStep) {
  m_tickDistance = std::abs(tickDistance);
  m_minValueStep = std::abs(minValueStep);
}

void VGAxisView::SetAxisUnit(UnitTrafo* unit) {
  m_unit = unit;
}

UnitTrafo* VGAxisView::GetAxisUnit() const {
  return m_unit;
}

void VGAxisView::SetAxisFonts(HFONT labelFont, HFONT unitFont) {
  m_labelFont = labelFont;
  m_unitFont = unitFont;
}

void VGAxisView::SetGrayColor(long color) {
  m_gray = static_cast<std::uint32_t>(color);
}

void VGAxisView::SetUnitTextPos(const dVect2D& pos) {
  m_hasUnitTextPlace = true;
  m_unitTextPos = pos;
}

void VGAxisView::SetUnitTextAlignment(int alignment) {
  m_hasUnitTextPlace = true;
  m_unitTextAlignment = alignment;
}

void VGAxisView::SetUnitTextColor(long color) {
  m_unitTextColor = static_cast<std::uint32_t>(color);
}

void VGAxisView::SetUnitTextAttributes(const dVect2D& pos, int alignment, long color) {
  SetUnitTextPos(pos);
  SetUnitTextAlignment(alignment);
  SetUnitTextColor(color);
}

VGAxisView::HLValue* VGAxisView::HLValueAt(int index) {
  return index == 0 || index == 1 ? &m_hlValues[index] : nullptr;
}

const VGAxisView::HLValue* VGAxisView::HLValueAt(int index) const {
  return index == 0 || index == 1 ? &m_hlValues[index] : nullptr;
}

void VGAxisView::EnableHLValue(bool enable, int index) {
  if (HLValue* const entry = HLValueAt(index)) {
    entry->isEnabled = enable;
  }
}

bool VGAxisView::IsHLValueEnabled(int index) const {
  const HLValue* const entry = HLValueAt(index);
  return entry != nullptr && entry->isEnabled;
}

void VGAxisView::SetHLValue(double value, int index) {
  if (HLValue* const entry = HLValueAt(index)) {
    entry->value = value;
  }
}

double VGAxisView::GetHLValue(int index) const {
  const HLValue* const entry = HLValueAt(index);
  return entry != nullptr ? entry->value : 0.0;
}

void VGAxisView::SetHLValueType(int type, int index) {
  if (HLValue* const entry = HLValueAt(index)) {
    entry->type = type;
  }
}

void VGAxisView::SetHLColors(long color, long bgColor, int index) {
  if (HLValue* const entry = HLValueAt(index)) {
    entry->color = static_cast<std::uint32_t>(color);
    entry->bgColor = static_cast<std::uint32_t>(bgColor);
  }
}

void VGAxisView::GetValueRange(double& start, double& end) const {
  const bool isX = IsHorizontal();
  start = isX ? GetPos().x : GetPos().y;
  end = start + (isX ? GetVector().x : GetVector().y);
  if (m_unit != nullptr) {
    start = m_unit->A2B(start);
    end = m_unit->A2B(end);
  }
}

double VGAxisView::CalcScalaValueDistance() const {
  double start = 0.0;
  double end = 0.0;
  GetValueRange(start, end);
  double raw = std::abs(m_tickDistance / m_viewVector.Length() * (end - start));
  if (m_minValueStep > raw) {
    raw = m_minValueStep;
  }
  if (!(raw > 0.0) || !std::isfinite(raw)) {
    return 0.0;
  }
  const double log = std::log10(raw);
  const double power = PowerOf10(Truncated<int>(log) - (log <= 0.0 ? 1 : 0));
  const double mantissa = raw / power;
  if (mantissa <= 1.001) {
    return power;
  }
  return (mantissa <= 2.0 ? 2.0 : mantissa <= 5.0 ? 5.0 : 10.0) * power;
}

VGAxisView::Format VGAxisView::FormatOf(double value) const {
  double start = 0.0;
  double end = 0.0;
  GetValueRange(start, end);
  // 0 has no digits of its own.
  const bool isZero = start == 0.0 && end == 0.0;
  const int digits = isZero ? 0 : std::max(DigitsOf(end), DigitsOf(start));
  int decimals = value != 0.0 && DigitsOf(value) < 0 ? -DigitsOf(value) : 0;
  if (digits == 0) {
    ++decimals;
  }
  if (m_unit != nullptr && m_unit->IsIntegerUnit()) {
    decimals = 0;
  }
  return {decimals + digits, decimals};
}

void VGAxisView::CalcValueFormat(double value, char* format) const {
  if (format == nullptr) {
    return;
  }
  double x = 0.0;
  double y = 0.0;
  GetTransformation()->vA2B(IsHorizontal() ? value : 0.0, IsHorizontal() ? 0.0 : value, x, y);
  value = IsHorizontal() ? x : y;
  if (m_unit != nullptr) {
    value = m_unit->A2B(value);
  }
  const Format found = FormatOf(value);
  std::snprintf(format, kFormatSize, "%%%d.%df", found.width, found.decimals);
}

}  // namespace vorl
