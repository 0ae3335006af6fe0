#ifndef VORL_DATA_DVECT2D_H
#define VORL_DATA_DVECT2D_H

/// @file
/// A vector or point of the plane.

#include <vorl/Common/BaseClass.h>
#include <vorl/Platform/GdiFwd.h>

inline namespace vorl {

/// Two components in single precision.
///
/// Everything is computed in double precision and rounded to single when it is stored; results
/// that are returned (lengths, products, angles) stay double. A value is near zero when its
/// absolute value is at most 1e-6. Arguments may be the vector itself.
class VORL_API dVect2D : public DataBase {
 public:
  /// (0, 0).
  dVect2D();
  dVect2D(float x, float y);
  /// The unit vector of an angle in radians: (cos a, sin a). Explicit, because a bare number that
  /// turned into a direction by itself would hide mistakes.
  explicit dVect2D(double angle);
  dVect2D(const tagPOINT& point);
  /// The way from `a` to `b`: b - a.
  dVect2D(const dVect2D& a, const dVect2D& b);
  dVect2D(const dVect2D& source);
  dVect2D& operator=(const dVect2D& source);
  dVect2D& operator=(const tagPOINT& point);

  ClassInfo* GetClassInfo() override;
  ~dVect2D() override;
  /// (0, 0).
  void Reset() override;

  static dVect2D* Create();
  static ClassInfo& CI();

  void Set(double newX, double newY);
  void Set(const tagPOINT& point);
  void Set(const dVect2D& source);

  /// Component 0 is x, 1 is y; an index outside gives the nearest of them.
  float& operator[](int index);
  const float& operator[](int index) const;

  /// Equal when both differences are near zero; a component that is not a number equals nothing.
  bool operator==(const dVect2D& other) const;
  bool operator!=(const dVect2D& other) const;
  /// Both components are near zero.
  bool IsZero() const;
  /// Both components are at most `eps` from zero.
  bool IsZero(float eps) const;

  /// Becomes b - a.
  void Diff(const dVect2D& a, const dVect2D& b);
  /// Becomes p - this: mind the order.
  void Diff(const dVect2D& p);
  dVect2D& operator+=(const dVect2D& other);
  dVect2D& operator+=(const tagPOINT& point);
  dVect2D& operator-=(const dVect2D& other);
  dVect2D& operator-=(const tagPOINT& point);
  void Add(double dx, double dy);
  void Add(const dVect2D& other);

  /// Multiplies by the factor rounded to single precision.
  dVect2D& operator*=(double factor);
  /// Divides by the divisor rounded to single precision; a divisor that is exactly 0 then leaves
  /// the vector unchanged.
  dVect2D& operator/=(double divisor);
  /// As `operator*=`.
  void Scale(double factor);
  /// Multiplies each component by its factor.
  void Scale(double factorX, double factorY);
  /// Each component v becomes v + (factor - 1) * (centre - v): the distance from the centre is
  /// multiplied by 2 - factor. Factor 1 changes nothing, 2 moves the vector onto the centre, 0
  /// doubles its distance.
  void Scale(double factor, const dVect2D& centre);
  /// The same with a factor for each component.
  void Scale(double factorX, double factorY, const dVect2D& centre);

  /// The Euclidean length.
  double Length() const;
  /// The squared length.
  double Length2() const;
  double Distance(const dVect2D& other) const;
  /// The squared distance.
  double Distance2(const dVect2D& other) const;
  /// Divides by the length, which is first rounded to single precision (a length beyond its range
  /// therefore gives zeros). False, with the vector unchanged, when the length is near zero.
  bool Normalize();
  /// The length differs from 1 by less than 1e-6.
  bool IsNormalized() const;
  /// The dot product.
  double Product(const dVect2D& other) const;
  /// x * other.y - y * other.x.
  double CrossProduct(const dVect2D& other) const;

  /// The cosine of the direction; 1 for a vector that is near zero.
  double AngleCos() const;
  /// The sine of the direction; 0 for a vector that is near zero.
  double AngleSin() const;
  /// y / x; where x is near zero, the largest single-precision number with the sign of y.
  double AngleTan() const;
  /// The arc tangent of `AngleTan`, from -pi/2 to pi/2: opposite directions have the same angle.
  double AngleRad() const;
  /// `AngleRad` in degrees, with pi taken as 3.1415926535.
  double AngleDeg() const;

  /// Rotates by an angle in radians, from x towards y. Angles near zero change nothing.
  void vRotate(double angle);
  /// Rotates as a point about the centre.
  void pRotate(const dVect2D& centre, double angle);

  float x = 0.0F;
  float y = 0.0F;
};

VORL_API dVect2D operator+(const dVect2D& a, const dVect2D& b);
VORL_API dVect2D operator-(const dVect2D& a, const dVect2D& b);
/// The vector multiplied by the factor rounded to single precision.
VORL_API dVect2D operator*(const dVect2D& v, double factor);
/// The pair (a.x b.y - a.y b.x, a.y b.x - a.x b.y), not a number; a component that is near zero
/// becomes exactly 0.
VORL_API dVect2D operator*(const dVect2D& a, const dVect2D& b);

}  // namespace vorl

#endif
