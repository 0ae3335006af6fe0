#include <vorl/Common/detail/ClassRegistration.h>
#include <vorl/Data/dTrafo.h>

inline namespace vorl {

namespace {

void Apply(const dVect2D m[2], const dVect2D& in, dVect2D& out) {
  const double x = in.x;
  const double y = in.y;
  out.Set(x * m[0].x + y * m[1].x, x * m[0].y + y * m[1].y);
}

void Apply(const dVect2D m[2], const dVect2D& translation, const dVect2D& in, dVect2D& out) {
  const double x = in.x;
  const double y = in.y;
  out.Set(x * m[0].x + y * m[1].x + translation.x, x * m[0].y + y * m[1].y + translation.y);
}

/// The translation with which the matrix maps `from` to `to`: to - m * from.
dVect2D TranslationFor(const dVect2D m[2], const dVect2D& from, const dVect2D& to) {
  const double x = from.x;
  const double y = from.y;
  dVect2D translation;
  translation.Set(to.x - (x * m[0].x + y * m[1].x), to.y - (x * m[0].y + y * m[1].y));
  return translation;
}

/// The coordinates of a vector in a system with orthogonal axes.
void Project(const dVect2D& v, const dCoordSys2D& system, dVect2D& out) {
  out.Set(v.Product(system.axisX) / system.axisX.Length2(),
          v.Product(system.axisY) / system.axisY.Length2());
}

void SetIdentity(dVect2D m[2]) {
  m[0].Set(1.0, 0.0);
  m[1].Set(0.0, 1.0);
}

}  // namespace

VORL_REGISTER_CLASS(dTrafo2D, DataBase);

dTrafo2D::dTrafo2D() = default;

dTrafo2D::dTrafo2D(const dTrafo2D& source) = default;

dTrafo2D::dTrafo2D(const dCoordSys2D& s, const dCoordSys2D& t) {
  Init(s, t);
}

dTrafo2D::dTrafo2D(const dCoordSys2D& s, const dCoordSys2D& t, const dVect2D& ps,
                   const dVect2D& pt) {
  Init(s, t, ps, pt);
}

dTrafo2D& dTrafo2D::operator=(const dTrafo2D& source) = default;

dTrafo2D::~dTrafo2D() = default;

void dTrafo2D::Reset() {
  SetIdentity(s2t);
  transS2T.Reset();
  SetIdentity(t2s);
  transT2S.Reset();
}

bool dTrafo2D::IsValid() {
  return true;
}

bool dTrafo2D::Init(const dCoordSys2D& s, const dCoordSys2D& t, const dVect2D& ps,
                    const dVect2D& pt) {
  const dVect2D sourcePoint(ps);  // the points may be vectors of this transform
  const dVect2D targetPoint(pt);
  Project(s.axisX, t, s2t[0]);
  Project(s.axisY, t, s2t[1]);
  Project(t.axisX, s, t2s[0]);
  Project(t.axisY, s, t2s[1]);
  SetTranslation(sourcePoint, targetPoint);
  return true;
}

bool dTrafo2D::Init(const dCoordSys2D& s, const dCoordSys2D& t) {
  const dVect2D zero;
  return Init(s, t, zero, zero);
}

void dTrafo2D::SetTranslation(const dVect2D& ps, const dVect2D& pt) {
  const dVect2D there = TranslationFor(s2t, ps, pt);
  transT2S = TranslationFor(t2s, pt, ps);
  transS2T = there;
}

void dTrafo2D::vS2T(const dVect2D& in, dVect2D& out) const {
  Apply(s2t, in, out);
}

void dTrafo2D::pS2T(const dVect2D& in, dVect2D& out) const {
  Apply(s2t, transS2T, in, out);
}

void dTrafo2D::vT2S(const dVect2D& in, dVect2D& out) const {
  Apply(t2s, in, out);
}

void dTrafo2D::pT2S(const dVect2D& in, dVect2D& out) const {
  Apply(t2s, transT2S, in, out);
}

void dTrafo2D::vS2T(dVect2D& v) const {
  vS2T(v, v);
}

void dTrafo2D::pS2T(dVect2D& p) const {
  pS2T(p, p);
}

void dTrafo2D::vT2S(dVect2D& v) const {
  vT2S(v, v);
}

void dTrafo2D::pT2S(dVect2D& p) const {
  pT2S(p, p);
}

}  // namespace vorl
