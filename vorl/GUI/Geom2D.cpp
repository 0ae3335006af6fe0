#include <vorl/GUI/Geom2D.h>

#include <algorithm>
#include <cmath>
#include <limits>
#include <utility>

#include <vorl/Data/detail/Single.h>
#include <vorl/Platform/Gdi.h>

inline namespace vorl {

using vorl_detail::Difference;
using vorl_detail::kNearZero;

namespace {

bool IsFinite(const dVect2D& v) {
  return std::isfinite(v.x) && std::isfinite(v.y);
}

/// The components of a vector, for tests that are made for each object under the mouse: every
/// vector is counted when it is made and when it goes, which takes longer than such a test.
struct Way {
  explicit Way(const dVect2D& v) : x(v.x), y(v.y) {}
  Way(const dVect2D& from, const dVect2D& to)
      : x(Difference(to.x, from.x)), y(Difference(to.y, from.y)) {}

  double Length2() const { return Product(*this); }
  double Product(const Way& other) const {
    return static_cast<double>(x) * other.x + static_cast<double>(y) * other.y;
  }

  float x;
  float y;
};

/// The rest of `r` that does not run along `dir`, squared, with the place t along it.
double Distance2Beside(const Way& r, const Way& dir, double t) {
  const double x = r.x - t * dir.x;
  const double y = r.y - t * dir.y;
  return x * x + y * y;
}

/// Where the foot of `r` on `dir` stands, in lengths of `dir`; NaN when it has none.
double PlaceAlong(const Way& r, const Way& dir) {
  return r.Product(dir) / dir.Length2();
}

/// A line through (x, y) along (dx, dy).
struct Line {
  double x;
  double y;
  double dx;
  double dy;
};

/// One direction of clipping: where a line, at `pos` with `step` per unit of its parameter t, lies
/// between two edges.
struct Slab {
  Slab(double posAt0, double stepPerT, double edge1, double edge2)
      : pos(posAt0),
        step(stepPerT),
        lowest(std::min(edge1, edge2)),
        highest(std::max(edge1, edge2)) {
    if (step != 0.0) {
      enter = ((step > 0.0 ? lowest : highest) - pos) / step;
      leave = ((step > 0.0 ? highest : lowest) - pos) / step;
    } else if (pos < lowest || pos > highest) {
      std::swap(enter, leave);  // nowhere
    }
  }

  /// The coordinate at t: exactly the edge's where the line is cut by it, and never outside.
  double At(double t) const {
    if (t == enter) {
      return step > 0.0 ? lowest : highest;
    }
    if (t == leave) {
      return step > 0.0 ? highest : lowest;
    }
    return std::clamp(pos + t * step, lowest, highest);
  }

  double pos;
  double step;
  double lowest;
  double highest;
  double enter = -std::numeric_limits<double>::infinity();
  double leave = std::numeric_limits<double>::infinity();
};

/// 1. Each direction bounds the parameter of the line by its two edges. 2. What lies within both
/// bounds is inside. 3. The ends take the coordinates of the edges that bound them.
bool Clip(const Line& line, const tagRECT& rect, dVect2D& start, dVect2D& end) {
  if (line.dx == 0.0 && line.dy == 0.0) {
    return false;
  }
  const Slab x(line.x, line.dx, rect.left, rect.right);
  const Slab y(line.y, line.dy, rect.top, rect.bottom);
  const double enter = std::max(x.enter, y.enter);
  const double leave = std::min(x.leave, y.leave);
  if (!(enter <= leave)) {
    return false;
  }
  start.Set(x.At(enter), y.At(enter));
  end.Set(x.At(leave), y.At(leave));
  return true;
}

}  // namespace

bool Geom2D::IsPointOnPoint(const dVect2D& p, const dVect2D& q, double tolerance) {
  return Way(p, q).Length2() <= tolerance * tolerance;
}

bool Geom2D::IsPointOnPoint(const tagPOINT& p, const tagPOINT& q, double tolerance) {
  // Not by way of vectors, which round the points themselves when they are far from the origin.
  dVect2D way;
  way.Set(static_cast<double>(q.x) - p.x, static_cast<double>(q.y) - p.y);
  return way.Length2() <= tolerance * tolerance;
}

bool Geom2D::IsPointOnLine(const dVect2D& p, const dVect2D& pos, const dVect2D& dir,
                           double tolerance) {
  const Way r(pos, p);
  const Way along(dir);
  // Without a direction the place is NaN, and so the distance, which is at most nothing then.
  return Distance2Beside(r, along, PlaceAlong(r, along)) <= tolerance * tolerance;
}

bool Geom2D::IsPointOnLineSegment(const dVect2D& p, const dVect2D& a, const dVect2D& b,
                                  double tolerance) {
  const Way d(a, b);
  const Way r(a, p);
  const double t = PlaceAlong(r, d);
  return t >= 0.0 && t <= 1.0 && Distance2Beside(r, d, t) <= tolerance * tolerance;
}

bool Geom2D::IsPointOnRect(const dVect2D& p, const Rect2D& rect, double tolerance) {
  const dVect2D corners[] = {rect.GetTL(), rect.GetTR(), rect.GetBR(), rect.GetBL()};
  for (int i = 0; i < 4; ++i) {
    if (IsPointOnPoint(p, corners[i], tolerance) ||
        IsPointOnLineSegment(p, corners[i], corners[(i + 1) % 4], tolerance)) {
      return true;
    }
  }
  return false;
}

bool Geom2D::ClipLine(const dVect2D& pos, double angle, const tagRECT& rect, dVect2D& start,
                      dVect2D& end) {
  if (!IsFinite(pos) || !std::isfinite(angle)) {
    return false;
  }
  return Clip({pos.x, pos.y, std::cos(angle), std::sin(angle)}, rect, start, end);
}

bool Geom2D::ClipLine(const dVect2D& a, const dVect2D& b, const tagRECT& rect, dVect2D& start,
                      dVect2D& end) {
  if (!IsFinite(a) || !IsFinite(b)) {
    return false;
  }
  const double ax = a.x;
  const double ay = a.y;
  return Clip({ax, ay, b.x - ax, b.y - ay}, rect, start, end);
}

bool Geom2D::CalcIntersection(const dVect2D& a1, const dVect2D& a2, const dVect2D& b1,
                              const dVect2D& b2, dVect2D& point) {
  const double ax = static_cast<double>(a2.x) - a1.x;
  const double ay = static_cast<double>(a2.y) - a1.y;
  const double bx = static_cast<double>(b2.x) - b1.x;
  const double by = static_cast<double>(b2.y) - b1.y;
  const double cross = ax * by - ay * bx;
  if (!(std::abs(cross) > kNearZero * std::hypot(ax, ay) * std::hypot(bx, by))) {
    return false;
  }
  const double rx = static_cast<double>(b1.x) - a1.x;
  const double ry = static_cast<double>(b1.y) - a1.y;
  const double t = (rx * by - ry * bx) / cross;
  dVect2D met;
  met.Set(a1.x + t * ax, a1.y + t * ay);
  if (!IsFinite(met)) {
    return false;
  }
  point = met;
  return true;
}

}  // namespace vorl
