#include <cmath>

#include <vorl/Data/detail/Single.h>
#include <vorl/GUI/Geom2D.h>

inline namespace vorl {

using vorl_detail::kNearZero;

namespace {

/// A vector that is not rounded between the steps of a computation.
struct Exact {
  Exact(double newX, double newY, double newZ) : x(newX), y(newY), z(newZ) {}
  explicit Exact(const dVect3D& v) : x(v.x), y(v.y), z(v.z) {}

  double x;
  double y;
  double z;
};

Exact operator+(const Exact& a, const Exact& b) {
  return {a.x + b.x, a.y + b.y, a.z + b.z};
}

Exact operator-(const Exact& a, const Exact& b) {
  return {a.x - b.x, a.y - b.y, a.z - b.z};
}

Exact operator*(double factor, const Exact& v) {
  return {factor * v.x, factor * v.y, factor * v.z};
}

double Dot(const Exact& a, const Exact& b) {
  return a.x * b.x + a.y * b.y + a.z * b.z;
}

Exact Cross(const Exact& a, const Exact& b) {
  return {a.y * b.z - a.z * b.y, a.z * b.x - a.x * b.z, a.x * b.y - a.y * b.x};
}

double Length(const Exact& v) {
  return std::sqrt(Dot(v, v));
}

dVect3D Rounded(const Exact& v) {
  dVect3D rounded;
  rounded.Set(v.x, v.y, v.z);
  return rounded;
}

bool IsFinite(const dVect3D& v) {
  return std::isfinite(v.x) && std::isfinite(v.y) && std::isfinite(v.z);
}

/// The vector with the length 1; NaN without a length.
Exact Unit(const Exact& v) {
  return 1.0 / Length(v) * v;
}

}  // namespace

bool Geom3D::LinePlaneIntersection(const dVect3D& linePos, const dVect3D& lineDir,
                                   const dVect3D& planePos, const dVect3D& planeNormal,
                                   dVect3D& point) {
  const Exact direction = Unit(Exact(lineDir));
  const Exact normal = Unit(Exact(planeNormal));
  const double sine = Dot(direction, normal);
  if (!(std::abs(sine) > kNearZero)) {
    return false;
  }
  const Exact pos(linePos);
  const double way = Dot(Exact(planePos) - pos, normal) / sine;
  const dVect3D met = Rounded(pos + way * direction);
  if (!IsFinite(met)) {
    return false;
  }
  point = met;
  return true;
}

bool Geom3D::PlaneIntersection(const dVect3D& pos1, const dVect3D& normal1, const dVect3D& pos2,
                               const dVect3D& normal2, dVect3D& linePos, dVect3D& lineDir) {
  const Exact n1 = Unit(Exact(normal1));
  const Exact n2 = Unit(Exact(normal2));
  const Exact along = Cross(n1, n2);
  const double sine = Length(along);
  if (!(sine > kNearZero)) {
    return false;
  }
  // From pos1 in the first plane, square to the line, as far as the second plane is away.
  const Exact across = Cross(along, n1);
  const double way = Dot(Exact(pos2) - Exact(pos1), n2) / (sine * sine);
  const dVect3D pos = Rounded(Exact(pos1) + way * across);
  if (!IsFinite(pos)) {
    return false;
  }
  linePos = pos;
  lineDir = Rounded(1.0 / sine * along);
  return true;
}

}  // namespace vorl
