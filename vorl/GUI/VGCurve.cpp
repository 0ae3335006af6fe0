#include <vorl/GUI/VGCurve.h>

#include <vorl/Data/detail/Single.h>
#include <vorl/GUI/Geom2D.h>
#include <vorl/GUI/detail/ShapePen.h>

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <functional>
#include <new>
#include <utility>

inline namespace vorl {

using vorl_detail::ShapePen;
using vorl_detail::ShapeROP;
using vorl_detail::TransparentGaps;
using vorl_detail::Truncated;

namespace {

constexpr int kThickness = 2;
constexpr int kGreen = 0x00DD00;

}  // namespace

VGCurve::VGCurve() = default;

VGCurve::VGCurve(const VGCurve& source, CurveStorageMode mode) {
  SetData(source.m_firstX, source.m_deltaX, source.m_count, source.m_values, mode);
}

VGCurve::VGCurve(const VGCurve& source) : dVect2D(source), VGObject(source) {
  VGCurve::operator=(source);
}

VGCurve& VGCurve::operator=(const VGCurve& source) {
  if (this != &source) {
    dVect2D::operator=(source);
    SetData(source.m_firstX, source.m_deltaX, source.m_count, source.m_values,
            source.m_owned ? CurveStorageMode_Copy : CurveStorageMode_Reference);
  }
  return *this;
}

VGCurve::~VGCurve() = default;

void VGCurve::Reset() {
  m_owned.reset();
  m_values = nullptr;
  m_count = 0;
  m_firstX = 0.0F;
  m_deltaX = 0.0F;
}

bool VGCurve::SetData(float firstX, float deltaX, int count, float* values, CurveStorageMode mode) {
  std::unique_ptr<float[]> copy;
  if (mode == CurveStorageMode_Copy) {
    if (count > 0 && values != nullptr) {
      const auto size = static_cast<std::size_t>(count);
      copy.reset(new (std::nothrow) float[size]);
      if (copy) {
        std::copy_n(values, size, copy.get());  // before the old ones go: they may be the same
      }
    }
    values = copy.get();
  } else if (m_owned && !std::less<>()(values, m_owned.get()) &&
             std::less<>()(values, m_owned.get() + m_count)) {
    values = nullptr;
  }
  VGCurve::Reset();
  if (count < 1 || values == nullptr) {
    return false;
  }
  m_owned = std::move(copy);
  m_values = values;
  m_count = count;
  m_firstX = firstX;
  m_deltaX = deltaX;
  return true;
}

float* VGCurve::GetData() {
  return m_values;
}

const float* VGCurve::GetData() const {
  return m_values;
}

int VGCurve::GetSize() const {
  return m_count;
}

float VGCurve::GetFirstXVal() const {
  return m_firstX;
}

float VGCurve::GetDeltaX() const {
  return m_deltaX;
}

/// -1 where there is no value.
int VGCurve::IndexAt(float xVal) const {
  if (m_deltaX == 0.0F) {
    return -1;
  }
  // In single precision: 0.7 / 0.1 is 7 there, as the caller means it.
  const float place = (xVal - m_firstX) / m_deltaX;
  return std::isnan(place) ? -1 : Truncated<int>(place);
}

bool VGCurve::SetValue(int i, float v) {
  if (i < 0 || i >= m_count) {
    return false;
  }
  m_values[i] = v;
  return true;
}

bool VGCurve::SetValue(float xVal, float v) {
  return SetValue(IndexAt(xVal), v);
}

bool VGCurve::SetValue(double xVal, float v) {
  return SetValue(vorl_detail::Single(xVal), v);
}

float VGCurve::GetValue(int i) const {
  return i < 0 || i >= m_count ? 0.0F : m_values[i];
}

float VGCurve::GetValue(float xVal) const {
  return GetValue(IndexAt(xVal));
}

float VGCurve::GetValue(double xVal) const {
  return GetValue(vorl_detail::Single(xVal));
}

VGCurveView::VGCurveView() {
  SetPenThickness(kThickness);
  SetPenColor(kGreen);
}

VGCurveView::VGCurveView(const VGCurve& curve) : VGCurve(curve) {
  SetPenThickness(kThickness);
  SetPenColor(kGreen);
}

VGCurveView::VGCurveView(const VGCurveView& source) = default;

VGCurveView& VGCurveView::operator=(const VGCurve& curve) {
  VGCurve::operator=(curve);
  return *this;
}

VGCurveView& VGCurveView::operator=(const VGCurveView& source) {
  if (this != &source) {
    VGObjectView::operator=(source);
    VGCurve::operator=(source);
    m_drawMode = source.m_drawMode;
    m_barOrigin = source.m_barOrigin;
  }
  return *this;
}

VGCurveView::~VGCurveView() = default;

VGType VGCurveView::GetObjType() {
  return VGType_Curve;
}

void VGCurveView::Transform(bool /*toGraphic*/) {}

/// The place of sample i at a height in view coordinates. False where it has none.
bool VGCurveView::MapSample(int i, double height, dVect2D& pos) const {
  pos.Set(GetFirstXVal() + i * double{GetDeltaX()}, height);
  GetTransformation()->pA2B(pos);
  return std::isfinite(pos.x) && std::isfinite(pos.y);
}

/// Calls `visit` with start and end, in view coordinates, of each line that is drawn. A dot is a
/// line without length; so is a sample of the polyline that stands alone.
template <class Visitor>
void VGCurveView::VisitPieces(Visitor&& visit) const {
  const bool isPolyline = m_drawMode != CurveDrawMode_Bars && m_drawMode != CurveDrawMode_Dots;
  dVect2D last;
  dVect2D pos;
  bool hasLast = false;
  bool isJoined = false;
  for (int i = 0; i < GetSize(); ++i) {
    const bool hasPos = MapSample(i, GetValue(i), pos);
    if (isPolyline) {
      if (hasLast && hasPos) {
        visit(last, pos);
      } else if (hasLast && !isJoined) {
        visit(last, last);
      }
      isJoined = hasLast && hasPos;
    } else if (hasPos) {
      // From the sample on, so that its pixel is drawn rather than the origin's.
      const bool isBar = m_drawMode == CurveDrawMode_Bars;
      last = pos;
      if (!isBar || MapSample(i, m_barOrigin, last)) {
        visit(pos, last);
      }
    }
    last = pos;
    hasLast = hasPos;
  }
  if (isPolyline && hasLast && !isJoined) {
    visit(last, last);
  }
}

bool VGCurveView::IsPointOnGraphic(dVect2D& point, int tolerance) {
  bool isHit = false;
  VisitPieces([&](const dVect2D& start, const dVect2D& end) {
    isHit = isHit || Geom2D::IsPointOnPoint(point, start, tolerance) ||
            (start != end && Geom2D::IsPointOnLineSegment(point, start, end, tolerance));
  });
  return isHit;
}

void VGCurveView::DrawGraphic(HDC dc) {
  tagRECT clip{};
  GetClipBox(dc, &clip);
  const ShapePen pen(dc, *this, GetPenThickness());
  const ShapeROP rop(dc, *this);
  const TransparentGaps gaps(dc);
  const double reach = std::abs(static_cast<double>(GetPenThickness())) + 1.0;
  const auto isSeen = [&clip](const dVect2D& start, const dVect2D& end, double margin) {
    return std::trunc(std::max(start.x, end.x)) >= clip.left - margin &&
           std::min(start.x, end.x) < clip.right + margin &&
           std::trunc(std::max(start.y, end.y)) >= clip.top - margin &&
           std::min(start.y, end.y) < clip.bottom + margin;
  };
  const bool isThin = GetPenThickness() >= -1 && GetPenThickness() <= 1;
  VisitPieces([&](const dVect2D& start, const dVect2D& end) {
    const bool isDot = start == end;
    if (!isSeen(start, end, isDot ? 0.0 : reach)) {
      return;
    }
    if (!isDot || !isThin) {
      pen.Line(start, end);
    } else if (GetPenStyle() != PS_NULL) {
      // A thin pen leaves no trace on a way without length.
      SetPixel(dc, Truncated<int>(start.x), Truncated<int>(start.y),
               static_cast<COLORREF>(GetPenColor()));
    }
  });
}

void VGCurveView::CalcBoundingBox(HDC /*dc*/, dVect2D& min, dVect2D& max) {
  bool isEmpty = true;
  min.Set(0.0, 0.0);
  max.Set(0.0, 0.0);
  VisitPieces([&](const dVect2D& start, const dVect2D& end) {
    if (isEmpty) {
      min = start;
      max = start;
      isEmpty = false;
    }
    UpdateBoundingBox(start, min, max);
    UpdateBoundingBox(end, min, max);
  });
}

void VGCurveView::SetDrawMode(CurveDrawMode mode) {
  m_drawMode = mode;
}

CurveDrawMode VGCurveView::GetDrawMode() const {
  return m_drawMode;
}

void VGCurveView::SetBarOrigin(double origin) {
  m_barOrigin = origin;
}

double VGCurveView::GetBarOrigin() const {
  return m_barOrigin;
}

}  // namespace vorl
