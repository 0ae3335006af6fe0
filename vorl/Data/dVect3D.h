#ifndef VORL_DATA_DVECT3D_H
#define VORL_DATA_DVECT3D_H

/// @file
/// A vector or point of space.

#include <vorl/Common/BaseClass.h>

inline namespace vorl {

/// Three components in single precision.
///
/// Everything is computed in double precision and rounded to single when it is stored; results
/// that are returned (lengths, products) stay double. A value is near zero when its absolute value
/// is at most 1e-6. Arguments may be the vector itself.
class VORL_API dVect3D : public DataBase {
 public:
  /// (0, 0, 0).
  dVect3D();
  dVect3D(float x, float y, float z);
  /// The way from `a` to `b`: b - a.
  dVect3D(const dVect3D& a, const dVect3D& b);
  dVect3D(const dVect3D& source);
  dVect3D& operator=(const dVect3D& source);

  ClassInfo* GetClassInfo() override;
  ~dVect3D() override;
  /// (0, 0, 0).
  void Reset() override;

  static dVect3D* Create();
  static ClassInfo& CI();

  void Set(double newX, double newY, double newZ);
  void Set(const dVect3D& source);

  /// Component 0 is x, 1 is y, 2 is z; an index outside gives the nearest of them.
  float& operator[](int index);
  const float& operator[](int index) const;

  /// Equal when all three differences are near zero; a component that is not a number equals
  /// nothing.
  bool operator==(const dVect3D& other) const;
  bool operator!=(const dVect3D& other) const;
  /// All components are near zero.
  bool IsZero() const;
  /// All components are at most `eps` from zero.
  bool IsZero(float eps) const;

  /// Becomes b - a.
  void Diff(const dVect3D& a, const dVect3D& b);
  /// Becomes p - this: mind the order.
  void Diff(const dVect3D& p);
  dVect3D& operator+=(const dVect3D& other);
  dVect3D& operator-=(const dVect3D& other);
  /// Adds to the components.
  void Move(double dx, double dy, double dz);
  void Move(const dVect3D& way);

  /// Multiplies by the factor rounded to single precision.
  dVect3D& operator*=(double factor);
  /// Divides by the divisor rounded to single precision; a divisor that is exactly 0 then leaves
  /// the vector unchanged.
  dVect3D& operator/=(double divisor);
  /// As `operator*=`.
  void Scale(double factor);
  /// Multiplies each component by its factor.
  void Scale(double factorX, double factorY, double factorZ);
  /// Each component v becomes v + (factor - 1) * (centre - v): the distance from the centre is
  /// multiplied by 2 - factor. Factor 1 changes nothing, 2 moves the vector onto the centre, 0
  /// doubles its distance.
  void Scale(double factor, const dVect3D& centre);
  /// The same with a factor for each component.
  void Scale(double factorX, double factorY, double factorZ, const dVect3D& centre);

  /// The Euclidean length.
  double Length() const;
  /// The squared length.
  double Length2() const;
  double Distance(const dVect3D& other) const;
  /// The squared distance.
  double Distance2(const dVect3D& other) const;
  /// Divides by the length, which is first rounded to single precision (a length beyond its range
  /// therefore gives zeros). False, with the vector unchanged, when the length is near zero.
  bool Normalize();
  /// The squared length differs from 1 by less than 1e-6 (in the plane it is the length).
  bool IsNormalized() const;
  /// The dot product.
  double Product(const dVect3D& other) const;
  /// The sum of the three components of the cross product; `operator*` gives the vector.
  double CrossProduct(const dVect3D& other) const;

  /// Rotates about the axis by an angle in radians, by the right-hand rule. The axis may have any
  /// length; an axis or an angle near zero changes nothing.
  /// @details The part along the axis stays, the rest turns (Rodrigues' formula). Each step is
  /// rounded to single precision.
  void vRotate(const dVect3D& axis, double angle);
  /// Rotates as a point about the line through the centre along the axis.
  void pRotate(const dVect3D& centre, const dVect3D& axis, double angle);

  float x = 0.0F;
  float y = 0.0F;
  float z = 0.0F;
};

VORL_API dVect3D operator+(const dVect3D& a, const dVect3D& b);
VORL_API dVect3D operator-(const dVect3D& a, const dVect3D& b);
/// The vector multiplied by the factor rounded to single precision.
VORL_API dVect3D operator*(const dVect3D& v, double factor);
/// The cross product; a component that is near zero becomes exactly 0.
VORL_API dVect3D operator*(const dVect3D& a, const dVect3D& b);

}  // namespace vorl

#endif
