#include <vorl/Common/detail/ClassRegistration.h>
#include <vorl/Data/dCoordSys.h>
#include <vorl/Data/detail/Single.h>

inline namespace vorl {

using vorl_detail::Single;

VORL_REGISTER_CLASS(dCoordSys2D, DataBase);

dCoordSys2D::dCoordSys2D() : axisX(1.0F, 0.0F), axisY(0.0F, 1.0F) {}

dCoordSys2D::dCoordSys2D(const dVect2D& newOrigin, const dVect2D& newAxisX, const dVect2D& newAxisY)
    : origin(newOrigin), axisX(newAxisX), axisY(newAxisY) {}

dCoordSys2D::dCoordSys2D(const dCoordSys2D& source) = default;

dCoordSys2D& dCoordSys2D::operator=(const dCoordSys2D& source) = default;

dCoordSys2D::~dCoordSys2D() = default;

void dCoordSys2D::Reset() {
  *this = dCoordSys2D();
}

bool dCoordSys2D::IsValid() {
  return true;
}

// By way of a new system: the arguments may be vectors of this one.
void dCoordSys2D::Set(const dVect2D& newOrigin, const dVect2D& newAxisX, const dVect2D& newAxisY) {
  *this = dCoordSys2D(newOrigin, newAxisX, newAxisY);
}

void dCoordSys2D::Move(double dx, double dy) {
  origin.Add(Single(dx), Single(dy));
}

void dCoordSys2D::Move(const dVect2D& way) {
  origin += way;
}

void dCoordSys2D::Scale(double factorX, double factorY) {
  axisX.Scale(factorX, factorX);
  axisY.Scale(factorY, factorY);
}

void dCoordSys2D::Scale(double factorX, double factorY, const dVect2D& centre) {
  const double dx = (factorX - 1.0) * (static_cast<double>(centre.x) - origin.x);
  const double dy = (factorY - 1.0) * (static_cast<double>(centre.y) - origin.y);
  Move(dx, dy);
  Scale(factorX, factorY);
}

}  // namespace vorl
