#include <vorl/Common/detail/ClassRegistration.h>
#include <vorl/Data/dTrafo.h>
#include <vorl/Data/detail/Single.h>

inline namespace vorl {

namespace {

void Apply(const dVect3D m[3], const dVect3D& in, dVect3D& out) {
  const double x = in.x;
  const double y = in.y;
  const double z = in.z;
  out.Set(x * m[0].x + y * m[1].x + z * m[2].x,  //
          x * m[0].y + y * m[1].y + z * m[2].y,  //
          x * m[0].z + y * m[1].z + z * m[2].z);
}

void Apply(const dVect3D m[3], const dVect3D& translation, const dVect3D& in, dVect3D& out) {
  const double x = in.x;
  const double y = in.y;
  const double z = in.z;
  out.Set(x * m[0].x + y * m[1].x + z * m[2].x + translation.x,
          x * m[0].y + y * m[1].y + z * m[2].y + translation.y,
          x * m[0].z + y * m[1].z + z * m[2].z + translation.z);
}

/// The translation with which the matrix maps `from` to `to`: to - m * from.
dVect3D TranslationFor(const dVect3D m[3], const dVect3D& from, const dVect3D& to) {
  const double x = from.x;
  const double y = from.y;
  const double z = from.z;
  dVect3D translation;
  translation.Set(to.x - (x * m[0].x + y * m[1].x + z * m[2].x),
                  to.y - (x * m[0].y + y * m[1].y + z * m[2].y),
                  to.z - (x * m[0].z + y * m[1].z + z * m[2].z));
  return translation;
}

void SetIdentity(dVect3D m[3]) {
  m[0].Set(1.0, 0.0, 0.0);
  m[1].Set(0.0, 1.0, 0.0);
  m[2].Set(0.0, 0.0, 1.0);
}

}  // namespace

VORL_REGISTER_CLASS(dTrafo3D, DataBase);

dTrafo3D::dTrafo3D() = default;

dTrafo3D::dTrafo3D(const dTrafo3D& source) = default;

dTrafo3D::dTrafo3D(const dCoordSys3D& s, const dCoordSys3D& t) {
  Init(s, t);
}

dTrafo3D& dTrafo3D::operator=(const dTrafo3D& source) = default;

dTrafo3D::~dTrafo3D() = default;

void dTrafo3D::Reset() {
  SetIdentity(s2t);
  transS2T.Reset();
  SetIdentity(t2s);
  transT2S.Reset();
}

bool dTrafo3D::IsValid() {
  return true;
}

bool dTrafo3D::Init(const dCoordSys3D& s, const dCoordSys3D& t) {
  CalculateTransformation(s, t, s2t[0], s2t[1], s2t[2]);
  CalculateTransformation(t, s, t2s[0], t2s[1], t2s[2]);
  dVect3D world2t[3];  // stays zero when t is singular
  CalculateTransformation(dCoordSys3D(), t, world2t[0], world2t[1], world2t[2]);
  dVect3D sourceOrigin = s.origin - t.origin;
  Apply(world2t, sourceOrigin, sourceOrigin);
  SetTranslation(dVect3D(), sourceOrigin);
  return true;
}

void dTrafo3D::SetTranslation(const dVect3D& ps, const dVect3D& pt) {
  const dVect3D there = TranslationFor(s2t, ps, pt);
  transT2S = TranslationFor(t2s, pt, ps);
  transS2T = there;
}

bool dTrafo3D::InvertMatrix(dVect3D m[3]) {
  const double ax = m[0].x, ay = m[0].y, az = m[0].z;
  const double bx = m[1].x, by = m[1].y, bz = m[1].z;
  const double cx = m[2].x, cy = m[2].y, cz = m[2].z;
  const double determinant = ax * by * cz + bx * cy * az + cx * ay * bz  //
                             - cx * by * az - ax * cy * bz - bx * ay * cz;
  if (vorl_detail::NearZero(determinant)) {
    return false;
  }
  m[0].Set((by * cz - cy * bz) / determinant, (cy * az - ay * cz) / determinant,
           (ay * bz - by * az) / determinant);
  m[1].Set((cx * bz - bx * cz) / determinant, (ax * cz - cx * az) / determinant,
           (bx * az - ax * bz) / determinant);
  m[2].Set((bx * cy - cx * by) / determinant, (cx * ay - ax * cy) / determinant,
           (ax * by - bx * ay) / determinant);
  return true;
}

void dTrafo3D::CalculateTransformation(const dCoordSys3D& a, const dCoordSys3D& b, dVect3D& out0,
                                       dVect3D& out1, dVect3D& out2) {
  dVect3D world2b[3] = {b.axisX, b.axisY, b.axisZ};
  if (!InvertMatrix(world2b)) {
    Reset();
    return;
  }
  Apply(world2b, a.axisX, out0);
  Apply(world2b, a.axisY, out1);
  Apply(world2b, a.axisZ, out2);
}

void dTrafo3D::vS2T(const dVect3D& in, dVect3D& out) const {
  Apply(s2t, in, out);
}

void dTrafo3D::pS2T(const dVect3D& in, dVect3D& out) const {
  Apply(s2t, transS2T, in, out);
}

void dTrafo3D::vT2S(const dVect3D& in, dVect3D& out) const {
  Apply(t2s, in, out);
}

void dTrafo3D::pT2S(const dVect3D& in, dVect3D& out) const {
  Apply(t2s, transT2S, in, out);
}

void dTrafo3D::vS2T(dVect3D& v) const {
  vS2T(v, v);
}

void dTrafo3D::pS2T(dVect3D& p) const {
  pS2T(p, p);
}

void dTrafo3D::vT2S(dVect3D& v) const {
  vT2S(v, v);
}

void dTrafo3D::pT2S(dVect3D& p) const {
  pT2S(p, p);
}

}  // namespace vorl
