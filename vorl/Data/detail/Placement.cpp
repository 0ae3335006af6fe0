#include <vorl/Data/detail/Placement.h>

inline namespace vorl {
namespace vorl_detail {

void GridCenter(const dCoordSys3D& coordinates, double nx, double ny, double nz, dVect3D& center) {
  const dVect3D& x = coordinates.axisX;
  const dVect3D& y = coordinates.axisY;
  const dVect3D& z = coordinates.axisZ;
  const dVect3D half(static_cast<float>(0.5 * (nx * x.x + ny * y.x + nz * z.x)),
                     static_cast<float>(0.5 * (nx * x.y + ny * y.y + nz * z.y)),
                     static_cast<float>(0.5 * (nx * x.z + ny * y.z + nz * z.z)));
  center = coordinates.origin;
  center += half;
}

void CopyParts(const dCoordSys3D& coordinates, dVect3D& origin, dVect3D& axisX, dVect3D& axisY,
               dVect3D& axisZ) {
  origin = coordinates.origin;
  axisX = coordinates.axisX;
  axisY = coordinates.axisY;
  axisZ = coordinates.axisZ;
}

}  // namespace vorl_detail
}  // namespace vorl
