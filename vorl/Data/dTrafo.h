#ifndef VORL_DATA_DTRAFO_H
#define VORL_DATA_DTRAFO_H

/// @file
/// Affine transforms between two frames, a source "S" and a target "T", in both directions.
///
/// Conversions are named by what they take and where they lead: `v` a vector (a direction or a
/// difference, which no translation touches), `p` a point; `S2T` from source to target, `T2S` back.
/// Each comes in a form that fills a separate output and in one that works in place; input and
/// output of the former may also be one object. The two directions are held side by side, as they
/// were initialised; changing one field does not change the other direction.

#include <vorl/Data/dCoordSys.h>

#include <concepts>
#include <limits>
#include <string>

inline namespace vorl {

/// A linear map of a scalar axis, for example of data values to a physical unit. All in double
/// precision. No division is guarded: a length or scale of zero gives infinities or NaNs.
class VORL_API dTrafo1D : public DataBase {
 public:
  /// Not initialised: every field is NaN, and so is what comes out, until `Reset` or `Init`.
  dTrafo1D();
  dTrafo1D(const dTrafo1D& source);
  /// As `Init` with the same arguments.
  dTrafo1D(const dCoordSys1D& s, const dCoordSys1D& t);
  dTrafo1D(const dCoordSys1D& s, const dCoordSys1D& t, double ps, double pt);
  dTrafo1D(double a, double b, double ps, double pt);
  dTrafo1D& operator=(const dTrafo1D& source);

  ClassInfo* GetClassInfo() override;
  ~dTrafo1D() override;
  /// The identity, both ways.
  void Reset() override;
  /// Always true.
  bool IsValid() override;

  static dTrafo1D* Create();
  static ClassInfo& CI();

  /// A length a in the source corresponds to a length b in the target, and the source value ps to
  /// the target value pt. Returns true.
  bool Init(double a, double b, double ps, double pt);
  /// The scales are t.scale / s.scale and its counterpart, the offsets 0: the origins of the
  /// systems are not used. Returns true.
  bool Init(const dCoordSys1D& s, const dCoordSys1D& t);
  /// The same scales; the source value ps corresponds to the target value pt. Returns true.
  bool Init(const dCoordSys1D& s, const dCoordSys1D& t, double ps, double pt);
  /// Makes the source value ps correspond to the target value pt; the scales stay.
  void SetTranslation(double ps, double pt);

  double vS2T(double x) const;
  double pS2T(double x) const;
  double vT2S(double x) const;
  double pT2S(double x) const;
  /// In place; a null pointer is ignored.
  void vS2T(double* x) const;
  void pS2T(double* x) const;
  void vT2S(double* x) const;
  void pT2S(double* x) const;
  /// For whole numbers, of which a literal 0 could else be taken for a null pointer.
  template <std::integral Integer>
  double vS2T(Integer x) const {
    return vS2T(static_cast<double>(x));
  }
  template <std::integral Integer>
  double pS2T(Integer x) const {
    return pS2T(static_cast<double>(x));
  }
  template <std::integral Integer>
  double vT2S(Integer x) const {
    return vT2S(static_cast<double>(x));
  }
  template <std::integral Integer>
  double pT2S(Integer x) const {
    return pT2S(static_cast<double>(x));
  }

  double scaleS2T = std::numeric_limits<double>::quiet_NaN();
  double offsetS2T = std::numeric_limits<double>::quiet_NaN();
  double scaleT2S = std::numeric_limits<double>::quiet_NaN();
  double offsetT2S = std::numeric_limits<double>::quiet_NaN();
};

/// A transform of a scalar axis with the name of the unit it leads to.
class VORL_API dUnitTrafo : public dTrafo1D {
 public:
  /// The numbers not initialised (see `dTrafo1D`); every constructor leaves the texts empty.
  dUnitTrafo();
  dUnitTrafo(const dUnitTrafo& source);
  dUnitTrafo(const dCoordSys1D& s, const dCoordSys1D& t);
  dUnitTrafo(const dCoordSys1D& s, const dCoordSys1D& t, double ps, double pt);
  dUnitTrafo(double a, double b, double ps, double pt);
  dUnitTrafo& operator=(const dUnitTrafo& source);

  ClassInfo* GetClassInfo() override;
  ~dUnitTrafo() override;
  /// The identity, and empty texts.
  void Reset() override;

  static dUnitTrafo* Create();
  static ClassInfo& CI();

  /// Copies the text, for example the unit's abbreviation; null empties it.
  void SetShortUnitText(const char* text);
  /// Copies the text, the unit's full name; null empties it.
  void SetLongUnitText(const char* text);
  /// The stored text, never null; valid until it changes.
  const char* GetShortUnitText() const;
  const char* GetLongUnitText() const;

 private:
  std::string m_shortUnitText;
  std::string m_longUnitText;
};

/// An affine map of the plane.
class VORL_API dTrafo2D : public DataBase {
 public:
  /// All zero, which is not the identity: call `Reset` or `Init` before use.
  dTrafo2D();
  dTrafo2D(const dTrafo2D& source);
  /// As `Init` with the same arguments.
  dTrafo2D(const dCoordSys2D& s, const dCoordSys2D& t);
  dTrafo2D(const dCoordSys2D& s, const dCoordSys2D& t, const dVect2D& ps, const dVect2D& pt);
  dTrafo2D& operator=(const dTrafo2D& source);

  ClassInfo* GetClassInfo() override;
  ~dTrafo2D() override;
  /// The identity, both ways.
  void Reset() override;
  /// Always true.
  bool IsValid() override;

  static dTrafo2D* Create();
  static ClassInfo& CI();

  /// Takes the matrices from the axes of the systems, and lets the source point ps correspond to
  /// the target point pt. The origins of the systems are not used. Each matrix projects the axes of
  /// one system onto those of the other, which is exact only where the axes projected onto are
  /// orthogonal. Returns true; an axis without length gives infinities or NaNs.
  bool Init(const dCoordSys2D& s, const dCoordSys2D& t, const dVect2D& ps, const dVect2D& pt);
  /// The same with both points (0, 0).
  bool Init(const dCoordSys2D& s, const dCoordSys2D& t);
  /// Makes the source point ps correspond to the target point pt; the matrices stay.
  void SetTranslation(const dVect2D& ps, const dVect2D& pt);

  void vS2T(const dVect2D& in, dVect2D& out) const;
  void pS2T(const dVect2D& in, dVect2D& out) const;
  void vT2S(const dVect2D& in, dVect2D& out) const;
  void pT2S(const dVect2D& in, dVect2D& out) const;
  /// In place.
  void vS2T(dVect2D& v) const;
  void pS2T(dVect2D& p) const;
  void vT2S(dVect2D& v) const;
  void pT2S(dVect2D& p) const;

  dVect2D s2t[2];    ///< columns of the source-to-target matrix: images of the unit vectors
  dVect2D transS2T;  ///< added to points behind it
  dVect2D t2s[2];    ///< columns of the target-to-source matrix
  dVect2D transT2S;  ///< added to points behind it
};

/// An affine map of space, such as from the pixels of a slice to the voxels of a volume.
class VORL_API dTrafo3D : public DataBase {
 public:
  /// All zero, which is not the identity: call `Reset` or `Init` before use.
  dTrafo3D();
  dTrafo3D(const dTrafo3D& source);
  /// As `Init` with the same arguments.
  dTrafo3D(const dCoordSys3D& s, const dCoordSys3D& t);
  dTrafo3D& operator=(const dTrafo3D& source);

  ClassInfo* GetClassInfo() override;
  ~dTrafo3D() override;
  /// The identity, both ways.
  void Reset() override;
  /// Always true.
  bool IsValid() override;

  static dTrafo3D* Create();
  static ClassInfo& CI();

  /// Maps coordinates of s to coordinates of t by way of the world, origins included. Returns true,
  /// also when the axes of a system are singular (see `InvertMatrix`): where those of t are, the
  /// transform is the identity afterwards; where only those of s are, its matrices are the identity
  /// and its translations carry the origin of s to its place in t, and back.
  bool Init(const dCoordSys3D& s, const dCoordSys3D& t);
  /// Makes the source point ps correspond to the target point pt; the matrices stay.
  void SetTranslation(const dVect3D& ps, const dVect3D& pt);

  void vS2T(const dVect3D& in, dVect3D& out) const;
  void pS2T(const dVect3D& in, dVect3D& out) const;
  void vT2S(const dVect3D& in, dVect3D& out) const;
  void pT2S(const dVect3D& in, dVect3D& out) const;
  /// In place.
  void vS2T(dVect3D& v) const;
  void pS2T(dVect3D& p) const;
  void vT2S(dVect3D& v) const;
  void pT2S(dVect3D& p) const;

  dVect3D s2t[3];    ///< columns of the source-to-target matrix: images of the unit vectors
  dVect3D transS2T;  ///< added to points behind it
  dVect3D t2s[3];    ///< columns of the target-to-source matrix
  dVect3D transT2S;  ///< added to points behind it

 protected:
  /// Inverts the matrix with the columns m[0] to m[2] in place, every entry rounded to single
  /// precision. False, with the matrix unchanged, when the determinant (by the rule of Sarrus, in
  /// double precision) is at most 1e-6 from zero, whatever the scale of the entries: a grid with
  /// voxel edges of 0.01 counts as singular.
  static bool InvertMatrix(dVect3D m[3]);
  /// Expresses the axes of a in the coordinates of b, one to each output. When the axes of b are
  /// singular, the whole transform is reset and the outputs are not written.
  void CalculateTransformation(const dCoordSys3D& a, const dCoordSys3D& b, dVect3D& out0,
                               dVect3D& out1, dVect3D& out2);
};

}  // namespace vorl

#endif
