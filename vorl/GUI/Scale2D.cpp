#include <vorl/GUI/Trafo2D.h>

inline namespace vorl {

Scale2D::Scale2D() = default;

Scale2D::Scale2D(double sx, double sy, double cx, double cy) {
  Init(sx, sy, cx, cy);
}

Scale2D::Scale2D(const Scale2D& source) = default;

Scale2D& Scale2D::operator=(const Scale2D& source) = default;

Scale2D::~Scale2D() = default;

void Scale2D::Init(double sx, double sy, double cx, double cy) {
  m_sx = sx;
  m_sy = sy;
  m_ox = (1.0 - sx) * cx;
  m_oy = (1.0 - sy) * cy;
}

void Scale2D::Init(double ax1, double bx1, double ax2, double bx2, double ay1, double by1,
                   double ay2, double by2) {
  m_sx = (bx2 - bx1) / (ax2 - ax1);
  m_ox = bx1 - ax1 * m_sx;
  m_sy = (by2 - by1) / (ay2 - ay1);
  m_oy = by1 - ay1 * m_sy;
}

double Scale2D::GetSx() const {
  return m_sx;
}

double Scale2D::GetSy() const {
  return m_sy;
}

double Scale2D::GetOriginX() const {
  return m_ox;
}

double Scale2D::GetOriginY() const {
  return m_oy;
}

void Scale2D::_pA2B(double x, double y, double& xOut, double& yOut) {
  xOut = _X_pA2B(x);
  yOut = _Y_pA2B(y);
}

void Scale2D::_pB2A(double x, double y, double& xOut, double& yOut) {
  xOut = _X_pB2A(x);
  yOut = _Y_pB2A(y);
}

void Scale2D::_vA2B(double x, double y, double& xOut, double& yOut) {
  xOut = m_sx * x;
  yOut = m_sy * y;
}

void Scale2D::_vB2A(double x, double y, double& xOut, double& yOut) {
  xOut = x / m_sx;
  yOut = y / m_sy;
}

double Scale2D::_X_pA2B(double x) {
  return m_sx * x + m_ox;
}

double Scale2D::_X_pB2A(double x) {
  return m_sx == 0.0 ? x : (x - m_ox) / m_sx;
}

double Scale2D::_Y_pA2B(double y) {
  return m_sy * y + m_oy;
}

double Scale2D::_Y_pB2A(double y) {
  return m_sy == 0.0 ? y : (y - m_oy) / m_sy;
}

}  // namespace vorl
