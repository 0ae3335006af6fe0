#include <vorl/GUI/Trafo2D.h>

#include <vorl/Platform/Gdi.h>

inline namespace vorl {

namespace {

/// The corners of a rectangle of either kind, neither of which rounds the other's.
struct Corners {
  explicit Corners(const Rect2D& rect)
      : x1(rect.GetTL().x), y1(rect.GetTL().y), x2(rect.GetBR().x), y2(rect.GetBR().y) {}
  explicit Corners(const tagRECT& rect)
      : x1(rect.left), y1(rect.top), x2(rect.right), y2(rect.bottom) {}

  double x1;
  double y1;
  double x2;
  double y2;
};

void SetFromCorners(AnchoredTrafo2D& trafo, const Corners& a, const Corners& b) {
  trafo.Set(a.x1, a.y1, a.x2, a.y2, b.x1, b.y1, b.x2, b.y2);
}

}  // namespace

AnchoredTrafo2D::AnchoredTrafo2D() = default;

AnchoredTrafo2D::AnchoredTrafo2D(const AnchoredTrafo2D& source) = default;

AnchoredTrafo2D& AnchoredTrafo2D::operator=(const AnchoredTrafo2D& source) = default;

AnchoredTrafo2D::~AnchoredTrafo2D() = default;

void AnchoredTrafo2D::SetScale(double sx, double sy) {
  m_sx = sx;
  m_sy = sy;
  CalculateTranslation();
}

void AnchoredTrafo2D::UpdateScale(double fx, double fy) {
  SetScale(m_sx * fx, m_sy * fy);
}

void AnchoredTrafo2D::SetTranslation(double tx, double ty) {
  m_tx = tx;
  m_ty = ty;
  m_ax = 0.0;
  m_ay = 0.0;
  m_bx = tx;
  m_by = ty;
}

void AnchoredTrafo2D::UpdateTranslation(double dx, double dy) {
  SetTranslation(m_tx + dx, m_ty + dy);
}

void AnchoredTrafo2D::SetTranslation(double ax, double ay, double bx, double by) {
  m_ax = ax;
  m_ay = ay;
  m_bx = bx;
  m_by = by;
  CalculateTranslation();
}

void AnchoredTrafo2D::Set(double ax1, double ay1, double ax2, double ay2, double bx1, double by1,
                          double bx2, double by2) {
  m_sx = (bx2 - bx1) / (ax2 - ax1);
  m_sy = (by2 - by1) / (ay2 - ay1);
  SetTranslation(ax1, ay1, bx1, by1);
}

void AnchoredTrafo2D::Set(const Rect2D& a, const Rect2D& b) {
  SetFromCorners(*this, Corners(a), Corners(b));
}

void AnchoredTrafo2D::Set(const tagRECT& a, const tagRECT& b) {
  SetFromCorners(*this, Corners(a), Corners(b));
}

void AnchoredTrafo2D::Set(const Rect2D& a, const tagRECT& b) {
  SetFromCorners(*this, Corners(a), Corners(b));
}

void AnchoredTrafo2D::Set(const tagRECT& a, const Rect2D& b) {
  SetFromCorners(*this, Corners(a), Corners(b));
}

double AnchoredTrafo2D::GetSx() const {
  return m_sx;
}

double AnchoredTrafo2D::GetSy() const {
  return m_sy;
}

double AnchoredTrafo2D::GetTx() const {
  return m_tx;
}

double AnchoredTrafo2D::GetTy() const {
  return m_ty;
}

void AnchoredTrafo2D::ResetScaleAndAnchor() {
  m_sx = 1.0;
  m_sy = 1.0;
  SetTranslation(0.0, 0.0);
}

void AnchoredTrafo2D::CalculateTranslation() {
  m_tx = 0.0;
  m_ty = 0.0;
  double x = 0.0;
  double y = 0.0;
  _pA2B(m_ax, m_ay, x, y);
  m_tx = m_bx - x;
  m_ty = m_by - y;
}

}  // namespace vorl
