#ifndef VORL_DATA_DCOORDSYS_H
#define VORL_DATA_DCOORDSYS_H

/// @file
/// Coordinate systems in one, two and three dimensions: where a local frame stands in the world.
///
/// Conversions are named by what they take and where they lead: `v` a vector (a direction or a
/// difference, which no translation touches), `p` a point; `CS2W` from the coordinate system to the
/// world. A matrix or frame applied to a vector is computed in double precision and rounded once.

#include <vorl/Data/dVect2D.h>
#include <vorl/Data/dVect3D.h>

inline namespace vorl {

/// An axis: where its zero point lies, and how long one unit is.
class VORL_API dCoordSys1D : public DataBase {
 public:
  /// Origin 0, scale 1.
  dCoordSys1D();
  dCoordSys1D(double newOrigin, double newScale);
  dCoordSys1D(const dCoordSys1D& source);
  dCoordSys1D& operator=(const dCoordSys1D& source);

  ClassInfo* GetClassInfo() override;
  ~dCoordSys1D() override;
  /// Origin 0, scale 1.
  void Reset() override;
  /// The scale is not 0 (one that is not a number counts as valid).
  bool IsValid() override;

  static dCoordSys1D* Create();
  static ClassInfo& CI();

  void Set(double newOrigin, double newScale);
  /// Adds to the origin.
  void Move(double distance);
  /// Multiplies the scale.
  void Scale(double factor);
  /// The origin becomes origin + (factor - 1) * (centre - origin), which moves it towards the
  /// centre for factors greater than 1; then the scale is multiplied.
  void Scale(double factor, double centre);

  double origin = 0.0;
  double scale = 1.0;
};

/// A frame in the plane. It only initialises transforms; it converts nothing itself.
class VORL_API dCoordSys2D : public DataBase {
 public:
  /// Origin (0, 0), unit axes.
  dCoordSys2D();
  dCoordSys2D(const dVect2D& newOrigin, const dVect2D& newAxisX, const dVect2D& newAxisY);
  dCoordSys2D(const dCoordSys2D& source);
  dCoordSys2D& operator=(const dCoordSys2D& source);

  ClassInfo* GetClassInfo() override;
  ~dCoordSys2D() override;
  /// Origin (0, 0), unit axes.
  void Reset() override;
  /// Always true.
  bool IsValid() override;

  static dCoordSys2D* Create();
  static ClassInfo& CI();

  void Set(const dVect2D& newOrigin, const dVect2D& newAxisX, const dVect2D& newAxisY);
  /// Adds to the origin, each distance first rounded to single precision.
  void Move(double dx, double dy);
  void Move(const dVect2D& way);
  /// Multiplies each axis by its factor; the origin stays.
  void Scale(double factorX, double factorY);
  /// Adds (factor - 1) * (centre - origin), rounded to single precision, to each coordinate of the
  /// origin, then scales the axes.
  void Scale(double factorX, double factorY, const dVect2D& centre);

  dVect2D origin;
  dVect2D axisX;  ///< one unit along x, in world coordinates
  dVect2D axisY;  ///< one unit along y
};

/// A frame in space, such as the voxel grid of a slice or volume: world = origin + x * axisX +
/// y * axisY + z * axisZ. The axes need neither be orthogonal nor of unit length.
class VORL_API dCoordSys3D : public DataBase {
 public:
  /// Origin (0, 0, 0), unit axes.
  dCoordSys3D();
  dCoordSys3D(const dVect3D& newOrigin, const dVect3D& newAxisX, const dVect3D& newAxisY,
              const dVect3D& newAxisZ);
  dCoordSys3D(const dCoordSys3D& source);
  dCoordSys3D& operator=(const dCoordSys3D& source);

  ClassInfo* GetClassInfo() override;
  ~dCoordSys3D() override;
  /// Origin (0, 0, 0), unit axes.
  void Reset() override;
  /// Always true.
  bool IsValid() override;

  static dCoordSys3D* Create();
  static ClassInfo& CI();

  void Set(const dVect3D& newOrigin, const dVect3D& newAxisX, const dVect3D& newAxisY,
           const dVect3D& newAxisZ);
  /// Adds to the origin.
  void Move(double dx, double dy, double dz);
  void Move(const dVect3D& way);
  /// Multiplies each axis by its factor rounded to single precision; the origin stays.
  void Scale(double factorX, double factorY, double factorZ);
  /// Scales the axes, then the origin about the centre (see `dVect3D::Scale`).
  void Scale(double factorX, double factorY, double factorZ, const dVect3D& centre);
  /// Rotates the axes about the given direction by an angle in radians (see `dVect3D::vRotate`);
  /// the origin stays. Mind the order of the arguments.
  void Rotate(double angle, const dVect3D& axis);
  /// Rotates the axes as above, and the origin about the line through the centre.
  void Rotate(const dVect3D& centre, const dVect3D& axis, double angle);

  /// Converts a vector or point of this system to the world. `in` and `out` may be one object.
  void vCS2W(const dVect3D& in, dVect3D& out) const;
  void pCS2W(const dVect3D& in, dVect3D& out) const;
  /// The same in place.
  void vCS2W(dVect3D& v) const;
  void pCS2W(dVect3D& p) const;

  dVect3D origin;
  dVect3D axisX;  ///< one unit along x, in world coordinates
  dVect3D axisY;  ///< one unit along y
  dVect3D axisZ;  ///< one unit along z
};

}  // namespace vorl

#endif
