#ifndef VORL_GUI_TRAFO2D_H
#define VORL_GUI_TRAFO2D_H

/// @file
/// Maps between two planes, A (the model: graphic coordinates) and B (the device: view
/// coordinates), and chains of them.
///
/// Mappings are named by what they take and where they lead: `p` a point, `v` a vector (a direction
/// or a difference, which no translation touches), `r` a rectangle; `A2B` from A to B, `B2A` back.
/// Each comes in forms that fill a separate output and in forms that work in place; input and
/// output of the former may also be one object.
///
/// An integer coordinate names a pixel, and what is mapped is the pixel's centre: the integer forms
/// add 0.5 to each input, vectors included, and cut off the decimals of each result, so that -0.9
/// becomes 0. A result beyond the range of its type gives the nearest limit, one that is not a
/// number gives 0.
///
/// Nothing here fails. Degenerate input, such as a scale of zero on the way back, gives infinities
/// or NaN where nothing else is said.

#include <vorl/GUI/Rect2D.h>
#include <vorl/Platform/GdiFwd.h>
#include <vorl/export.h>

#include <cstdint>
#include <vector>

inline namespace vorl {

/// The interface that all maps of the plane share. A class of an application's own overrides the
/// four protected mappings; all others go through them.
class VORL_API Trafo2DBase {
 public:
  /// A point from A to B. The in-place form for vectors comes here too.
  virtual void pA2B(dVect2D& in, dVect2D& out);
  /// The two corners as points. The order of the corners is not restored where the map mirrors.
  virtual void rA2B(Rect2D& in, Rect2D& out);
  virtual void rB2A(Rect2D& in, Rect2D& out);

  /// Further forms of mapping a point from A to B.
  void pA2B(const dVect2D& in, dVect2D& out);
  void pA2B(dVect2D& point);
  void pA2B(double x, double y, double& xOut, double& yOut);
  void pA2B(double& x, double& y);
  void pA2B(long x, long y, long& xOut, long& yOut);
  void pA2B(long& x, long& y);
  void pA2B(std::int32_t x, std::int32_t y, std::int32_t& xOut, std::int32_t& yOut);
  void pA2B(std::int32_t& x, std::int32_t& y);
  void pA2B(const tagPOINT& in, tagPOINT& out);
  void pA2B(tagPOINT& point);

  /// A point from B to A.
  void pB2A(const dVect2D& in, dVect2D& out);
  void pB2A(dVect2D& point);
  void pB2A(double x, double y, double& xOut, double& yOut);
  void pB2A(double& x, double& y);
  void pB2A(long x, long y, long& xOut, long& yOut);
  void pB2A(long& x, long& y);
  void pB2A(std::int32_t x, std::int32_t y, std::int32_t& xOut, std::int32_t& yOut);
  void pB2A(std::int32_t& x, std::int32_t& y);
  void pB2A(const tagPOINT& in, tagPOINT& out);
  void pB2A(tagPOINT& point);

  /// A vector from A to B.
  void vA2B(const dVect2D& in, dVect2D& out);
  void vA2B(dVect2D& vector);
  void vA2B(double x, double y, double& xOut, double& yOut);
  void vA2B(double& x, double& y);
  void vA2B(long x, long y, long& xOut, long& yOut);
  void vA2B(long& x, long& y);
  void vA2B(std::int32_t x, std::int32_t y, std::int32_t& xOut, std::int32_t& yOut);
  void vA2B(std::int32_t& x, std::int32_t& y);
  void vA2B(const tagPOINT& in, tagPOINT& out);
  void vA2B(tagPOINT& vector);

  /// A vector from B to A.
  void vB2A(const dVect2D& in, dVect2D& out);
  void vB2A(dVect2D& vector);
  void vB2A(double x, double y, double& xOut, double& yOut);
  void vB2A(double& x, double& y);
  void vB2A(long x, long y, long& xOut, long& yOut);
  void vB2A(long& x, long& y);
  void vB2A(std::int32_t x, std::int32_t y, std::int32_t& xOut, std::int32_t& yOut);
  void vB2A(std::int32_t& x, std::int32_t& y);
  void vB2A(const tagPOINT& in, tagPOINT& out);
  void vB2A(tagPOINT& vector);

  /// Further forms of mapping a rectangle; integer rectangles map both corners as integer points.
  void rA2B(const Rect2D& in, Rect2D& out);
  void rA2B(Rect2D& rect);
  void rA2B(const tagRECT& in, tagRECT& out);
  void rA2B(tagRECT& rect);
  void rB2A(const Rect2D& in, Rect2D& out);
  void rB2A(Rect2D& rect);
  void rB2A(const tagRECT& in, tagRECT& out);
  void rB2A(tagRECT& rect);

 protected:
  Trafo2DBase();
  Trafo2DBase(const Trafo2DBase& source);
  Trafo2DBase& operator=(const Trafo2DBase& source);

  /// The four mappings that make a map. The outputs may be variables that the inputs came from.
  virtual void _pA2B(double x, double y, double& xOut, double& yOut) = 0;
  virtual void _pB2A(double x, double y, double& xOut, double& yOut) = 0;
  virtual void _vA2B(double x, double y, double& xOut, double& yOut) = 0;
  virtual void _vB2A(double x, double y, double& xOut, double& yOut) = 0;

 public:
  // Behind the mappings, which have the first places in the table of virtual functions.
  virtual ~Trafo2DBase();

 private:
  using Mapping = void (Trafo2DBase::*)(double, double, double&, double&);

  void Map(Mapping mapping, const dVect2D& in, dVect2D& out);
  void Map(Mapping mapping, const tagPOINT& in, tagPOINT& out);
  void Map(Mapping mapping, const tagRECT& in, tagRECT& out);
  template <typename Integer>
  void Map(Mapping mapping, Integer x, Integer y, Integer& xOut, Integer& yOut);
};

/// Moves points by a fixed way; vectors stay.
class VORL_API Translate2D : public Trafo2DBase {
 public:
  /// No way at all: the identity.
  Translate2D();
  Translate2D(double tx, double ty);
  /// As `Init`.
  Translate2D(double a1, double b1, double a2, double b2);
  Translate2D(const Translate2D& source);
  Translate2D& operator=(const Translate2D& source);
  ~Translate2D() override;

  /// The way that takes a1 to b1 in x, and a2 to b2 in y.
  void Init(double a1, double b1, double a2, double b2);
  double GetTx() const;
  double GetTy() const;

 protected:
  void _pA2B(double x, double y, double& xOut, double& yOut) override;
  void _pB2A(double x, double y, double& xOut, double& yOut) override;
  void _vA2B(double x, double y, double& xOut, double& yOut) override;
  void _vB2A(double x, double y, double& xOut, double& yOut) override;

 private:
  double m_tx = 0.0;
  double m_ty = 0.0;
};

/// Scales each direction about a fixed point: x in A is sx * x + ox in B.
class VORL_API Scale2D : public Trafo2DBase {
 public:
  /// The identity.
  Scale2D();
  /// As `Init` with the same arguments.
  Scale2D(double sx, double sy, double cx, double cy);
  Scale2D(const Scale2D& source);
  Scale2D& operator=(const Scale2D& source);
  ~Scale2D() override;

  /// Scales about (cx, cy), which keeps its place.
  void Init(double sx, double sy, double cx, double cy);
  /// Takes ax1 to bx1 and ax2 to bx2 in x, and ay1 to by1 and ay2 to by2 in y. Infinities or NaN
  /// when both values of A are the same.
  void Init(double ax1, double bx1, double ax2, double bx2, double ay1, double by1, double ay2,
            double by2);
  double GetSx() const;
  double GetSy() const;
  /// Where the origin of A lies in B.
  double GetOriginX() const;
  double GetOriginY() const;

 protected:
  void _pA2B(double x, double y, double& xOut, double& yOut) override;
  /// A point comes back unchanged in a direction whose scale is exactly 0.
  void _pB2A(double x, double y, double& xOut, double& yOut) override;
  void _vA2B(double x, double y, double& xOut, double& yOut) override;
  /// Divides by the scales, whatever they are: points alone are guarded against a scale of 0.
  void _vB2A(double x, double y, double& xOut, double& yOut) override;
  /// The coordinates of a point, one by one.
  virtual double _X_pA2B(double x);
  virtual double _X_pB2A(double x);
  virtual double _Y_pA2B(double y);
  virtual double _Y_pB2A(double y);

 private:
  double m_sx = 1.0;
  double m_sy = 1.0;
  double m_ox = 0.0;
  double m_oy = 0.0;
};

/// Rotates about a point, from x towards y. It rotates in the same sense in both directions: from B
/// to A it does what it does from A to B, and does not undo it. The inverse is a rotation by the
/// negated angle.
class VORL_API Rotate2D : public Trafo2DBase {
 public:
  /// Angle 0 about (0, 0): the identity.
  Rotate2D();
  /// As `InitRad`.
  Rotate2D(double angle, double cx, double cy);
  Rotate2D(const Rotate2D& source);
  Rotate2D& operator=(const Rotate2D& source);
  ~Rotate2D() override;

  /// Rotates about (cx, cy) by an angle in radians.
  void InitRad(double angle, double cx, double cy);
  /// The same in degrees, with pi taken as 3.1415926535.
  void InitDeg(double angle, double cx, double cy);
  double GetAngleRad() const;
  /// In degrees, with the same pi.
  double GetAngleDeg() const;
  /// The centre.
  double GetRx() const;
  double GetRy() const;

 protected:
  void _pA2B(double x, double y, double& xOut, double& yOut) override;
  void _pB2A(double x, double y, double& xOut, double& yOut) override;
  void _vA2B(double x, double y, double& xOut, double& yOut) override;
  void _vB2A(double x, double y, double& xOut, double& yOut) override;

 private:
  double m_angle = 0.0;
  double m_sin = 0.0;
  double m_cos = 1.0;
  double m_cx = 0.0;
  double m_cy = 0.0;
};

/// What `TrafoST2D` and `TrafoSRT2D` share: scales, a translation, and an anchor, that is a point
/// of A together with its place in B. Whatever else changes, the anchor keeps its place: the
/// translation follows.
class VORL_API AnchoredTrafo2D : public Trafo2DBase {
 public:
  ~AnchoredTrafo2D() override;

  /// Sets the scales; the anchor keeps its place.
  void SetScale(double sx, double sy);
  /// Multiplies the scales; the anchor keeps its place.
  void UpdateScale(double fx, double fy);
  /// Sets the translation. The anchor is the origin of A from now on, whose place is (tx, ty).
  void SetTranslation(double tx, double ty);
  /// Adds to the translation. The anchor is the origin of A from now on.
  void UpdateTranslation(double dx, double dy);
  /// The anchor is (ax, ay) of A from now on, and its place in B (bx, by).
  void SetTranslation(double ax, double ay, double bx, double by);

  /// Takes the point (ax1, ay1) of A to (bx1, by1) in B, which become the anchor, and (ax2, ay2) to
  /// (bx2, by2). Infinities or NaN when the points of A have the same x or the same y. A rotation
  /// stays: it turns the image of the second point about that of the first.
  void Set(double ax1, double ay1, double ax2, double ay2, double bx1, double by1, double bx2,
           double by2);
  /// Takes the rectangle a of A to the rectangle b of B: the same with their corners, which are
  /// taken as numbers (no half pixel is added).
  void Set(const Rect2D& a, const Rect2D& b);
  void Set(const tagRECT& a, const tagRECT& b);
  void Set(const Rect2D& a, const tagRECT& b);
  void Set(const tagRECT& a, const Rect2D& b);

  double GetSx() const;
  double GetSy() const;
  /// The translation, which follows from the anchor.
  double GetTx() const;
  double GetTy() const;

 protected:
  AnchoredTrafo2D();
  AnchoredTrafo2D(const AnchoredTrafo2D& source);
  AnchoredTrafo2D& operator=(const AnchoredTrafo2D& source);

  /// Scales 1, translation 0, anchor (0, 0) at (0, 0).
  void ResetScaleAndAnchor();
  /// Chooses the translation that takes the anchor to its place under the current mapping.
  void CalculateTranslation();

 private:
  double m_sx = 1.0;
  double m_sy = 1.0;
  double m_tx = 0.0;
  double m_ty = 0.0;
  double m_ax = 0.0;  ///< the anchor in A
  double m_ay = 0.0;
  double m_bx = 0.0;  ///< its place in B
  double m_by = 0.0;
};

/// Scales, then translates: x in A is sx * x + tx in B.
class VORL_API TrafoST2D : public AnchoredTrafo2D {
 public:
  /// The identity.
  TrafoST2D();
  TrafoST2D(const TrafoST2D& source);
  TrafoST2D& operator=(const TrafoST2D& source);
  ~TrafoST2D() override;

  /// The identity: scales 1, translation 0, the anchor (0, 0) at (0, 0).
  void Reset();

 protected:
  void _pA2B(double x, double y, double& xOut, double& yOut) override;
  void _pB2A(double x, double y, double& xOut, double& yOut) override;
  void _vA2B(double x, double y, double& xOut, double& yOut) override;
  void _vB2A(double x, double y, double& xOut, double& yOut) override;
};

/// Scales, then rotates, then translates. The rotation leads from y towards x, against the sense of
/// `Rotate2D`: (x, y) in A is (c sx x + s sy y + tx, c sy y - s sx x + ty) in B, with the sine s
/// and cosine c of the angle.
class VORL_API TrafoSRT2D : public AnchoredTrafo2D {
 public:
  /// The identity.
  TrafoSRT2D();
  TrafoSRT2D(const TrafoSRT2D& source);
  TrafoSRT2D& operator=(const TrafoSRT2D& source);
  ~TrafoSRT2D() override;

  /// The identity: scales 1, angle and translation 0, the anchor (0, 0) at (0, 0).
  void Reset();
  /// Sets the angle, in radians; the anchor keeps its place.
  void SetRotationRad(double angle);
  /// The same in degrees, with pi taken as 3.1415926535.
  void SetRotationDeg(double angle);
  /// Adds to the angle, in radians; the anchor keeps its place.
  void UpdateRotationRad(double angle);
  /// The same in degrees.
  void UpdateRotationDeg(double angle);
  double GetAngleRad() const;
  /// In degrees, with the same pi.
  double GetAngleDeg() const;

 protected:
  void _pA2B(double x, double y, double& xOut, double& yOut) override;
  void _pB2A(double x, double y, double& xOut, double& yOut) override;
  void _vA2B(double x, double y, double& xOut, double& yOut) override;
  void _vB2A(double x, double y, double& xOut, double& yOut) override;

 private:
  double m_angle = 0.0;
  double m_sin = 0.0;
  double m_cos = 1.0;
};

/// A chain: from A to B through its members in the order of their addition, from B to A back
/// through them from the last to the first. An empty chain is the identity.
///
/// The members stay the caller's and must live as long as the chain, or any copy of it, is used.
class VORL_API MultiTrafo2D : public Trafo2DBase {
 public:
  /// The empty chain.
  MultiTrafo2D();
  /// A chain of the same members. Empty when there is no memory for it.
  MultiTrafo2D(const MultiTrafo2D& source);
  /// The same; a member that is this chain, or leads back to it, is left out.
  MultiTrafo2D& operator=(const MultiTrafo2D& source);
  ~MultiTrafo2D() override;

  /// Appends a member; one may stand in a chain several times. False, with the chain unchanged, for
  /// null, for a chain that leads back to this one (it would never end), and when there is no
  /// memory.
  bool AddTransformation(Trafo2DBase* trafo);
  /// Empties the chain.
  void Reset();

 protected:
  void _pA2B(double x, double y, double& xOut, double& yOut) override;
  void _pB2A(double x, double y, double& xOut, double& yOut) override;
  void _vA2B(double x, double y, double& xOut, double& yOut) override;
  void _vB2A(double x, double y, double& xOut, double& yOut) override;

 private:
  /// The other map is this chain, or a chain that this one is part of.
  bool IsPartOf(Trafo2DBase* trafo) const;

  std::vector<Trafo2DBase*> m_members;
};

}  // namespace vorl

#endif
