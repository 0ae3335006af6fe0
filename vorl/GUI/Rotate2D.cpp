#include <vorl/GUI/Trafo2D.h>

#include <cmath>

#include <vorl/Data/detail/Single.h>

inline namespace vorl {

using vorl_detail::kRadPerDegree;

Rotate2D::Rotate2D() = default;

Rotate2D::Rotate2D(double angle, double cx, double cy) {
  InitRad(angle, cx, cy);
}

Rotate2D::Rotate2D(const Rotate2D& source) = default;

Rotate2D& Rotate2D::operator=(const Rotate2D& source) = default;

Rotate2D::~Rotate2D() = default;

void Rotate2D::InitRad(double angle, double cx, double cy) {
  m_angle = angle;
  m_sin = std::sin(angle);
  m_cos = std::cos(angle);
  m_cx = cx;
  m_cy = cy;
}

void Rotate2D::InitDeg(double angle, double cx, double cy) {
  InitRad(angle * kRadPerDegree, cx, cy);
}

double Rotate2D::GetAngleRad() const {
  return m_angle;
}

double Rotate2D::GetAngleDeg() const {
  return m_angle / kRadPerDegree;
}

double Rotate2D::GetRx() const {
  return m_cx;
}

double Rotate2D::GetRy() const {
  return m_cy;
}

void Rotate2D::_pA2B(double x, double y, double& xOut, double& yOut) {
  const double u = x - m_cx;
  const double v = y - m_cy;
  xOut = u * m_cos - v * m_sin + m_cx;
  yOut = u * m_sin + v * m_cos + m_cy;
}

void Rotate2D::_pB2A(double x, double y, double& xOut, double& yOut) {
  _pA2B(x, y, xOut, yOut);  // the same sense both ways: see the class
}

void Rotate2D::_vA2B(double x, double y, double& xOut, double& yOut) {
  xOut = x * m_cos - y * m_sin;
  yOut = x * m_sin + y * m_cos;
}

void Rotate2D::_vB2A(double x, double y, double& xOut, double& yOut) {
  _vA2B(x, y, xOut, yOut);
}

}  // namespace vorl
