#include <vorl/GUI/Trafo2D.h>

inline namespace vorl {

TrafoST2D::TrafoST2D() = default;

TrafoST2D::TrafoST2D(const TrafoST2D& source) = default;

TrafoST2D& TrafoST2D::operator=(const TrafoST2D& source) = default;

TrafoST2D::~TrafoST2D() = default;

void TrafoST2D::Reset() {
  ResetScaleAndAnchor();
}

void TrafoST2D::_pA2B(double x, double y, double& xOut, double& yOut) {
  xOut = GetSx() * x + GetTx();
  yOut = GetSy() * y + GetTy();
}

void TrafoST2D::_pB2A(double x, double y, double& xOut, double& yOut) {
  xOut = (x - GetTx()) / GetSx();
  yOut = (y - GetTy()) / GetSy();
}

void TrafoST2D::_vA2B(double x, double y, double& xOut, double& yOut) {
  xOut = GetSx() * x;
  yOut = GetSy() * y;
}

void TrafoST2D::_vB2A(double x, double y, double& xOut, double& yOut) {
  xOut = x / GetSx();
  yOut = y / GetSy();
}

}  // namespace vorl
