#include <vorl/Common/detail/ClassRegistration.h>
#include <vorl/Data/dCoordSys.h>

inline namespace vorl {

VORL_REGISTER_CLASS(dCoordSys3D, DataBase);

dCoordSys3D::dCoordSys3D()
    : axisX(1.0F, 0.0F, 0.0F), axisY(0.0F, 1.0F, 0.0F), axisZ(0.0F, 0.0F, 1.0F) {}

dCoordSys3D::dCoordSys3D(const dVect3D& newOrigin, const dVect3D& newAxisX, const dVect3D& newAxisY,
                         const dVect3D& newAxisZ)
    : origin(newOrigin), axisX(newAxisX), axisY(newAxisY), axisZ(newAxisZ) {}

dCoordSys3D::dCoordSys3D(const dCoordSys3D& source) = default;

dCoordSys3D& dCoordSys3D::operator=(const dCoordSys3D& source) = default;

dCoordSys3D::~dCoordSys3D() = default;

void dCoordSys3D::Reset() {
  *this = dCoordSys3D();
}

bool dCoordSys3D::IsValid() {
  return true;
}

// By way of a new system: the arguments may be vectors of this one.
void dCoordSys3D::Set(const dVect3D& newOrigin, const dVect3D& newAxisX, const dVect3D& newAxisY,
                      const dVect3D& newAxisZ) {
  *this = dCoordSys3D(newOrigin, newAxisX, newAxisY, newAxisZ);
}

void dCoordSys3D::Move(double dx, double dy, double dz) {
  origin.Move(dx, dy, dz);
}

void dCoordSys3D::Move(const dVect3D& way) {
  origin.Move(way);
}

void dCoordSys3D::Scale(double factorX, double factorY, double factorZ) {
  axisX *= factorX;
  axisY *= factorY;
  axisZ *= factorZ;
}

void dCoordSys3D::Scale(double factorX, double factorY, double factorZ, const dVect3D& centre) {
  const dVect3D about(centre);  // may be one of the axes
  Scale(factorX, factorY, factorZ);
  origin.Scale(factorX, factorY, factorZ, about);
}

void dCoordSys3D::Rotate(double angle, const dVect3D& axis) {
  const dVect3D direction(axis);  // may be one of the axes
  axisX.vRotate(direction, angle);
  axisY.vRotate(direction, angle);
  axisZ.vRotate(direction, angle);
}

void dCoordSys3D::Rotate(const dVect3D& centre, const dVect3D& axis, double angle) {
  const dVect3D about(centre);  // may be one of the axes, as may the direction
  const dVect3D direction(axis);
  Rotate(angle, direction);
  origin.pRotate(about, direction, angle);
}

void dCoordSys3D::vCS2W(const dVect3D& in, dVect3D& out) const {
  const double x = in.x;
  const double y = in.y;
  const double z = in.z;
  out.Set(x * axisX.x + y * axisY.x + z * axisZ.x,  //
          x * axisX.y + y * axisY.y + z * axisZ.y,  //
          x * axisX.z + y * axisY.z + z * axisZ.z);
}

void dCoordSys3D::pCS2W(const dVect3D& in, dVect3D& out) const {
  const double x = in.x;
  const double y = in.y;
  const double z = in.z;
  out.Set(origin.x + x * axisX.x + y * axisY.x + z * axisZ.x,
          origin.y + x * axisX.y + y * axisY.y + z * axisZ.y,
          origin.z + x * axisX.z + y * axisY.z + z * axisZ.z);
}

void dCoordSys3D::vCS2W(dVect3D& v) const {
  vCS2W(v, v);
}

void dCoordSys3D::pCS2W(dVect3D& p) const {
  pCS2W(p, p);
}

}  // namespace vorl
