#include <vorl/GUI/Trafo2D.h>

inline namespace vorl {

Translate2D::Translate2D() = default;

Translate2D::Translate2D(double tx, double ty) : m_tx(tx), m_ty(ty) {}

Translate2D::Translate2D(double a1, double b1, double a2, double b2) {
  Init(a1, b1, a2, b2);
}

Translate2D::Translate2D(const Translate2D& source) = default;

Translate2D& Translate2D::operator=(const Translate2D& source) = default;

Translate2D::~Translate2D() = default;

void Translate2D::Init(double a1, double b1, double a2, double b2) {
  m_tx = b1 - a1;
  m_ty = b2 - a2;
}

double Translate2D::GetTx() const {
  return m_tx;
}

double Translate2D::GetTy() const {
  return m_ty;
}

void Translate2D::_pA2B(double x, double y, double& xOut, double& yOut) {
  xOut = x + m_tx;
  yOut = y + m_ty;
}

void Translate2D::_pB2A(double x, double y, double& xOut, double& yOut) {
  xOut = x - m_tx;
  yOut = y - m_ty;
}

void Translate2D::_vA2B(double x, double y, double& xOut, double& yOut) {
  xOut = x;
  yOut = y;
}

void Translate2D::_vB2A(double x, double y, double& xOut, double& yOut) {
  xOut = x;
  yOut = y;
}

}  // namespace vorl
