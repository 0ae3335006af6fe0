#ifndef VORL_GUI_GEOM2D_H
#define VORL_GUI_GEOM2D_H

/// @file
/// Geometry of points, lines and planes: hit tests, clipping, intersections.
///
/// Nothing here fails. A question that has no answer, because a line has no direction, two lines
/// are parallel, or a number is infinite or none, gives false, with the outputs unchanged. Outputs
/// may be the very objects that are asked about.

#include <vorl/Data/dVect2D.h>
#include <vorl/Data/dVect3D.h>
#include <vorl/GUI/Rect2D.h>
#include <vorl/Platform/GdiFwd.h>
#include <vorl/export.h>

inline namespace vorl {

/// Questions about points and lines of the plane.
///
/// The hit tests measure true distances, not those along the axes, and count the tolerance itself
/// as a hit. Differences of coordinates are rounded to single precision; all else is computed in
/// double. The sign of a tolerance does not matter.
class VORL_API Geom2D {
 public:
  /// The distance of both points is at most `tolerance`.
  static bool IsPointOnPoint(const dVect2D& p, const dVect2D& q, double tolerance);
  static bool IsPointOnPoint(const tagPOINT& p, const tagPOINT& q, double tolerance);
  /// The distance from the infinite line through `pos` along `dir` is at most `tolerance`. The
  /// length of `dir` does not matter, but without any there is no line, and no hit.
  static bool IsPointOnLine(const dVect2D& p, const dVect2D& pos, const dVect2D& dir,
                            double tolerance);
  /// The point lies beside the segment from `a` to `b`, at a distance of at most `tolerance`. One
  /// beyond either end is not on it, even where the end itself is within the tolerance. Two equal
  /// ends are never hit.
  static bool IsPointOnLineSegment(const dVect2D& p, const dVect2D& a, const dVect2D& b,
                                   double tolerance);
  /// The distance from the outline of the rectangle is at most `tolerance`: beside one of its four
  /// edges, or near one of its corners. The inside does not count.
  static bool IsPointOnRect(const dVect2D& p, const Rect2D& rect, double tolerance);

  /// Cuts the piece out of an infinite line that lies in the rectangle, whose edges belong to it,
  /// whatever their order. `start` and `end` are in the direction of the line, and lie exactly on
  /// the edges where they are cut, so far as single precision holds these. False when the line
  /// misses the rectangle; one that touches a corner gives that corner twice.
  ///
  /// The line goes through `pos` at an angle in radians, from x towards y.
  static bool ClipLine(const dVect2D& pos, double angle, const tagRECT& rect, dVect2D& start,
                       dVect2D& end);
  /// The same for the line through `a` and `b`, from `a` towards `b`.
  ///
  /// Source: Y.-D. Liang and B. A. Barsky, "A New Concept and Method for Line Clipping", ACM
  /// Transactions on Graphics 3 (1984), here with a parameter that is bounded by the rectangle
  /// only.
  static bool ClipLine(const dVect2D& a, const dVect2D& b, const tagRECT& rect, dVect2D& start,
                       dVect2D& end);

  /// Where the infinite lines through a1 and a2, and through b1 and b2, meet. False when they are
  /// parallel, that is when the sine of the angle between them is at most 1e-6, or the point lies
  /// beyond single precision.
  static bool CalcIntersection(const dVect2D& a1, const dVect2D& a2, const dVect2D& b1,
                               const dVect2D& b2, dVect2D& point);
};

/// Questions about lines and planes of space. Directions and normals may have any length but zero.
class VORL_API Geom3D {
 public:
  /// Where the infinite line through `linePos` along `lineDir` meets the plane through `planePos`
  /// with the given normal. False when the line runs along the plane, that is when the sine of the
  /// angle between them is at most 1e-6, or the point lies beyond single precision.
  static bool LinePlaneIntersection(const dVect3D& linePos, const dVect3D& lineDir,
                                    const dVect3D& planePos, const dVect3D& planeNormal,
                                    dVect3D& point);
  /// The line that two planes share, each given by a point and a normal. `linePos` is the point of
  /// the line nearest to `pos1`; `lineDir` has the length 1 and the direction of normal1 x normal2.
  /// False when the planes are parallel, that is when the sine of the angle between them is at most
  /// 1e-6, or the line lies beyond single precision.
  static bool PlaneIntersection(const dVect3D& pos1, const dVect3D& normal1, const dVect3D& pos2,
                                const dVect3D& normal2, dVect3D& linePos, dVect3D& lineDir);
};

}  // namespace vorl

#endif
