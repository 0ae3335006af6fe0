#include <study/phantom/Shapes.h>

#include <algorithm>

namespace study {
namespace {

double Square(double v) {
  return v * v;
}

Vec3 Smaller(const Vec3& a, const Vec3& b) {
  return {std::min(a.x, b.x), std::min(a.y, b.y), std::min(a.z, b.z)};
}

Vec3 Larger(const Vec3& a, const Vec3& b) {
  return {std::max(a.x, b.x), std::max(a.y, b.y), std::max(a.z, b.z)};
}

/// The squared distance of `p` from the line from `a` to `b`.
double Distance2(const Vec3& p, const Vec3& a, const Vec3& b) {
  const Vec3 along = b - a;
  const Vec3 from = p - a;
  const double length2 = Dot(along, along);
  const double t = length2 > 0 ? std::clamp(Dot(from, along) / length2, 0.0, 1.0) : 0.0;
  const Vec3 off = from - along * t;
  return Dot(off, off);
}

}  // namespace

bool Shape::Contains(const Vec3& p) const {
  const Vec3 d = p - a;
  switch (kind) {
    case Kind::Ellipsoid:
      return Square(d.x / b.x) + Square(d.y / b.y) + Square(d.z / b.z) <= 1;
    case Kind::Column:
      return std::abs(d.z) <= b.z && Square(d.x / b.x) + Square(d.y / b.y) <= 1;
    case Kind::Box:
      return std::abs(d.x) <= b.x && std::abs(d.y) <= b.y && std::abs(d.z) <= b.z;
    case Kind::Capsule:
      return Distance2(p, a, b) <= Square(radius);
  }
  return false;
}

Vec3 Shape::Lower() const {
  return kind == Kind::Capsule ? Smaller(a, b) - Vec3{radius, radius, radius} : a - b;
}

Vec3 Shape::Upper() const {
  return kind == Kind::Capsule ? Larger(a, b) + Vec3{radius, radius, radius} : a + b;
}

}  // namespace study
