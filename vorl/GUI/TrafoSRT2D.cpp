#include <vorl/GUI/Trafo2D.h>

#include <cmath>

#include <vorl/Data/detail/Single.h>

inline namespace vorl {

using vorl_detail::kRadPerDegree;

TrafoSRT2D::TrafoSRT2D() = default;

TrafoSRT2D::TrafoSRT2D(const TrafoSRT2D& source) = default;

TrafoSRT2D& TrafoSRT2D::operator=(const TrafoSRT2D& source) = default;

TrafoSRT2D::~TrafoSRT2D() = default;

void TrafoSRT2D::Reset() {
  m_angle = 0.0;
  m_sin = 0.0;
  m_cos = 1.0;
  ResetScaleAndAnchor();
}

void TrafoSRT2D::SetRotationRad(double angle) {
  m_angle = angle;
  m_sin = std::sin(angle);
  m_cos = std::cos(angle);
  CalculateTranslation();
}

void TrafoSRT2D::SetRotationDeg(double angle) {
  SetRotationRad(angle * kRadPerDegree);
}

void TrafoSRT2D::UpdateRotationRad(double angle) {
  SetRotationRad(m_angle + angle);
}

void TrafoSRT2D::UpdateRotationDeg(double angle) {
  UpdateRotationRad(angle * kRadPerDegree);
}

double TrafoSRT2D::GetAngleRad() const {
  return m_angle;
}

double TrafoSRT2D::GetAngleDeg() const {
  return m_angle / kRadPerDegree;
}

void TrafoSRT2D::_pA2B(double x, double y, double& xOut, double& yOut) {
  _vA2B(x, y, xOut, yOut);
  xOut += GetTx();
  yOut += GetTy();
}

void TrafoSRT2D::_pB2A(double x, double y, double& xOut, double& yOut) {
  _vB2A(x - GetTx(), y - GetTy(), xOut, yOut);
}

void TrafoSRT2D::_vA2B(double x, double y, double& xOut, double& yOut) {
  const double scaledX = GetSx() * x;
  const double scaledY = GetSy() * y;
  xOut = m_sin * scaledY + m_cos * scaledX;
  yOut = m_cos * scaledY - m_sin * scaledX;
}

void TrafoSRT2D::_vB2A(double x, double y, double& xOut, double& yOut) {
  xOut = (m_cos * x - m_sin * y) / GetSx();
  yOut = (m_sin * x + m_cos * y) / GetSy();
}

}  // namespace vorl
