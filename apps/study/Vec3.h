#ifndef VORL_APPS_STUDY_VEC3_H
#define VORL_APPS_STUDY_VEC3_H

/// @file
/// Vectors in double precision, for geometry that is computed once and stored in single precision.

#include <cmath>

namespace study {

/// Three components in double precision; millimetres in patient coordinates unless said otherwise.
struct Vec3 {
  double x = 0;
  double y = 0;
  double z = 0;

  friend bool operator==(const Vec3&, const Vec3&) = default;
};

inline Vec3 operator+(const Vec3& a, const Vec3& b) {
  return {a.x + b.x, a.y + b.y, a.z + b.z};
}
inline Vec3 operator-(const Vec3& a, const Vec3& b) {
  return {a.x - b.x, a.y - b.y, a.z - b.z};
}
inline Vec3 operator*(const Vec3& v, double f) {
  return {v.x * f, v.y * f, v.z * f};
}
inline Vec3 operator*(double f, const Vec3& v) {
  return v * f;
}

inline double Dot(const Vec3& a, const Vec3& b) {
  return a.x * b.x + a.y * b.y + a.z * b.z;
}

/// The right-handed vector product.
inline Vec3 Cross(const Vec3& a, const Vec3& b) {
  return {a.y * b.z - a.z * b.y, a.z * b.x - a.x * b.z, a.x * b.y - a.y * b.x};
}

inline double Length(const Vec3& v) {
  return std::sqrt(Dot(v, v));
}

/// `v` at length 1; `v` itself when it is zero.
inline Vec3 Normalised(const Vec3& v) {
  const double length = Length(v);
  return length > 0 ? v * (1 / length) : v;
}

inline bool IsFinite(const Vec3& v) {
  return std::isfinite(v.x) && std::isfinite(v.y) && std::isfinite(v.z);
}

/// `v` turned by `radians` about the unit vector `axis`, right-handed.
inline Vec3 Rotated(const Vec3& v, const Vec3& axis, double radians) {
  const double cosine = std::cos(radians);
  return v * cosine + Cross(axis, v) * std::sin(radians) + axis * (Dot(axis, v) * (1 - cosine));
}

}  // namespace study

#endif
