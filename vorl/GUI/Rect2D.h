#ifndef VORL_GUI_RECT2D_H
#define VORL_GUI_RECT2D_H

/// @file
/// A rectangle of the plane.

#include <vorl/Data/dVect2D.h>
#include <vorl/Platform/GdiFwd.h>
#include <vorl/export.h>

inline namespace vorl {

/// Two corners in single precision, top left (x1, y1) and bottom right (x2, y2).
///
/// A rectangle is normalised when x2 >= x1 and y2 >= y1; it need not be, and keeps its order of
/// corners: width and height are negative then. Everything is computed in double precision and
/// rounded to single when it is stored; sizes that are returned stay double. Integer rectangles and
/// points are taken as numbers: no half pixel is added.
class VORL_API Rect2D {
 public:
  /// All zero.
  Rect2D();
  Rect2D(const Rect2D& source);
  /// The edges left, top, right and bottom become x1, y1, x2 and y2.
  Rect2D(const tagRECT& rect);
  Rect2D(const dVect2D& topLeft, const dVect2D& bottomRight);
  Rect2D(const tagPOINT& topLeft, const tagPOINT& bottomRight);
  Rect2D(float x1, float y1, float x2, float y2);
  Rect2D& operator=(const Rect2D& source);
  virtual ~Rect2D();

  /// All zero.
  void Reset();
  /// As the constructors with the same arguments.
  void Set(const Rect2D& source);
  void Set(const tagRECT& rect);
  void Set(const dVect2D& topLeft, const dVect2D& bottomRight);
  void Set(const tagPOINT& topLeft, const tagPOINT& bottomRight);
  void Set(float x1, float y1, float x2, float y2);
  /// Moves the top left corner to the point; the size stays.
  void SetPos(const dVect2D& topLeft);
  void SetPos(float x, float y);
  /// Adds to both corners.
  void Move(const dVect2D& way);
  void Move(float dx, float dy);

  /// x2 - x1, negative when the rectangle is not normalised.
  double Width() const;
  /// y2 - y1, likewise.
  double Height() const;
  /// (x1, y1). Each corner comes in two forms, one that returns it and one that fills a vector.
  dVect2D GetTL() const;
  void GetTL(dVect2D& corner) const;
  /// (x2, y1).
  dVect2D GetTR() const;
  void GetTR(dVect2D& corner) const;
  /// (x1, y2).
  dVect2D GetBL() const;
  void GetBL(dVect2D& corner) const;
  /// (x2, y2).
  dVect2D GetBR() const;
  void GetBR(dVect2D& corner) const;
  /// Halfway between the corners.
  dVect2D GetCenter() const;
  void GetCenter(dVect2D& center) const;
  /// The point at a fraction of the way across and down: (0, 0) gives the top left corner, (1, 1)
  /// the bottom right one. Fractions outside 0 to 1 lead outside.
  void GetRelativePos(float fx, float fy, dVect2D& pos) const;

  /// Multiplies the size; the centre keeps its place.
  void Scale(float factor);
  /// The same with a factor for each direction.
  void Scale(float factorX, float factorY);
  /// The same about the given point, which keeps its place: each corner v becomes
  /// v + (factor - 1) * (v - centre). A factor of 1 changes nothing.
  void Scale(float factorX, float factorY, const dVect2D& centre);

  /// x1 = x2 or y1 = y2.
  bool IsEmpty() const;
  /// Not empty.
  bool IsValid() const;
  /// x2 >= x1 and y2 >= y1.
  bool IsNormalized() const;
  /// Swaps x1 and x2 when x2 < x1, and y1 and y2 when y2 < y1.
  void Normalize();

  /// The point lies between the edges, or on one, whatever the order of the corners.
  bool IsInside(const dVect2D& point) const;
  bool IsInside(const tagPOINT& point) const;
  bool IsInside(float x, float y) const;
  /// Both corners of the other rectangle lie inside: it covers nothing outside of this one.
  bool IsInside(const Rect2D& other) const;

  /// Both corners are equal as vectors, that is to within 1e-6.
  bool operator==(const Rect2D& other) const;
  bool operator!=(const Rect2D& other) const;
  /// Equal to the rectangle built from these edges.
  bool operator==(const tagRECT& rect) const;
  bool operator!=(const tagRECT& rect) const;

  /// Becomes the overlap of both, whatever the order of their corners; this rectangle keeps its
  /// own: one that was not normalised is not afterwards. All zero when there is no overlap, also
  /// when the two only touch.
  Rect2D& operator&=(const Rect2D& other);
  Rect2D& operator&=(const tagRECT& rect);
  /// Becomes the bounding rectangle of both, in this rectangle's own order of corners. An empty
  /// rectangle counts with its position.
  Rect2D& operator|=(const Rect2D& other);
  Rect2D& operator|=(const tagRECT& rect);

 private:
  dVect2D m_topLeft;
  dVect2D m_bottomRight;
};

/// The overlap, in the first rectangle's order of corners (see `Rect2D::operator&=`).
VORL_API Rect2D operator&(const Rect2D& a, const Rect2D& b);
/// The bounding rectangle, likewise (see `Rect2D::operator|=`).
VORL_API Rect2D operator|(const Rect2D& a, const Rect2D& b);

}  // namespace vorl

#endif
