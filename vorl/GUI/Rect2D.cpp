#include <vorl/GUI/Rect2D.h>

#include <algorithm>

#include <vorl/Data/detail/Single.h>
#include <vorl/Platform/Gdi.h>

inline namespace vorl {

using vorl_detail::Single;

namespace {

/// One direction of a rectangle: its two coordinates in their own order.
struct Span {
  float first;
  float second;
};

bool IsReversed(const Span& span) {
  return span.second < span.first;
}

Span Normalized(const Span& span) {
  return IsReversed(span) ? Span{span.second, span.first} : span;
}

/// The coordinates of `result` in the order that `own` has.
Span InOrderOf(const Span& own, const Span& result) {
  return IsReversed(own) ? Span{result.second, result.first} : result;
}

/// What two normalised spans share; without any length, or less, when they share nothing.
Span Overlap(const Span& a, const Span& b) {
  return {std::max(a.first, b.first), std::min(a.second, b.second)};
}

Span Bounds(const Span& a, const Span& b) {
  return {std::min(a.first, b.first), std::max(a.second, b.second)};
}

bool Holds(const Span& span, double value) {
  const Span edges = Normalized(span);
  return edges.first <= value && value <= edges.second;
}

/// The point at a fraction of the way from the first coordinate to the second.
double Between(const Span& span, double fraction) {
  const double first = span.first;
  return first + (span.second - first) * fraction;
}

/// Written so that a factor of 1 and a value in the centre stay exactly what they are.
Span Scaled(const Span& span, double factor, double centre) {
  const auto scaled = [&](double v) { return Single(v + (factor - 1.0) * (v - centre)); };
  return {scaled(span.first), scaled(span.second)};
}

Span SpanX(const Rect2D& rect) {
  return {rect.GetTL().x, rect.GetBR().x};
}

Span SpanY(const Rect2D& rect) {
  return {rect.GetTL().y, rect.GetBR().y};
}

void SetSpans(Rect2D& rect, const Span& x, const Span& y) {
  rect.Set(x.first, y.first, x.second, y.second);
}

void ScaleAbout(Rect2D& rect, double factorX, double factorY, double centreX, double centreY) {
  SetSpans(rect, Scaled(SpanX(rect), factorX, centreX), Scaled(SpanY(rect), factorY, centreY));
}

}  // namespace

Rect2D::Rect2D() = default;

Rect2D::Rect2D(const Rect2D& source) = default;

Rect2D::Rect2D(const tagRECT& rect) {
  Set(rect);
}

Rect2D::Rect2D(const dVect2D& topLeft, const dVect2D& bottomRight)
    : m_topLeft(topLeft), m_bottomRight(bottomRight) {}

Rect2D::Rect2D(const tagPOINT& topLeft, const tagPOINT& bottomRight)
    : m_topLeft(topLeft), m_bottomRight(bottomRight) {}

Rect2D::Rect2D(float x1, float y1, float x2, float y2) : m_topLeft(x1, y1), m_bottomRight(x2, y2) {}

Rect2D& Rect2D::operator=(const Rect2D& source) = default;

Rect2D::~Rect2D() = default;

void Rect2D::Reset() {
  m_topLeft.Reset();
  m_bottomRight.Reset();
}

void Rect2D::Set(const Rect2D& source) {
  *this = source;
}

void Rect2D::Set(const tagRECT& rect) {
  Set(tagPOINT{rect.left, rect.top}, tagPOINT{rect.right, rect.bottom});
}

void Rect2D::Set(const dVect2D& topLeft, const dVect2D& bottomRight) {
  m_topLeft = topLeft;
  m_bottomRight = bottomRight;
}

void Rect2D::Set(const tagPOINT& topLeft, const tagPOINT& bottomRight) {
  m_topLeft = topLeft;
  m_bottomRight = bottomRight;
}

void Rect2D::Set(float x1, float y1, float x2, float y2) {
  m_topLeft.Set(x1, y1);
  m_bottomRight.Set(x2, y2);
}

void Rect2D::SetPos(const dVect2D& topLeft) {
  const double width = Width();
  const double height = Height();
  m_topLeft = topLeft;
  m_bottomRight.Set(topLeft.x + width, topLeft.y + height);
}

void Rect2D::SetPos(float x, float y) {
  SetPos(dVect2D(x, y));
}

void Rect2D::Move(const dVect2D& way) {
  m_topLeft += way;
  m_bottomRight += way;
}

void Rect2D::Move(float dx, float dy) {
  Move(dVect2D(dx, dy));
}

double Rect2D::Width() const {
  return static_cast<double>(m_bottomRight.x) - m_topLeft.x;
}

double Rect2D::Height() const {
  return static_cast<double>(m_bottomRight.y) - m_topLeft.y;
}

dVect2D Rect2D::GetTL() const {
  return m_topLeft;
}

void Rect2D::GetTL(dVect2D& corner) const {
  corner = GetTL();
}

dVect2D Rect2D::GetTR() const {
  return dVect2D(m_bottomRight.x, m_topLeft.y);
}

void Rect2D::GetTR(dVect2D& corner) const {
  corner = GetTR();
}

dVect2D Rect2D::GetBL() const {
  return dVect2D(m_topLeft.x, m_bottomRight.y);
}

void Rect2D::GetBL(dVect2D& corner) const {
  corner = GetBL();
}

dVect2D Rect2D::GetBR() const {
  return m_bottomRight;
}

void Rect2D::GetBR(dVect2D& corner) const {
  corner = GetBR();
}

dVect2D Rect2D::GetCenter() const {
  dVect2D center;
  GetRelativePos(0.5F, 0.5F, center);
  return center;
}

void Rect2D::GetCenter(dVect2D& center) const {
  center = GetCenter();
}

void Rect2D::GetRelativePos(float fx, float fy, dVect2D& pos) const {
  pos.Set(Between(SpanX(*this), fx), Between(SpanY(*this), fy));
}

void Rect2D::Scale(float factor) {
  Scale(factor, factor);
}

void Rect2D::Scale(float factorX, float factorY) {
  // The centre itself in double precision: rounded, it would shift a thin rectangle far from zero.
  ScaleAbout(*this, factorX, factorY, Between(SpanX(*this), 0.5), Between(SpanY(*this), 0.5));
}

void Rect2D::Scale(float factorX, float factorY, const dVect2D& centre) {
  ScaleAbout(*this, factorX, factorY, centre.x, centre.y);
}

bool Rect2D::IsEmpty() const {
  return m_topLeft.x == m_bottomRight.x || m_topLeft.y == m_bottomRight.y;
}

bool Rect2D::IsValid() const {
  return !IsEmpty();
}

bool Rect2D::IsNormalized() const {
  return m_bottomRight.x >= m_topLeft.x && m_bottomRight.y >= m_topLeft.y;
}

void Rect2D::Normalize() {
  SetSpans(*this, Normalized(SpanX(*this)), Normalized(SpanY(*this)));
}

bool Rect2D::IsInside(const dVect2D& point) const {
  return IsInside(point.x, point.y);
}

bool Rect2D::IsInside(const tagPOINT& point) const {
  return Holds(SpanX(*this), point.x) && Holds(SpanY(*this), point.y);
}

bool Rect2D::IsInside(float x, float y) const {
  return Holds(SpanX(*this), x) && Holds(SpanY(*this), y);
}

bool Rect2D::IsInside(const Rect2D& other) const {
  return IsInside(other.m_topLeft) && IsInside(other.m_bottomRight);
}

bool Rect2D::operator==(const Rect2D& other) const {
  return m_topLeft == other.m_topLeft && m_bottomRight == other.m_bottomRight;
}

bool Rect2D::operator!=(const Rect2D& other) const {
  return !(*this == other);
}

bool Rect2D::operator==(const tagRECT& rect) const {
  return *this == Rect2D(rect);
}

bool Rect2D::operator!=(const tagRECT& rect) const {
  return !(*this == rect);
}

Rect2D& Rect2D::operator&=(const Rect2D& other) {
  const Span x = Overlap(Normalized(SpanX(*this)), Normalized(SpanX(other)));
  const Span y = Overlap(Normalized(SpanY(*this)), Normalized(SpanY(other)));
  if (x.first < x.second && y.first < y.second) {
    SetSpans(*this, InOrderOf(SpanX(*this), x), InOrderOf(SpanY(*this), y));
  } else {
    Reset();
  }
  return *this;
}

Rect2D& Rect2D::operator&=(const tagRECT& rect) {
  return *this &= Rect2D(rect);
}

Rect2D& Rect2D::operator|=(const Rect2D& other) {
  const Span x = Bounds(Normalized(SpanX(*this)), Normalized(SpanX(other)));
  const Span y = Bounds(Normalized(SpanY(*this)), Normalized(SpanY(other)));
  SetSpans(*this, InOrderOf(SpanX(*this), x), InOrderOf(SpanY(*this), y));
  return *this;
}

Rect2D& Rect2D::operator|=(const tagRECT& rect) {
  return *this |= Rect2D(rect);
}

Rect2D operator&(const Rect2D& a, const Rect2D& b) {
  Rect2D overlap(a);
  overlap &= b;
  return overlap;
}

Rect2D operator|(const Rect2D& a, const Rect2D& b) {
  Rect2D bounds(a);
  bounds |= b;
  return bounds;
}

}  // namespace vorl
